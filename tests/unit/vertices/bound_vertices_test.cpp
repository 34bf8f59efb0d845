// The vertices that bounds alone leave, called below the C interface so that no earlier check touches the bounds.
#include <cmath>
#include <gtest/gtest.h>
#include <set>
#include <vector>

#include "support/vertex_engine.h"

namespace reisti::test {
namespace {

PlainRegion region(std::vector<double> lower, std::vector<double> upper) {
    PlainRegion made;
    made.lower = std::move(lower);
    made.upper = std::move(upper);
    return made;
}

TEST(BoundVertices, TheWholeSimplexHasTheUnitVectorsInTheOrderOfTheBoundCombinations) {
    const auto found = enumerated(region({0, 0, 0}, {1, 1, 1}));
    EXPECT_TRUE(sameTable(found.points, {{0, 0, 1}, {1, 0, 0}, {0, 1, 0}}));
}

class SimplexOfManyComponents : public testing::TestWithParam<std::size_t> {};

TEST_P(SimplexOfManyComponents, HasItsCorners) {
    const std::size_t q = GetParam();
    const auto found = enumerated(region(std::vector<double>(q, 0.0), std::vector<double>(q, 1.0)));
    EXPECT_EQ(found.numVertices, q);
    std::set<std::vector<double>> unitVectors;
    for (std::size_t j = 0; j < q; ++j) {
        std::vector<double> x(q, 0.0);
        x[j] = 1.0;
        unitVectors.insert(x);
    }
    EXPECT_EQ(std::set<std::vector<double>>(found.points.begin(), found.points.end()), unitVectors);
}

TEST_P(SimplexOfManyComponents, HalfCutOffHasTheMiddlesOfItsEdges) {
    const std::size_t q = GetParam();
    const auto found = enumerated(region(std::vector<double>(q, 0.0), std::vector<double>(q, 0.5)));
    EXPECT_EQ(found.numVertices, q * (q - 1) / 2);
    std::set<std::vector<double>> middles;
    for (std::size_t j = 0; j < q; ++j) {
        for (std::size_t k = 0; k < j; ++k) {
            std::vector<double> x(q, 0.0);
            x[j] = x[k] = 0.5;
            middles.insert(x);
        }
    }
    EXPECT_EQ(std::set<std::vector<double>>(found.points.begin(), found.points.end()), middles);
}

// Which components are at their upper bounds is kept in words of 64 bits.
INSTANTIATE_TEST_SUITE_P(Components, SimplexOfManyComponents, testing::Values(20, 63, 64, 65, 130),
                         testing::PrintToStringParamName());

TEST(BoundVertices, ComponentsAreOrderedByRangesThatDifferByMoreThanTheToleranceOnly) {
    // Differences of exactly the tolerance, of a hair less and a hair more; all are doubled without rounding.
    constexpr double kTolerance = 1e-12;
    for (const double factor : {1.0, 1.0 - 0x1p-50, 1.0 + 0x1p-50}) {
        const double step = kTolerance * factor;
        for (const std::vector<double>& upper :
             {std::vector<double>{2 * step, step, 1, 1}, std::vector<double>{1, 2 * step, step, 1},
              std::vector<double>{4 * step, 2 * step, step, 1}}) {
            const PlainRegion made = region({0, 0, 0, 0}, upper);
            EXPECT_TRUE(sameEnumeration(enumerated(made), plainlyEnumerated(made))) << factor;
        }
    }
}

TEST(BoundVertices, WithoutConstraintsThereAreTwoPlanesForEachComponent) {
    const auto found = enumerated(region({0, 0.1, 0.2}, {0.5, 0.6, 0.7}));
    EXPECT_EQ(found.numPlanes, 6);
    for (const auto& row : found.slack)
        EXPECT_EQ(row.size(), 6U);
}

TEST(BoundVertices, SlackHoldsTheDistancesToTheLowerThenToTheUpperBounds) {
    const auto found = enumerated(region({0.1, 0.2, 0.3}, {0.3, 0.5, 0.6}));
    ASSERT_FALSE(found.points.empty());
    for (std::size_t r = 0; r < found.points.size(); ++r) {
        for (std::size_t j = 0; j < 3; ++j) {
            EXPECT_EQ(found.slack[r][j], found.points[r][j] - found.lower[j]);
            EXPECT_EQ(found.slack[r][3 + j], found.upper[j] - found.points[r][j]);
        }
    }
}

TEST(BoundVertices, WithoutConstraintsBoundsAreLeftAloneEvenWhenTheyAreLoose) {
    const auto found = enumerated(region({0.1, 0.1, 0.1}, {0.9, 0.9, 0.9}));
    EXPECT_EQ(found.upper, (std::vector<double>{0.9, 0.9, 0.9}));
    EXPECT_FALSE(found.boundsChanged);
}

TEST(BoundVertices, AFlagThatIsSetStaysSet) {
    PlainRegion loose = region({0, 0, 0}, {1, 1, 1});
    loose.boundsChanged = true;
    EXPECT_TRUE(enumerated(loose).boundsChanged);
}

TEST(BoundVertices, ComponentsWithNarrowRangesAreCombinedAndTheWidestIsFree) {
    // Ranges 0.5, 0.4, 0.3: the third component varies fastest, the second slower, the first takes what is left. In the
    // first row that is too much; the rest goes to the third component and then, in another vertex, to the second.
    const auto found = enumerated(region({0.1, 0.1, 0.1}, {0.6, 0.5, 0.4}));
    EXPECT_TRUE(sameTable(found.points, {{0.6, 0.1, 1 - (0.1 + 0.6)},
                                         {0.6, 1 - (0.1 + 0.6), 0.1},
                                         {1 - (0.4 + 0.1), 0.1, 0.4},
                                         {1 - (0.1 + 0.5), 0.5, 0.1},
                                         {0.1, 0.5, 0.4}}));
}

TEST(BoundVertices, ARangeSmallerByLessThanTheToleranceDoesNotChangeTheOrder) {
    const double slightly = 5e-13;
    const auto equal = enumerated(region({0.1, 0.1, 0.1}, {0.5, 0.5, 0.5}));
    const auto found = enumerated(region({0.1, 0.1, 0.1}, {0.5, 0.5 - slightly, 0.5}));
    ASSERT_EQ(found.numVertices, equal.numVertices);
    for (std::size_t r = 0; r < found.points.size(); ++r)
        for (std::size_t j = 0; j < 3; ++j)
            EXPECT_NEAR(found.points[r][j], equal.points[r][j], 1e-11);
}

TEST(BoundVertices, ARangeSmallerByMoreThanTheToleranceChangesTheOrder) {
    // The first row has every fixed component at its lower bound. With equal ranges these are the first two; a third
    // range smaller by 2e-12 makes them the third and, swapped behind it, the second.
    const auto equal = enumerated(region({0.1, 0.1, 0.1}, {0.9, 0.9, 0.9}));
    const auto found = enumerated(region({0.1, 0.1, 0.1}, {0.9, 0.9, 0.9 - 2e-12}));
    EXPECT_NEAR(equal.points.at(0)[2], 0.8, 1e-11);
    EXPECT_NEAR(found.points.at(0)[0], 0.8, 1e-11);
}

TEST(BoundVertices, EqualRangesKeepTheOrderOfTheComponents) {
    const auto found = enumerated(region({0.0, 0.1, 0.2, 0.0}, {0.5, 0.6, 0.7, 0.5}));
    EXPECT_TRUE(sameEnumeration(found, plainlyEnumerated(region({0.0, 0.1, 0.2, 0.0}, {0.5, 0.6, 0.7, 0.5}))));
    // First row: the first three at their lower bounds leave 0.7 to the fourth, too much; it goes to 0.5 and the others
    // are raised in turn, the first one first.
    EXPECT_NEAR(found.points.at(0)[0], 0.2, 1e-12);
    EXPECT_NEAR(found.points.at(1)[1], 0.3, 1e-12);
    EXPECT_NEAR(found.points.at(2)[2], 0.4, 1e-12);
}

TEST(BoundVertices, NoVertexIsLostWhereDecimalsTie) {
    // 1 - (0.2 + 0.3 + 0.2) misses 0.3 by an ulp or two.
    const auto found = enumerated(region({0.2, 0.2, 0.2, 0.0}, {0.5, 0.3, 0.5, 0.3}));
    EXPECT_EQ(found.numVertices, 9U);
}

TEST(BoundVertices, AComponentBesideItsBoundIsSetToIt) {
    const PlainRegion ties = region({0.2, 0.2, 0.2, 0.0}, {0.5, 0.3, 0.5, 0.3});
    const auto found = enumerated(ties);
    for (const auto& x : found.points) {
        for (std::size_t j = 0; j < 4; ++j) {
            EXPECT_TRUE(x[j] == ties.lower[j] || std::fabs(x[j] - ties.lower[j]) > 1e-12) << x[j];
            EXPECT_TRUE(x[j] == ties.upper[j] || std::fabs(x[j] - ties.upper[j]) > 1e-12) << x[j];
        }
    }
}

TEST(BoundVertices, AFreeComponentJustInsideItsBoundIsSetToIt) {
    const double upper = 0.6 + 4e-13;
    const auto found = enumerated(region({0.2, 0.2, 0.0}, {0.3, 0.3, upper}));
    EXPECT_EQ(found.points.at(0), (std::vector<double>{0.2, 0.2, upper}));
}

TEST(BoundVertices, AFreeComponentClearlyInsideItsBoundIsKept) {
    const double upper = 0.6 + 4e-12;
    const auto found = enumerated(region({0.2, 0.2, 0.0}, {0.3, 0.3, upper}));
    EXPECT_EQ(found.points.at(0)[2], 1 - (0.2 + 0.2));
}

TEST(BoundVertices, AFreeComponentClearlyOutsideItsBoundIsReplacedByRepairedPoints) {
    const double upper = 0.6 - 4e-12;
    const auto found = enumerated(region({0.2, 0.2, 0.0}, {0.3, 0.3, upper}));
    EXPECT_EQ(found.points.at(0), (std::vector<double>{1 - (0.2 + upper), 0.2, upper}));
    EXPECT_EQ(found.points.at(1), (std::vector<double>{0.2, 1 - (0.2 + upper), upper}));
}

TEST(BoundVertices, ComponentsWithoutARangeAreAccepted) {
    const auto found = enumerated(region({0.5, 0.1, 0.0}, {0.5, 0.3, 0.6}));
    EXPECT_TRUE(sameTable(found.points, {{0.5, 0.1, 1 - (0.5 + 0.1)}, {0.5, 0.3, 1 - (0.5 + 0.3)}}));
}

TEST(BoundVertices, BoundsThatLeaveNothingGiveNoVertices) {
    const auto found = enumerated(region({0.5, 0.5, 0.5}, {0.6, 0.6, 0.6}));
    EXPECT_EQ(found.numVertices, 0U);
    EXPECT_TRUE(found.points.empty());
    EXPECT_TRUE(found.returned);
}

TEST(BoundVertices, ARegionThatIsOnePointHasOneVertex) {
    const auto found = enumerated(region({0.25, 0.25, 0.5}, {0.75, 0.75, 0.75}));
    EXPECT_TRUE(sameTable(found.points, {{0.25, 0.25, 0.5}}));
}

TEST(BoundVertices, TwoComponentsHaveTwoVertices) {
    const auto found = enumerated(region({0.1, 0.3}, {0.6, 0.8}));
    EXPECT_TRUE(sameTable(found.points, {{1 - 0.8, 0.8}, {0.6, 1 - 0.6}}));
}

TEST(BoundVertices, NegativeLowerBoundsAreBoundsLikeOthers) {
    const PlainRegion negative = region({-0.5, 0.1, -0.1}, {0.5, 0.7, 0.8});
    const auto found = enumerated(negative);
    EXPECT_TRUE(sameEnumeration(found, plainlyEnumerated(negative)));
    EXPECT_GT(found.numVertices, 0U);
}

}  // namespace
}  // namespace reisti::test
