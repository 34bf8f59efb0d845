#ifndef REISTI_MIXTURE_RUN_REPLICATION_H
#define REISTI_MIXTURE_RUN_REPLICATION_H

#include <cstdint>

#include "mixture/run_counts.h"
#include "reisti/reisti.h"

namespace reisti {

// Each function works on the first `written` runs of the design, writes its copies behind them and changes `written` to
// the number of all of them. The array of runs has room for what is asked.

/// Repeats the points of each class as often as its replicates say: all copies behind all distinct points, by class,
/// within a class in the order of the points, the copies of one point side by side.
void repeatPoints(des_MixtureDesign& design, const PointClasses& classes, std::uint32_t& written);

/// Repeats all runs until there are designReplicates of the whole set.
void repeatDesign(des_MixtureDesign& design, std::uint32_t& written);

/// Gives the runs their total amounts; two amounts or more take one copy of all runs each.
void runAtEveryAmount(des_MixtureDesign& design, std::uint32_t& written);

/// Puts the runs into random order by rewriting their run orders; the records stay in their places.
void randomizeRunOrder(des_MixtureDesign& design);

}  // namespace reisti

#endif
