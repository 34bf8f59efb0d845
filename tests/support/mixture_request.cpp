#include "support/mixture_request.h"

namespace reisti::test {

MixtureRequest centroidRequest(std::uint32_t numComponents) {
    MixtureRequest request;
    request.lowerBounds.assign(numComponents, 0.0);
    request.upperBounds.assign(numComponents, 1.0);
    return request;
}

MixtureRequest latticeRequest(std::uint32_t numComponents, std::int32_t degree, std::uint8_t centerPoint) {
    MixtureRequest request = centroidRequest(numComponents);
    request.lattice = true;
    request.degree = degree;
    request.centerPoint = centerPoint;
    return request;
}

MixtureOutcome MixtureOutcome::untouched(const MixtureRequest& request) {
    const std::vector<double> numbers(request.numComponents(), POISON_NUMBER);
    const std::vector<std::uint32_t> counts(request.numComponents(), POISON_COUNT);
    MixtureOutcome outcome;
    outcome.lowerBounds = request.lowerBounds;
    outcome.upperBounds = request.upperBounds;
    outcome.scaledLowerBounds = outcome.scaledUpperBounds = numbers;
    outcome.pseudoLowerBounds = outcome.pseudoUpperBounds = numbers;
    outcome.pointsPerType = outcome.boundaryCounts = counts;
    return outcome;
}

}  // namespace reisti::test
