#ifndef REISTI_MIXTURE_BOUNDARY_COUNTS_H
#define REISTI_MIXTURE_BOUNDARY_COUNTS_H

#include <cstdint>
#include <vector>

#include "matrix/matrix_library.h"

namespace reisti {

/// Counts the subsets of the components by size and by how the sum of their ranges compares with rStar: entry k-1 of L
/// counts the subsets of k components whose sum is below rStar, entry k-1 of E those whose sum equals it within the
/// tolerance of equalWithinFuzz at scale 1. The counts are taken modulo 2^32.
///
/// The time is that of the number of different sums that do not exceed rStar, at worst 2^(q/2), not of the 2^q subsets.
/// Values that are not finite, or whose sum is not, bound no region: then all counts are 0.
void CalculateLE(double rStar, const std::vector<double>& ranges, std::vector<std::uint32_t>& L,
                 std::vector<std::uint32_t>& E);

/// Numbers of faces of the bounded region by dimension, from the counts of CalculateLE: vertices first, the region
/// itself last. Source: R. B. Crosier, "The geometry of constrained mixture experiments", Technometrics 28 (1986)
/// 95-102.
/// @param M M(i, j) is the binomial coefficient of i+1 over j+1
void CalculateNumberOfBoundaries(const std::vector<std::uint32_t>& L, const std::vector<std::uint32_t>& E,
                                 const qan::matrix_library::matrix<int>& M, std::vector<int>& counts);

/// The matrix M of CalculateNumberOfBoundaries for q components, modulo 2^32.
/// @throw std::length_error when a q x q matrix cannot be indexed in 32 bits
qan::matrix_library::matrix<int> binomialTable(std::uint32_t q);

}  // namespace reisti

#endif
