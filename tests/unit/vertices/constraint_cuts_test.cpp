// Linear constraints: which planes cut, what they cut off, what is told about them.
#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>
#include <limits>
#include <string>
#include <vector>

#include "support/vertex_engine.h"
#include "support/vertices_request.h"

namespace reisti::test {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
PlainRegion simplexWith(std::vector<PlainConstraint> constraints) {
    PlainRegion made;
    made.lower.assign(3, 0.0);
    made.upper.assign(3, 1.0);
    made.constraints = std::move(constraints);
    return made;
}

TEST(ConstraintCuts, TheCornerCutOffIsReplacedByTheEndsOfTheCut) {
    // x1 <= 0.5 takes the second vertex (1, 0, 0) away; its edges lead to the first and to the third.
    const auto found = enumerated(simplexWith({atMost(0.5, {1, 0, 0})}));
    EXPECT_TRUE(sameTable(found.points, {{0, 0, 1}, {0, 1, 0}, {0.5, 0, 0.5}, {0.5, 0.5, 0}}));
}

TEST(ConstraintCuts, ACuttingPlaneAddsOneColumnOfSlack) {
    const auto found = enumerated(simplexWith({atMost(0.5, {1, 0, 0})}));
    EXPECT_EQ(found.numPlanes, 7);
    for (std::size_t r = 0; r < found.points.size(); ++r)
        EXPECT_EQ(found.slack[r][6], 0.5 - found.points[r][0]);
}

TEST(ConstraintCuts, TheLowerPlaneOfATwoSidedConstraintComesFirst) {
    const auto found = enumerated(simplexWith({between(0.25, 0.5, {1, 0, 0})}));
    ASSERT_EQ(found.numPlanes, 8);
    for (std::size_t r = 0; r < found.points.size(); ++r) {
        EXPECT_EQ(found.slack[r][6], found.points[r][0] - 0.25);
        EXPECT_EQ(found.slack[r][7], 0.5 - found.points[r][0]);
    }
}

TEST(ConstraintCuts, APlaneThatDoesNotCutLeavesNoColumn) {
    const auto found = enumerated(simplexWith({atMost(2.0, {1, 0, 0}), atMost(0.5, {0, 1, 0})}));
    ASSERT_EQ(found.numPlanes, 7);
    for (std::size_t r = 0; r < found.points.size(); ++r)
        EXPECT_EQ(found.slack[r][6], 0.5 - found.points[r][1]);
}

TEST(ConstraintCuts, ValuesAreInTheUnitsOfTheTotal) {
    PlainRegion of200 = simplexWith({atMost(100.0, {1, 0, 0})});
    of200.total = 200.0;
    EXPECT_TRUE(sameTable(enumerated(of200).points, enumerated(simplexWith({atMost(0.5, {1, 0, 0})})).points));
}

TEST(ConstraintCuts, CoefficientsWhoseDifferenceOverflowsAddNoVertexTwice) {
    // From (-1, 1, 1) to (1, -1, 1) the plane's values differ by more than a double holds: the cut point is the kept
    // vertex itself, although it lies far from the plane.
    PlainRegion region = simplexWith({atLeast(0.0, {0.8e308, -0.8e308, 0})});
    region.lower.assign(3, -1.0);
    const auto found = enumerated(region);
    EXPECT_TRUE(sameEnumeration(found, plainlyEnumerated(region)));
    EXPECT_EQ(std::count(found.points.begin(), found.points.end(), std::vector<double>{1, -1, 1}), 1);
}

TEST(ConstraintCuts, BoundsBecomeTheImpliedBounds) {
    const auto found = enumerated(simplexWith({between(0.25, 0.5, {1, 0, 0})}));
    EXPECT_EQ(found.lower, (std::vector<double>{0.25, 0, 0}));
    EXPECT_EQ(found.upper, (std::vector<double>{0.5, 0.75, 0.75}));
    EXPECT_TRUE(found.boundsChanged);
}

TEST(ConstraintCuts, BoundsAreNarrowedAlsoWhenNoConstraintCuts) {
    PlainRegion loose = simplexWith({atMost(2.0, {1, 1, 1})});
    loose.lower.assign(3, 0.1);
    loose.upper.assign(3, 0.9);
    const auto found = enumerated(loose);
    for (const double bound : found.upper)
        EXPECT_NEAR(bound, 0.8, 1e-15);
    EXPECT_TRUE(found.boundsChanged);
}

TEST(ConstraintCuts, BoundsThatFitAreLeftAlone) {
    const auto found = enumerated(simplexWith({atMost(2.0, {1, 1, 1})}));
    EXPECT_EQ(found.upper, (std::vector<double>{1, 1, 1}));
    EXPECT_FALSE(found.boundsChanged);
}

TEST(ConstraintCuts, ABoundWithinTheRelativeToleranceOfTheImpliedOneIsLeftAlone) {
    PlainRegion nearly = simplexWith({atMost(2.0, {1, 1, 1})});
    const double bound = 1.0 + 5e-13;
    nearly.upper.assign(3, bound);
    const auto found = enumerated(nearly);
    EXPECT_EQ(found.upper, (std::vector<double>{bound, bound, bound}));
    EXPECT_FALSE(found.boundsChanged);
}

TEST(ConstraintCuts, ANewPointBesideAVertexThatStaysIsNotAdded) {
    // The plane leaves 4e-6 of each edge at the third vertex: the ends of the cut fall together with it.
    const auto found = enumerated(simplexWith({atLeast(1 - 4e-6, {0, 1, 0})}));
    EXPECT_TRUE(sameTable(found.points, {{0, 1, 0}}));
}

TEST(ConstraintCuts, ANewPointBesideAVertexThatGoesIsAdded) {
    // (0.66667, 0.33333, 0) misses the ratio of 2 by 1e-5 and goes; the corner (2/3, 1/3, 0) beside it takes its place.
    PlainRegion typed = simplexWith({atLeast(0.0, {-1, 2, 0})});
    typed.upper[0] = 0.66667;
    const auto found = enumerated(typed);
    ASSERT_EQ(found.numVertices, 3U);
    EXPECT_NEAR(found.points[2][0], 2.0 / 3.0, 1e-12);
    EXPECT_NEAR(found.points[2][1], 1.0 / 3.0, 1e-12);
    EXPECT_NEAR(found.upper[0], 2.0 / 3.0, 1e-12);
}

TEST(ConstraintCuts, EdgesThatMeetThePlaneSideBySideGiveOnePoint) {
    // The third component moves by 5e-6 only: edges that differ in nothing else end in the same point of the cut.
    PlainRegion thin = simplexWith({atMost(0.5, {1, 0, 0, 0})});
    thin.lower.assign(4, 0.0);
    thin.upper = {1, 1, 5e-6, 1};
    const auto found = enumerated(thin);
    const auto onTheCut = std::count_if(found.points.begin(), found.points.end(),
                                        [](const auto& x) { return std::fabs(x[0] - 0.5) < 1e-9; });
    EXPECT_EQ(onTheCut, 2);
    EXPECT_TRUE(sameEnumeration(found, plainlyEnumerated(thin)));
}

TEST(ConstraintCuts, ConstraintsAreAppliedInTheirOrder) {
    const PlainConstraint first = atMost(0.6, {1, 0, 0});
    const PlainConstraint second = atMost(0.7, {1, 1, 0});
    const auto oneWay = enumerated(simplexWith({first, second}));
    const auto otherWay = enumerated(simplexWith({second, first}));
    EXPECT_EQ(oneWay.numVertices, otherWay.numVertices);
    EXPECT_FALSE(sameTable(oneWay.points, otherWay.points));
}

TEST(ConstraintCuts, CoefficientsWhoseDifferencesOverflowGiveNoPointThatIsNotANumber) {
    const PlainRegion huge = simplexWith({atMost(0.0, {1e308, -1e308, 0})});
    const auto found = enumerated(huge);
    EXPECT_TRUE(sameEnumeration(found, plainlyEnumerated(huge)));
    EXPECT_TRUE(sameTable(found.points, {{0, 0, 1}, {0, 1, 0}}));
}

TEST(ConstraintCuts, MoreThanSixtyFourPlanesAreHandled) {
    // Forty tangents to a circle inside the simplex.
    PlainRegion round = simplexWith({});
    constexpr double kPi = 3.14159265358979323846;
    for (int i = 0; i < 40; ++i) {
        const double angle = 2.0 * kPi * i / 40.0;
        const double u = std::cos(angle);
        const double v = std::sin(angle);
        // Two orthogonal directions in the plane of mixtures, from the centroid.
        const std::vector<double> c = {u / std::sqrt(2.0) + v / std::sqrt(6.0),
                                       -u / std::sqrt(2.0) + v / std::sqrt(6.0), -2.0 * v / std::sqrt(6.0)};
        round.constraints.push_back(i % 2 == 0 ? atMost(0.2, c) : between(-0.9, 0.2, c));
    }
    const auto found = enumerated(round);
    EXPECT_EQ(found.numVertices, 40U);
    EXPECT_EQ(found.numPlanes, 46);
    EXPECT_TRUE(sameEnumeration(found, plainlyEnumerated(round)));

    // The same on a third component split in two: more planes, and edges to tell from diagonals.
    PlainRegion split = round;
    split.lower.assign(4, 0.0);
    split.upper.assign(4, 1.0);
    for (auto& constraint : split.constraints)
        constraint.coefficients.push_back(constraint.coefficients[2]);
    for (int i = 0; i < 24; ++i)
        split.constraints.push_back(atMost(0.30 + 0.002 * i, {0.01 * i, 0.0, 1.0, 0.02 * (24 - i)}));
    const auto more = enumerated(split);
    EXPECT_GT(more.numPlanes, 64);
    EXPECT_TRUE(sameEnumeration(more, plainlyEnumerated(split)));
}

struct StatusCase {
    std::string name;
    PlainConstraint constraint;
    int status;
    std::uint32_t numVertices;
};

void PrintTo(const StatusCase& c, std::ostream* out) {
    *out << c.name;
}

class ConstraintStatus : public testing::TestWithParam<StatusCase> {};

TEST_P(ConstraintStatus, TellsWhichSidesDoNotCut) {
    const auto found = enumerated(simplexWith({GetParam().constraint}));
    EXPECT_EQ(found.statuses.at(0), GetParam().status);
    EXPECT_EQ(found.numVertices, GetParam().numVertices);
}

INSTANTIATE_TEST_SUITE_P(
    Cases, ConstraintStatus,
    testing::Values(
        StatusCase{"LowerCuts", atLeast(0.5, {1, 0, 0}), STATUS_BEFORE, 3},
        StatusCase{"LowerRedundant", atLeast(-0.5, {1, 0, 0}), 1, 3},
        StatusCase{"LowerExcludesAll", atLeast(1.5, {1, 0, 0}), 1, 3},
        StatusCase{"LowerLeavesAVertex", atLeast(1.0, {1, 0, 0}), 1, 3},
        StatusCase{"UpperCuts", atMost(0.5, {1, 0, 0}), STATUS_BEFORE, 4},
        StatusCase{"UpperRedundant", atMost(1.5, {1, 0, 0}), 2, 3},
        StatusCase{"UpperExcludesAll", atMost(-0.5, {1, 0, 0}), 2, 3},
        StatusCase{"UpperLeavesAnEdge", atMost(0.0, {1, 0, 0}), 2, 3},
        StatusCase{"UpperThroughAVertex", atMost(1.0, {1, 0, 0}), 2, 3},
        StatusCase{"BothCut", between(0.2, 0.5, {1, 0, 0}), STATUS_BEFORE, 4},
        StatusCase{"OnlyLowerCuts", between(0.2, 1.5, {1, 0, 0}), 2, 3},
        StatusCase{"OnlyUpperCuts", between(-0.2, 0.5, {1, 0, 0}), 1, 4},
        StatusCase{"NeitherCuts", between(-0.2, 1.5, {1, 0, 0}), 3, 3},
        StatusCase{"UpperExcludesWhatTheLowerLeaves", between(0.5, 0.2, {1, 0, 0}), 2, 3},
        StatusCase{"EquationWithTheLowerSideCutting", between(0.5, 0.5, {1, 0, 0}), 2, 3},
        StatusCase{"LowerWithoutLimit", atLeast(-kInfinity, {1, 0, 0}), 1, 3},
        StatusCase{"UpperWithoutLimit", atMost(kInfinity, {1, 0, 0}), 2, 3},
        StatusCase{"TwoSidesWithoutLimit", between(-kInfinity, kInfinity, {1, 0, 0}), 3, 3},
        StatusCase{"OnlyLowerHasALimit", between(0.2, kInfinity, {1, 0, 0}), 2, 3},
        StatusCase{"OnlyUpperHasALimit", between(-kInfinity, 0.5, {1, 0, 0}), 1, 4},
        StatusCase{"NoSide", PlainConstraint{false, 0.2, false, 0.5, {1, 0, 0}, STATUS_BEFORE}, STATUS_BEFORE, 4},
        StatusCase{"NoSideAndRedundant", PlainConstraint{false, 0.2, false, 1.5, {1, 0, 0}, STATUS_BEFORE}, 2, 3},
        StatusCase{"ZeroCoefficients", between(-1.0, 1.0, {0, 0, 0}), 3, 3},
        StatusCase{"CutsLessThanTheTolerance", atMost(1.0 - 5e-7, {1, 0, 0}), 2, 3},
        StatusCase{"CutsMoreThanTheTolerance", atMost(1.0 - 2e-5, {1, 0, 0}), STATUS_BEFORE, 4},
        StatusCase{"LeavesLessThanTheTolerance", atMost(5e-7, {1, 1, 0}), 2, 3}),
    [](const auto& instance) { return instance.param.name; });

TEST(ConstraintStatuses, EachConstraintHasItsOwn) {
    const auto found =
        enumerated(simplexWith({atMost(0.5, {1, 0, 0}), atLeast(-1.0, {0, 1, 0}), between(-1.0, 2.0, {0, 0, 1})}));
    EXPECT_EQ(found.statuses, (std::vector<int>{STATUS_BEFORE, 1, 3}));
}

TEST(ConstraintStatuses, ARepeatedConstraintIsRedundantTheSecondTime) {
    const auto found = enumerated(simplexWith({atMost(0.5, {1, 0, 0}), atMost(0.5, {1, 0, 0})}));
    EXPECT_EQ(found.statuses, (std::vector<int>{STATUS_BEFORE, 2}));
    EXPECT_EQ(found.numPlanes, 7);
}

TEST(ConstraintStatuses, TheOppositeOfAConstraintLeavesAFaceAndDoesNotCut) {
    const auto found = enumerated(simplexWith({atMost(0.5, {1, 0, 0}), atLeast(0.5, {1, 0, 0})}));
    EXPECT_EQ(found.statuses, (std::vector<int>{STATUS_BEFORE, 1}));
    EXPECT_EQ(found.numVertices, 4U);
}

}  // namespace
}  // namespace reisti::test
