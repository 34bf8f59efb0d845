// What a host gets: points, order, types, counts, units, on regions small enough to be worked out by hand.
#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <numeric>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "support/vertices_record.h"

namespace reisti::test {
namespace {

using testing::ElementsAre;
using Mixture = std::vector<double>;

constexpr double kThird = 1.0 / 3.0;

/// The simplex without the corner of the first component; its vertices in order are (0, 0, 1), (0, 1, 0),
/// (0.5, 0, 0.5), (0.5, 0.5, 0) and their mean is (0.25, 0.375, 0.375).
VerticesRequest cutSimplex(std::int32_t degree = 1) {
    VerticesRequest request = simplexRequest(3, degree);
    request.constraints = {atMost(0.5, {1, 0, 0})};
    return request;
}

std::vector<std::int32_t> typesOf(const MixtureOutcome& design) {
    std::vector<std::int32_t> types;
    for (const auto& run : design.runs)
        types.push_back(run.pointType);
    return types;
}

std::vector<Mixture> mixturesOf(const MixtureOutcome& design) {
    std::vector<Mixture> mixtures;
    for (const auto& run : design.runs)
        mixtures.push_back(run.proportions);
    return mixtures;
}

std::vector<std::uint32_t> ordersOf(const MixtureOutcome& design) {
    std::vector<std::uint32_t> orders;
    for (const auto& run : design.runs)
        orders.push_back(run.runOrder);
    return orders;
}

MixtureOutcome built(const VerticesRequest& request) {
    VerticesOutcome outcome = builtVertices(request);
    EXPECT_EQ(outcome.design.code, des_Success);
    return outcome.design;
}

TEST(VerticesDesign, DegreeOneHoldsTheVertices) {
    const MixtureOutcome design = built(cutSimplex(1));
    EXPECT_THAT(mixturesOf(design),
                ElementsAre(Mixture{0, 0, 1}, Mixture{0, 1, 0}, Mixture{0.5, 0, 0.5}, Mixture{0.5, 0.5, 0}));
    EXPECT_THAT(typesOf(design), ElementsAre(1, 1, 1, 1));
    EXPECT_THAT(design.pointsPerType, ElementsAre(4, 0, 0));
}

TEST(VerticesDesign, DegreeZeroHoldsTheVerticesToo) {
    EXPECT_EQ(mixturesOf(built(cutSimplex(0))), mixturesOf(built(cutSimplex(1))));
}

TEST(VerticesDesign, DegreeTwoAddsTheMidpointsOfEdges) {
    const MixtureOutcome design = built(cutSimplex(2));
    EXPECT_THAT(typesOf(design), ElementsAre(1, 1, 1, 1, 2, 2, 2, 2));
    EXPECT_THAT(design.pointsPerType, ElementsAre(4, 4, 0));
    EXPECT_EQ(design.numCenterPoints, 0U);
}

TEST(VerticesDesign, FullDegreeEndsWithTheOverallCentroid) {
    const MixtureOutcome design = built(cutSimplex(3));
    EXPECT_THAT(typesOf(design), ElementsAre(1, 1, 1, 1, 2, 2, 2, 2, 0));
    EXPECT_EQ(design.runs.back().proportions, (Mixture{0.25, 0.375, 0.375}));
    EXPECT_EQ(design.numCenterPoints, 1U);
}

TEST(VerticesDesign, FaceCentroidsAreTypedByDimension) {
    const MixtureOutcome design = built(simplexRequest(5, 5));
    EXPECT_THAT(design.pointsPerType, ElementsAre(5, 10, 10, 5, 0));
    EXPECT_EQ(design.numCenterPoints, 1U);
    const auto types = typesOf(design);
    EXPECT_TRUE(std::is_sorted(types.begin(), types.end() - 1));
    EXPECT_EQ(types.back(), 0);
}

TEST(OverallCentre, IsTheMeanOfTheVerticesBehindTheBasePoints) {
    VerticesRequest request = cutSimplex(2);
    request.centerPoint = 1;
    const MixtureOutcome design = built(request);
    EXPECT_THAT(typesOf(design), ElementsAre(1, 1, 1, 1, 2, 2, 2, 2, 0));
    EXPECT_EQ(design.runs.back().proportions, (Mixture{0.25, 0.375, 0.375}));
    EXPECT_EQ(design.numCenterPoints, 1U);
}

TEST(OverallCentre, IsNotAddedTwiceAtFullDegree) {
    VerticesRequest request = cutSimplex(3);
    request.centerPoint = 1;
    EXPECT_EQ(mixturesOf(built(request)), mixturesOf(built(cutSimplex(3))));
    EXPECT_EQ(built(request).numCenterPoints, 1U);
}

TEST(OverallCentre, IsNeitherWrittenNorCountedAtDegreeZero) {
    VerticesRequest request = cutSimplex(0);
    request.centerPoint = 1;
    const MixtureOutcome design = built(request);
    EXPECT_EQ(design.runs.size(), 4U);
    EXPECT_EQ(design.numCenterPoints, 0U);
}

TEST(OverallCentre, IsNotCountedWhereAFaceCentroidTookItsPlace) {
    // A range too small for the planes to tell its ends apart: the centroid of a lower face is the overall one.
    VerticesRequest request = verticesRequest({0.0, 0.0, 0.99995}, {1.0, 1.0, 1.0});
    request.degree = 3;
    request.centerPoint = 1;
    const MixtureOutcome design = built(request);
    EXPECT_EQ(design.numCenterPoints, 0U);
    EXPECT_THAT(typesOf(design), testing::Not(testing::Contains(0)));
}

TEST(AxialPoints, LieHalfwayBetweenEachVertexAndTheMeanOfTheVertices) {
    VerticesRequest request = cutSimplex(1);
    request.axialPoints = 1;
    const MixtureOutcome design = built(request);
    EXPECT_THAT(typesOf(design), ElementsAre(1, 1, 1, 1, -1, -1, -1, -1));
    EXPECT_EQ(design.runs[4].proportions, (Mixture{0.125, 0.1875, 0.6875}));
    EXPECT_EQ(design.runs[5].proportions, (Mixture{0.125, 0.6875, 0.1875}));
    EXPECT_EQ(design.runs[6].proportions, (Mixture{0.375, 0.1875, 0.4375}));
    EXPECT_EQ(design.runs[7].proportions, (Mixture{0.375, 0.4375, 0.1875}));
    EXPECT_EQ(design.numAxialPoints, 4U);
}

TEST(AxialPoints, FollowTheOverallCentre) {
    VerticesRequest request = cutSimplex(2);
    request.centerPoint = 1;
    request.axialPoints = 1;
    EXPECT_THAT(typesOf(built(request)), ElementsAre(1, 1, 1, 1, 2, 2, 2, 2, 0, -1, -1, -1, -1));
}

TEST(AxialPoints, AreAsManyAsVerticesNotAsComponents) {
    VerticesRequest request = verticesRequest({0.1, 0.1, 0.1}, {0.6, 0.6, 0.6});
    request.axialPoints = 1;
    const MixtureOutcome design = built(request);
    EXPECT_EQ(design.numAxialPoints, 6U);
    EXPECT_EQ(design.runs.size(), 12U);
}

TEST(Statuses, AreWrittenForConstraintsThatDoNotCut) {
    VerticesRequest request = cutSimplex();
    request.constraints.push_back(atLeast(-1, {0, 1, 0}));
    request.constraints.push_back(atMost(2, {0, 1, 0}));
    request.constraints.push_back(between(-1, 2, {0, 1, 0}));
    request.constraints.push_back(between(0.5, 0.5, {0, 0, 1}));
    EXPECT_THAT(builtVertices(request).statuses, ElementsAre(STATUS_BEFORE, 1, 2, 3, 2));
}

TEST(ImpliedBounds, ReplaceTheBoundsWhenConstraintsAreGiven) {
    const MixtureOutcome design = built(cutSimplex());
    EXPECT_EQ(design.upperBounds, (Mixture{0.5, 1, 1}));
    EXPECT_EQ(design.scaledUpperBounds, (Mixture{0.5, 1, 1}));
    EXPECT_TRUE(design.boundsAdjusted);
}

TEST(ImpliedBounds, AreFoundByTheCheckOfBoundsWithoutConstraints) {
    const MixtureOutcome design = built(verticesRequest({0.1, 0.1, 0.1}, {0.9, 0.9, 0.9}));
    for (const double bound : design.upperBounds)
        EXPECT_NEAR(bound, 0.8, 1e-15);
    EXPECT_TRUE(design.boundsAdjusted);
}

TEST(ImpliedBounds, LeaveBoundsThatFitAlone) {
    const MixtureOutcome design = built(verticesRequest({0.1, 0.1, 0.1}, {0.6, 0.6, 0.6}));
    EXPECT_EQ(design.upperBounds, (Mixture{0.6, 0.6, 0.6}));
    EXPECT_FALSE(design.boundsAdjusted);
}

TEST(ImpliedBounds, AreGivenInTheUnitsOfTheTotal) {
    VerticesRequest request = cutSimplex();
    request.amounts = {8};
    request.upperBounds = {8, 8, 8};
    request.constraints = {atMost(4, {1, 0, 0})};
    const MixtureOutcome design = built(request);
    EXPECT_EQ(design.upperBounds, (Mixture{4, 8, 8}));
    EXPECT_EQ(design.scaledUpperBounds, (Mixture{0.5, 1, 1}));
}

TEST(PseudoBounds, AreRangesOverWhatTheLowerBoundsLeave) {
    VerticesRequest request = simplexRequest(3, 1);
    request.constraints = {between(0.25, 0.5, {1, 0, 0})};
    const MixtureOutcome design = built(request);
    EXPECT_EQ(design.pseudoLowerBounds, (Mixture{0, 0, 0}));
    EXPECT_EQ(design.pseudoUpperBounds, (Mixture{0.25 / 0.75, 1, 1}));
}

class OutputUnits : public testing::TestWithParam<std::uint32_t> {
  protected:
    VerticesRequest request() const {
        VerticesRequest made = simplexRequest(3, 1);
        made.constraints = {atLeast(0.5, {1, 0, 0})};
        made.outputUnits = GetParam();
        return made;
    }
};

TEST_P(OutputUnits, WithoutAmountsAreProportionsOrPseudoComponents) {
    const MixtureOutcome design = built(request());
    const std::vector<Mixture> expected = GetParam() == des_UnitsPseudo
                                              ? std::vector<Mixture>{{1, 0, 0}, {0, 0, 1}, {0, 1, 0}}
                                              : std::vector<Mixture>{{1, 0, 0}, {0.5, 0, 0.5}, {0.5, 0.5, 0}};
    EXPECT_THAT(mixturesOf(design), testing::UnorderedElementsAreArray(expected));
}

TEST_P(OutputUnits, WithOneAmountAreMultipliedForAmountsOnly) {
    VerticesRequest scaled = request();
    scaled.amounts = {8};
    scaled.upperBounds = {8, 8, 8};
    scaled.constraints = {atLeast(4, {1, 0, 0})};
    const MixtureOutcome design = built(scaled);
    std::vector<Mixture> expected = mixturesOf(built(request()));
    for (auto& x : expected)
        for (double& component : x)
            component *= GetParam() == des_UnitsAmount ? 8 : 1;
    EXPECT_EQ(mixturesOf(design), expected);
    for (const auto& run : design.runs)
        EXPECT_EQ(run.amount, 8);
}

TEST_P(OutputUnits, WithSeveralAmountsAreMultipliedByTheAmountOfTheRun) {
    VerticesRequest scaled = request();
    scaled.amounts = {8, 2};
    scaled.upperBounds = {8, 8, 8};
    scaled.constraints = {atLeast(4, {1, 0, 0})};
    const MixtureOutcome design = built(scaled);
    const std::vector<Mixture> once = mixturesOf(built(request()));
    ASSERT_EQ(design.runs.size(), 6U);
    for (std::size_t i = 0; i < 6; ++i) {
        const double amount = i < 3 ? 8 : 2;
        EXPECT_EQ(design.runs[i].amount, amount);
        for (std::size_t j = 0; j < 3; ++j)
            EXPECT_EQ(design.runs[i].proportions[j], once[i % 3][j] * (GetParam() == des_UnitsAmount ? amount : 1));
    }
}

INSTANTIATE_TEST_SUITE_P(All, OutputUnits, testing::Values(0U, 1U, 2U, 3U), testing::PrintToStringParamName());

TEST(PseudoComponents, WithoutLowerBoundsAreTheProportions) {
    VerticesRequest request = cutSimplex(3);
    const auto proportions = mixturesOf(built(request));
    request.outputUnits = des_UnitsPseudo;
    const auto pseudo = mixturesOf(built(request));
    for (std::size_t i = 0; i < proportions.size(); ++i)
        for (std::size_t j = 0; j < 3; ++j)
            EXPECT_NEAR(pseudo[i][j], proportions[i][j], 1e-15);
}

TEST(PseudoComponents, SumToOne) {
    VerticesRequest request = verticesRequest({0.1, 0.2, 0.05, 0.0}, {0.5, 0.4, 0.7, 0.3});
    request.degree = 4;
    request.outputUnits = des_UnitsPseudo;
    for (const auto& x : mixturesOf(built(request)))
        EXPECT_NEAR(std::accumulate(x.begin(), x.end(), 0.0), 1.0, 1e-15);
}

TEST(Replicates, RepeatEachClassBehindTheDistinctPoints) {
    VerticesRequest request = cutSimplex(2);
    request.centerPoint = 1;
    request.axialPoints = 1;
    request.vertexReplicates = 2;
    request.typeReplicates = {2};
    request.centerReplicates = 3;
    request.axialReplicates = 2;
    EXPECT_THAT(typesOf(built(request)),
                ElementsAre(1, 1, 1, 1, 2, 2, 2, 2, 0, -1, -1, -1, -1, 1, 1, 1, 1, 2, 2, 2, 2, 0, 0, -1, -1, -1, -1));
}

TEST(Replicates, OfNoneLeaveTheClassOutAndNumberTheRest) {
    VerticesRequest request = cutSimplex(2);
    request.axialPoints = 1;
    request.typeReplicates = {0};
    const MixtureOutcome design = built(request);
    EXPECT_THAT(typesOf(design), ElementsAre(1, 1, 1, 1, -1, -1, -1, -1));
    EXPECT_THAT(ordersOf(design), ElementsAre(1, 2, 3, 4, 5, 6, 7, 8));
    EXPECT_THAT(design.pointsPerType, ElementsAre(4, 4, 0));
}

TEST(Replicates, OfNoVerticesKeepTheAxialPoints) {
    VerticesRequest request = cutSimplex(1);
    request.axialPoints = 1;
    request.vertexReplicates = 0;
    const MixtureOutcome design = built(request);
    EXPECT_THAT(typesOf(design), ElementsAre(-1, -1, -1, -1));
    EXPECT_EQ(design.runs[0].proportions, (Mixture{0.125, 0.1875, 0.6875}));
    EXPECT_EQ(design.numAxialPoints, 4U);
}

TEST(Replicates, OfAllClassesNoneGiveNoRuns) {
    VerticesRequest request = cutSimplex(1);
    request.vertexReplicates = 0;
    EXPECT_TRUE(built(request).runs.empty());
    request.vertexReplicates = 1;
    request.designReplicates = 0;
    const MixtureOutcome design = built(request);
    EXPECT_TRUE(design.runs.empty());
    EXPECT_THAT(design.pointsPerType, ElementsAre(4, 0, 0));
}

TEST(Replicates, OfTheDesignRepeatItWhole) {
    VerticesRequest request = cutSimplex(1);
    request.designReplicates = 3;
    const MixtureOutcome design = built(request);
    ASSERT_EQ(design.runs.size(), 12U);
    for (std::size_t i = 0; i < 12; ++i)
        EXPECT_EQ(design.runs[i].proportions, design.runs[i % 4].proportions);
}

TEST(ProcessVariables, RunEveryPointAtEverySetting) {
    VerticesRequest request = cutSimplex(1);
    request.numProcessVariables = 3;
    request.processFraction = 2;
    request.fractionIndex = 2;
    const MixtureOutcome design = built(request);
    ASSERT_EQ(design.runs.size(), 16U);
    for (std::size_t i = 0; i < 16; ++i) {
        const std::int32_t a = i / 4 % 2 == 0 ? -1 : 1;
        const std::int32_t b = i / 8 == 0 ? -1 : 1;
        EXPECT_THAT(design.runs[i].processLevels, ElementsAre(a, b, a * b));
        EXPECT_EQ(design.runs[i].proportions, design.runs[i % 4].proportions);
    }
}

TEST(RunOrder, IsThePositionUnlessRandomized) {
    EXPECT_THAT(ordersOf(built(cutSimplex(2))), ElementsAre(1, 2, 3, 4, 5, 6, 7, 8));
}

TEST(RunOrder, IsAPermutationThatTheSeedRepeats) {
    VerticesRequest request = cutSimplex(3);
    request.axialPoints = 1;
    request.randomize = 1;
    request.seed = 42.0;
    const auto first = ordersOf(built(request));
    EXPECT_EQ(first, ordersOf(built(request)));
    auto sorted = first;
    std::sort(sorted.begin(), sorted.end());
    for (std::size_t i = 0; i < sorted.size(); ++i)
        EXPECT_EQ(sorted[i], i + 1);
    EXPECT_NE(first, sorted);
}

TEST(RunOrder, MovesNoRun) {
    VerticesRequest request = cutSimplex(3);
    const auto standard = mixturesOf(built(request));
    request.randomize = 1;
    request.seed = 42.0;
    EXPECT_EQ(mixturesOf(built(request)), standard);
}

TEST(BoundaryCounts, CountTheFacesWithinTheImpliedBounds) {
    EXPECT_THAT(built(cutSimplex()).boundaryCounts, ElementsAre(4, 4, 1));
    EXPECT_THAT(built(verticesRequest({0.1, 0.1, 0.1}, {0.6, 0.6, 0.6})).boundaryCounts, ElementsAre(6, 6, 1));
}

TEST(ManyComponents, AreHandledWithMoreThanSixtyFourPlanes) {
    // A simplex of forty components without the corner of the first: 39 vertices stay, 39 edges are cut.
    VerticesRequest request = simplexRequest(40, 2);
    Mixture first(40, 0.0);
    first[0] = 1.0;
    request.constraints = {atMost(0.5, first)};
    const MixtureOutcome design = built(request);
    EXPECT_EQ(design.pointsPerType[0], 78U);
    // Edges of the simplex of 39, the cut edges, and the edges of the cut.
    EXPECT_EQ(design.pointsPerType[1], 39U * 38U / 2U + 39U + 39U * 38U / 2U);
}

TEST(ManyComponents, GiveEveryFaceOfTheSimplex) {
    const MixtureOutcome design = built(simplexRequest(12, 12));
    EXPECT_EQ(design.runs.size(), 4095U);
    EXPECT_EQ(design.pointsPerType[5], 924U);
    for (const auto& run : design.runs) {
        const auto size = run.pointType == 0 ? 12 : run.pointType;
        for (const double x : run.proportions)
            EXPECT_TRUE(x == 0.0 || std::fabs(x - 1.0 / size) < 1e-15);
    }
}

TEST(TwoComponents, HaveTwoVerticesAndTheirMiddle) {
    VerticesRequest request = verticesRequest({0.25, 0.25}, {0.75, 0.75});
    request.degree = 2;
    EXPECT_THAT(mixturesOf(built(request)), ElementsAre(Mixture{0.25, 0.75}, Mixture{0.75, 0.25}, Mixture{0.5, 0.5}));
}

TEST(OneVertex, IsADesignOfOneRun) {
    VerticesRequest request = simplexRequest(3, 1);
    request.constraints = {atLeast(1 - 4e-6, {0, 1, 0})};
    request.axialPoints = 1;
    request.centerPoint = 1;
    const MixtureOutcome design = built(request);
    EXPECT_THAT(mixturesOf(design), ElementsAre(Mixture{0, 1, 0}, Mixture{0, 1, 0}, Mixture{0, 1, 0}));
    EXPECT_THAT(typesOf(design), ElementsAre(1, 0, -1));
}

TEST(Centroids, AreAverages) {
    const MixtureOutcome design = built(simplexRequest(3, 3));
    EXPECT_EQ(design.runs.back().proportions, (Mixture{kThird, kThird, kThird}));
}

}  // namespace
}  // namespace reisti::test
