#ifndef REISTI_TESTS_SUPPORT_VERTICES_REQUEST_H
#define REISTI_TESTS_SUPPORT_VERTICES_REQUEST_H

#include <cstdint>
#include <vector>

#include "support/mixture_request.h"
#include "support/plain_extreme_vertices.h"

namespace reisti::test {

/// What a caller asks of an extreme vertices design.
struct VerticesRequest : MixtureRequest {
    std::vector<PlainConstraint> constraints;
    std::int32_t maxPoints = 0;
};

/// Everything that a run leaves behind.
struct VerticesOutcome {
    MixtureOutcome design;
    std::vector<std::int32_t> statuses;
};

/// Degree 1 on these bounds, everything else as a new record has it.
VerticesRequest verticesRequest(std::vector<double> lower, std::vector<double> upper);

/// The whole simplex.
VerticesRequest simplexRequest(std::uint32_t numComponents, std::int32_t degree);

/// A constraint with a status that no run writes.
inline constexpr std::int32_t STATUS_BEFORE = 77;
PlainConstraint atLeast(double value, std::vector<double> coefficients);
PlainConstraint atMost(double value, std::vector<double> coefficients);
PlainConstraint between(double low, double high, std::vector<double> coefficients);

}  // namespace reisti::test

#endif
