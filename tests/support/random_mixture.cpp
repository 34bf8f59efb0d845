#include "support/random_mixture.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numeric>
#include <utility>

#include "support/plain_points.h"
#include "support/plain_process.h"

namespace reisti::test {

namespace {

/// Parts of `sum`, some of them 0.
std::vector<double> randomParts(Random& random, std::uint32_t count, double sum) {
    std::vector<double> parts(count);
    for (double& part : parts)
        part = below(random, 3) == 0 ? 0.0 : between(random, 0.0, 1.0);
    const double whole = std::accumulate(parts.begin(), parts.end(), 0.0);
    if (whole > 0.0) {
        for (double& part : parts)
            part *= sum / whole;
    }
    return parts;
}

void chooseKind(Random& random, MixtureRequest& request) {
    request.lattice = below(random, 2) != 0;
    const std::int32_t limit = std::min(plainDegreeLimit(request.numComponents()), 4);
    request.degree = static_cast<std::int32_t>(1 + below(random, static_cast<std::uint32_t>(limit)));
    request.centerPoint = static_cast<std::uint8_t>(below(random, 2));
}

void chooseTotal(Random& random, MixtureRequest& request) {
    if (below(random, 2) == 0) return;
    const double totals[] = {1.0, 100.0, 0.1, 7.0, 1e-9, 1e12, between(random, 0.5, 1000.0)};
    const double total = totals[below(random, 7)];
    request.amounts = {total};
    for (double& bound : request.lowerBounds)
        bound *= total;
    for (double& bound : request.upperBounds)
        bound *= total;
}

/// Any upper bound that leaves the simplex of the lower bounds whole.
double looseUpperBound(Random& random, double lower, double room) {
    const double tight = lower + room;
    const double upperBounds[] = {1.0, tight, std::nextafter(tight, 2.0), std::nextafter(tight, 0.0),
                                  between(random, tight, 1.0)};
    return upperBounds[below(random, 5)];
}

}  // namespace

std::uint32_t below(Random& random, std::uint32_t bound) {
    return static_cast<std::uint32_t>(random() % bound);
}

double between(Random& random, double low, double high) {
    return low + (high - low) * std::uniform_real_distribution<double>(0.0, 1.0)(random);
}

MixtureRequest randomSimplexRequest(Random& random) {
    MixtureRequest request = centroidRequest(2 + below(random, 6));
    const double sums[] = {0.0, between(random, 0.0, 0.99), between(random, 0.0, 0.99), 0.999};
    request.lowerBounds = randomParts(random, request.numComponents(), sums[below(random, 4)]);
    const double room = 1.0 - std::accumulate(request.lowerBounds.begin(), request.lowerBounds.end(), 0.0);
    for (std::size_t i = 0; i < request.upperBounds.size(); ++i)
        request.upperBounds[i] = looseUpperBound(random, request.lowerBounds[i], room);
    chooseKind(random, request);
    chooseTotal(random, request);
    request.outputUnits = below(random, 4);
    return request;
}

MixtureRequest randomDesignRequest(Random& random) {
    MixtureRequest request = randomSimplexRequest(random);
    const auto replicates = [&] { return std::vector<std::uint32_t>{1, 1, 2, 3, 0}[below(random, 5)]; };
    request.axialPoints = static_cast<std::uint8_t>(below(random, 2) * (1 + below(random, 255)));
    request.vertexReplicates = replicates();
    request.centerReplicates = replicates();
    request.axialReplicates = replicates();
    request.designReplicates = replicates();
    if (below(random, 2) != 0) {
        request.typeReplicates.emplace(std::max(request.numComponents(), 2U) - 2U);
        for (std::uint32_t& count : *request.typeReplicates)
            count = replicates();
    }
    if (below(random, 2) != 0 && !request.amounts.empty()) {
        for (std::uint32_t more = below(random, 3); more > 0; --more)
            request.amounts.push_back(request.amounts[0] * between(random, 0.1, 10.0));
    }
    if (request.amounts.size() < 2 && below(random, 2) != 0) {
        request.numProcessVariables = 1 + below(random, 7);
        do {
            request.processFraction = 1U << below(random, 5);
        } while (!plainFractionAllowed(request.numProcessVariables, request.processFraction));
        request.fractionIndex = 1 + below(random, request.processFraction);
    }
    request.randomize = static_cast<std::uint8_t>(below(random, 2));
    request.seed = between(random, 1.0, 1e6);
    return request;
}

MixtureRequest randomBoundsRequest(Random& random) {
    MixtureRequest request = centroidRequest(1 + below(random, 5));
    const std::uint32_t steps[] = {2, 4, 10, 1000};
    const std::uint32_t step = steps[below(random, 4)];
    for (std::size_t i = 0; i < request.lowerBounds.size(); ++i) {
        request.lowerBounds[i] = static_cast<double>(below(random, step / 2 + 1)) / step;
        request.upperBounds[i] = request.lowerBounds[i] + static_cast<double>(below(random, step + 1)) / step;
        if (below(random, 2) != 0) request.upperBounds[i] = std::min(request.upperBounds[i], 1.0);
    }
    chooseKind(random, request);
    chooseTotal(random, request);
    return request;
}

}  // namespace reisti::test
