// Constrained regions from the literature: their vertices, the centroids of their faces, their implied bounds.
#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <numeric>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "support/golden_lines.h"
#include "support/vertices_record.h"

namespace reisti::test {
namespace {

constexpr double kExactPoint = 1e-12;
constexpr double kPrintedPoint = 6e-5;
constexpr double kSinglePrecision = 1e-6;

/// A point and the dimension of the face whose centroid it is.
struct Centroid {
    std::int32_t dimension;
    std::vector<double> mixture;
};

PlainConstraint constraintOf(const std::vector<std::string>& words) {
    const auto groups = groupsOf(words);
    const std::vector<double> sides = numbersFrom(groups.at(0));
    return {sides.at(0) != 0.0, sides.at(1), sides.at(2) != 0.0, sides.at(3), numbersFrom(groups.at(1)), STATUS_BEFORE};
}

VerticesRequest requestOf(const GoldenLines& golden) {
    VerticesRequest request = verticesRequest(golden.numbers("lowerBounds"), golden.numbers("upperBounds"));
    for (const auto& words : golden.all("constraint"))
        request.constraints.push_back(constraintOf(words));
    return request;
}

std::vector<std::vector<double>> pointsOf(const GoldenLines& golden, const std::string& keyword) {
    std::vector<std::vector<double>> points;
    for (const auto& words : golden.all(keyword))
        points.push_back(numbersFrom(words));
    return points;
}

std::vector<Centroid> centroidsOf(const GoldenLines& golden, const std::string& keyword) {
    std::vector<Centroid> centroids;
    for (const auto& words : golden.all(keyword)) {
        const auto groups = groupsOf(words);
        centroids.push_back({std::stoi(groups.at(0).at(0)), numbersFrom(groups.at(1))});
    }
    return centroids;
}

bool near(const std::vector<double>& a, const std::vector<double>& b, double tolerance) {
    return std::equal(a.begin(), a.end(), b.begin(), b.end(),
                      [=](double x, double y) { return std::fabs(x - y) <= tolerance; });
}

class PublishedRegion : public testing::TestWithParam<std::string> {
  protected:
    VerticesOutcome built(std::int32_t degree) const {
        VerticesRequest request = requestOf(golden_);
        request.degree = degree;
        return builtVertices(request);
    }
    VerticesOutcome builtWhole() const { return built(static_cast<std::int32_t>(q_)); }

    /// The runs of a type, as points.
    static std::vector<std::vector<double>> ofType(const VerticesOutcome& design, std::int32_t type) {
        std::vector<std::vector<double>> points;
        for (const auto& run : design.design.runs)
            if (run.pointType == type) points.push_back(run.proportions);
        return points;
    }

    /// Each expected point is there, and as many points as expected.
    static void expectPoints(const std::vector<std::vector<double>>& actual,
                             const std::vector<std::vector<double>>& expected, double tolerance) {
        EXPECT_EQ(actual.size(), expected.size());
        for (const auto& x : expected) {
            const bool found =
                std::any_of(actual.begin(), actual.end(), [&](const auto& point) { return near(point, x, tolerance); });
            EXPECT_TRUE(found) << testing::PrintToString(x);
        }
    }

    /// The point type of the centroid of a face.
    std::int32_t typeOf(std::int32_t dimension) const {
        return dimension + 1 == static_cast<std::int32_t>(q_) ? 0 : dimension + 1;
    }

    std::vector<std::vector<double>> ofDimension(const std::vector<Centroid>& centroids, std::int32_t dimension) const {
        std::vector<std::vector<double>> points;
        for (const auto& centroid : centroids)
            if (centroid.dimension == dimension) points.push_back(centroid.mixture);
        return points;
    }

