#ifndef REISTI_TESTS_UNIT_MIXTURE_EXPECT_PLAIN_H
#define REISTI_TESTS_UNIT_MIXTURE_EXPECT_PLAIN_H

#include <cstdint>
#include <gtest/gtest.h>
#include <vector>

#include "support/mixture_record.h"
#include "support/plain_mixture.h"

namespace reisti::test {

/// Bit for bit what the plain formulation gives.
inline void expectPlain(const MixtureRequest& request) {
    EXPECT_TRUE(sameOutcome(builtDesign(request), plainDesign(request)));
}

inline std::vector<std::vector<double>> mixturesOf(const MixtureOutcome& design) {
    std::vector<std::vector<double>> mixtures;
    for (const auto& run : design.runs)
        mixtures.push_back(run.proportions);
    return mixtures;
}

inline std::vector<std::int32_t> typesOf(const MixtureOutcome& design) {
    std::vector<std::int32_t> types;
    for (const auto& run : design.runs)
        types.push_back(run.pointType);
    return types;
}

inline std::vector<std::uint32_t> ordersOf(const MixtureOutcome& design) {
    std::vector<std::uint32_t> orders;
    for (const auto& run : design.runs)
        orders.push_back(run.runOrder);
    return orders;
}

inline std::vector<double> amountsOf(const MixtureOutcome& design) {
    std::vector<double> amounts;
    for (const auto& run : design.runs)
        amounts.push_back(run.amount);
    return amounts;
}

/// 1, 2, .. count.
inline std::vector<std::uint32_t> standardOrder(std::size_t count) {
    std::vector<std::uint32_t> order(count);
    for (std::size_t i = 0; i < count; ++i)
        order[i] = static_cast<std::uint32_t>(i + 1);
    return order;
}

}  // namespace reisti::test

#endif
