#include <algorithm>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <vector>

#include "reisti/reisti.h"
#include "unit/mixture/expect_plain.h"

namespace reisti::test {
namespace {

using testing::ElementsAre;
using testing::ElementsAreArray;
using testing::IsEmpty;

TEST(PointReplicates, FurtherVerticesStandBehindTheDistinctPoints) {
    MixtureRequest request = centroidRequest(3);
    request.vertexReplicates = 2;
    const auto design = builtDesign(request);
    ASSERT_EQ(design.runs.size(), 10U);
    EXPECT_THAT(typesOf(design), ElementsAre(1, 1, 1, 2, 2, 2, 0, 1, 1, 1));
    EXPECT_THAT(design.runs[7].proportions, ElementsAre(1, 0, 0));
    EXPECT_THAT(design.runs[8].proportions, ElementsAre(0, 1, 0));
    EXPECT_THAT(design.runs[9].proportions, ElementsAre(0, 0, 1));
}

TEST(PointReplicates, CopiesAreNumberedOn) {
    MixtureRequest request = centroidRequest(3);
    request.vertexReplicates = 3;
    EXPECT_THAT(ordersOf(builtDesign(request)), ElementsAreArray(standardOrder(13)));
}

TEST(PointReplicates, CopiesOfOnePointStandTogether) {
    MixtureRequest request = centroidRequest(3);
    request.typeReplicates = {3};
    const auto mixtures = mixturesOf(builtDesign(request));
    ASSERT_EQ(mixtures.size(), 13U);
    EXPECT_THAT(mixtures[7], ElementsAre(0.5, 0.5, 0));
    EXPECT_THAT(mixtures[8], ElementsAre(0.5, 0.5, 0));
    EXPECT_THAT(mixtures[9], ElementsAre(0.5, 0, 0.5));
    EXPECT_THAT(mixtures[10], ElementsAre(0.5, 0, 0.5));
    EXPECT_THAT(mixtures[11], ElementsAre(0, 0.5, 0.5));
    EXPECT_THAT(mixtures[12], ElementsAre(0, 0.5, 0.5));
}

TEST(PointReplicates, ClassesComeByTypeThenCentroidThenAxial) {
    MixtureRequest request = centroidRequest(3);
    request.axialPoints = 1;
    request.vertexReplicates = request.centerReplicates = request.axialReplicates = 2;
    request.typeReplicates = {2};
    EXPECT_THAT(typesOf(builtDesign(request)),
                ElementsAre(1, 1, 1, 2, 2, 2, 0, -1, -1, -1, 1, 1, 1, 2, 2, 2, 0, -1, -1, -1));
}

TEST(PointReplicates, EachTypeHasItsOwnCount) {
    MixtureRequest request = centroidRequest(5);
    request.typeReplicates = {2, 3, 4};
    const auto types = typesOf(builtDesign(request));
    EXPECT_EQ(std::count(types.begin(), types.end(), 1), 5);
    EXPECT_EQ(std::count(types.begin(), types.end(), 2), 20);
    EXPECT_EQ(std::count(types.begin(), types.end(), 3), 30);
    EXPECT_EQ(std::count(types.begin(), types.end(), 4), 20);
    EXPECT_EQ(std::count(types.begin(), types.end(), 0), 1);
}

TEST(PointReplicates, NullTypeReplicatesMeanOnceEach) {
    MixtureRequest request = centroidRequest(5);
    const auto without = builtDesign(request);
    request.typeReplicates = {1, 1, 1};
    EXPECT_TRUE(sameOutcome(without, builtDesign(request)));
    EXPECT_EQ(without.runs.size(), 31U);
}

TEST(PointReplicates, CountsOfDistinctPointsAreNotMultiplied) {
    MixtureRequest request = centroidRequest(3);
    request.axialPoints = 1;
    request.vertexReplicates = request.centerReplicates = request.axialReplicates = 4;
    request.typeReplicates = {4};
    request.designReplicates = 2;
    const auto design = builtDesign(request);
    EXPECT_THAT(design.pointsPerType, ElementsAre(3, 3, 0));
    EXPECT_EQ(design.numCenterPoints, 1U);
    EXPECT_EQ(design.numAxialPoints, 3U);
}

TEST(PointReplicates, AxialCountIsNotReadWithoutAxialPoints) {
    MixtureRequest request = centroidRequest(3);
    request.axialReplicates = 4000000000U;
    EXPECT_EQ(builtDesign(request).runs.size(), 7U);
}

TEST(PointReplicates, CentreCountIsNotReadWithoutACentre) {
    MixtureRequest request = latticeRequest(3, 2);
    request.centerReplicates = 4000000000U;
    EXPECT_EQ(builtDesign(request).runs.size(), 6U);
}

TEST(PointReplicates, OfTypesThatALatticeLacksAreNotRead) {
    MixtureRequest request = latticeRequest(5, 2);
    request.typeReplicates = {2, 4000000000U, 4000000000U};
    EXPECT_EQ(builtDesign(request).runs.size(), 25U);
}

TEST(PointReplicates, BlendsOfAllComponentsOffTheCentreAreRunOnce) {
    MixtureRequest request = latticeRequest(3, 4);
    request.vertexReplicates = 2;
    request.typeReplicates = {2};
    const auto types = typesOf(builtDesign(request));
    EXPECT_EQ(std::count(types.begin(), types.end(), 1), 6);
    EXPECT_EQ(std::count(types.begin(), types.end(), 2), 18);
    EXPECT_EQ(std::count(types.begin(), types.end(), 3), 3);
}

TEST(PointReplicates, OfTwoComponentsHaveNoTypeReplicates) {
    MixtureRequest request = latticeRequest(2, 3);
    request.vertexReplicates = 3;
    EXPECT_THAT(typesOf(builtDesign(request)), ElementsAre(1, 2, 2, 1, 1, 1, 1, 1));
}

TEST(LeftOutPoints, OfTheVerticesLeaveTheOthersInOrder) {
    MixtureRequest request = centroidRequest(3);
    request.vertexReplicates = 0;
    const auto design = builtDesign(request);
    EXPECT_EQ(design.code, des_Success);
    EXPECT_THAT(typesOf(design), ElementsAre(2, 2, 2, 0));
    EXPECT_THAT(design.runs[0].proportions, ElementsAre(0.5, 0.5, 0));
    EXPECT_THAT(ordersOf(design), ElementsAreArray(standardOrder(4)));
}

TEST(LeftOutPoints, OfOneTypeInTheMiddle) {
    MixtureRequest request = centroidRequest(4);
    request.typeReplicates = {0, 2};
    const auto design = builtDesign(request);
    EXPECT_THAT(typesOf(design), ElementsAre(1, 1, 1, 1, 3, 3, 3, 3, 0, 3, 3, 3, 3));
    EXPECT_THAT(ordersOf(design), ElementsAreArray(standardOrder(13)));
}

TEST(LeftOutPoints, OfTheCentroid) {
    MixtureRequest request = centroidRequest(3);
    request.centerReplicates = 0;
    request.axialPoints = 1;
    EXPECT_THAT(typesOf(builtDesign(request)), ElementsAre(1, 1, 1, 2, 2, 2, -1, -1, -1));
}

TEST(LeftOutPoints, OfTheAxialPoints) {
    MixtureRequest request = centroidRequest(3);
    request.axialPoints = 1;
    request.axialReplicates = 0;
    EXPECT_THAT(typesOf(builtDesign(request)), ElementsAre(1, 1, 1, 2, 2, 2, 0));
}

TEST(LeftOutPoints, OfTheCentreAddedToALattice) {
    MixtureRequest request = latticeRequest(3, 2, 1);
    request.centerReplicates = 0;
    const auto design = builtDesign(request);
    EXPECT_THAT(typesOf(design), ElementsAre(1, 2, 2, 1, 2, 1));
    EXPECT_EQ(design.numCenterPoints, 1U);
}

TEST(LeftOutPoints, OfTheCentreInsideALattice) {
    MixtureRequest request = latticeRequest(3, 3);
    request.centerReplicates = 0;
    const auto design = builtDesign(request);
    EXPECT_THAT(typesOf(design), ElementsAre(1, 2, 2, 2, 2, 1, 2, 2, 1));
    EXPECT_THAT(ordersOf(design), ElementsAreArray(standardOrder(9)));
}

TEST(LeftOutPoints, AreStillCountedAsDistinctPoints) {
    MixtureRequest request = centroidRequest(3);
    request.axialPoints = 1;
    request.vertexReplicates = request.centerReplicates = request.axialReplicates = 0;
    request.typeReplicates = {1};
    const auto design = builtDesign(request);
    EXPECT_EQ(design.runs.size(), 3U);
    EXPECT_THAT(design.pointsPerType, ElementsAre(3, 3, 0));
    EXPECT_EQ(design.numCenterPoints, 1U);
    EXPECT_EQ(design.numAxialPoints, 3U);
}

/// Nothing to run is no error: the bounds are checked, reported and restored as ever.
struct EmptyCase {
    std::string name;
    MixtureRequest request;
};

std::vector<EmptyCase> emptyCases() {
    MixtureRequest noReplicates = centroidRequest(3);
    noReplicates.designReplicates = 0;
    MixtureRequest noPoints = centroidRequest(3);
    noPoints.vertexReplicates = noPoints.centerReplicates = 0;
    noPoints.typeReplicates = {0};
    MixtureRequest everything = noReplicates;
    everything.axialPoints = everything.randomize = 1;
    everything.amounts = {10};
    everything.lowerBounds = {1, 2, 3};
    everything.upperBounds = {10, 10, 10};
    everything.numProcessVariables = 3;
    everything.processFraction = 2;
    everything.seed = 4.0;
    MixtureRequest amounts = noPoints;
    amounts.amounts = {1, 2, 3};
    MixtureRequest lattice = latticeRequest(3, 2, 1);
    lattice.designReplicates = 0;
    return {{"NoDesignReplicates", noReplicates},
            {"NoPointReplicates", noPoints},
            {"WithEverythingElse", everything},
            {"WithAmounts", amounts},
            {"Lattice", lattice}};
}

class EmptyDesign : public testing::TestWithParam<EmptyCase> {};

TEST_P(EmptyDesign, HasNoRunsAndIsDeleted) {
    MixtureRecord record(GetParam().request);
    EXPECT_EQ(record.run(), des_Success);
    EXPECT_EQ(record->numRuns, 0U);
}

TEST_P(EmptyDesign, ReportsBoundsAndCountsAsEver) {
    expectPlain(GetParam().request);
}

INSTANTIATE_TEST_SUITE_P(All, EmptyDesign, testing::ValuesIn(emptyCases()),
                         [](const auto& instance) { return instance.param.name; });

TEST(DesignReplicates, RepeatTheWholeSet) {
    MixtureRequest request = centroidRequest(3);
    request.designReplicates = 3;
    const auto design = builtDesign(request);
    ASSERT_EQ(design.runs.size(), 21U);
    EXPECT_THAT(ordersOf(design), ElementsAreArray(standardOrder(21)));
    for (std::size_t i = 7; i < 21; ++i) {
        EXPECT_EQ(design.runs[i].pointType, design.runs[i - 7].pointType);
        EXPECT_EQ(design.runs[i].proportions, design.runs[i - 7].proportions);
    }
}

TEST(DesignReplicates, RepeatThePointReplicatesToo) {
    MixtureRequest request = latticeRequest(3, 2);
    request.vertexReplicates = 2;
    request.designReplicates = 2;
    EXPECT_THAT(typesOf(builtDesign(request)), ElementsAre(1, 2, 2, 1, 2, 1, 1, 1, 1, 1, 2, 2, 1, 2, 1, 1, 1, 1));
}

TEST(Replication, InEveryCombinationIsThePlainDesign) {
    for (const bool lattice : {false, true}) {
        for (unsigned i = 0; i < 3 * 3 * 3 * 3 * 3; ++i) {
            MixtureRequest request = lattice ? latticeRequest(4, 2, 1) : centroidRequest(4);
            request.axialPoints = 1;
            request.vertexReplicates = i % 3;
            request.typeReplicates = {i / 3 % 3, 2 - i / 3 % 3};
            request.centerReplicates = i / 9 % 3;
            request.axialReplicates = i / 27 % 3;
            request.designReplicates = i / 81;
            SCOPED_TRACE(testing::Message() << (lattice ? "lattice, " : "centroid, ") << i);
            expectPlain(request);
        }
    }
}

}  // namespace
}  // namespace reisti::test