    const GoldenLines golden_{"vertices/" + GetParam() + ".txt"};
    const std::size_t q_ = static_cast<std::size_t>(golden_.integer("numComponents"));
};

TEST_P(PublishedRegion, HasItsVertices) {
    expectPoints(ofType(built(1), 1), pointsOf(golden_, "vertex"), kExactPoint);
}

TEST_P(PublishedRegion, HasTheCentroidsOfItsFaces) {
    const VerticesOutcome design = builtWhole();
    const std::vector<Centroid> centroids = centroidsOf(golden_, "centroid");
    for (std::int32_t dimension = 1; dimension < static_cast<std::int32_t>(q_); ++dimension)
        expectPoints(ofType(design, typeOf(dimension)), ofDimension(centroids, dimension), kExactPoint);
}

TEST_P(PublishedRegion, HasItsNumberOfPointsForEachDegree) {
    const std::vector<double> counts = golden_.numbers("basePoints");
    ASSERT_EQ(counts.size(), q_);
    for (std::size_t degree = 1; degree <= q_; ++degree)
        EXPECT_EQ(built(static_cast<std::int32_t>(degree)).design.runs.size(), counts[degree - 1]);
}

TEST_P(PublishedRegion, HasItsFacesByDimension) {
    const VerticesOutcome design = builtWhole();
    std::vector<double> faces(design.design.pointsPerType.begin(), design.design.pointsPerType.end());
    faces.back() = design.design.numCenterPoints;
    EXPECT_EQ(faces, golden_.numbers("faces"));
}

TEST_P(PublishedRegion, HasItsBoundaryCounts) {
    const VerticesOutcome design = built(1);
    EXPECT_EQ(std::vector<double>(design.design.boundaryCounts.begin(), design.design.boundaryCounts.end()),
              golden_.numbers("boundaryCounts"));
}

TEST_P(PublishedRegion, TightensItsBoundsToTheImpliedOnes) {
    const VerticesOutcome design = built(1);
    EXPECT_TRUE(near(design.design.lowerBounds, golden_.numbers("impliedLower"), kExactPoint));
    EXPECT_TRUE(near(design.design.upperBounds, golden_.numbers("impliedUpper"), kExactPoint));
    EXPECT_EQ(design.design.boundsAdjusted, golden_.integer("boundsAdjusted") != 0);
}

TEST_P(PublishedRegion, LeavesTheStatusOfConstraintsThatCut) {
    for (const std::int32_t status : built(1).statuses)
        EXPECT_EQ(status, STATUS_BEFORE);
}

TEST_P(PublishedRegion, AgreesWithWhatWasPrinted) {
    const VerticesOutcome design = builtWhole();
    if (golden_.has("printedVertex"))
        expectPoints(ofType(design, 1), pointsOf(golden_, "printedVertex"), kPrintedPoint);
    if (golden_.has("printedEdgeCentroid"))
        expectPoints(ofType(design, 2), pointsOf(golden_, "printedEdgeCentroid"), kPrintedPoint);
    if (golden_.has("printedOverallCentroid"))
        expectPoints(ofType(design, 0), pointsOf(golden_, "printedOverallCentroid"), kPrintedPoint);
    const std::vector<Centroid> program = centroidsOf(golden_, "programPoint");
    for (std::int32_t dimension = 0; !program.empty() && dimension < static_cast<std::int32_t>(q_); ++dimension)
        expectPoints(ofType(design, typeOf(dimension)), ofDimension(program, dimension), kSinglePrecision);
}

TEST_P(PublishedRegion, HasAnAxialPointHalfwayFromEachVertexToTheirMean) {
    VerticesRequest request = requestOf(golden_);
    request.axialPoints = 1;
    const auto vertices = pointsOf(golden_, "vertex");
    std::vector<std::vector<double>> expected = vertices;
    for (std::size_t j = 0; j < q_; ++j) {
        double mean = 0.0;
        for (const auto& x : vertices)
            mean += x[j] / static_cast<double>(vertices.size());
        for (auto& x : expected)
            x[j] = (x[j] + mean) / 2.0;
    }
    expectPoints(ofType(builtVertices(request), -1), expected, kExactPoint);
}

INSTANTIATE_TEST_SUITE_P(All, PublishedRegion,
                         testing::Values("railroad_flare", "vinyl_plasticizers", "two_constraints", "hexagon",
                                         "simplex_3"),
                         [](const auto& instance) { return instance.param; });

}  // namespace
}  // namespace reisti::test
