#include "support/vertices_request.h"

#include <utility>

namespace reisti::test {

VerticesRequest verticesRequest(std::vector<double> lower, std::vector<double> upper) {
    VerticesRequest request;
    request.lowerBounds = std::move(lower);
    request.upperBounds = std::move(upper);
    return request;
}

VerticesRequest simplexRequest(std::uint32_t numComponents, std::int32_t degree) {
    VerticesRequest request =
        verticesRequest(std::vector<double>(numComponents, 0.0), std::vector<double>(numComponents, 1.0));
    request.degree = degree;
    return request;
}

PlainConstraint atLeast(double value, std::vector<double> coefficients) {
    return {true, value, false, 0.0, std::move(coefficients), STATUS_BEFORE};
}

PlainConstraint atMost(double value, std::vector<double> coefficients) {
    return {false, 0.0, true, value, std::move(coefficients), STATUS_BEFORE};
}

PlainConstraint between(double low, double high, std::vector<double> coefficients) {
    return {true, low, true, high, std::move(coefficients), STATUS_BEFORE};
}

}  // namespace reisti::test
