#ifndef REISTI_TESTS_SUPPORT_PLAIN_EXTREME_VERTICES_RUN_H
#define REISTI_TESTS_SUPPORT_PLAIN_EXTREME_VERTICES_RUN_H

#include <cstdint>
#include <vector>

#include "support/plain_extreme_vertices.h"

// A whole extreme vertices run in its plainest form: from the caller's request to the run records and summaries.

namespace reisti::test {

/// What a caller asks for: the inputs of the record and the arguments of the run function.
struct PlainRequest {
    std::vector<double> lower;
    std::vector<double> upper;
    std::vector<PlainConstraint> constraints;
    int degree = 1;
    bool centerPoint = false;
    int maxPoints = 0;
    std::uint32_t vertexReplicates = 1;
    std::vector<std::uint32_t> typeReplicates;  ///< empty: the caller gives none
    std::uint32_t centerReplicates = 1;
    std::uint32_t axialReplicates = 1;
    std::uint32_t designReplicates = 1;
    std::uint32_t numProcessVariables = 0;
    std::uint32_t processFraction = 1;
    std::uint32_t fractionIndex = 1;
    std::vector<double> amounts;
    bool axialPoints = false;
    std::uint32_t outputUnits = 0;
    bool randomize = false;
    double seed = 1.0;
};

struct PlainRun {
    std::uint32_t runOrder = 0;
    std::int32_t pointType = 0;
    std::vector<double> proportions;
    double amount = 1.0;
    std::vector<std::int32_t> processLevels;
};

/// What the call leaves in the record. After an error only the bounds, the flag and the statuses are told.
struct PlainOutcome {
    std::int32_t code = 0;
    std::vector<double> lower;
    std::vector<double> upper;
    bool boundsAdjusted = false;
    std::vector<int> statuses;
    std::vector<PlainRun> runs;
    std::vector<double> scaledLower;
    std::vector<double> scaledUpper;
    std::vector<double> pseudoLower;
    std::vector<double> pseudoUpper;
    std::vector<std::uint32_t> pointsPerType;
    std::uint32_t numCenterPoints = 0;
    std::uint32_t numAxialPoints = 0;
    std::vector<std::uint32_t> boundaryCounts;
};

/// -1, 0 or 1 like plainCompare, with the tolerance 1e-12 and the floor that `scale` gives.
int plainEqualWithinFuzz(double a, double b, double scale);

/// Checks the bounds, already divided by the total, and tightens them; an error code or 0.
std::int32_t plainCheckBounds(std::vector<double>& lower, std::vector<double>& upper, bool& adjusted);

/// Counts of the faces of each dimension of the region within the bounds, by counting subsets of the ranges.
std::vector<std::uint32_t> plainBoundaryCounts(const std::vector<double>& lower, const std::vector<double>& upper);

PlainOutcome plainExtremeVerticesRun(const PlainRequest& request);

}  // namespace reisti::test

#endif
