#include <new>

#include "capi/guard.h"
#include "capi/required_arrays.h"
#include "mixture/run_array.h"
#include "mixture/simplex_centroid_design.h"
#include "mixture/simplex_lattice_design.h"
#include "reisti/reisti.h"

extern "C" des_MixtureDesign* des_CreateMixtureDesignContainer() {
    auto* const design = new (std::nothrow) des_MixtureDesign{};
    if (design == nullptr) return nullptr;
    design->numComponents = 3;
    design->vertexReplicates = 1;
    design->centerReplicates = 1;
    design->axialReplicates = 1;
    design->designReplicates = 1;
    design->processFraction = 1;
    design->fractionIndex = 1;
    return design;
}

extern "C" std::int32_t des_RunSimplexCentroidDesign(des_MixtureDesign* design) {
    if (design == nullptr || !reisti::hasRequiredArrays(*design)) return des_ErrorNullPointer;
    return reisti::guard([design] {
        int error = 0;
        reisti::SimplexCentroidDesign(design).Calculate(error);
        return error;
    });
}

extern "C" std::int32_t des_RunSimplexLatticeDesign(des_MixtureDesign* design, std::int32_t degree,
                                                    std::uint8_t centerPoint) {
    if (design == nullptr) return des_ErrorNullPointer;
    if (!reisti::isLatticeDegreeAllowed(design->numComponents, degree)) return des_ErrorDegree;
    if (!reisti::hasRequiredArrays(*design)) return des_ErrorNullPointer;
    return reisti::guard([=] {
        int error = 0;
        reisti::SimplexLatticeDesign(design, degree, centerPoint != 0).Calculate(error);
        return error;
    });
}

extern "C" void des_DeleteMixtureDesignContainer(des_MixtureDesign** design) {
    if (design == nullptr || *design == nullptr) return;
    reisti::releaseRuns((*design)->runs, (*design)->numRuns);
    delete *design;
    *design = nullptr;
}
