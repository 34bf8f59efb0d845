#ifndef REISTI_FUZZ_BASE_RUNS_H
#define REISTI_FUZZ_BASE_RUNS_H

#include <cstdint>

namespace fuzz {

/// Order of the smallest conference matrix that is documented for this number of factors; 0 where there is none.
inline std::uint32_t conferenceOrder(std::int64_t numFactors) {
    if (numFactors < 2) return 0;
    for (const std::uint32_t order : {6U, 8U, 10U, 12U, 14U, 16U, 18U, 20U, 24U, 26U, 30U, 32U, 38U, 42U, 44U, 48U})
        if (numFactors <= std::int64_t{order}) return order;
    return 0;
}

/// Runs of a screening design that is not replicated; 0 where there is none.
inline std::uint32_t countBaseRuns(std::int64_t numFactors, bool hasCategorical) {
    const std::uint32_t order = conferenceOrder(numFactors);
    return order == 0 ? 0 : 2 * order + (hasCategorical ? 2 : 1);
}

}  // namespace fuzz

#endif
