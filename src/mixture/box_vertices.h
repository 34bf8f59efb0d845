#ifndef REISTI_MIXTURE_BOX_VERTICES_H
#define REISTI_MIXTURE_BOX_VERTICES_H

#include <cstddef>
#include <vector>

namespace reisti {

/// A component this close to one of its bounds, absolutely, lies on it; two vertices this close in every component are
/// one. Bounds are typed as decimals: where a sum of them meets a bound exactly, doubles miss it by rounding.
inline constexpr double kSameVertexAbsolute = 1e-12;

/// Takes a computed component to the bound on which it lies within kSameVertexAbsolute, the lower one first.
/// @return whether the component is within its bounds
bool settleWithinBounds(double& component, double lower, double upper);

/// The vertices of the mixtures within bounds, {x : sum of x = 1, lower <= x <= upper}, each once: a row of q
/// proportions for each.
///
/// All components but the one with the widest range, the free one, are set to their bounds in every combination, and
/// the free one takes what is left of the total. Where that violates a bound, the free component is set to this bound
/// and each of the others in turn takes what is left (R. D. Snee and D. W. Marquardt, "Extreme vertices designs for
/// linear mixture models", Technometrics 16 (1974) 399-408). The combinations count up in binary, the component with
/// the smallest range fastest; vertices come in the order of their first combination.
///
/// The time is that of the combinations that yield a vertex, not of all 2^(q-1).
/// @throw std::length_error when the vertices or the table of their slacks could not be indexed in 32 bits
std::vector<double> enumerateBoxVertices(std::size_t q, const double* lower, const double* upper);

}  // namespace reisti

#endif
