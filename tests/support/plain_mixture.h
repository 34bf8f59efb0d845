#ifndef REISTI_TESTS_SUPPORT_PLAIN_MIXTURE_H
#define REISTI_TESTS_SUPPORT_PLAIN_MIXTURE_H

#include <gtest/gtest.h>

#include "support/mixture_request.h"

namespace reisti::test {

/// The whole simplex design in its plainest formulation, as the oracle of the engines: values instead of records, lists
/// that grow instead of counted arrays. Floating-point expressions are evaluated in the order that the engines promise,
/// so that results are compared bit for bit. The keys of a random run order come from the library's adapter.
MixtureOutcome plainDesign(const MixtureRequest& request);

/// Bit for bit the same, or the first difference.
testing::AssertionResult sameOutcome(const MixtureOutcome& actual, const MixtureOutcome& expected);

/// Bit for bit the same numbers, or the first difference.
testing::AssertionResult sameBits(const std::vector<double>& actual, const std::vector<double>& expected);

}  // namespace reisti::test

#endif
