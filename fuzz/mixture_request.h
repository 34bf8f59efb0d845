#ifndef REISTI_FUZZ_MIXTURE_REQUEST_H
#define REISTI_FUZZ_MIXTURE_REQUEST_H

#include <cstddef>
#include <cstdint>
#include <fuzzer/FuzzedDataProvider.h>
#include <optional>
#include <vector>

#include "reisti/reisti.h"

namespace fuzz {

/// The amounts as a missing array; the arrays of a number for each component come before them.
inline constexpr std::size_t kAmountsArray = 8;

/// Everything that a caller sets before a run.
struct MixtureRequest {
    /// The inputs that are no arrays.
    des_MixtureDesign inputs{};
    std::vector<double> lowerBounds;
    std::vector<double> upperBounds;
    std::optional<std::vector<std::uint32_t>> typeReplicates;
    std::vector<double> amounts;
    /// A required array that is left out: its place among the CallerArrays.
    std::optional<std::size_t> missingArray;
};

/// A number of components such that designs stay small, one that no record can count the points of, or one that no
/// table of the library can hold.
std::uint32_t drawNumComponents(FuzzedDataProvider& bytes);

MixtureRequest drawMixtureRequest(FuzzedDataProvider& bytes, std::uint32_t numComponents);

/// What the bounds are divided by.
double totalOf(const MixtureRequest& request);

bool isWholeSimplex(const MixtureRequest& request);

/// How many distinct points of each type a design has before replication. Counts are doubles: exact wherever a design
/// can be made, and large where none can.
struct PointCounts {
    /// Entry t-1 for type t = 1..q.
    std::vector<double> ofType;
    double center = 0;
    double axial = 0;
};

double countSubsets(double n, double k);

/// How often each point of a type is run before everything else repeats it.
double replicatesOf(const MixtureRequest& request, std::int64_t pointType);

/// The number of runs that the points give in the request.
double countRuns(const MixtureRequest& request, const PointCounts& points);

/// How often every point is run beside its own replicates.
double countRepeats(const MixtureRequest& request);

}  // namespace fuzz

#endif
