#include "support/plain_bounds.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <numeric>

#include "reisti/reisti.h"

namespace reisti::test {

namespace {

double sum(const std::vector<double>& values) {
    return std::accumulate(values.begin(), values.end(), 0.0);
}

/// The sum of the ranges whose bits are set in the mask, smallest index first.
double subsetSum(const std::vector<double>& ranges, std::uint32_t mask) {
    double total = 0.0;
    for (std::size_t i = 0; i < ranges.size(); ++i)
        if (mask >> i & 1U) total += ranges[i];
    return total;
}

/// One component's test and tightening; false when it is refused.
bool tightenComponent(PlainBounds& bounds, std::size_t i, double room, double excess, bool requireSimplex) {
    const double lower = bounds.lower[i];
    const double upper = bounds.upper[i];
    const double range = upper - lower;
    if (plainCompare(upper, 1.0, 0.0) == 1) {
        bounds.code = des_ErrorUpperBound;
    } else if (range <= upper * 1e-5) {
        bounds.code = des_ErrorEmptyRange;
    } else if (requireSimplex && bounds.lower.size() > 2 && plainCompare(room + range, excess, 0.0) == 1) {
        bounds.code = des_ErrorNotSimplex;
    }
    if (bounds.code != des_Success) return false;
    if (plainCompare(range, room, 1.0) == 1) {
        bounds.upper[i] = lower + room;
        bounds.adjusted = true;
    }
    if (plainCompare(range, excess, 1.0) == 1) {
        bounds.lower[i] = upper - excess;
        bounds.adjusted = true;
    }
    const double reference = bounds.upper[0] - bounds.lower[0];
    if (requireSimplex && plainCompare(bounds.upper[i] - bounds.lower[i], reference, 1.0) != 0)
        bounds.code = des_ErrorNotSimplex;
    return bounds.code == des_Success;
}

}  // namespace

int plainCompare(double a, double b, double scale) {
    const double larger = std::isnan(std::fabs(a)) ? std::fabs(b) : std::max(std::fabs(a), std::fabs(b));
    const double tolerance = larger * 1e-12 + (scale != 0.0 ? scale * 1e-14 : 1e-30);
    if (tolerance >= std::fabs(a - b)) return 0;
    return b > a ? -1 : 1;
}

PlainBounds plainBounds(std::vector<double> lower, std::vector<double> upper, double total, bool requireSimplex) {
    PlainBounds bounds;
    for (double& bound : lower)
        bound /= total;
    for (double& bound : upper)
        bound /= total;
    bounds.lower = lower;
    bounds.upper = upper;
    const double lowerSum = sum(lower);
    const double upperSum = sum(upper);
    if (plainCompare(lowerSum, 1.0, 0.0) != -1) {
        bounds.code = des_ErrorLowerBoundSum;
        return bounds;
    }
    if (plainCompare(upperSum, 1.0, 0.0) != 1) {
        bounds.code = des_ErrorUpperBoundSum;
        return bounds;
    }
    for (std::size_t i = 0; i < lower.size(); ++i)
        if (!tightenComponent(bounds, i, 1.0 - lowerSum, upperSum - 1.0, requireSimplex)) return bounds;
    if (requireSimplex && plainCompare(bounds.upper[0] - bounds.lower[0], 1.0 - sum(bounds.lower), 1.0) != 0)
        bounds.code = des_ErrorNotSimplex;
    return bounds;
}

std::uint32_t plainBinomial(std::uint32_t n, std::uint32_t k) {
    std::vector<std::uint32_t> row(k + 1, 0);
    row[0] = 1;
    for (std::uint32_t i = 1; i <= n; ++i) {
        for (std::uint32_t j = k; j > 0; --j)
            row[j] += row[j - 1];
    }
    return row[k];
}

SubsetSumCounts plainSubsetSumCounts(double rStar, const std::vector<double>& ranges) {
    const std::size_t q = ranges.size();
    SubsetSumCounts counts{std::vector<std::uint32_t>(q, 0), std::vector<std::uint32_t>(q, 0)};
    for (std::uint32_t mask = 1; mask < 1U << q; ++mask) {
        const int comparison = plainCompare(rStar, subsetSum(ranges, mask), 1.0);
        const auto entry = static_cast<std::size_t>(std::popcount(mask)) - 1;
        if (comparison == 1) ++counts.below[entry];
        if (comparison == 0) ++counts.equal[entry];
    }
    return counts;
}

double plainSharedRange(const std::vector<double>& lower, const std::vector<double>& upper) {
    const double lowerSum = sum(lower);
    const double upperSum = sum(upper);
    return 1.0 - lowerSum <= upperSum - 1.0 ? 1.0 - lowerSum : upperSum - 1.0;
}

std::vector<std::uint32_t> plainBoundaryCounts(const SubsetSumCounts& counts) {
    const auto q = static_cast<std::uint32_t>(counts.below.size());
    std::vector<std::uint32_t> faces(q, 0);
    faces[q - 1] = 1;
    const auto below = [&](std::uint32_t k) { return counts.below[k - 1]; };
    const auto equal = [&](std::uint32_t k) { return counts.equal[k - 1]; };
    for (std::uint32_t d = 1; d + 1 < q; ++d) {
        faces[d] = plainBinomial(q, d + 1);
        for (std::uint32_t k = 1; k + d + 1 <= q; ++k)
            faces[d] += below(k) * plainBinomial(q - k, d + 1);
        for (std::uint32_t k = d + 1; k <= q; ++k)
            faces[d] -= (below(k) + equal(k)) * plainBinomial(k, d + 1);
    }
    faces[0] = q;
    for (std::uint32_t k = 1; k <= q; ++k)
        faces[0] += below(k) * (q - 2 * k) - equal(k) * (k - 1);
    return faces;
}

std::vector<std::uint32_t> plainBoundaryCounts(const std::vector<double>& lower, const std::vector<double>& upper) {
    std::vector<double> ranges(lower.size());
    for (std::size_t i = 0; i < ranges.size(); ++i)
        ranges[i] = upper[i] - lower[i];
    return plainBoundaryCounts(plainSubsetSumCounts(plainSharedRange(lower, upper), ranges));
}

std::vector<std::uint32_t> facesOfBoxSection(double rStar, const std::vector<double>& ranges) {
    const std::size_t q = ranges.size();
    std::vector<std::uint32_t> faces(q, 0);
    const std::uint32_t all = (1U << q) - 1;
    for (std::uint32_t free = 0; free <= all; ++free) {
        // The other components of a face of the box stand at an end of their range: `full` at the upper one.
        const std::uint32_t fixed = all & ~free;
        for (std::uint32_t full = fixed;; full = (full - 1) & fixed) {
            const int atLowest = plainCompare(rStar, subsetSum(ranges, full), 1.0);
            const int atHighest = plainCompare(rStar, subsetSum(ranges, full | free), 1.0);
            // A corner on the plane is a vertex; a larger face of the box is cut when the plane passes through its
            // inside.
            if (free == 0 && atLowest == 0) ++faces[0];
            if (free != 0 && atLowest == 1 && atHighest == -1)
                ++faces[static_cast<std::size_t>(std::popcount(free)) - 1];
            if (full == 0) break;
        }
    }
    return faces;
}

}  // namespace reisti::test
