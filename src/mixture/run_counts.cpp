#include "mixture/run_counts.h"

#include <algorithm>
#include <limits>
#include <numeric>
#include <stdexcept>

namespace reisti {

namespace {

constexpr std::uint64_t kUncountable = std::numeric_limits<std::uint64_t>::max();

std::uint32_t fitRecord(std::uint64_t count) {
    if (count > std::numeric_limits<std::uint32_t>::max()) throw std::length_error("more points than 32 bits count");
    return static_cast<std::uint32_t>(count);
}

}  // namespace

std::uint64_t saturatingSum(std::uint64_t a, std::uint64_t b) {
    return a > kUncountable - b ? kUncountable : a + b;
}

std::uint64_t saturatingProduct(std::uint64_t a, std::uint64_t b) {
    if (a == 0 || b == 0) return 0;
    return a > kUncountable / b ? kUncountable : a * b;
}

std::uint64_t countSubsets(std::uint64_t n, std::uint64_t k) {
    if (k > n) return 0;
    k = std::min(k, n - k);
    std::uint64_t count = 1;
    for (std::uint64_t i = 1; i <= k && count != kUncountable; ++i) {
        // count becomes C(n-k+i, i). What divides is cancelled first, so that nothing larger than that is ever formed.
        const std::uint64_t common = std::gcd(count, i);
        count = saturatingProduct(count / common, (n - k + i) / (i / common));
    }
    return count;
}

PointClasses classifyPoints(const des_MixtureDesign& design, const std::vector<std::uint64_t>& basePoints,
                            bool hasCentroid, std::uint32_t axialPoints) {
    const std::size_t q = design.numComponents;
    PointClasses classes{std::vector<std::uint32_t>(q + 2, 0), std::vector<std::uint32_t>(q + 2, 1)};
    for (std::size_t type = 1; type <= q; ++type)
        classes.points[type - 1] = fitRecord(basePoints[type]);
    classes.points[q] = hasCentroid ? 1 : 0;
    classes.points[q + 1] = axialPoints;

    classes.replicates[0] = design.vertexReplicates;
    if (q > 2 && design.typeReplicates != nullptr)
        std::copy_n(design.typeReplicates, q - 2, classes.replicates.begin() + 1);
    classes.replicates[q] = design.centerReplicates;
    classes.replicates[q + 1] = design.axialReplicates;
    for (std::size_t i = 0; i < q + 2; ++i)
        if (classes.points[i] == 0) classes.replicates[i] = 0;
    return classes;
}

std::uint64_t countProcessSettings(std::uint32_t numProcessVariables, std::uint32_t fraction) {
    if (numProcessVariables == 0) return 1;
    if (numProcessVariables >= 64) return kUncountable;
    return (std::uint64_t{1} << numProcessVariables) / fraction;
}

std::uint32_t countRuns(const des_MixtureDesign& design, const PointClasses& classes) {
    std::uint64_t count = 0;
    for (std::size_t i = 0; i < classes.points.size(); ++i)
        count = saturatingSum(count, saturatingProduct(classes.points[i], classes.replicates[i]));
    count = saturatingProduct(count, design.designReplicates);
    if (design.numAmounts != 0) count = saturatingProduct(count, design.numAmounts);
    count = saturatingProduct(count, countProcessSettings(design.numProcessVariables, design.processFraction));
    return fitRecord(count);
}

}  // namespace reisti
