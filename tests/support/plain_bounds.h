#ifndef REISTI_TESTS_SUPPORT_PLAIN_BOUNDS_H
#define REISTI_TESTS_SUPPORT_PLAIN_BOUNDS_H

#include <cstdint>
#include <vector>

/// Bounds on the components and the faces of the region they leave, the plain way: every subset is visited. Expressions
/// are evaluated in the order that the engines promise, so that bounds are compared bit for bit.
namespace reisti::test {

/// -1, 0 or 1: a below b, equal within 1e-12 relative plus a floor that depends on the scale, a above b.
int plainCompare(double a, double b, double scale);

struct PlainBounds {
    std::int32_t code = 0;
    bool adjusted = false;
    std::vector<double> lower;
    std::vector<double> upper;
};

/// Divides the bounds by the total and tightens them; stops at the first violation with the bounds as they are then.
/// @param requireSimplex whether the bounds have to leave a simplex
PlainBounds plainBounds(std::vector<double> lower, std::vector<double> upper, double total, bool requireSimplex = true);

/// C(n, k) modulo 2^32.
std::uint32_t plainBinomial(std::uint32_t n, std::uint32_t k);

/// Entry k-1: number of subsets of k ranges whose sum is below rStar, and equal to it; modulo 2^32.
struct SubsetSumCounts {
    std::vector<std::uint32_t> below;
    std::vector<std::uint32_t> equal;

    bool operator==(const SubsetSumCounts&) const = default;
};
SubsetSumCounts plainSubsetSumCounts(double rStar, const std::vector<double>& ranges);

/// The room that the components share: 1 less the lower bounds, or the excess of the upper bounds over 1 when smaller.
double plainSharedRange(const std::vector<double>& lower, const std::vector<double>& upper);

/// Number of faces of each dimension 0..q-1 by the closed formulas over the subset counts, modulo 2^32.
std::vector<std::uint32_t> plainBoundaryCounts(const SubsetSumCounts& counts);
std::vector<std::uint32_t> plainBoundaryCounts(const std::vector<double>& lower, const std::vector<double>& upper);

/// The same numbers by geometry: which faces of the box of ranges does the plane sum = rStar cut?
std::vector<std::uint32_t> facesOfBoxSection(double rStar, const std::vector<double>& ranges);

}  // namespace reisti::test

#endif
