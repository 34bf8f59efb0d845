#ifndef REISTI_MIXTURE_RUN_ARRAY_H
#define REISTI_MIXTURE_RUN_ARRAY_H

#include <cstdint>

#include "reisti/reisti.h"

namespace reisti {

/// Allocates the runs of a design with their initial values and no arrays, after making sure that there is memory for
/// the arrays, too. Each run gets its arrays when it is written: then its memory is touched once, while it is at hand.
/// @throw std::bad_alloc when there is no memory for the whole design
des_MixtureRun* allocateRuns(std::uint32_t count, std::uint32_t numComponents, std::uint32_t numProcessVariables);

/// Allocates the arrays of one run of the design: process levels all zero, proportions not yet set.
inline void allocateArrays(const des_MixtureDesign& design, des_MixtureRun& run) {
    run.proportions = new double[design.numComponents];
    if (design.numProcessVariables != 0) run.processLevels = new std::int32_t[design.numProcessVariables]();
}

/// Frees the first `count` runs with their arrays, and the array of runs.
void releaseRuns(des_MixtureRun* runs, std::uint32_t count) noexcept;

/// Writes run `to`, which has no arrays yet, as a copy of the mixture of run `from`, in its own place in the order.
/// Amount and process levels belong to the place and are not copied.
/// @throw std::length_error when the design has no run `to`
void copyMixture(des_MixtureDesign& design, std::uint32_t from, std::uint32_t to);

}  // namespace reisti

#endif
