#ifndef REISTI_TESTS_SUPPORT_PLAIN_VERTICES_DESIGN_H
#define REISTI_TESTS_SUPPORT_PLAIN_VERTICES_DESIGN_H

#include <gtest/gtest.h>

#include "support/vertices_request.h"

namespace reisti::test {

/// A whole extreme vertices run in its plainest formulation. `patience` is handed to the enumeration.
VerticesOutcome plainVerticesDesign(const VerticesRequest& request,
                                    std::size_t patience = static_cast<std::size_t>(-1));

/// Bit for bit the same, or the first difference.
testing::AssertionResult sameOutcome(const VerticesOutcome& actual, const VerticesOutcome& expected);

}  // namespace reisti::test

#endif
