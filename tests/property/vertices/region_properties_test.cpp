// What holds for every extreme vertices design, also at sizes that no plain enumeration reaches.
#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <iterator>
#include <numeric>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "support/plain_mixture.h"
#include "support/plain_vertices_design.h"
#include "support/random_regions.h"
#include "support/scale.h"
#include "support/vertices_record.h"

namespace reisti::test {
namespace {

/// Far above rounding.
constexpr double kOnPlane = 1e-10;
/// Beyond what the search for vertices, and that for centroids, takes for a point of a plane.
constexpr double kClearWhenCutting = 5e-6;
constexpr double kClearOfFaces = 2e-4;

VerticesRequest continuousRequest(RegionMaker& maker, std::size_t q) {
    VerticesRequest request;
    if (q > 3 && (q > 8 || maker.oneIn(2))) {
        maker.typicalBounds(q, request.lowerBounds, request.upperBounds);
    } else {
        maker.nominalBounds(q, 0.1 + 0.4 * maker.uniform(), request.lowerBounds, request.upperBounds);
    }
    request.outputUnits = des_UnitsProportion;
    return request;
}

/// Constraints with continuous coefficients, each through the middle of the region.
void addCuts(RegionMaker& maker, VerticesRequest& request, std::size_t count) {
    const std::size_t q = request.numComponents();
    for (std::size_t c = 0; c < count; ++c) {
        std::vector<double> coefficients(q);
        for (double& x : coefficients)
            x = 2.0 * maker.uniform() - 1.0;
        const std::vector<double> x = maker.inside(request.lowerBounds, request.upperBounds);
        request.constraints.push_back(
            atLeast(std::inner_product(x.begin(), x.end(), coefficients.begin(), 0.0), coefficients));
    }
}

/// The values of all planes at a point: positive inside.
std::vector<double> slackOf(const VerticesRequest& request, const std::vector<double>& x) {
    std::vector<double> slack;
    for (std::size_t j = 0; j < x.size(); ++j) {
        slack.push_back(x[j] - request.lowerBounds[j]);
        slack.push_back(request.upperBounds[j] - x[j]);
    }
    for (const PlainConstraint& c : request.constraints)
        slack.push_back(std::inner_product(x.begin(), x.end(), c.coefficients.begin(), 0.0) - c.lower);
    return slack;
}

/// How many of the planes of the region a point lies on; -1 when it lies outside.
int planesThrough(const VerticesRequest& request, const std::vector<double>& x) {
    const std::vector<double> slack = slackOf(request, x);
    if (std::any_of(slack.begin(), slack.end(), [](double s) { return s < -kOnPlane; })) return -1;
    return static_cast<int>(std::count_if(slack.begin(), slack.end(), [](double s) { return s <= kOnPlane; }));
}

/// Whether every vertex lies on a plane or clearly beside it. Elsewhere the tolerances of the search decide, and points
/// come and go that exact geometry does not know.
bool isClear(const VerticesRequest& request, const MixtureOutcome& design, double distance) {
    for (const auto& run : design.runs) {
        if (run.pointType != 1) continue;
        for (const double s : slackOf(request, run.proportions))
            if (s > kOnPlane && s < distance) return false;
    }
    return true;
}

/// Faces by dimension, from the types of the points.
std::vector<std::uint32_t> facesOf(const MixtureOutcome& design) {
    std::vector<std::uint32_t> faces = design.pointsPerType;
    faces.back() = design.numCenterPoints;
    return faces;
}

std::string describe(const VerticesRequest& request) {
    return describe(request.lowerBounds, request.upperBounds, request.constraints, 1.0);
}

struct BuiltRegion {
    VerticesRequest request;
    MixtureOutcome design;
};

class RegionProperties : public testing::TestWithParam<std::size_t> {
  protected:
    const std::size_t q_ = GetParam();
    RegionMaker maker_{900 + GetParam()};

