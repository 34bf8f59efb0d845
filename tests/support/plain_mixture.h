#ifndef REISTI_TESTS_SUPPORT_PLAIN_MIXTURE_H
#define REISTI_TESTS_SUPPORT_PLAIN_MIXTURE_H

#include <cstdint>
#include <gtest/gtest.h>
#include <vector>

#include "support/mixture_request.h"
#include "support/plain_points.h"

namespace reisti::test {

/// The whole simplex design in its plainest formulation, as the oracle of the engines: values instead of records, lists
/// that grow instead of counted arrays. Floating-point expressions are evaluated in the order that the engines promise,
/// so that results are compared bit for bit. The keys of a random run order come from the library's adapter.
MixtureOutcome plainDesign(const MixtureRequest& request);

// The steps that all kinds of mixture designs share, for the oracles of the others.

/// What is refused before degree and bounds are looked at: an error code or 0.
std::int32_t plainRefusal(const MixtureRequest& request);

/// Counts the distinct points by type.
void plainCountPoints(const std::vector<PlainPoint>& distinct, MixtureOutcome& outcome);

/// Replicates the distinct points and crosses them with amounts and process variables; false when the process variables
/// have no such fraction.
bool plainRunsOf(const MixtureRequest& request, const std::vector<PlainPoint>& distinct,
                 std::vector<MixtureRunValue>& runs);

void plainRandomize(const MixtureRequest& request, std::vector<MixtureRunValue>& runs);

/// Multiplies the bounds by the total again.
void plainRestoreBounds(const MixtureRequest& request, MixtureOutcome& outcome);

/// Fills the scaled and the pseudo-component bounds from the restored ones.
void plainReportBounds(const MixtureRequest& request, MixtureOutcome& outcome);

/// Bit for bit the same, or the first difference.
testing::AssertionResult sameOutcome(const MixtureOutcome& actual, const MixtureOutcome& expected);

/// Bit for bit the same numbers, or the first difference.
testing::AssertionResult sameBits(const std::vector<double>& actual, const std::vector<double>& expected);

}  // namespace reisti::test

#endif
