#include "util/math_routines.h"

#include <climits>
#include <cmath>
#include <gtest/gtest.h>
#include <limits>
#include <string>

#include "support/plain_matrix.h"
#include "support/scale.h"

namespace reisti::test {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kLargest = std::numeric_limits<double>::max();
const double kNaN = std::numeric_limits<double>::quiet_NaN();

static_assert(MAX_EXPONENT == 709.7827128933839, "known before any object is initialized");

TEST(MaxExponent, IsTheLargestArgumentBelowTheLogarithmOfTheLargestNumber) {
    EXPECT_EQ(MAX_EXPONENT, std::nextafter(709.782712893384, 0.0));
    EXPECT_TRUE(std::isfinite(std::exp(MAX_EXPONENT)));
}

struct Comparison {
    const char* name;
    double a;
    double b;
    double tolerance;  ///< fuzz or scale
    int expected;
};

std::string nameOf(const testing::TestParamInfo<Comparison>& caseInfo) {
    return caseInfo.param.name;
}

class CompareWithFuzz : public testing::TestWithParam<Comparison> {};

TEST_P(CompareWithFuzz, OrdersThePair) {
    const Comparison& c = GetParam();
    EXPECT_EQ(mCompareWithFuzz(c.a, c.b, 0.0, c.tolerance), c.expected);
}

TEST_P(CompareWithFuzz, IgnoresItsThirdArgument) {
    const Comparison& c = GetParam();
    for (const double ignored : {1.0, -1e300, kInfinity, kNaN})
        EXPECT_EQ(mCompareWithFuzz(c.a, c.b, ignored, c.tolerance), c.expected);
}

INSTANTIATE_TEST_SUITE_P(
    Cases, CompareWithFuzz,
    testing::Values(Comparison{"NearlyEqual", 1.0, 1.0 + 1e-13, 1e-12, 0}, Comparison{"Smaller", 1.0, 1.1, 1e-12, -1},
                    Comparison{"Greater", 1.1, 1.0, 1e-12, 1}, Comparison{"BothZero", 0.0, 0.0, 0.0, 0},
                    Comparison{"ZerosOfBothSigns", 0.0, -0.0, 0.0, 0}, Comparison{"ExactGreater", 2.0, 1.0, 0.0, 1},
                    Comparison{"ExactSmaller", 1.0, std::nextafter(1.0, 2.0), 0.0, -1},
                    Comparison{"ExactEqual", 3.0, 3.0, 0.0, 0},
                    Comparison{"DifferenceAtTheToleranceIsEqual", 1.0, 2.0, 0.5, 0},
                    Comparison{"DifferenceJustAboveTheTolerance", 1.0, 2.0, 0.49, -1},
                    Comparison{"LargerMagnitudeSetsTheTolerance", -2.0, -1.0, 0.5, 0},
                    Comparison{"NegativeNumbersAreOrderedByValue", -2.0, -1.0, 0.1, -1},
                    Comparison{"OppositeSigns", -1e-20, 1e-20, 1e-12, -1},
                    Comparison{"ZeroAndTinyDiffer", 0.0, 1e-300, 1e-12, -1},
                    Comparison{"TinyAndZeroDiffer", 1e-300, 0.0, 1e-12, 1},
                    Comparison{"InfinityIsWithinItsOwnFuzz", kInfinity, 1.0, 1e-12, 0},
                    Comparison{"EqualInfinitiesHaveNoDifference", kInfinity, kInfinity, 1e-12, 1},
                    Comparison{"NaNOnTheLeft", kNaN, 1.0, 1e-12, 1}, Comparison{"NaNOnTheRight", 1.0, kNaN, 1e-12, 1}),
    nameOf);

TEST(TransferSign, TakesTheMagnitudeFromTheFirstAndTheSignBitFromTheSecond) {
    EXPECT_EQ(mTransferSign(3.0, 5.0), 3.0);
    EXPECT_EQ(mTransferSign(3.0, -5.0), -3.0);
    EXPECT_EQ(mTransferSign(-3.0, 5.0), 3.0);
    EXPECT_EQ(mTransferSign(-3.0, -5.0), -3.0);
    EXPECT_EQ(mTransferSign(3.0, 0.0), 3.0);
    EXPECT_EQ(mTransferSign(3.0, -0.0), -3.0);
    EXPECT_TRUE(std::signbit(mTransferSign(0.0, -1.0)));
    EXPECT_FALSE(std::signbit(mTransferSign(-0.0, 1.0)));
    EXPECT_EQ(mTransferSign(-kInfinity, 1.0), kInfinity);
    EXPECT_EQ(mTransferSign(2.0, std::copysign(kNaN, -1.0)), -2.0);
}

TEST(FuzzMax, IsAFixedShareOfItsArgument) {
    for (const double x : {0.0, 1.0, -1.0, 3.7, 1e300, -1e-300})
        EXPECT_EQ(getFuzzMax(x), x * 1e-14);
}

class EqualWithinFuzz : public testing::TestWithParam<Comparison> {};

TEST_P(EqualWithinFuzz, OrdersThePair) {
    const Comparison& c = GetParam();
    EXPECT_EQ(equalWithinFuzz(c.a, c.b, c.tolerance), c.expected);
}

INSTANTIATE_TEST_SUITE_P(
    Cases, EqualWithinFuzz,
    testing::Values(Comparison{"BelowTheFloor", 0.0, 1e-31, 0.0, 0}, Comparison{"AboveTheFloor", 0.0, 1e-29, 0.0, -1},
                    Comparison{"AboveTheFloorOnTheLeft", 1e-29, 0.0, 0.0, 1},
                    Comparison{"AtTheFloor", 0.0, 1e-30, 0.0, 0}, Comparison{"BothZero", 0.0, 0.0, 0.0, 0},
                    Comparison{"FloorAroundZeroHasBothSigns", -4e-31, 4e-31, 0.0, 0},
                    Comparison{"RelativePart", 1.0, 1.0 + 9e-13, 0.0, 0},
                    Comparison{"BeyondTheRelativePart", 1.0, 1.0 + 1.1e-12, 0.0, -1},
                    Comparison{"RelativePartFollowsTheLargerMagnitude", -1e6, -1e6 - 9e-7, 0.0, 0},
                    Comparison{"GreaterBeyondTheRelativePart", 1.0 + 1.1e-12, 1.0, 0.0, 1},
                    Comparison{"ScaleReplacesTheFloor", 0.0, 1e-31, 1e-20, -1},
                    Comparison{"ScaleWidensTheTolerance", 0.0, 9e-15, 1.0, 0},
                    Comparison{"BeyondTheScale", 0.0, 1.1e-14, 1.0, -1},
                    Comparison{"ScaleAndRelativePartAdd", 1.0, 1.0 + 1.9e-12, 100.0, 0},
                    Comparison{"BeyondBothParts", 1.0, 1.0 + 2.1e-12, 100.0, -1},
                    Comparison{"NegativeScaleNarrows", 0.0, 0.0, -1.0, 1},
                    Comparison{"NegativeZeroScaleIsZero", 0.0, 1e-31, -0.0, 0},
                    Comparison{"NaNOnTheLeft", kNaN, 1.0, 0.0, 1}, Comparison{"NaNOnTheRight", 1.0, kNaN, 0.0, 1},
                    Comparison{"BothNaN", kNaN, kNaN, 0.0, 1}, Comparison{"InfinityAndFinite", kInfinity, 1.0, 0.0, 0}),
    nameOf);

/// The Lanczos series as it has to be summed: smallest terms first.
double plainLogGamma(double x) {
    if (x == 1.0 || x == 2.0) return 0.0;
    const double coefficients[] = {1.659470187408462e-7, 9.934937113930748e-6, -0.1385710331296526, 12.50734324009056,
                                   -176.6150291498386,   771.3234287757674,    -1259.139216722289,  676.5203681218835};
    double sum = 0.0;
    double denominator = x + 7.0;
    for (const double coefficient : coefficients) {
        sum += coefficient / denominator;
        denominator -= 1.0;
    }
    sum += 0.9999999999995183;
    return std::log(sum) + 0.9189385332046727 - (x + 6.5) + (x - 0.5) * std::log(x + 6.5);
}

TEST(LogGamma, IsExactlyZeroAtOneAndTwo) {
    EXPECT_TRUE(sameBits(LogGamma(1.0), 0.0));
    EXPECT_TRUE(sameBits(LogGamma(2.0), 0.0));
}

TEST(LogGamma, IsTheLogarithmOfAFactorial) {
    EXPECT_NEAR(LogGamma(5.0), std::log(24.0), 1e-14 * std::log(24.0));
    double logFactorial = 0.0;
    for (int n = 3; n <= 170; ++n) {
        logFactorial += std::log(static_cast<double>(n - 1));
        EXPECT_NEAR(LogGamma(n), logFactorial, 1e-12 + 1e-13 * logFactorial) << n;
    }
}

TEST(LogGamma, IsAccurateBetweenWholeNumbers) {
    EXPECT_NEAR(LogGamma(0.5), 0.5 * std::log(3.14159265358979323846), 1e-12);
    for (double x = 0.05; x < 200.0; x += 0.37)
        EXPECT_NEAR(LogGamma(x), std::lgamma(x), 2e-12 * (1.0 + x)) << x;
}

TEST(LogGamma, HasTheBitsOfItsSeries) {
    UniformNumbers random(1);
    for (int n = 3; n < 400; ++n)
        EXPECT_TRUE(sameBits(LogGamma(n), plainLogGamma(n))) << n;
    for (int trial = 0; trial < scaled(20000); ++trial) {
        const double x = random.between(1e-6, random.integer(1, 100000));
        ASSERT_TRUE(sameBits(LogGamma(x), plainLogGamma(x))) << x;
    }
}

TEST(LogGamma, AnswersOutsideItsDomainToo) {
    for (const double x : {0.0, -0.0, -0.5, -1.0, -2.0, -6.0, -6.5, -7.0, -100.0, kInfinity, -kInfinity, kNaN})
        EXPECT_TRUE(sameBits(LogGamma(x), plainLogGamma(x))) << x;
}

TEST(LogNChooseK, OfNothingIsZeroWhateverTheSubset) {
    for (const int k : {0, 3, -3, INT_MAX, INT_MIN})
        EXPECT_TRUE(sameBits(LogNChooseK(0, k), 0.0)) << k;
}

TEST(LogNChooseK, OfTheTrivialSubsetsIsZero) {
    for (const int n : {1, 2, 5, 30, 1000}) {
        EXPECT_NEAR(LogNChooseK(n, 0), 0.0, 1e-12);
        EXPECT_NEAR(LogNChooseK(n, n), 0.0, 1e-12);
    }
}

double plainLogFactorial(int m) {
    return m == 0 || m == 1 ? 0.0 : plainLogGamma(m + 1.0);
}

double plainLogCount(int n, int k) {
    if (n == 0) return 0.0;
    return (plainLogFactorial(n) - plainLogFactorial(k)) - plainLogFactorial(n - k);
}

TEST(LogNChooseK, SubtractsTheLogarithmsInOrder) {
    for (int n = 0; n <= 60; ++n)
        for (int k = -3; k <= n + 3; ++k)
            EXPECT_TRUE(sameBits(LogNChooseK(n, k), plainLogCount(n, k))) << n << ", " << k;
}

TEST(Exponential, IsClampedBeyondTheLargestArgument) {
    EXPECT_EQ(Exponential(710.0), kLargest);
    EXPECT_EQ(Exponential(-710.0), 0.0);
    EXPECT_EQ(Exponential(kInfinity), kLargest);
    EXPECT_EQ(Exponential(-kInfinity), 0.0);
}

TEST(Exponential, IsTheFunctionUpToTheLargestArgument) {
    EXPECT_EQ(Exponential(1.0), std::exp(1.0));
    EXPECT_EQ(Exponential(0.0), 1.0);
    EXPECT_EQ(Exponential(MAX_EXPONENT), std::exp(MAX_EXPONENT));
    EXPECT_EQ(Exponential(-MAX_EXPONENT), std::exp(-MAX_EXPONENT));
    EXPECT_EQ(Exponential(std::nextafter(MAX_EXPONENT, 1e9)), kLargest);
    EXPECT_EQ(Exponential(std::nextafter(-MAX_EXPONENT, -1e9)), 0.0);
    EXPECT_TRUE(std::isnan(Exponential(kNaN)));
}

/// The count by its formula with a safe conversion at the end.
int plainCount(int n, int k) {
    const double logarithm = plainLogCount(n, k);
    double value = std::exp(logarithm) + 0.5;
    if (logarithm > MAX_EXPONENT) value = kLargest;
    if (logarithm < -MAX_EXPONENT) value = 0.5;
    value = std::floor(value);
    if (std::isnan(value)) return 0;
    return value > 2147483647.0 ? INT_MAX : static_cast<int>(value);
}

TEST(NChooseK, CountsSubsets) {
    EXPECT_EQ(NChooseK(5, 2), 10);
    EXPECT_EQ(NChooseK(10, 5), 252);
    EXPECT_EQ(NChooseK(33, 16), 1166803110);
    for (int n = 0; n <= 3000; ++n) {
        ASSERT_EQ(NChooseK(n, 0), 1) << n;
        ASSERT_EQ(NChooseK(n, n), 1) << n;
    }
}

TEST(NChooseK, IsExactForEveryCountThatFitsUpToThreeThousand) {
    for (int n = 1; n <= 3000; ++n) {
        long long exact = 1;
        for (int k = 1; k <= n; ++k) {
            exact = exact * (n - k + 1) / k;
            if (exact > INT_MAX) break;
            ASSERT_EQ(NChooseK(n, k), exact) << n << ", " << k;
            ASSERT_EQ(NChooseK(n, n - k), exact) << n << ", " << n - k;
        }
    }
}

TEST(NChooseK, SaturatesWhereTheCountDoesNotFit) {
    EXPECT_EQ(NChooseK(34, 17), INT_MAX);
    EXPECT_EQ(NChooseK(100, 50), INT_MAX);
    EXPECT_EQ(NChooseK(2000, 1000), INT_MAX);
    EXPECT_EQ(NChooseK(1000000, 500000), INT_MAX);
}

TEST(NChooseK, KeepsItsFormulaOutsideItsDomain) {
    EXPECT_EQ(NChooseK(0, 3), 1);
    EXPECT_EQ(NChooseK(0, -3), 1);
    EXPECT_EQ(NChooseK(3, 4), 0);
    EXPECT_EQ(NChooseK(3, 5), 0);
    EXPECT_EQ(NChooseK(5, -1), 0);
    EXPECT_EQ(NChooseK(5, -2), 0);
    for (int n = -12; n <= 40; ++n)
        for (int k = -12; k <= 45; ++k)
            EXPECT_EQ(NChooseK(n, k), plainCount(n, k)) << n << ", " << k;
}

TEST(NChooseK, HasNoOverflowOfItsOwnAtTheEndsOfTheRange) {
    EXPECT_NEAR(NChooseK(INT_MAX, 1), 2147483647.0, 1e-3 * 2147483647.0);
    EXPECT_EQ(NChooseK(INT_MAX, INT_MAX), 1);
    EXPECT_EQ(NChooseK(5, INT_MIN), 0);
    EXPECT_EQ(NChooseK(5, INT_MAX), 0);
    EXPECT_EQ(NChooseK(INT_MIN, 5), 0);
    EXPECT_EQ(NChooseK(INT_MIN, INT_MAX), 0);
}

}  // namespace
}  // namespace reisti::test
