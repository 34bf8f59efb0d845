#include "mixture_request.h"
#include "require.h"

namespace {

using fuzz::require;

void checkDefaults(const des_MixtureDesign& design) {
    require(design.numComponents == 3 && design.vertexReplicates == 1 && design.centerReplicates == 1 &&
                design.axialReplicates == 1 && design.designReplicates == 1 && design.processFraction == 1 &&
                design.fractionIndex == 1,
            "a container holds 3 components and counts of 1");
    require(design.numProcessVariables == 0 && design.numAmounts == 0 && design.outputUnits == des_UnitsAmount &&
                design.axialPoints == 0 && design.randomize == 0 && design.seed == 0.0,
            "a container asks for nothing else");
    require(design.lowerBounds == nullptr && design.upperBounds == nullptr && design.typeReplicates == nullptr &&
                design.amounts == nullptr && design.runs == nullptr && design.numRuns == 0,
            "a container has no arrays");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider bytes(data, size);
    des_DeleteMixtureDesignContainer(nullptr);
    des_MixtureDesign* design = nullptr;
    des_DeleteMixtureDesignContainer(&design);
    require(design == nullptr, "deleting nothing does nothing");

    design = des_CreateMixtureDesignContainer();
    require(design != nullptr, "a container is created while there is memory");
    checkDefaults(*design);
    // Whatever a caller writes into its fields but `runs` and `numRuns`, nothing of it is freed.
    const fuzz::MixtureRequest request = fuzz::drawMixtureRequest(bytes, bytes.ConsumeIntegralInRange(0U, 12U));
    *design = request.inputs;
    design->lowerBounds = const_cast<double*>(request.lowerBounds.data());
    design->amounts = request.amounts.data();
    design->numAmounts = bytes.ConsumeIntegral<std::uint32_t>();
    design->numComponents = bytes.ConsumeIntegral<std::uint32_t>();
    // Without arrays a run is refused, and the container stays what it was.
    if (bytes.ConsumeBool()) {
        design->upperBounds = nullptr;
        if (design->numComponents != 0)
            require(des_RunSimplexCentroidDesign(design) == des_ErrorNullPointer, "required arrays are asked for");
        require(design->runs == nullptr && design->numRuns == 0, "a refused run makes no runs");
    }
    des_DeleteMixtureDesignContainer(&design);
    require(design == nullptr, "deleting sets the caller's pointer to null");
    des_DeleteMixtureDesignContainer(&design);
    return 0;
}
