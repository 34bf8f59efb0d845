#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "support/plain_bounds.h"
#include "unit/mixture/expect_plain.h"

namespace reisti::test {
namespace {

using testing::Each;
using testing::ElementsAre;
using testing::ElementsAreArray;
using testing::IsEmpty;

TEST(Centroid, ThreeComponentsGiveVerticesBlendsAndCentroidInThisOrder) {
    const double third = 1.0 / 3;
    EXPECT_THAT(mixturesOf(builtDesign(centroidRequest(3))),
                ElementsAre(ElementsAre(1, 0, 0), ElementsAre(0, 1, 0), ElementsAre(0, 0, 1), ElementsAre(0.5, 0.5, 0),
                            ElementsAre(0.5, 0, 0.5), ElementsAre(0, 0.5, 0.5), ElementsAre(third, third, third)));
}

TEST(Centroid, PointTypeIsTheNumberOfComponentsAndZeroForTheCentroid) {
    EXPECT_THAT(typesOf(builtDesign(centroidRequest(3))), ElementsAre(1, 1, 1, 2, 2, 2, 0));
}

TEST(Centroid, RunOrderIsTheStandardOrder) {
    EXPECT_THAT(ordersOf(builtDesign(centroidRequest(4))), ElementsAreArray(standardOrder(15)));
}

TEST(Centroid, SubsetsOfOneSizeComeInLexicographicOrder) {
    const auto mixtures = mixturesOf(builtDesign(centroidRequest(4)));
    EXPECT_THAT(mixtures[4], ElementsAre(0.5, 0.5, 0, 0));
    EXPECT_THAT(mixtures[5], ElementsAre(0.5, 0, 0.5, 0));
    EXPECT_THAT(mixtures[6], ElementsAre(0.5, 0, 0, 0.5));
    EXPECT_THAT(mixtures[7], ElementsAre(0, 0.5, 0.5, 0));
    EXPECT_THAT(mixtures[8], ElementsAre(0, 0.5, 0, 0.5));
    EXPECT_THAT(mixtures[9], ElementsAre(0, 0, 0.5, 0.5));
    EXPECT_THAT(mixtures[11], ElementsAre(1.0 / 3, 1.0 / 3, 0, 1.0 / 3));
}

TEST(Centroid, TwoComponentsHaveTheirBlendAsCentroid) {
    const auto design = builtDesign(centroidRequest(2));
    EXPECT_THAT(mixturesOf(design), ElementsAre(ElementsAre(1, 0), ElementsAre(0, 1), ElementsAre(0.5, 0.5)));
    EXPECT_THAT(typesOf(design), ElementsAre(1, 1, 0));
    EXPECT_THAT(design.pointsPerType, ElementsAre(2, 0));
}

TEST(Centroid, CountsPointsPerTypeWithoutTheCentroid) {
    const auto design = builtDesign(centroidRequest(5));
    EXPECT_THAT(design.pointsPerType, ElementsAre(5, 10, 10, 5, 0));
    EXPECT_EQ(design.numCenterPoints, 1U);
    EXPECT_EQ(design.numAxialPoints, 0U);
}

TEST(Centroid, WithoutAmountsEveryRunHasAmountOne) {
    EXPECT_THAT(amountsOf(builtDesign(centroidRequest(3))), Each(1.0));
}

TEST(Centroid, ReservedWordOfEveryRunIsOne) {
    MixtureRecord record(centroidRequest(3));
    ASSERT_EQ(record.run(), des_Success);
    for (std::uint32_t i = 0; i < record->numRuns; ++i)
        EXPECT_EQ(record->runs[i].reserved, 1U);
}

TEST(Centroid, WithoutProcessVariablesThereAreNoProcessLevels) {
    MixtureRecord record(centroidRequest(3));
    ASSERT_EQ(record.run(), des_Success);
    for (std::uint32_t i = 0; i < record->numRuns; ++i)
        EXPECT_EQ(record->runs[i].processLevels, nullptr);
}

TEST(Centroid, UnitBoundsAreReportedAsTheyAre) {
    const auto design = builtDesign(centroidRequest(3));
    EXPECT_THAT(design.scaledLowerBounds, Each(0.0));
    EXPECT_THAT(design.scaledUpperBounds, Each(1.0));
    EXPECT_THAT(design.pseudoLowerBounds, Each(0.0));
    EXPECT_THAT(design.pseudoUpperBounds, Each(1.0));
}

TEST(Centroid, BoundaryCountsAreThoseOfASimplex) {
    EXPECT_THAT(builtDesign(centroidRequest(5)).boundaryCounts, ElementsAre(5, 10, 10, 5, 1));
}

class CentroidSize : public testing::TestWithParam<std::uint32_t> {};

TEST_P(CentroidSize, IsThePlainDesign) {
    expectPlain(centroidRequest(GetParam()));
}

TEST_P(CentroidSize, IsThePlainDesignWithAxialPoints) {
    MixtureRequest request = centroidRequest(GetParam());
    request.axialPoints = 1;
    expectPlain(request);
}

INSTANTIATE_TEST_SUITE_P(Components, CentroidSize, testing::Values(2, 3, 4, 5, 6, 7, 8, 9, 10, 12, 14),
                         testing::PrintToStringParamName());

TEST(Centroid, SixteenComponentsGiveEverySubsetOnce) {
    const auto design = builtDesign(centroidRequest(16));
    ASSERT_EQ(design.runs.size(), 65535U);
    for (std::uint32_t type = 1; type < 16; ++type)
        EXPECT_EQ(design.pointsPerType[type - 1], plainBinomial(16, type));
    EXPECT_EQ(design.pointsPerType[15], 0U);
    EXPECT_EQ(design.runs.back().pointType, 0);
}

TEST(AxialPoints, StandBehindTheBaseDesign) {
    MixtureRequest request = centroidRequest(3);
    request.axialPoints = 1;
    const auto design = builtDesign(request);
    EXPECT_THAT(typesOf(design), ElementsAre(1, 1, 1, 2, 2, 2, 0, -1, -1, -1));
    EXPECT_THAT(ordersOf(design), ElementsAreArray(standardOrder(10)));
}

TEST(AxialPoints, LieHalfwayBetweenVertexAndCentroid) {
    MixtureRequest request = centroidRequest(3);
    request.axialPoints = 1;
    const auto mixtures = mixturesOf(builtDesign(request));
    EXPECT_THAT(mixtures[7], ElementsAre(4.0 / 6, 1.0 / 6, 1.0 / 6));
    EXPECT_THAT(mixtures[8], ElementsAre(1.0 / 6, 4.0 / 6, 1.0 / 6));
    EXPECT_THAT(mixtures[9], ElementsAre(1.0 / 6, 1.0 / 6, 4.0 / 6));
}

TEST(AxialPoints, AreCountedApart) {
    MixtureRequest request = centroidRequest(4);
    request.axialPoints = 1;
    const auto design = builtDesign(request);
    EXPECT_EQ(design.numAxialPoints, 4U);
    EXPECT_EQ(design.numCenterPoints, 1U);
    EXPECT_THAT(design.pointsPerType, ElementsAre(4, 6, 4, 0));
}

class AnyFlagValue : public testing::TestWithParam<std::uint8_t> {};

TEST_P(AnyFlagValue, OtherThanZeroAddsAxialPoints) {
    MixtureRequest request = centroidRequest(3);
    request.axialPoints = GetParam();
    EXPECT_EQ(builtDesign(request).runs.size(), 10U);
}

TEST_P(AnyFlagValue, OtherThanZeroAddsTheCentreToALattice) {
    EXPECT_EQ(builtDesign(latticeRequest(3, 2, GetParam())).runs.size(), 7U);
}

TEST_P(AnyFlagValue, OtherThanZeroRandomizes) {
    MixtureRequest request = centroidRequest(8);
    request.seed = 17.0;
    request.randomize = 1;
    const auto randomized = ordersOf(builtDesign(request));
    request.randomize = GetParam();
    EXPECT_EQ(ordersOf(builtDesign(request)), randomized);
    EXPECT_NE(randomized, standardOrder(255));
}

INSTANTIATE_TEST_SUITE_P(Values, AnyFlagValue, testing::Values(1, 2, 128, 255),
                         [](const auto& instance) { return std::to_string(instance.param); });

}  // namespace
}  // namespace reisti::test
