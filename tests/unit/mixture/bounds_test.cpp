#include <cmath>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <limits>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "unit/mixture/expect_plain.h"

namespace reisti::test {
namespace {

using testing::DoubleNear;
using testing::Each;
using testing::ElementsAre;

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

MixtureRequest bounded(std::vector<double> lower, std::vector<double> upper, std::vector<double> amounts = {}) {
    MixtureRequest request;
    request.lowerBounds = std::move(lower);
    request.upperBounds = std::move(upper);
    request.amounts = std::move(amounts);
    return request;
}

TEST(Bounds, ZeroAndOneArePassedUnchanged) {
    const auto design = builtDesign(centroidRequest(3));
    EXPECT_EQ(design.code, des_Success);
    EXPECT_FALSE(design.boundsAdjusted);
    EXPECT_THAT(design.lowerBounds, Each(0.0));
    EXPECT_THAT(design.upperBounds, Each(1.0));
}

TEST(Bounds, UpperBoundsAreTightenedToWhatTheLowerOnesLeave) {
    const auto design = builtDesign(bounded({0.2, 0.1, 0.1}, {1, 1, 1}));
    EXPECT_EQ(design.code, des_Success);
    EXPECT_TRUE(design.boundsAdjusted);
    EXPECT_THAT(design.lowerBounds, ElementsAre(0.2, 0.1, 0.1));
    EXPECT_THAT(design.upperBounds,
                ElementsAre(DoubleNear(0.8, 1e-15), DoubleNear(0.7, 1e-15), DoubleNear(0.7, 1e-15)));
}

TEST(Bounds, RunsAreMappedIntoTheBoundedSimplex) {
    const auto mixtures = mixturesOf(builtDesign(bounded({0.2, 0.1, 0.1}, {1, 1, 1})));
    const auto near = [](double x) { return DoubleNear(x, 1e-15); };
    EXPECT_THAT(mixtures[0], ElementsAre(near(0.8), near(0.1), near(0.1)));
    EXPECT_THAT(mixtures[4], ElementsAre(near(0.5), near(0.1), near(0.4)));
    EXPECT_THAT(mixtures[6], ElementsAre(near(0.4), near(0.3), near(0.3)));
}

TEST(Bounds, PseudoComponentsRunFromZeroToOne) {
    const auto design = builtDesign(bounded({0.2, 0.1, 0.1}, {1, 1, 1}));
    EXPECT_THAT(design.pseudoLowerBounds, Each(0.0));
    EXPECT_THAT(design.pseudoUpperBounds, Each(DoubleNear(1.0, 1e-15)));
}

TEST(Bounds, TightenedUpperBoundsAlreadyGivenAreLeft) {
    const auto design = builtDesign(bounded({0.25, 0.125, 0.125}, {0.75, 0.625, 0.625}));
    EXPECT_EQ(design.code, des_Success);
    EXPECT_FALSE(design.boundsAdjusted);
    EXPECT_THAT(design.upperBounds, ElementsAre(0.75, 0.625, 0.625));
}

TEST(Bounds, OneLooseUpperBoundAloneIsTightened) {
    const auto design = builtDesign(bounded({0.25, 0.125, 0.125}, {0.75, 0.625, 0.875}));
    EXPECT_TRUE(design.boundsAdjusted);
    EXPECT_THAT(design.upperBounds, ElementsAre(0.75, 0.625, 0.625));
}

TEST(Bounds, OfTwoComponentsTightenEachOther) {
    const auto design = builtDesign(bounded({0.25, 0.125}, {0.625, 1}));
    EXPECT_EQ(design.code, des_Success);
    EXPECT_TRUE(design.boundsAdjusted);
    EXPECT_THAT(design.lowerBounds, ElementsAre(0.25, 0.375));
    EXPECT_THAT(design.upperBounds, ElementsAre(0.625, 0.75));
}

TEST(Bounds, LowerBoundIsTightenedFromTheUpperOneAsGiven) {
    // The second component's upper bound falls from 1 to 0.75 first; its lower bound still follows from the 1.
    const auto design = builtDesign(bounded({0.25, 0.125}, {0.5, 1}));
    EXPECT_EQ(design.code, des_Success);
    EXPECT_THAT(design.lowerBounds, ElementsAre(0.25, 0.5));
    EXPECT_THAT(design.upperBounds, ElementsAre(0.5, 0.75));
}

TEST(Bounds, AdjustedFlagOfAnEarlierRunIsCleared) {
    MixtureRecord record(centroidRequest(3));
    record->boundsAdjusted = 1;
    ASSERT_EQ(record.run(), des_Success);
    EXPECT_EQ(record->boundsAdjusted, 0);
}

TEST(Bounds, AdjustedFlagIsWrittenAsOne) {
    MixtureRecord record(bounded({0.2, 0.1, 0.1}, {1, 1, 1}));
    record->boundsAdjusted = 255;
    ASSERT_EQ(record.run(), des_Success);
    EXPECT_EQ(record->boundsAdjusted, 1);
}

TEST(Bounds, AreGivenInUnitsOfTheTotal) {
    const auto design = builtDesign(bounded({30, 0, 0}, {100, 100, 100}, {100}));
    EXPECT_EQ(design.code, des_Success);
    EXPECT_THAT(design.upperBounds, ElementsAre(100, DoubleNear(70, 1e-12), DoubleNear(70, 1e-12)));
    EXPECT_THAT(design.scaledUpperBounds, ElementsAre(1, DoubleNear(0.7, 1e-14), DoubleNear(0.7, 1e-14)));
    EXPECT_THAT(design.scaledLowerBounds, ElementsAre(DoubleNear(0.3, 1e-15), 0, 0));
}

TEST(Bounds, AreRestoredByMultiplyingWhatTheDivisionLeft) {
    const MixtureRequest request = bounded({0.1, 0.2, 0}, {7, 7, 7}, {7});
    const auto design = builtDesign(request);
    ASSERT_EQ(design.code, des_Success);
    for (std::size_t i = 0; i < 3; ++i)
        EXPECT_EQ(design.lowerBounds[i], request.lowerBounds[i] / 7.0 * 7.0);
}

struct RefusedCase {
    std::string name;
    MixtureRequest request;
    std::int32_t code;
};

struct AcceptedCase {
    std::string name;
    MixtureRequest request;
};

const std::vector<RefusedCase> REFUSED = {
    {"LowerSumIsOne", bounded({0.5, 0.25, 0.25}, {1, 1, 1}), des_ErrorLowerBoundSum},
    {"LowerSumIsAboveOne", bounded({0.5, 0.5, 0.25}, {1, 1, 1}), des_ErrorLowerBoundSum},
    {"LowerSumIsOneWithinTheTolerance", bounded({0.5, 0.25, 0.25 - 1e-13}, {1, 1, 1}), des_ErrorLowerBoundSum},
    {"LowerSumIsTheTotal", bounded({25, 15, 10}, {50, 50, 50}, {50}), des_ErrorLowerBoundSum},
    {"LowerSumComesBeforeTheUpperSum", bounded({0.5, 0.5, 0.5}, {0.1, 0.1, 0.1}), des_ErrorLowerBoundSum},
    {"LowerSumIsNotANumber", bounded({0, kNaN, 0}, {1, 1, 1}), des_ErrorLowerBoundSum},
    {"LowerSumIsInfinite", bounded({0, kInfinity, 0}, {1, 1, 1}), des_ErrorLowerBoundSum},
    {"LowerSumOfATotalOfZero", bounded({0, 0, 0}, {1, 1, 1}, {0}), des_ErrorLowerBoundSum},
    {"LowerSumOfATotalThatIsNotANumber", bounded({0, 0, 0}, {1, 1, 1}, {kNaN}), des_ErrorLowerBoundSum},
    {"UpperSumIsOne", bounded({0, 0, 0}, {0.5, 0.25, 0.25}), des_ErrorUpperBoundSum},
    {"UpperSumIsBelowOne", bounded({0, 0, 0}, {0.5, 0.25, 0.125}), des_ErrorUpperBoundSum},
    {"UpperSumIsOneWithinTheTolerance", bounded({0, 0, 0}, {0.5, 0.25, 0.25 + 1e-13}), des_ErrorUpperBoundSum},
    {"UpperSumIsTheTotal", bounded({0, 0, 0}, {25, 15, 10}, {50}), des_ErrorUpperBoundSum},
    {"UpperSumComesBeforeASingleUpperBound", bounded({0, 0, 0}, {1.5, -0.5, -0.5}), des_ErrorUpperBoundSum},
    {"UpperSumIsInfinite", bounded({0, 0, 0}, {1, kInfinity, 1}), des_ErrorUpperBoundSum},
    {"UpperSumOfANegativeTotal", bounded({0, 0, 0}, {1, 1, 1}, {-1}), des_ErrorUpperBoundSum},
    {"UpperSumOfAnInfiniteTotal", bounded({0, 0, 0}, {1, 1, 1}, {kInfinity}), des_ErrorUpperBoundSum},
    {"UpperSumOfOneComponent", bounded({0}, {1}), des_ErrorUpperBoundSum},
    {"UpperSumOfNoComponents", bounded({}, {}), des_ErrorUpperBoundSum},
    {"UpperBoundIsAboveOne", bounded({0, 0, 0}, {1.5, 1, 1}), des_ErrorUpperBound},
    {"UpperBoundOfTheLastComponentIsAboveOne", bounded({0, 0, 0}, {1, 1, 1.01}), des_ErrorUpperBound},
    {"UpperBoundIsAboveTheTotal", bounded({0, 0, 0}, {51, 50, 50}, {50}), des_ErrorUpperBound},
    {"UpperBoundOfTheFirstComponentIsNotANumber", bounded({0, 0, 0}, {kNaN, 1, 1}), des_ErrorUpperBound},
    {"UpperBoundOfOneComponentIsAboveOne", bounded({0}, {2}), des_ErrorUpperBound},
    // Tests run component by component: the first component's range is refused before the second's
    // upper bound is looked at.
    {"UpperBoundIsLookedAtAfterEarlierComponents", bounded({0.5, 0, 0}, {0.5, 2, 1}), des_ErrorEmptyRange},
    {"RangeIsZero", bounded({0, 0.5, 0}, {1, 0.5, 1}), des_ErrorEmptyRange},
    {"RangeIsNegative", bounded({0.5, 0, 0}, {0.25, 1, 1}), des_ErrorEmptyRange},
    {"RangeIsZeroAtZero", bounded({0, 0, 0}, {0, 1, 1}), des_ErrorEmptyRange},
    {"RangeOfTwoComponentsIsAtMostOneInAHundredThousand", bounded({0.5 - 4e-6, 0}, {0.5, 1}), des_ErrorEmptyRange},
    {"RangeOfATotal", bounded({20, 0, 0}, {20, 50, 50}, {50}), des_ErrorEmptyRange},
    {"NotASimplexWhenOneUpperBoundCutsACorner", bounded({0, 0, 0}, {0.5, 1, 1}), des_ErrorNotSimplex},
    {"NotASimplexWhenAllUpperBoundsCut", bounded({0, 0, 0}, {0.5, 0.5, 0.5}), des_ErrorNotSimplex},
    {"NotASimplexWhenTheLastUpperBoundCutsABoundedCorner", bounded({0.2, 0.2, 0.2}, {0.6, 0.6, 0.5}),
     des_ErrorNotSimplex},
    {"NotASimplexWhenRangesDifferThoughEachPairIsWide", bounded({0.2, 0.2, 0.2}, {0.52, 0.68, 0.72}),
     des_ErrorNotSimplex},
    {"NotASimplexWhenARangeDiffersBehindATightenedOne", bounded({0.2, 0.2, 0.2}, {0.68, 0.72, 0.52}),
     des_ErrorNotSimplex},
    {"NotASimplexWhenEqualRangesFallShortOfTheRoom",
     bounded({0.125, 0.125, 0.125, 0.125}, {0.575, 0.575, 0.575, 0.575}), des_ErrorNotSimplex},
    {"NotASimplexWhenALowerBoundIsNegative", bounded({-0.1, 0, 0}, {1, 1, 1}), des_ErrorNotSimplex},
    {"NotASimplexWhenALaterUpperBoundIsNotANumber", bounded({0, 0, 0}, {1, kNaN, 1}), des_ErrorNotSimplex},
    {"NotASimplexWhenTotalsAreGiven", bounded({10, 10, 10}, {26, 34, 36}, {50, 80}), des_ErrorNotSimplex},
};

const std::vector<AcceptedCase> ACCEPTED = {
    {"LowerSumIsBelowOneByLittle", bounded({0.5, 0.25, 0.25 - 1e-9}, {1, 1, 1})},
    {"UpperSumOfTwoComponentsIsAboveOneByLittle", bounded({0, 0}, {0.5, 0.501})},
    {"UpperBoundIsOneWithinTheTolerance", bounded({0, 0, 0}, {1 + 1e-13, 1, 1})},
    {"RangeOfTwoComponentsIsSlightlyAboveThat", bounded({0.5 - 6e-6, 0}, {0.5, 1})},
    {"SimplexOfThree", bounded({0.2, 0.1, 0.1}, {1, 1, 1})},
    {"SimplexOfATotal", bounded({30, 0, 0}, {100, 100, 100}, {100})},
    {"SimplexOfTwoTotals", bounded({3, 1, 1}, {10, 10, 10}, {10, 25})},
    {"SimplexOfTwo", bounded({0.25, 0.125}, {0.625, 1})},
    {"SimplexWithRoundingInItsUpperBounds", bounded({0.1, 0.2, 0.3}, {0.5, 0.6, 0.7})},
    {"SimplexWithAnUpperBoundOneUlpAboveOne", bounded({0, 0, 0}, {std::nextafter(1.0, 2.0), 1, 1})},
    {"SimplexOfATinyTotal", bounded({0, 0, 0}, {1e-200, 1e-200, 1e-200}, {1e-200})},
    {"SimplexOfALargeTotal", bounded({0, 0, 0}, {1e200, 1e200, 1e200}, {1e200})},
};

MixtureRequest asLattice(MixtureRequest request) {
    request.lattice = true;
    request.degree = 2;
    return request;
}

class RefusedBounds : public testing::TestWithParam<RefusedCase> {};

TEST_P(RefusedBounds, GiveTheirCode) {
    EXPECT_EQ(builtDesign(GetParam().request).code, GetParam().code);
}

TEST_P(RefusedBounds, GiveTheSameCodeForALattice) {
    EXPECT_EQ(builtDesign(asLattice(GetParam().request)).code, GetParam().code);
}

TEST_P(RefusedBounds, LeaveBoundsAndFlagAsThePlainCheckDoes) {
    EXPECT_TRUE(sameOutcome(builtDesign(GetParam().request), plainDesign(GetParam().request)));
}

TEST_P(RefusedBounds, LeaveRunsAndCountsUntouched) {
    MixtureRecord record(GetParam().request);
    des_MixtureRun theirs{};
    record->runs = &theirs;
    record->numRuns = 77;
    record->numCenterPoints = 78;
    record->numAxialPoints = 79;
    record.run();
    EXPECT_EQ(record->runs, &theirs);
    EXPECT_EQ(record->numRuns, 77U);
    EXPECT_EQ(record->numCenterPoints, 78U);
    EXPECT_EQ(record->numAxialPoints, 79U);
    record->runs = nullptr;
    record->numRuns = 0;
}

INSTANTIATE_TEST_SUITE_P(All, RefusedBounds, testing::ValuesIn(REFUSED),
                         [](const auto& instance) { return instance.param.name; });

class AcceptedBounds : public testing::TestWithParam<AcceptedCase> {};

TEST_P(AcceptedBounds, GiveThePlainDesign) {
    EXPECT_EQ(builtDesign(GetParam().request).code, des_Success);
    expectPlain(GetParam().request);
}

TEST_P(AcceptedBounds, GiveThePlainLattice) {
    EXPECT_EQ(builtDesign(asLattice(GetParam().request)).code, des_Success);
    expectPlain(asLattice(GetParam().request));
}

INSTANTIATE_TEST_SUITE_P(All, AcceptedBounds, testing::ValuesIn(ACCEPTED),
                         [](const auto& instance) { return instance.param.name; });

TEST(FailedBoundsCheck, LeavesTheBoundsDividedByTheTotal) {
    const auto design = builtDesign(bounded({25, 15, 10}, {50, 40, 30}, {50}));
    EXPECT_THAT(design.lowerBounds, ElementsAre(25.0 / 50, 15.0 / 50, 10.0 / 50));
    EXPECT_THAT(design.upperBounds, ElementsAre(50.0 / 50, 40.0 / 50, 30.0 / 50));
}

TEST(FailedBoundsCheck, LeavesTheBoundsTightenedSoFar) {
    // The first two components are tightened to a range of 0.5, the third has 0.375 only.
    const auto design = builtDesign(bounded({0.125, 0.125, 0.25}, {0.75, 0.875, 0.625}));
    EXPECT_EQ(design.code, des_ErrorNotSimplex);
    EXPECT_TRUE(design.boundsAdjusted);
    EXPECT_THAT(design.upperBounds, ElementsAre(0.625, 0.625, 0.625));
}

}  // namespace
}  // namespace reisti::test
