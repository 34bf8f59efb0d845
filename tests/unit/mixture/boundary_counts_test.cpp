#include "mixture/boundary_counts.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <random>
#include <vector>

#include "matrix/matrix_library.h"
#include "support/plain_bounds.h"
#include "support/scale.h"

namespace reisti::test {
namespace {

using testing::Each;
using testing::ElementsAre;

SubsetSumCounts countsOf(double rStar, const std::vector<double>& ranges) {
    SubsetSumCounts counts;
    CalculateLE(rStar, ranges, counts.below, counts.equal);
    return counts;
}

/// C(i+1, j+1) in row i and column j.
qan::matrix_library::matrix<int> plainBinomialTable(std::uint32_t q) {
    qan::matrix_library::matrix<int> binomials(static_cast<int>(q), static_cast<int>(q), 0);
    for (std::uint32_t i = 0; i < q; ++i) {
        for (std::uint32_t j = 0; j <= i; ++j)
            binomials(static_cast<int>(i), static_cast<int>(j)) = static_cast<int>(plainBinomial(i + 1, j + 1));
    }
    return binomials;
}

std::vector<std::uint32_t> facesOf(const SubsetSumCounts& counts) {
    std::vector<int> faces;
    CalculateNumberOfBoundaries(counts.below, counts.equal,
                                plainBinomialTable(static_cast<std::uint32_t>(counts.below.size())), faces);
    return {faces.begin(), faces.end()};
}

std::vector<std::uint32_t> facesOf(double rStar, const std::vector<double>& ranges) {
    return facesOf(countsOf(rStar, ranges));
}

/// Subsets by size and sum of whole numbers, by adding one range after the other: exact, and quick for forty ranges.
SubsetSumCounts countsOfWholeRanges(std::uint32_t rStar, const std::vector<std::uint32_t>& ranges) {
    std::uint32_t largest = rStar;
    for (const std::uint32_t range : ranges)
        largest += range;
    const std::size_t q = ranges.size();
    std::vector<std::vector<std::uint32_t>> ways(q + 1, std::vector<std::uint32_t>(largest + 1, 0));
    ways[0][0] = 1;
    for (const std::uint32_t range : ranges) {
        for (std::size_t size = q; size > 0; --size) {
            for (std::size_t sum = range; sum <= largest; ++sum)
                ways[size][sum] += ways[size - 1][sum - range];
        }
    }
    SubsetSumCounts counts{std::vector<std::uint32_t>(q, 0), std::vector<std::uint32_t>(q, 0)};
    for (std::size_t size = 1; size <= q; ++size) {
        for (std::uint32_t sum = 0; sum < rStar; ++sum)
            counts.below[size - 1] += ways[size][sum];
        counts.equal[size - 1] = ways[size][rStar];
    }
    return counts;
}

/// Ranges that are multiples of 1/1024: every sum is exact, equal sums are equal in bits.
std::vector<double> in1024ths(const std::vector<std::uint32_t>& ranges) {
    std::vector<double> numbers;
    for (const std::uint32_t range : ranges)
        numbers.push_back(range / 1024.0);
    return numbers;
}

TEST(SubsetSums, OfTheWholeSimplexAreEqualForSinglesOnly) {
    const auto counts = countsOf(1.0, {1, 1, 1, 1});
    EXPECT_THAT(counts.below, Each(0U));
    EXPECT_THAT(counts.equal, ElementsAre(4, 0, 0, 0));
}

TEST(SubsetSums, AreSortedBySizeIntoBelowAndEqual) {
    const auto counts = countsOf(0.5, {0.25, 0.25, 0.5, 1});
    EXPECT_THAT(counts.below, ElementsAre(2, 0, 0, 0));
    EXPECT_THAT(counts.equal, ElementsAre(1, 1, 0, 0));
}

TEST(SubsetSums, OldEntriesOfTheOutputAreDropped) {
    SubsetSumCounts counts{std::vector<std::uint32_t>(7, 99), std::vector<std::uint32_t>(1, 99)};
    CalculateLE(1.0, {1, 1, 1}, counts.below, counts.equal);
    EXPECT_THAT(counts.below, ElementsAre(0, 0, 0));
    EXPECT_THAT(counts.equal, ElementsAre(3, 0, 0));
}

TEST(SubsetSums, WithinRoundingAreEqual) {
    // 0.1 + 0.2 is one ulp above 0.3.
    EXPECT_THAT(countsOf(0.3, {0.1, 0.2, 0.4}).equal, ElementsAre(0, 1, 0));
}

TEST(SubsetSums, NearTheOrderOfOneAreEqualAlsoWhenTiny) {
    // 5e-15 apart: beyond 1e-12 relative, within the absolute part that belongs to sums of the order of one.
    EXPECT_THAT(countsOf(1e-3, {1e-3 + 5e-15, 1, 1}).equal, ElementsAre(1, 0, 0));
    EXPECT_THAT(countsOf(1e-3, {1e-3 - 5e-15, 1, 1}).equal, ElementsAre(1, 0, 0));
}

TEST(SubsetSums, BeyondTheToleranceAreNotEqual) {
    EXPECT_THAT(countsOf(1e-3, {1e-3 + 5e-14, 1, 1}).equal, Each(0U));
    EXPECT_THAT(countsOf(1e-3, {1e-3 - 5e-14, 1, 1}).below, ElementsAre(1, 0, 0));
}

TEST(SubsetSums, AllBelowALargeLimit) {
    const auto counts = countsOf(100.0, {1, 1, 1, 1, 1});
    EXPECT_THAT(counts.below, ElementsAre(5, 10, 10, 5, 1));
    EXPECT_THAT(counts.equal, Each(0U));
}

TEST(SubsetSums, NoneBelowZero) {
    const auto counts = countsOf(0.0, {1, 1, 1});
    EXPECT_THAT(counts.below, Each(0U));
    EXPECT_THAT(counts.equal, Each(0U));
}

TEST(SubsetSums, RangesOfZeroChangeNoSum) {
    const auto counts = countsOf(1.0, {0, 0, 1});
    EXPECT_THAT(counts.below, ElementsAre(2, 1, 0));
    EXPECT_THAT(counts.equal, ElementsAre(1, 2, 1));
}

TEST(SubsetSums, OfRandomRangesAreThoseOfThePlainEnumeration) {
    std::mt19937_64 random(20240611);
    std::uniform_real_distribution<double> unit(0.0, 1.0);
    for (int i = 0; i < scaled(400); ++i) {
        std::vector<double> ranges(2 + random() % 11);
        for (double& range : ranges)
            range = unit(random);
        const double rStar = unit(random) * static_cast<double>(ranges.size()) / 2;
        EXPECT_EQ(countsOf(rStar, ranges), plainSubsetSumCounts(rStar, ranges));
    }
}

TEST(SubsetSums, WithManyTiesAreThoseOfThePlainEnumeration) {
    std::mt19937_64 random(77);
    for (int i = 0; i < scaled(400); ++i) {
        // Tenths and thirtieths are not exact in binary: equal sums differ by rounding.
        const double unit = i % 2 == 0 ? 10.0 : 30.0;
        std::vector<double> ranges(2 + random() % 11);
        for (double& range : ranges)
            range = static_cast<double>(1 + random() % 5) / unit;
        const double rStar = static_cast<double>(1 + random() % 20) / unit;
        EXPECT_EQ(countsOf(rStar, ranges), plainSubsetSumCounts(rStar, ranges));
    }
}

TEST(SubsetSums, OfRangesOfVeryDifferentSizeAreThoseOfThePlainEnumeration) {
    std::mt19937_64 random(5);
    for (int i = 0; i < scaled(200); ++i) {
        std::vector<double> ranges(2 + random() % 11);
        for (double& range : ranges)
            range = std::pow(10.0, -static_cast<double>(random() % 7));
        const double rStar = std::pow(10.0, -static_cast<double>(random() % 7));
        EXPECT_EQ(countsOf(rStar, ranges), plainSubsetSumCounts(rStar, ranges));
    }
}

TEST(SubsetSums, OfEighteenRangesAreThoseOfThePlainEnumeration) {
    std::mt19937_64 random(18);
    std::vector<double> ranges(18);
    for (double& range : ranges)
        range = static_cast<double>(1 + random() % 9) / 10;
    EXPECT_EQ(countsOf(1.7, ranges), plainSubsetSumCounts(1.7, ranges));
}

class WholeRanges : public testing::TestWithParam<std::uint32_t> {};

TEST_P(WholeRanges, CountsAreThoseOfAddingRangeAfterRange) {
    std::mt19937_64 random(GetParam());
    std::vector<std::uint32_t> ranges(GetParam());
    std::uint32_t total = 0;
    for (std::uint32_t& range : ranges)
        total += range = static_cast<std::uint32_t>(1 + random() % 1024);
    for (const std::uint32_t rStar : {total / 20, total / 4, total / 2})
        EXPECT_EQ(countsOf(rStar / 1024.0, in1024ths(ranges)), countsOfWholeRanges(rStar, ranges));
}

TEST_P(WholeRanges, FewDifferentOnesAreCountedRight) {
    std::mt19937_64 random(GetParam());
    std::vector<std::uint32_t> ranges(GetParam());
    for (std::uint32_t& range : ranges)
        range = static_cast<std::uint32_t>(64 * (1 + random() % 3));
    for (const std::uint32_t rStar : {256U, 512U, 1024U})
        EXPECT_EQ(countsOf(rStar / 1024.0, in1024ths(ranges)), countsOfWholeRanges(rStar, ranges));
}

INSTANTIATE_TEST_SUITE_P(Components, WholeRanges, testing::Values(19, 20, 25, 30, 33, 36, 40),
                         testing::PrintToStringParamName());

/// Subsets of `size` whole ranges whose sum is below rStar, and equal to it, by visiting them.
std::pair<std::uint32_t, std::uint32_t> visitSubsets(const std::vector<std::uint32_t>& ranges, std::uint64_t rStar,
                                                     std::size_t first, std::uint32_t size, std::uint64_t sum) {
    if (size == 0) return {sum < rStar, sum == rStar};
    std::pair<std::uint32_t, std::uint32_t> counts{0, 0};
    for (std::size_t i = first; i + size <= ranges.size(); ++i) {
        const auto [below, equal] = visitSubsets(ranges, rStar, i + 1, size - 1, sum + ranges[i]);
        counts.first += below;
        counts.second += equal;
    }
    return counts;
}

/// Forty ranges whose subset sums are nearly all different: nothing can be merged. Leaving a subset out instead of
/// taking it turns every count into one for the rest of the sum.
TEST(SubsetSums, OfFortyRangesWithoutTiesAreSymmetricAndRightForSmallSubsets) {
    std::mt19937_64 random(4040);
    constexpr double kUnit = 1 << 20;
    std::vector<std::uint32_t> whole(40);
    std::uint64_t total = 0;
    for (std::uint32_t& range : whole)
        total += range = static_cast<std::uint32_t>(1 + random() % (1 << 20));
    std::vector<double> ranges;
    for (const std::uint32_t range : whole)
        ranges.push_back(range / kUnit);
    const std::uint64_t rStar = total / 2 + whole[0] / 4;
    const auto counts = countsOf(static_cast<double>(rStar) / kUnit, ranges);
    const auto rest = countsOf(static_cast<double>(total - rStar) / kUnit, ranges);
    for (std::uint32_t k = 1; k < 40; ++k) {
        EXPECT_EQ(counts.below[k - 1] + counts.equal[k - 1] + rest.below[40 - k - 1], plainBinomial(40, k)) << k;
        EXPECT_EQ(counts.equal[k - 1], rest.equal[40 - k - 1]) << k;
    }
    const std::uint64_t few = total / 10;
    const auto small = countsOf(static_cast<double>(few) / kUnit, ranges);
    for (std::uint32_t k = 1; k <= 5; ++k) {
        const auto [below, equal] = visitSubsets(whole, few, 0, k, 0);
        EXPECT_EQ(small.below[k - 1], below) << k;
        EXPECT_EQ(small.equal[k - 1], equal) << k;
    }
}

TEST(BinomialTable, HoldsTheBinomialCoefficientsAndZerosAboveTheDiagonal) {
    for (const std::uint32_t q : {2U, 3U, 10U, 33U, 34U, 40U, 70U}) {
        const auto table = binomialTable(q);
        const auto plain = plainBinomialTable(q);
        for (int i = 0; i < static_cast<int>(q); ++i) {
            for (int j = 0; j < static_cast<int>(q); ++j)
                EXPECT_EQ(table(i, j), plain(i, j)) << i << ", " << j;
        }
    }
}

TEST(Boundaries, OfAPointlessRegionOfTwoAreTwoEndsAndTheSegment) {
    EXPECT_THAT(facesOf(1.0, {1, 1}), ElementsAre(2, 1));
}

TEST(Boundaries, OldEntriesOfTheOutputAreDropped) {
    std::vector<int> faces(9, 99);
    CalculateNumberOfBoundaries({0, 0}, {2, 0}, plainBinomialTable(2), faces);
    EXPECT_THAT(faces, ElementsAre(2, 1));
}

TEST(Boundaries, OfAHexagonInThreeComponents) {
    // Every component between 0 and 2/3: the plane cuts all six edges of the cube between its two opposite corners.
    EXPECT_THAT(facesOf(1.0, {2.0 / 3, 2.0 / 3, 2.0 / 3}), ElementsAre(6, 6, 1));
}

TEST(Boundaries, OfAnOctahedronInFourComponents) {
    EXPECT_THAT(facesOf(1.0, {0.5, 0.5, 0.5, 0.5}), ElementsAre(6, 12, 8, 1));
}

class SimplexFaces : public testing::TestWithParam<std::uint32_t> {};

TEST_P(SimplexFaces, AreTheSubsetsOfItsVertices) {
    const std::uint32_t q = GetParam();
    const auto faces = facesOf(1.0, std::vector<double>(q, 1.0));
    for (std::uint32_t d = 0; d < q; ++d)
        EXPECT_EQ(faces[d], plainBinomial(q, d + 1)) << "dimension " << d;
}

INSTANTIATE_TEST_SUITE_P(Components, SimplexFaces, testing::Values(2, 3, 4, 5, 10, 18, 20, 24, 30, 33, 40),
                         testing::PrintToStringParamName());

/// Vertices of the hypersimplex: ranges of 1/k each leave the mixtures whose vertices have k equal components.
TEST(Boundaries, OfHypersimplicesHaveAVertexForEachSubset) {
    for (const std::uint32_t q : {6U, 12U, 20U, 26U}) {
        for (std::uint32_t k = 2; k < q; ++k)
            EXPECT_EQ(facesOf(1.0, std::vector<double>(q, 1.0 / k))[0], plainBinomial(q, k)) << q << ", " << k;
    }
}

TEST(Boundaries, VertexCountBeyondThirtyTwoBitsWraps) {
    // C(40, 20) = 137846528820, that is 407575348 modulo 2^32.
    EXPECT_EQ(plainBinomial(40, 20), 407575348U);
    EXPECT_EQ(facesOf(1.0, std::vector<double>(40, 1.0 / 20))[0], 407575348U);
}

/// Faces of a cube cut between two layers of its corners: a (d+1)-face of the cube whose corners lie on both sides.
TEST(Boundaries, OfCubesCutBetweenTheirCornersAreTheCubeFacesInBetween) {
    for (const std::uint32_t q : {5U, 11U, 20U, 24U}) {
        for (const std::uint32_t k : {1U, 2U, q / 2}) {
            const auto faces = facesOf(1.0, std::vector<double>(q, 1.0 / (k + 0.5)));
            for (std::uint32_t d = 0; d + 1 < q; ++d) {
                std::uint32_t corners = 0;
                for (std::uint32_t full = k > d ? k - d : 0; full <= std::min(k, q - d - 1); ++full)
                    corners += plainBinomial(q - d - 1, full);
                EXPECT_EQ(faces[d], plainBinomial(q, d + 1) * corners) << "q " << q << " k " << k << " d " << d;
            }
            EXPECT_EQ(faces[q - 1], 1U);
        }
    }
}

TEST(Boundaries, OfRandomRegionsAreTheFacesOfTheBoxThatThePlaneCuts) {
    std::mt19937_64 random(99);
    for (int i = 0; i < scaled(200); ++i) {
        std::vector<double> ranges(2 + random() % 7);
        double total = 0.0;
        // Tenths tie often, so that corners of the box lie on the plane.
        for (double& range : ranges)
            total += range = static_cast<double>(1 + random() % 10) / 10;
        const double rStar = std::floor(total * 10 * (0.1 + 0.8 * static_cast<double>(random() % 100) / 100)) / 10;
        if (rStar <= 0.0) continue;
        EXPECT_EQ(facesOf(rStar, ranges), facesOfBoxSection(rStar, ranges));
    }
}

TEST(Boundaries, WrapAsThePlainFormulasDoForAnyCounts) {
    std::mt19937_64 random(32);
    for (int i = 0; i < scaled(100); ++i) {
        const std::size_t q = 2 + random() % 39;
        SubsetSumCounts counts{std::vector<std::uint32_t>(q), std::vector<std::uint32_t>(q)};
        for (std::size_t k = 0; k < q; ++k) {
            counts.below[k] = static_cast<std::uint32_t>(random());
            counts.equal[k] = static_cast<std::uint32_t>(random());
        }
        EXPECT_EQ(facesOf(counts), plainBoundaryCounts(counts));
    }
}

}  // namespace
}  // namespace reisti::test
