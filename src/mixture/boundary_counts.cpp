#include "mixture/boundary_counts.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <limits>
#include <numeric>
#include <stdexcept>

#include "util/math_routines.h"

namespace reisti {

namespace {

/// Scale of the comparisons of sums of ranges, which are of the order of 1.
constexpr double kSumScale = 1.0;

/// Largest number of sums listed in one list before the other components get a list of their own. It bounds the memory;
/// below it, every sum is formed as a plain enumeration forms it, component by component from the first to the last.
constexpr std::size_t kMostSums = std::size_t{1} << 20;

/// How many subsets of `size` components have this sum of ranges, modulo 2^32.
struct SumCount {
    double sum;
    std::uint32_t size;
    std::uint32_t count;
};

/// Properties:
/// 1. ascending by sum; subsets of one size with the same sum are one entry, so that regions with equal ranges, such as
///    every simplex, give short lists for any number of components;
/// 2. rounded addition is monotonic, so that adding one range to each entry keeps the order.
using SumList = std::vector<SumCount>;

/// Adds an entry that is not below any in the list.
void append(SumList& list, const SumCount& entry) {
    for (auto it = list.rbegin(); it != list.rend() && it->sum == entry.sum; ++it) {
        if (it->size == entry.size) {
            it->count += entry.count;
            return;
        }
    }
    list.push_back(entry);
}

/// The subsets of one more component: those in the list without it, and those in the list with it.
SumList withComponent(const SumList& list, double range, double rStar, bool dropAbove) {
    // Ranges are not negative here: a sum above rStar stays above it, and all later ones in the list are above it, too.
    const auto isKept = [=](const SumCount& subset) {
        return equalWithinFuzz(rStar, subset.sum + range, kSumScale) != -1;
    };
    const auto end = dropAbove ? std::partition_point(list.begin(), list.end(), isKept) : list.end();
    SumList extended;
    extended.reserve(2 * list.size());
    auto without = list.begin();
    for (auto it = list.begin(); it != end; ++it) {
        const SumCount with{it->sum + range, it->size + 1, it->count};
        while (without != list.end() && without->sum <= with.sum)
            append(extended, *without++);
        append(extended, with);
    }
    for (; without != list.end(); ++without)
        append(extended, *without);
    return extended;
}

/// Sums of the subsets of components begin, begin+1, .. until the list has grown to kMostSums or the components end.
/// @return the first component that is not in the list
std::size_t listSums(const std::vector<double>& ranges, std::size_t begin, double rStar, bool dropAbove,
                     std::size_t mostSums, SumList& list) {
    list.assign(1, SumCount{0.0, 0, 1});
    while (begin < ranges.size() && list.size() < mostSums)
        list = withComponent(list, ranges[begin++], rStar, dropAbove);
    return begin;
}

/// Counts by size the pairs of a subset from each list whose sum compares with rStar as at least `least`.
std::vector<std::uint32_t> countPairs(const SumList& left, const SumList& right, std::size_t q, double rStar,
                                      int least) {
    std::vector<std::uint32_t> pairs(q + 1, 0);
    std::uint32_t largest = 0;
    std::vector<std::uint32_t> reaching(q + 1, 0);  // by size, the left subsets that are low enough for the right one
    for (const SumCount& subset : left) {
        reaching[subset.size] += subset.count;
        largest = std::max(largest, subset.size);
    }
    std::size_t end = left.size();
    for (const SumCount& partner : right) {
        while (end > 0 && equalWithinFuzz(rStar, left[end - 1].sum + partner.sum, kSumScale) < least) {
            --end;
            reaching[left[end].size] -= left[end].count;
        }
        if (end == 0) break;
        for (std::size_t size = 0; size <= largest; ++size)
            pairs[size + partner.size] += reaching[size] * partner.count;
    }
    return pairs;
}

bool allSumsFinite(double rStar, const std::vector<double>& ranges) {
    const auto addMagnitude = [](double sum, double range) { return sum + std::fabs(range); };
    return std::isfinite(std::accumulate(ranges.begin(), ranges.end(), std::fabs(rStar), addMagnitude));
}

}  // namespace

void CalculateLE(double rStar, const std::vector<double>& ranges, std::vector<std::uint32_t>& L,
                 std::vector<std::uint32_t>& E) {
    const std::size_t q = ranges.size();
    L.assign(q, 0);
    E.assign(q, 0);
    if (!allSumsFinite(rStar, ranges)) return;
    const bool dropAbove = std::none_of(ranges.begin(), ranges.end(), [](double range) { return range < 0.0; });
    SumList left;
    SumList right;
    const std::size_t listed = listSums(ranges, 0, rStar, dropAbove, kMostSums, left);
    listSums(ranges, listed, rStar, dropAbove, std::numeric_limits<std::size_t>::max(), right);

    const std::vector<std::uint32_t> below = countPairs(left, right, q, rStar, 1);
    const std::vector<std::uint32_t> notAbove = countPairs(left, right, q, rStar, 0);
    for (std::size_t k = 1; k <= q; ++k) {
        L[k - 1] = below[k];
        E[k - 1] = notAbove[k] - below[k];
    }
}

void CalculateNumberOfBoundaries(const std::vector<std::uint32_t>& L, const std::vector<std::uint32_t>& E,
                                 const qan::matrix_library::matrix<int>& M, std::vector<int>& counts) {
    const auto q = static_cast<std::uint32_t>(L.size());
    counts.assign(q, 0);
    if (q == 0) return;
    const auto binomial = [&M](std::uint32_t n, std::uint32_t k) {
        return static_cast<std::uint32_t>(M(static_cast<int>(n) - 1, static_cast<int>(k) - 1));
    };
    counts[q - 1] = 1;
    // Unsigned, since counts of large regions wrap.
    std::uint32_t vertices = q;
    for (std::uint32_t k = 1; k <= q; ++k)
        vertices += L[k - 1] * (q - 2 * k) - E[k - 1] * (k - 1);
    counts[0] = static_cast<int>(vertices);
    for (std::uint32_t d = 1; d + 1 < q; ++d) {
        std::uint32_t faces = binomial(q, d + 1);
        for (std::uint32_t k = 1; k + d + 1 <= q; ++k)
            faces += L[k - 1] * binomial(q - k, d + 1);
        for (std::uint32_t k = d + 1; k <= q; ++k)
            faces -= (L[k - 1] + E[k - 1]) * binomial(k, d + 1);
        counts[d] = static_cast<int>(faces);
    }
}

qan::matrix_library::matrix<int> binomialTable(std::uint32_t q) {
    // The matrix indexes its elements by int.
    constexpr std::uint32_t kMostRows = 46340;
    static_assert(std::uint64_t{kMostRows} * kMostRows <= std::numeric_limits<int>::max());
    static_assert((std::uint64_t{kMostRows} + 1) * (kMostRows + 1) > std::numeric_limits<int>::max());
    if (q > kMostRows) throw std::length_error("more components than a matrix has rows");
    const int rows = static_cast<int>(q);
    qan::matrix_library::matrix<int> table(rows, rows, 0);
    // C(n, k) = C(n-1, k) + C(n-1, k-1), exact modulo 2^32 also where the logarithms behind NChooseK exceed 32 bits.
    for (int i = 0; i < rows; ++i) {
        table(i, 0) = i + 1;
        for (int j = 1; j < i; ++j) {
            table(i, j) = static_cast<int>(static_cast<std::uint32_t>(table(i - 1, j)) +
                                           static_cast<std::uint32_t>(table(i - 1, j - 1)));
        }
        if (i > 0) table(i, i) = 1;
    }
    return table;
}

}  // namespace reisti
