#ifndef REISTI_TESTS_SUPPORT_RANDOM_MIXTURE_H
#define REISTI_TESTS_SUPPORT_RANDOM_MIXTURE_H

#include <cstdint>
#include <random>

#include "support/mixture_request.h"

namespace reisti::test {

using Random = std::mt19937_64;

/// 0 .. bound-1.
std::uint32_t below(Random& random, std::uint32_t bound);
/// Uniform between low and high.
double between(Random& random, double low, double high);

/// Bounds that leave a simplex for 2..7 components, and any total: lower bounds from zero to almost everything, upper
/// bounds loose, exactly tight, or off by rounding.
MixtureRequest randomSimplexRequest(Random& random);

/// The same with any choice of replicates (some 0), axial points, centre, amounts or process variables, output units
/// and run order.
MixtureRequest randomDesignRequest(Random& random);

/// Bounds of any kind, most of which some check refuses.
MixtureRequest randomBoundsRequest(Random& random);

}  // namespace reisti::test

#endif
