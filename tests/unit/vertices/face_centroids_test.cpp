// The centroids of edges and faces, from tables of points and slack given by hand.
#include "mixture/face_centroids.h"

#include <cstddef>
#include <gtest/gtest.h>
#include <random>
#include <vector>

#include "support/vertex_engine.h"

namespace reisti::test {
namespace {

constexpr int kNoLimit = 2147483647;
constexpr double kThird = 1.0 / 3.0;

const Table kSimplex = {{0, 0, 1}, {1, 0, 0}, {0, 1, 0}};

/// Slack of the bounds 0 and 1.
Table unitSlack(const Table& points) {
    Table slack;
    for (const auto& x : points) {
        slack.push_back(x);
        for (const double component : x)
            slack.back().push_back(1.0 - component);
    }
    return slack;
}

TEST(FaceCentroids, DegreeOneGivesNone) {
    const auto found = faceCentroids(kSimplex, unitSlack(kSimplex), 6, 3, 1, kNoLimit);
    EXPECT_TRUE(found.withinLimit);
    EXPECT_EQ(found.count, 0);
    EXPECT_EQ(found.points, kSimplex);
}

TEST(FaceCentroids, DegreeZeroGivesNone) {
    const auto found = faceCentroids(kSimplex, unitSlack(kSimplex), 6, 3, 0, kNoLimit);
    EXPECT_TRUE(found.withinLimit);
    EXPECT_EQ(found.count, 0);
}

TEST(FaceCentroids, ANegativeDegreeGivesNone) {
    const auto found = faceCentroids(kSimplex, unitSlack(kSimplex), 6, 3, -3, kNoLimit);
    EXPECT_TRUE(found.withinLimit);
    EXPECT_EQ(found.count, 0);
}

TEST(FaceCentroids, EdgesOfTheSimplexAreMetThroughItsLowerBounds) {
    const auto found = faceCentroids(kSimplex, unitSlack(kSimplex), 6, 3, 2, kNoLimit);
    EXPECT_EQ(found.count, 3);
    EXPECT_TRUE(
        sameTable(found.points, {{0, 0, 1}, {1, 0, 0}, {0, 1, 0}, {0, 0.5, 0.5}, {0.5, 0, 0.5}, {0.5, 0.5, 0}}));
    EXPECT_EQ(found.types, (std::vector<int>{1, 1, 1, 2, 2, 2}));
}

TEST(FaceCentroids, FullDegreeAddsTheOverallCentroidLastWithTypeZero) {
    const auto found = faceCentroids(kSimplex, unitSlack(kSimplex), 6, 3, 3, kNoLimit);
    EXPECT_EQ(found.count, 4);
    ASSERT_EQ(found.points.size(), 7U);
    EXPECT_EQ(found.points.back(), (std::vector<double>{kThird, kThird, kThird}));
    EXPECT_EQ(found.types.back(), 0);
}

TEST(FaceCentroids, TwoComponentsHaveTheirCentroidAsOverallCentroid) {
    const Table segment = {{0, 1}, {1, 0}};
    const auto found = faceCentroids(segment, unitSlack(segment), 4, 2, 2, kNoLimit);
    EXPECT_TRUE(sameTable(found.points, {{0, 1}, {1, 0}, {0.5, 0.5}}));
    EXPECT_EQ(found.types, (std::vector<int>{1, 1, 0}));
}

TEST(FaceCentroids, AllVerticesOnAnEdgeAreAveraged) {
    const Table points = {{0, 0, 1}, {0, 1, 0}, {0, 0.25, 0.75}, {1, 0, 0}};
    const auto found = faceCentroids(points, unitSlack(points), 6, 3, 2, kNoLimit);
    EXPECT_EQ(found.points.at(4), (std::vector<double>{0, (1 + 0.25) / 3, (1 + 0.75) / 3}));
}

TEST(FaceCentroids, TwoPlanesThroughTheSameVerticesGiveOneCentroid) {
    Table slack = unitSlack(kSimplex);
    for (auto& row : slack)
        row.push_back(row[0]);
    const auto found = faceCentroids(kSimplex, slack, 7, 3, 2, kNoLimit);
    EXPECT_EQ(found.count, 3);
}

TEST(FaceCentroids, APlaneWithoutEnoughVerticesGivesNoFace) {
    Table slack = unitSlack(kSimplex);
    for (std::size_t r = 0; r < slack.size(); ++r)
        slack[r].push_back(r == 0 ? 0.0 : 1.0);
    const auto found = faceCentroids(kSimplex, slack, 7, 3, 2, kNoLimit);
    EXPECT_EQ(found.count, 3);
}

TEST(FaceCentroids, AVertexWithinTheToleranceOfAPlaneIsOnIt) {
    for (const double offset : {1e-4, -1e-4}) {
        Table slack = unitSlack(kSimplex);
        for (std::size_t r = 0; r < slack.size(); ++r)
            slack[r][0] = r == 1 ? 1.0 : offset;
        EXPECT_EQ(faceCentroids(kSimplex, slack, 6, 3, 2, kNoLimit).count, 3);
    }
}

TEST(FaceCentroids, AVertexJustBeyondTheToleranceIsNotOnThePlane) {
    for (const double offset : {1.0001e-4, -1.0001e-4}) {
        Table slack = unitSlack(kSimplex);
        slack[0][0] = offset;
        EXPECT_EQ(faceCentroids(kSimplex, slack, 6, 3, 2, kNoLimit).count, 2);
    }
}

TEST(FaceCentroids, CentroidsWithinTheToleranceInEveryCoordinateAreOne) {
    // Beside (0, 0, 1) lies another vertex: the edges to (1, 0, 0) have midpoints half as far apart.
    for (const double gap : {1.9e-5, 2.1e-5}) {
        const Table points = {{0, 0, 1}, {1, 0, 0}, {0, gap, 1 - gap}};
        Table slack(3, std::vector<double>(6, 1.0));
        slack[0][0] = slack[1][0] = 0.0;
        slack[1][1] = slack[2][1] = 0.0;
        EXPECT_EQ(faceCentroids(points, slack, 6, 3, 2, kNoLimit).count, gap < 2e-5 ? 1 : 2) << gap;
    }
}

TEST(FaceCentroids, ACentroidIsComparedWithCentroidsAndNotWithVertices) {
    // The last vertex lies where the centroid of the first two is.
    const Table points = {{0, 0, 1}, {0, 1, 0}, {0, 0.5, 0.5}};
    Table slack(3, std::vector<double>(6, 1.0));
    slack[0][0] = slack[1][0] = 0.0;
    const auto found = faceCentroids(points, slack, 6, 3, 2, kNoLimit);
    EXPECT_EQ(found.count, 1);
    EXPECT_EQ(found.points.back(), (std::vector<double>{0, 0.5, 0.5}));
}

TEST(FaceCentroids, AnOverallCentroidThatIsAFaceCentroidAlreadyIsNotAddedAgain) {
    // A plane on which every vertex lies: the centroid of the "edge" is the overall one.
    Table slack = unitSlack(kSimplex);
    for (auto& row : slack)
        row.push_back(0.0);
    const auto found = faceCentroids(kSimplex, slack, 7, 3, 3, kNoLimit);
    EXPECT_EQ(found.count, 4);
    EXPECT_EQ(found.types, (std::vector<int>{1, 1, 1, 2, 2, 2, 2}));
}

TEST(FaceCentroids, FewerVerticesThanComponentsHaveNoOverallCentroid) {
    const Table points = {{0.5, 0.5, 0}, {0.5, 0, 0.5}};
    const auto found = faceCentroids(points, Table(2, std::vector<double>(6, 1.0)), 6, 3, 3, kNoLimit);
    EXPECT_EQ(found.count, 0);
}

TEST(FaceCentroids, NoVerticesHaveNoCentroids) {
    const auto found = faceCentroids({}, {}, 6, 3, 3, kNoLimit);
    EXPECT_TRUE(found.withinLimit);
    EXPECT_EQ(found.count, 0);
}

TEST(FaceCentroidLimit, ExactlyAsManyPointsAsAllowedSucceed) {
    const auto found = faceCentroids(kSimplex, unitSlack(kSimplex), 6, 3, 3, 7);
    EXPECT_TRUE(found.withinLimit);
    EXPECT_EQ(found.points.size(), 7U);
}

TEST(FaceCentroidLimit, OneLessThanNeededFails) {
    EXPECT_FALSE(faceCentroids(kSimplex, unitSlack(kSimplex), 6, 3, 3, 6).withinLimit);
}

TEST(FaceCentroidLimit, TheNumberOfVerticesFailsAtTheFirstCentroid) {
    const auto found = faceCentroids(kSimplex, unitSlack(kSimplex), 6, 3, 2, 3);
    EXPECT_FALSE(found.withinLimit);
    EXPECT_EQ(found.count, 0);
    EXPECT_EQ(found.points, kSimplex);
}

TEST(FaceCentroidLimit, FewerPointsThanVerticesAreNoticedAtTheFirstCentroidOnly) {
    EXPECT_TRUE(faceCentroids(kSimplex, unitSlack(kSimplex), 6, 3, 1, 2).withinLimit);
    EXPECT_FALSE(faceCentroids(kSimplex, unitSlack(kSimplex), 6, 3, 2, 2).withinLimit);
}

TEST(FaceCentroidLimit, CentroidsAddedBeforeTheFailureStay) {
    const auto found = faceCentroids(kSimplex, unitSlack(kSimplex), 6, 3, 3, 5);
    EXPECT_FALSE(found.withinLimit);
    EXPECT_TRUE(sameTable(found.points, {{0, 0, 1}, {1, 0, 0}, {0, 1, 0}, {0, 0.5, 0.5}, {0.5, 0, 0.5}}));
}

TEST(FaceCentroidLimit, OnlyFinishedDimensionsAreCountedAndTyped) {
    const auto found = faceCentroids(kSimplex, unitSlack(kSimplex), 6, 3, 3, 6);
    EXPECT_FALSE(found.withinLimit);
    EXPECT_EQ(found.count, 3);
    EXPECT_EQ(found.types, (std::vector<int>{1, 1, 1, 2, 2, 2}));
}

TEST(FaceCentroidTypes, EntriesBeforeAndBehindTheCentroidsAreKept) {
    auto points = matrixOf(kSimplex, 3);
    const auto slack = matrixOf(unitSlack(kSimplex), 6);
    std::vector<int> types = {8, 8, 8, 8, 8, 8, 8, 8, 8};
    int count = 99;
    ASSERT_TRUE(mCalculateCentroidsControl(6, count, 3, 3, 3, slack, points, types, kNoLimit));
    EXPECT_EQ(types, (std::vector<int>{8, 8, 8, 2, 2, 2, 0, 8, 8}));
}

/// A random table of vertices on many planes: each vertex lies on about `tight` of them.
Table randomSlack(std::mt19937_64& random, std::size_t numVertices, std::size_t numPlanes, std::size_t tight) {
    Table slack(numVertices, std::vector<double>(numPlanes, 1.0));
    for (auto& row : slack)
        for (auto& value : row)
            if (random() % numPlanes < tight) value = random() % 4 == 0 ? 9e-5 : 0.0;
    return slack;
}

TEST(FaceCentroidPlanes, MoreThanSixtyFourPlanesGiveTheSameAsAllSubsets) {
    std::mt19937_64 random(5);
    for (const std::size_t numPlanes : {64U, 65U, 70U, 129U}) {
        for (const int q : {3, 4}) {
            Table points(30);
            for (auto& x : points)
                for (int j = 0; j < q; ++j)
                    x.push_back(static_cast<double>(random() % 1000) / 1000.0);
            const Table slack = randomSlack(random, points.size(), numPlanes, 9);
            const auto planes = static_cast<int>(numPlanes);
            EXPECT_TRUE(sameCentroids(faceCentroids(points, slack, planes, q, q, kNoLimit),
                                      plainFaceCentroids(points, slack, planes, q, q, kNoLimit)))
                << numPlanes << " planes, q " << q;
        }
    }
}

}  // namespace
}  // namespace reisti::test
