#ifndef REISTI_MIXTURE_RUN_COUNTS_H
#define REISTI_MIXTURE_RUN_COUNTS_H

#include <cstddef>
#include <cstdint>
#include <vector>

#include "reisti/reisti.h"

namespace reisti {

// Counts are formed in 64 bits and stay at the largest 64-bit number once they have reached it. So a count that does
// not fit the 32-bit fields of the records is recognised, never wrapped, and a factor of 0 still makes the product 0.
std::uint64_t saturatingSum(std::uint64_t a, std::uint64_t b);
std::uint64_t saturatingProduct(std::uint64_t a, std::uint64_t b);

/// Number of k-element subsets of n elements, exact until it saturates.
std::uint64_t countSubsets(std::uint64_t n, std::uint64_t k);

/// Points and replicates of a design by class of points: class t-1 holds the points of type t = 1..q, class q the
/// overall centroid, class q+1 the axial points.
struct PointClasses {
    std::vector<std::uint32_t> points;      ///< distinct points, [q+2]
    std::vector<std::uint32_t> replicates;  ///< runs of each of them, [q+2]; 0 in a class without points
};

/// The class of a point type: 1..q, 0 or des_MixturePointAxial.
inline std::size_t classOfType(std::int32_t pointType, std::uint32_t numComponents) {
    if (pointType > 0) return static_cast<std::size_t>(pointType) - 1;
    return std::size_t{numComponents} + (pointType == des_MixturePointCentroid ? 0 : 1);
}

/// Sorts the points of a design into classes and gives each class the replicates that the record asks for.
/// @param basePoints  entry t: base points of type t, for t = 0..q
/// @param hasCentroid whether the design holds the overall centroid, as a base point or added to them
/// @throw std::length_error when a count does not fit the record
PointClasses classifyPoints(const des_MixtureDesign& design, const std::vector<std::uint64_t>& basePoints,
                            bool hasCentroid, std::uint32_t axialPoints);

/// Number of settings of the process variables: the integer part of 2^p / fraction, 1 without process variables.
std::uint64_t countProcessSettings(std::uint32_t numProcessVariables, std::uint32_t fraction);

/// Number of runs of the whole design: every point as often as its class is replicated, times the design replicates,
/// the amounts and the settings of the process variables.
/// @throw std::length_error when it does not fit the record
std::uint32_t countRuns(const des_MixtureDesign& design, const PointClasses& classes);

}  // namespace reisti

#endif
