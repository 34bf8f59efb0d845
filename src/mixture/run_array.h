#ifndef REISTI_MIXTURE_RUN_ARRAY_H
#define REISTI_MIXTURE_RUN_ARRAY_H

#include <cstdint>

#include "reisti/reisti.h"

namespace reisti {

/// Allocates the runs of a design, each with its proportions, not yet set, and its process levels, all zero.
/// @throw std::bad_alloc when there is no memory for all of them; nothing stays allocated then
des_MixtureRun* allocateRuns(std::uint32_t count, std::uint32_t numComponents, std::uint32_t numProcessVariables);

/// Frees the first `count` runs with their arrays, and the array of runs.
void releaseRuns(des_MixtureRun* runs, std::uint32_t count) noexcept;

/// Makes run `to` a copy of the mixture of run `from`, in its own place in the order. Amount and process levels are
/// those of the place and stay as they are.
void copyMixture(des_MixtureDesign& design, std::uint32_t from, std::uint32_t to);

}  // namespace reisti

#endif
