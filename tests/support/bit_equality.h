// Comparison of results whose order of evaluation is fixed: nothing but the same bits will do.
#ifndef REISTI_TESTS_SUPPORT_BIT_EQUALITY_H
#define REISTI_TESTS_SUPPORT_BIT_EQUALITY_H

#include <bit>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <vector>

namespace reisti::test {

/// Equal including the sign of zero. All NaNs are one: which operand's NaN an operation passes on is the processor's
/// choice.
inline bool hasSameBits(double a, double b) {
    if (std::isnan(a) || std::isnan(b)) return std::isnan(a) && std::isnan(b);
    return std::bit_cast<std::uint64_t>(a) == std::bit_cast<std::uint64_t>(b);
}

/// Names the first difference.
inline testing::AssertionResult haveSameBits(const std::vector<double>& actual, const std::vector<double>& expected) {
    if (actual.size() != expected.size()) {
        return testing::AssertionFailure() << actual.size() << " values, expected " << expected.size();
    }
    for (std::size_t i = 0; i < actual.size(); ++i) {
        if (!hasSameBits(actual[i], expected[i])) {
            return testing::AssertionFailure() << "value " << i << " is " << testing::PrintToString(actual[i])
                                               << ", expected " << testing::PrintToString(expected[i]);
        }
    }
    return testing::AssertionSuccess();
}

}  // namespace reisti::test

#endif
