#ifndef REISTI_TESTS_SUPPORT_PLAIN_POINTS_H
#define REISTI_TESTS_SUPPORT_PLAIN_POINTS_H

#include <cstdint>
#include <vector>

/// The distinct points of the simplex designs, by plain recursion: lists that grow, nothing counted ahead.
namespace reisti::test {

struct PlainPoint {
    std::int32_t pointType;
    std::vector<double> proportions;
};

/// The k-subsets of 0..n-1 in lexicographic order.
std::vector<std::vector<std::uint32_t>> plainSubsets(std::uint32_t n, std::uint32_t k);

/// The ways to write `total` as a sum of `parts` counts, the largest first entry first.
std::vector<std::vector<std::int32_t>> plainCompositions(std::int32_t total, std::uint32_t parts);

std::vector<PlainPoint> plainCentroidPoints(std::uint32_t q);
std::vector<PlainPoint> plainLatticePoints(std::uint32_t q, std::int32_t degree);
std::vector<PlainPoint> plainAxialPoints(std::uint32_t q);

/// Largest degree of a lattice in q components.
std::int32_t plainDegreeLimit(std::uint32_t q);

}  // namespace reisti::test

#endif