    /// A random design, all of whose vertices are clear of the planes that they are not on.
    BuiltRegion clearRegion(std::int32_t degree, std::size_t maxCuts, double distance) {
        for (;;) {
            BuiltRegion made{continuousRequest(maker_, q_), {}};
            addCuts(maker_, made.request, maker_.below(maxCuts + 1));
            made.request.degree = 1;
            const VerticesOutcome vertices = builtVertices(made.request);
            EXPECT_EQ(vertices.design.code, des_Success);
            if (vertices.design.code == des_Success && !isClear(made.request, vertices.design, distance)) continue;
            // What does not cut is reported and left aside, be it that it would exclude everything.
            const auto& statuses = vertices.statuses;
            if (std::count(statuses.begin(), statuses.end(), STATUS_BEFORE) != std::ssize(statuses)) continue;
            made.request.degree = degree;
            made.design = builtVertices(made.request).design;
            return made;
        }
    }
};

/// The same for tests that need every face: their number grows like 4^q.
class AllFaces : public RegionProperties {};

TEST_P(RegionProperties, EveryVertexIsAMixtureOnEnoughPlanes) {
    for (int i = 0; i < scaled(30); ++i) {
        const auto [request, design] = clearRegion(1, 3, kClearWhenCutting);
        for (const auto& run : design.runs) {
            ASSERT_NEAR(std::accumulate(run.proportions.begin(), run.proportions.end(), 0.0), 1.0, 1e-12);
            ASSERT_GE(planesThrough(request, run.proportions), static_cast<int>(q_) - 1) << describe(request);
        }
    }
}

TEST_P(RegionProperties, FaceCentroidsLieOnAsManyPlanesAsTheirTypeLeaves) {
    for (int i = 0; i < scaled(10); ++i) {
        const auto [request, design] =
            clearRegion(static_cast<std::int32_t>(std::min<std::size_t>(q_, 4)), 2, kClearOfFaces);
        for (const auto& run : design.runs) {
            const int free = run.pointType == 0 ? static_cast<int>(q_) : run.pointType;
            ASSERT_GE(planesThrough(request, run.proportions), static_cast<int>(q_) - free) << describe(request);
        }
    }
}

TEST_P(AllFaces, WithinBoundsAreAsManyAsTheClosedFormulasCount) {
    for (int i = 0; i < scaled(10); ++i) {
        const auto [request, design] = clearRegion(static_cast<std::int32_t>(q_), 0, kClearOfFaces);
        ASSERT_EQ(facesOf(design), design.boundaryCounts) << describe(request);
    }
}

TEST_P(RegionProperties, VerticesWithinBoundsAreAsManyAsTheClosedFormulaCounts) {
    for (int i = 0; i < scaled(10); ++i) {
        const VerticesOutcome built = builtVertices(continuousRequest(maker_, q_));
        ASSERT_EQ(built.design.code, des_Success);
        ASSERT_EQ(built.design.pointsPerType[0], built.design.boundaryCounts[0]);
    }
}

// Euler's relation: vertices less edges plus faces and so on, the region included, is 1.
TEST_P(AllFaces, OfACutRegionFulfilEulersRelation) {
    for (int i = 0; i < scaled(20); ++i) {
        const auto [request, design] = clearRegion(static_cast<std::int32_t>(q_), 3, kClearOfFaces);
        std::int64_t sum = 0;
        std::int64_t sign = 1;
        for (const std::uint32_t count : facesOf(design)) {
            sum += sign * count;
            sign = -sign;
        }
        ASSERT_EQ(sum, 1) << describe(request);
    }
}

TEST_P(RegionProperties, ImpliedBoundsAreReachedByVertices) {
    for (int i = 0; i < scaled(20); ++i) {
        VerticesRequest request = continuousRequest(maker_, q_);
        addCuts(maker_, request, maker_.below(3));
        const MixtureOutcome design = builtVertices(request).design;
        for (std::size_t j = 0; j < q_; ++j) {
            const auto byComponent = [j](const auto& a, const auto& b) { return a.proportions[j] < b.proportions[j]; };
            const auto [least, greatest] = std::minmax_element(design.runs.begin(), design.runs.end(), byComponent);
            ASSERT_NEAR(least->proportions[j], design.lowerBounds[j], 1e-12);
            ASSERT_NEAR(greatest->proportions[j], design.upperBounds[j], 1e-12);
        }
    }
}

TEST_P(RegionProperties, ASecondRunGivesTheSameBits) {
    VerticesRequest request = continuousRequest(maker_, q_);
    request.degree = 2;
    request.axialPoints = request.randomize = 1;
    request.seed = 5.0;
    addCuts(maker_, request, 2);
    EXPECT_TRUE(sameOutcome(builtVertices(request), builtVertices(request)));
}

TEST_P(RegionProperties, PseudoComponentsMapBackToTheProportions) {
    for (int i = 0; i < scaled(10); ++i) {
        VerticesRequest request = continuousRequest(maker_, q_);
        addCuts(maker_, request, maker_.below(3));
        const MixtureOutcome proportions = builtVertices(request).design;
        request.outputUnits = des_UnitsPseudo;
        const MixtureOutcome pseudo = builtVertices(request).design;
        const double free = 1.0 - std::accumulate(pseudo.lowerBounds.begin(), pseudo.lowerBounds.end(), 0.0);
        if (free < 1e-3) continue;  // what is divided by so little says nothing
        for (std::size_t r = 0; r < pseudo.runs.size(); ++r)
            for (std::size_t j = 0; j < q_; ++j)
                ASSERT_NEAR(pseudo.runs[r].proportions[j] * free + pseudo.lowerBounds[j],
                            proportions.runs[r].proportions[j], 1e-10);
    }
}

INSTANTIATE_TEST_SUITE_P(Components, RegionProperties, testing::Values(3, 4, 5, 6, 7, 8, 10, 12),
                         testing::PrintToStringParamName());
INSTANTIATE_TEST_SUITE_P(Components, AllFaces, testing::Values(3, 4, 5, 6, 7, 8, 9), testing::PrintToStringParamName());

// The whole simplex of 20 components has 2^20 - 1 faces; the sizes below stay well under a second.
TEST(LargeRegions, TheSimplexOfSixteenComponentsHasAllItsFaces) {
    const VerticesOutcome built = builtVertices(simplexRequest(16, 16));
    ASSERT_EQ(built.design.code, des_Success);
    EXPECT_EQ(built.design.runs.size(), 65535U);
}

TEST(LargeRegions, NominalRangesOfFifteenComponentsHaveAsManyVerticesAsTheFormulaCounts) {
    RegionMaker maker(15);
    VerticesRequest request;
    maker.nominalBounds(15, 0.2, request.lowerBounds, request.upperBounds);
    const VerticesOutcome built = builtVertices(request);
    ASSERT_EQ(built.design.code, des_Success);
    EXPECT_EQ(built.design.pointsPerType[0], built.design.boundaryCounts[0]);
    EXPECT_GT(built.design.runs.size(), 10000U);
}

TEST(LargeRegions, EdgesOfEighteenComponentsAreAsManyAsTheFormulaCounts) {
    RegionMaker maker(18);
    VerticesRequest request;
    maker.typicalBounds(18, request.lowerBounds, request.upperBounds);
    request.degree = 2;
    const VerticesOutcome built = builtVertices(request);
    ASSERT_EQ(built.design.code, des_Success);
    EXPECT_EQ(built.design.pointsPerType[0], built.design.boundaryCounts[0]);
    EXPECT_EQ(built.design.pointsPerType[1], built.design.boundaryCounts[1]);
}

TEST(LargeRegions, MorePlanesThanAWordHasBitsKeepAllVertices) {
    RegionMaker maker(36);
    VerticesRequest request;
    maker.typicalBounds(36, request.lowerBounds, request.upperBounds);
    request.degree = 2;
    const VerticesOutcome built = builtVertices(request);
    ASSERT_EQ(built.design.code, des_Success);
    EXPECT_EQ(built.design.pointsPerType[0], built.design.boundaryCounts[0]);
    EXPECT_EQ(built.design.pointsPerType[1], built.design.boundaryCounts[1]);
}

}  // namespace
}  // namespace reisti::test
