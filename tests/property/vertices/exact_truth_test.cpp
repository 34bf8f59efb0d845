// The library's vertices against exact arithmetic: of a region typed in decimals no vertex is lost and none invented.
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <numeric>
#include <set>
#include <string>
#include <vector>

#include "support/exact_vertices.h"
#include "support/random_regions.h"
#include "support/scale.h"
#include "support/vertex_engine.h"

namespace reisti::test {
namespace {

/// Far above rounding errors, far below the distance of two vertices of these regions.
constexpr double kSamePoint = 1e-9;

/// A region in whole units of 1/scale and the same as a user types it.
struct TypedRegion {
    ExactRegion exact;
    PlainRegion typed;
};

double decimal(std::int64_t units, std::int64_t scale) {
    return static_cast<double>(units) / static_cast<double>(scale);
}

/// Random decimal bounds that leave a region with an interior.
TypedRegion randomBox(RegionMaker& maker, std::size_t q, std::int64_t scale) {
    TypedRegion made;
    made.exact.scale = scale;
    std::int64_t lowerSum = 0;
    std::int64_t upperSum = 0;
    do {
        made.exact.lower.assign(q, 0);
        made.exact.upper.assign(q, 0);
        const auto most = static_cast<std::uint64_t>(scale);
        for (std::size_t j = 0; j < q; ++j) {
            if (!maker.oneIn(3)) made.exact.lower[j] = static_cast<std::int64_t>(maker.below(2 * most / q));
            const auto room = most - static_cast<std::uint64_t>(made.exact.lower[j]);
            made.exact.upper[j] = made.exact.lower[j] + 1 + static_cast<std::int64_t>(maker.below(room));
        }
        lowerSum = std::accumulate(made.exact.lower.begin(), made.exact.lower.end(), std::int64_t{0});
        upperSum = std::accumulate(made.exact.upper.begin(), made.exact.upper.end(), std::int64_t{0});
    } while (lowerSum >= scale || upperSum <= scale);
    for (std::size_t j = 0; j < q; ++j) {
        made.typed.lower.push_back(decimal(made.exact.lower[j], scale));
        made.typed.upper.push_back(decimal(made.exact.upper[j], scale));
    }
    return made;
}

/// A constraint with small whole coefficients whose sides are decimals.
void addConstraint(RegionMaker& maker, TypedRegion& region) {
    const std::size_t q = region.exact.lower.size();
    std::vector<std::int64_t> coefficients(q);
    for (auto& c : coefficients)
        c = static_cast<std::int64_t>(maker.below(6)) - 2;
    // A value between those of two mixtures of the region, so that most constraints cut.
    const auto valueAt = [&](const std::vector<double>& x) {
        double sum = 0.0;
        for (std::size_t j = 0; j < q; ++j)
            sum += static_cast<double>(coefficients[j]) * x[j];
        return std::llround(sum * static_cast<double>(region.exact.scale));
    };
    std::int64_t low = valueAt(maker.inside(region.typed.lower, region.typed.upper));
    std::int64_t high = valueAt(maker.inside(region.typed.lower, region.typed.upper));
    if (low > high) std::swap(low, high);

    PlainConstraint typed;
    typed.hasLower = maker.oneIn(2);
    typed.hasUpper = !typed.hasLower || (low < high && maker.oneIn(3));
    typed.lower = decimal(low, region.exact.scale);
    typed.upper = decimal(high, region.exact.scale);
    typed.coefficients.assign(coefficients.begin(), coefficients.end());
    region.typed.constraints.push_back(typed);
    if (typed.hasLower) region.exact.halfSpaces.push_back({coefficients, low});
    if (typed.hasUpper) {
        for (auto& c : coefficients)
            c = -c;
        region.exact.halfSpaces.push_back({coefficients, -high});
    }
}

std::string describe(const PlainRegion& region) {
    return describe(region.lower, region.upper, region.constraints, region.total);
}

bool near(const std::vector<double>& a, const std::vector<double>& b) {
    for (std::size_t j = 0; j < a.size(); ++j)
        if (!(std::fabs(a[j] - b[j]) <= kSamePoint)) return false;
    return true;
}

bool contains(const Table& points, const std::vector<double>& x) {
    for (const auto& point : points)
        if (near(point, x)) return true;
    return false;
}

Table asDoubles(const std::set<ExactPoint>& points, std::int64_t scale) {
    Table table;
    for (const ExactPoint& point : points) {
        table.emplace_back();
        for (std::size_t j = 0; j < point.numerators.size(); ++j)
            table.back().push_back(point.proportion(j, scale));
    }
    return table;
}

bool isFeasible(const PlainRegion& region, const std::vector<double>& x) {
    for (std::size_t j = 0; j < x.size(); ++j)
        if (x[j] < region.lower[j] - kSamePoint || x[j] > region.upper[j] + kSamePoint) return false;
    for (const PlainConstraint& c : region.constraints) {
        const double value = std::inner_product(x.begin(), x.end(), c.coefficients.begin(), 0.0);
        if (c.hasLower && value < c.lower - kSamePoint) return false;
        if ((!c.hasLower || c.hasUpper) && value > c.upper + kSamePoint) return false;
    }
    return std::fabs(std::accumulate(x.begin(), x.end(), 0.0) - 1.0) <= kSamePoint;
}

TEST(TypedBounds, LoseNoVertexAndInventNone) {
    RegionMaker maker(31);
    const std::int64_t scales[] = {10, 20, 100, 1000};
    for (int i = 0; i < scaled(24000) && !testing::Test::HasFailure(); ++i) {
        const std::size_t q = 3 + static_cast<std::size_t>(i) % 4;
        const TypedRegion region = randomBox(maker, q, scales[maker.below(4)]);
        const auto truth = exactBoxVertices(region.exact.scale, region.exact.lower, region.exact.upper);
        std::set<std::vector<std::int64_t>> found;
        const EnumeratedRegion actual = enumerated(region.typed);
        for (const auto& x : actual.points) {
            std::vector<std::int64_t> units;
            for (const double component : x) {
                const double inUnits = component * static_cast<double>(region.exact.scale);
                units.push_back(std::llround(inUnits));
                ASSERT_NEAR(inUnits, static_cast<double>(units.back()), 1e-9) << describe(region.typed);
            }
            ASSERT_TRUE(found.insert(units).second) << "a vertex twice: " << describe(region.typed);
        }
        ASSERT_EQ(found, truth) << describe(region.typed);
    }
}

TEST(ExactOracles, AgreeOnBoundsAlone) {
    RegionMaker maker(32);
    for (int i = 0; i < scaled(400); ++i) {
        const TypedRegion region = randomBox(maker, 3 + static_cast<std::size_t>(i) % 4, 100);
        EXPECT_EQ(exactVertices(region.exact).size(),
                  exactBoxVertices(100, region.exact.lower, region.exact.upper).size())
            << describe(region.typed);
    }
}

/// Whether some mixture of the region satisfies every half-space strictly enough to be cut, not just touched.
bool hasInterior(const ExactRegion& region, const std::set<ExactPoint>& vertices) {
    if (vertices.size() < region.lower.size()) return false;
    for (const ExactHalfSpace& half : region.halfSpaces) {
        bool inside = false;
        for (const ExactPoint& point : vertices) {
            Int128 value = -point.denominator * half.value;
            for (std::size_t j = 0; j < point.numerators.size(); ++j)
                value += half.coefficients[j] * point.numerators[j];
            inside = inside || value > 0;
        }
        if (!inside) return false;
    }
    return true;
}

struct TruthCase {
    const char* name;
    std::size_t q;
    std::size_t constraints;
    int regions;
    /// Whether the number of common planes tells edges exactly: always with up to four components, and as long as only
    /// one plane cuts a region of bounds. Beyond that, points on edges may come along with the vertices.
    bool exact;
};

void PrintTo(const TruthCase& instance, std::ostream* out) {
    *out << instance.name;
}

class TypedConstraints : public testing::TestWithParam<TruthCase> {};

TEST_P(TypedConstraints, LoseNoVertexAndInventNoPointOutside) {
    const TruthCase& series = GetParam();
    RegionMaker maker(33 + 10 * series.q + series.constraints);
    int compared = 0;
    for (int i = 0; compared < scaled(series.regions) && i < 20 * series.regions && !HasFailure(); ++i) {
        TypedRegion region = randomBox(maker, series.q, 20);
        for (std::size_t c = 0; c < series.constraints; ++c)
            addConstraint(maker, region);
        if (series.exact && series.q > 4 && region.exact.halfSpaces.size() > 1) continue;
        const auto truth = exactVertices(region.exact);
        // Constraints that leave nothing, or a face, do not cut; they are reported and otherwise left aside.
        if (!hasInterior(region.exact, truth)) continue;
        ++compared;

        const EnumeratedRegion actual = enumerated(region.typed);
        const Table expected = asDoubles(truth, region.exact.scale);
        for (const auto& x : expected)
            ASSERT_TRUE(contains(actual.points, x)) << testing::PrintToString(x) << " lost, " << describe(region.typed);
        for (const auto& x : actual.points)
            ASSERT_TRUE(isFeasible(region.typed, x)) << testing::PrintToString(x) << ' ' << describe(region.typed);
        if (series.exact) {
            ASSERT_EQ(actual.points.size(), expected.size()) << describe(region.typed);
        }
        for (std::size_t j = 0; j < series.q; ++j) {
            double least = 1.0;
            double greatest = 0.0;
            for (const auto& x : expected) {
                least = std::fmin(least, x[j]);
                greatest = std::fmax(greatest, x[j]);
            }
            ASSERT_NEAR(actual.lower[j], least, kSamePoint) << describe(region.typed);
            ASSERT_NEAR(actual.upper[j], greatest, kSamePoint) << describe(region.typed);
        }
    }
    EXPECT_GE(compared, scaled(series.regions));
}

INSTANTIATE_TEST_SUITE_P(Sizes, TypedConstraints,
                         testing::Values(TruthCase{"ThreeComponentsOneConstraint", 3, 1, 4000, true},
                                         TruthCase{"ThreeComponentsThreeConstraints", 3, 3, 4000, true},
                                         TruthCase{"FourComponentsOneConstraint", 4, 1, 2000, true},
                                         TruthCase{"FourComponentsTwoConstraints", 4, 2, 2000, true},
                                         TruthCase{"FourComponentsFourConstraints", 4, 4, 1000, true},
                                         TruthCase{"FiveComponentsOneConstraint", 5, 1, 600, true},
                                         TruthCase{"FiveComponentsThreeConstraints", 5, 3, 300, false},
                                         TruthCase{"SixComponentsOneConstraint", 6, 1, 100, true},
                                         TruthCase{"SixComponentsTwoConstraints", 6, 2, 60, false}),
                         [](const auto& instance) { return instance.param.name; });

}  // namespace
}  // namespace reisti::test
