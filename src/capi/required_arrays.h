#ifndef REISTI_CAPI_REQUIRED_ARRAYS_H
#define REISTI_CAPI_REQUIRED_ARRAYS_H

#include <algorithm>
#include <array>

#include "reisti/reisti.h"

namespace reisti {

/// Whether every array that a run reads or writes is there. Arrays of no entries are never touched and may be null;
/// null replicates by type have a meaning of their own.
inline bool hasRequiredArrays(const des_MixtureDesign& design) {
    if (design.numAmounts != 0 && design.amounts == nullptr) return false;
    if (design.numComponents == 0) return true;
    const std::array<const void*, 8> arrays = {
        design.lowerBounds,       design.upperBounds,       design.scaledLowerBounds, design.scaledUpperBounds,
        design.pseudoLowerBounds, design.pseudoUpperBounds, design.pointsPerType,     design.boundaryCounts,
    };
    return std::ranges::none_of(arrays, [](const void* array) { return array == nullptr; });
}

}  // namespace reisti

#endif
