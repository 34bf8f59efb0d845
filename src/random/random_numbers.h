#ifndef REISTI_RANDOM_RANDOM_NUMBERS_H
#define REISTI_RANDOM_RANDOM_NUMBERS_H

#include <cstdint>
#include <vector>

struct ruv_ISampler;

namespace reisti {

/// Resizes `out` to `count` uniform numbers of [0, 1). Every call has a sampler of its own: the same nonzero seed, NaN
/// included, gives the same numbers on each call. A seed that equals 0.0 is replaced by a fresh one.
/// Throws std::bad_alloc when there is no memory for the numbers or the sampler.
void generateRandomNumbers(std::uint32_t count, double seed, std::vector<double>& out);

/// The sampler behind generateRandomNumbers, seeded in the same way; null when none could be made. The caller frees it
/// with ruv_DeleteISampler.
ruv_ISampler* constructActualRandomNumberGenerator(double seed);

}  // namespace reisti

#endif
