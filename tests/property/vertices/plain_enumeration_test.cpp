// The library's vertices and centroids against the plain enumeration: every bit, every row in its place.
#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <numeric>
#include <string>
#include <vector>

#include "support/plain_extreme_vertices.h"
#include "support/random_regions.h"
#include "support/scale.h"
#include "support/vertex_engine.h"

namespace reisti::test {
namespace {

constexpr int kNoLimit = 2147483647;

PlainRegion randomRegion(RegionMaker& maker, std::size_t q, std::size_t maxConstraints) {
    PlainRegion region;
    region.patience = 400;
    const double totals[] = {1.0, 1.0, 1.0, 2.0, 100.0, 0.3};
    region.total = totals[maker.below(6)];
    maker.bounds(q, region.lower, region.upper);
    const std::size_t constraints = maker.below(maxConstraints + 1);
    for (std::size_t c = 0; c < constraints; ++c)
        region.constraints.push_back(maker.constraint(region.lower, region.upper, region.total, region.constraints));
    return region;
}

std::string describe(const PlainRegion& region) {
    return describe(region.lower, region.upper, region.constraints, region.total);
}

// Compares the enumeration, then the centroids of a degree, then limits met exactly and missed.
void expectPlain(const PlainRegion& region, const EnumeratedRegion& expected, int degree) {
    ASSERT_TRUE(sameEnumeration(enumerated(region), expected)) << describe(region);
    if (expected.points.empty()) return;

    const int q = static_cast<int>(region.lower.size());
    const auto plain = [&](int limit) {
        return plainFaceCentroids(expected.points, expected.slack, expected.numPlanes, q, degree, limit);
    };
    const auto found = [&](int limit) {
        return faceCentroids(expected.points, expected.slack, expected.numPlanes, q, degree, limit);
    };
    const PlainCentroids all = plain(kNoLimit);
    ASSERT_TRUE(sameCentroids(found(kNoLimit), all)) << describe(region) << "\n degree " << degree;
    const int numPoints = static_cast<int>(all.points.size());
    ASSERT_TRUE(sameCentroids(found(numPoints), all)) << describe(region) << "\n degree " << degree << ", limit met";
    const int inTheMiddle = numPoints - all.count / 2;
    for (const int limit : {numPoints - 1, inTheMiddle}) {
        ASSERT_TRUE(sameCentroids(found(limit), plain(limit)))
            << describe(region) << "\n degree " << degree << ", limit " << limit;
    }
}

struct Series {
    const char* name;
    std::size_t q;
    int regions;
    std::size_t maxConstraints;
};

void PrintTo(const Series& series, std::ostream* out) {
    *out << series.name;
}

class PlainEnumeration : public testing::TestWithParam<Series> {};

TEST_P(PlainEnumeration, IsMetToTheLastBit) {
    const Series& series = GetParam();
    RegionMaker maker(1000 + series.q * 10 + series.maxConstraints);
    const int regions = scaled(series.regions);
    int compared = 0;
    for (int i = 0; i < regions && !HasFailure(); ++i) {
        const PlainRegion region = randomRegion(maker, series.q, series.maxConstraints);
        // Mostly the full degree, which holds all others.
        const int degree = static_cast<int>(maker.oneIn(4) ? maker.below(series.q + 1) : series.q);
        try {
            expectPlain(region, plainlyEnumerated(region), degree);
            ++compared;
        } catch (const OutOfPatience&) {
            // The library would need as long.
        }
    }
    EXPECT_GE(compared, regions * 95 / 100);
}

INSTANTIATE_TEST_SUITE_P(Sizes, PlainEnumeration,
                         testing::Values(Series{"TwoComponents", 2, 2000, 3}, Series{"ThreeComponents", 3, 12000, 4},
                                         Series{"FourComponents", 4, 12000, 4}, Series{"FiveComponents", 5, 5000, 4},
                                         Series{"SixComponents", 6, 1000, 4}, Series{"SevenComponents", 7, 120, 4},
                                         Series{"FourComponentsManyConstraints", 4, 600, 24},
                                         Series{"SixComponentsManyConstraints", 6, 100, 10}),
                         [](const auto& instance) { return instance.param.name; });

class PlainBoundVertices : public testing::TestWithParam<std::size_t> {};

TEST_P(PlainBoundVertices, OfManyComponentsAreMetToTheLastBit) {
    const std::size_t q = GetParam();
    RegionMaker maker(2000 + q);
    const int regions = scaled(q <= 10 ? 200 : q <= 12 ? 40 : 10);
    for (int i = 0; i < regions && !HasFailure(); ++i) {
        PlainRegion region;
        if (q <= 10 && maker.oneIn(2)) {
            maker.bounds(q, region.lower, region.upper);
        } else {
            maker.typicalBounds(q, region.lower, region.upper);
        }
        ASSERT_TRUE(sameEnumeration(enumerated(region), plainlyEnumerated(region))) << describe(region);
    }
}

INSTANTIATE_TEST_SUITE_P(Components, PlainBoundVertices, testing::Values(8, 9, 10, 11, 12, 13, 14),
                         testing::PrintToStringParamName());

TEST(PlainBoundVerticesAtTheDensest, OfNominalRangesAreMetToTheLastBit) {
    RegionMaker maker(7);
    for (const std::size_t q : {6U, 8U, 10U, 11U}) {
        PlainRegion region;
        maker.nominalBounds(q, 0.2, region.lower, region.upper);
        ASSERT_TRUE(sameEnumeration(enumerated(region), plainlyEnumerated(region))) << describe(region);
    }
}

/// Half-spaces that keep the middle of the region and each cut something off.
void addCuts(RegionMaker& maker, PlainRegion& region, std::size_t count) {
    const std::size_t q = region.lower.size();
    std::vector<double> middle(q, 0.0);
    for (int i = 0; i < 50; ++i) {
        const std::vector<double> x = maker.inside(region.lower, region.upper);
        for (std::size_t j = 0; j < q; ++j)
            middle[j] += x[j] / 50.0;
    }
    for (std::size_t c = 0; c < count; ++c) {
        const std::vector<double> x = maker.inside(region.lower, region.upper);
        std::vector<double> coefficients(q);
        for (std::size_t j = 0; j < q; ++j)
            coefficients[j] = x[j] - middle[j];
        const double bound = std::inner_product(x.begin(), x.end(), coefficients.begin(), 0.0);
        for (double& coefficient : coefficients)
            coefficient *= 100.0;
        region.constraints.push_back({false, 0.0, true, 100.0 * bound, coefficients, 0});
    }
}

// Sizes at which a fast search for edges has reason to work differently than on a few vertices.
TEST(PlainCuts, OfThousandsOfVerticesAreMetToTheLastBit) {
    RegionMaker maker(9);
    for (const std::size_t q : {9U, 10U, 11U}) {
        PlainRegion region;
        maker.nominalBounds(q, 0.2, region.lower, region.upper);
        addCuts(maker, region, 2);
        const EnumeratedRegion expected = plainlyEnumerated(region);
        EXPECT_EQ(expected.statuses, (std::vector<int>{0, 0})) << "a cut that is none";
        ASSERT_TRUE(sameEnumeration(enumerated(region), expected)) << describe(region);
    }
}

// The vertices that the first plane makes miss it by rounding, so that they lie on fewer planes than a vertex should.
TEST(PlainCuts, BehindAPlaneOfHugeCoefficientsAreMetToTheLastBit) {
    RegionMaker maker(12);
    PlainRegion region;
    maker.nominalBounds(10, 0.2, region.lower, region.upper);
    addCuts(maker, region, 2);
    PlainConstraint& huge = region.constraints[0];
    for (double& coefficient : huge.coefficients)
        coefficient *= 1e13;
    huge.upper *= 1e13;
    const EnumeratedRegion expected = plainlyEnumerated(region);
    EXPECT_EQ(expected.statuses, (std::vector<int>{0, 0})) << "a cut that is none";
    ASSERT_TRUE(sameEnumeration(enumerated(region), expected)) << describe(region);
}

class PlainCutsByManyPlanes : public testing::TestWithParam<std::size_t> {};

TEST_P(PlainCutsByManyPlanes, AreMetToTheLastBit) {
    const std::size_t q = GetParam();
    RegionMaker maker(10 + q);
    PlainRegion region;
    maker.nominalBounds(q, 0.3, region.lower, region.upper);
    addCuts(maker, region, 150);
    const EnumeratedRegion expected = plainlyEnumerated(region);
    EXPECT_GT(expected.numPlanes, 64) << "no more planes than a word has bits";
    ASSERT_TRUE(sameEnumeration(enumerated(region), expected)) << describe(region);
    // Subsets of so many planes are tried by twos and threes at most.
    const int degree = q == 5 ? 5 : 1;
    ASSERT_TRUE(sameCentroids(
        faceCentroids(expected.points, expected.slack, expected.numPlanes, static_cast<int>(q), degree, kNoLimit),
        plainFaceCentroids(expected.points, expected.slack, expected.numPlanes, static_cast<int>(q), degree,
                           kNoLimit)));
}

INSTANTIATE_TEST_SUITE_P(Components, PlainCutsByManyPlanes, testing::Values(5, 6), testing::PrintToStringParamName());

TEST(PlainCuts, ThroughVerticesThatTieAreMetToTheLastBit) {
    // Equal ranges and equal coefficients: many sums tie, many planes meet in one vertex.
    PlainRegion region;
    region.lower.assign(10, 0.05);
    region.upper.assign(10, 0.15);
    region.constraints = {{true, 0.3, false, 0.0, {1, 1, 1, 0, 0, 0, 0, 0, 0, 0}, 0},
                          {false, 0.0, true, 0.55, {0, 0, 1, 1, 1, 1, 1, 0, 0, 0}, 0},
                          {true, 0.0, false, 0.0, {0, 0, 0, 0, 0, 0, 0, 1, -1, 0}, 0}};
    ASSERT_TRUE(sameEnumeration(enumerated(region), plainlyEnumerated(region)));
}

class PlainFaces : public testing::TestWithParam<std::size_t> {};

TEST_P(PlainFaces, OfManyComponentsAreMetToTheLastBit) {
    const std::size_t q = GetParam();
    RegionMaker maker(80 + q);
    for (int i = 0; i < scaled(q <= 8 ? 10 : 2); ++i) {
        PlainRegion region;
        maker.typicalBounds(q, region.lower, region.upper);
        for (std::uint64_t left = maker.below(3); left > 0; --left)
            region.constraints.push_back(maker.constraint(region.lower, region.upper, 1.0, region.constraints));
        const EnumeratedRegion all = enumerated(region);
        const auto degree = static_cast<int>(q);
        ASSERT_TRUE(sameCentroids(faceCentroids(all.points, all.slack, all.numPlanes, degree, degree, kNoLimit),
                                  plainFaceCentroids(all.points, all.slack, all.numPlanes, degree, degree, kNoLimit)))
            << describe(region);
    }
}

INSTANTIATE_TEST_SUITE_P(Components, PlainFaces, testing::Values(8, 9, 10), testing::PrintToStringParamName());

TEST(PlainEdges, OfElevenComponentsAreMetToTheLastBit) {
    RegionMaker maker(8);
    PlainRegion region;
    maker.typicalBounds(11, region.lower, region.upper);
    const EnumeratedRegion all = enumerated(region);
    EXPECT_TRUE(sameCentroids(faceCentroids(all.points, all.slack, all.numPlanes, 11, 2, kNoLimit),
                              plainFaceCentroids(all.points, all.slack, all.numPlanes, 11, 2, kNoLimit)));
}

}  // namespace
}  // namespace reisti::test
