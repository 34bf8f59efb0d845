#ifndef REISTI_TESTS_SUPPORT_EXACT_VERTICES_H
#define REISTI_TESTS_SUPPORT_EXACT_VERTICES_H

#include <cstddef>
#include <cstdint>
#include <set>
#include <vector>

// The vertices of a region of mixtures in exact arithmetic, by definition: the feasible points in which q independent
// conditions hold with equality. Bounds and constraints are decimals, given as integers in units of 1/scale.

namespace reisti::test {

__extension__ using Int128 = __int128;

/// The half-space coefficients . x >= value; coefficients are whole numbers, the value is in units of 1/scale.
struct ExactHalfSpace {
    std::vector<std::int64_t> coefficients;
    std::int64_t value = 0;
};

struct ExactRegion {
    std::int64_t scale = 1;
    std::vector<std::int64_t> lower;
    std::vector<std::int64_t> upper;
    std::vector<ExactHalfSpace> halfSpaces;
};

/// A point with rational coordinates over one denominator, in lowest terms; component j is numerators[j] / denominator
/// in units of 1/scale.
struct ExactPoint {
    std::vector<Int128> numerators;
    Int128 denominator = 1;

    bool operator<(const ExactPoint& other) const {
        return numerators != other.numerators ? numerators < other.numerators : denominator < other.denominator;
    }
    /// Component j as a proportion.
    double proportion(std::size_t j, std::int64_t scale) const {
        return static_cast<double>(static_cast<long double>(numerators[j]) /
                                   (static_cast<long double>(denominator) * static_cast<long double>(scale)));
    }
};

/// Vertices within bounds alone: every choice of a free component, all others at one of their bounds.
std::set<std::vector<std::int64_t>> exactBoxVertices(std::int64_t scale, const std::vector<std::int64_t>& lower,
                                                     const std::vector<std::int64_t>& upper);

/// Vertices of the region, half-spaces included: every independent choice of q-1 planes beside the sum.
std::set<ExactPoint> exactVertices(const ExactRegion& region);

}  // namespace reisti::test

#endif
