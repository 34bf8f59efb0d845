#include "support/plain_points.h"

#include <algorithm>
#include <limits>

namespace reisti::test {

namespace {

void addSubsets(std::vector<std::vector<std::uint32_t>>& subsets, std::vector<std::uint32_t> chosen, std::uint32_t next,
                std::uint32_t n, std::uint32_t k) {
    if (chosen.size() == k) {
        subsets.push_back(chosen);
        return;
    }
    for (std::uint32_t element = next; element < n; ++element) {
        chosen.push_back(element);
        addSubsets(subsets, chosen, element + 1, n, k);
        chosen.pop_back();
    }
}

void addCompositions(std::vector<std::vector<std::int32_t>>& all, std::vector<std::int32_t> begun, std::int32_t left,
                     std::uint32_t parts) {
    if (begun.size() + 1 == parts) {
        begun.push_back(left);
        all.push_back(begun);
        return;
    }
    for (std::int32_t part = left; part >= 0; --part) {
        begun.push_back(part);
        addCompositions(all, begun, left - part, parts);
        begun.pop_back();
    }
}

}  // namespace

std::vector<std::vector<std::uint32_t>> plainSubsets(std::uint32_t n, std::uint32_t k) {
    std::vector<std::vector<std::uint32_t>> subsets;
    addSubsets(subsets, {}, 0, n, k);
    return subsets;
}

std::vector<std::vector<std::int32_t>> plainCompositions(std::int32_t total, std::uint32_t parts) {
    std::vector<std::vector<std::int32_t>> all;
    addCompositions(all, {}, total, parts);
    return all;
}

std::vector<PlainPoint> plainCentroidPoints(std::uint32_t q) {
    std::vector<PlainPoint> points;
    for (std::uint32_t k = 1; k <= q; ++k) {
        for (const auto& subset : plainSubsets(q, k)) {
            points.push_back({k == q ? 0 : static_cast<std::int32_t>(k), std::vector<double>(q, 0.0)});
            for (const std::uint32_t component : subset)
                points.back().proportions[component] = 1.0 / k;
        }
    }
    return points;
}

std::vector<PlainPoint> plainLatticePoints(std::uint32_t q, std::int32_t degree) {
    std::vector<PlainPoint> points;
    for (const auto& composition : plainCompositions(degree, q)) {
        const bool centroid = std::all_of(composition.begin(), composition.end(),
                                          [&](std::int32_t part) { return part == composition.front(); });
        const auto positive =
            std::count_if(composition.begin(), composition.end(), [](std::int32_t part) { return part > 0; });
        points.push_back({centroid ? 0 : static_cast<std::int32_t>(positive), {}});
        for (const std::int32_t part : composition)
            points.back().proportions.push_back(part / static_cast<double>(degree));
    }
    return points;
}

std::vector<PlainPoint> plainAxialPoints(std::uint32_t q) {
    std::vector<PlainPoint> points;
    for (std::uint32_t j = 0; j < q; ++j) {
        points.push_back({-1, std::vector<double>(q, 1.0 / (2.0 * q))});
        points.back().proportions[j] = (q + 1.0) / (2.0 * q);
    }
    return points;
}

std::int32_t plainDegreeLimit(std::uint32_t q) {
    if (q <= 5) return 10;
    if (q == 6) return 7;
    if (q == 7) return 6;
    if (q == 8) return 5;
    if (q <= 11) return 4;
    if (q <= 17) return 3;
    if (q <= 20) return 2;
    return std::numeric_limits<std::int32_t>::max();
}

}  // namespace reisti::test
