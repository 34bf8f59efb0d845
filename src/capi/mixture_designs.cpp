#include <algorithm>
#include <array>
#include <new>

#include "capi/guard.h"
#include "mixture/run_array.h"
#include "mixture/simplex_centroid_design.h"
#include "mixture/simplex_lattice_design.h"
#include "reisti/reisti.h"

namespace {

/// Whether every array that a run reads or writes is there. Arrays of no entries are never touched and may be null;
/// null replicates by type have a meaning of their own.
bool hasRequiredArrays(const des_MixtureDesign& design) {
    if (design.numAmounts != 0 && design.amounts == nullptr) return false;
    if (design.numComponents == 0) return true;
    const std::array<const void*, 8> arrays = {
        design.lowerBounds,       design.upperBounds,       design.scaledLowerBounds, design.scaledUpperBounds,
        design.pseudoLowerBounds, design.pseudoUpperBounds, design.pointsPerType,     design.boundaryCounts,
    };
    return std::ranges::none_of(arrays, [](const void* array) { return array == nullptr; });
}

}  // namespace

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
    if (design == nullptr || !hasRequiredArrays(*design)) return des_ErrorNullPointer;
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
    if (!hasRequiredArrays(*design)) return des_ErrorNullPointer;
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
