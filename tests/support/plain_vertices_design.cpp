#include "support/plain_vertices_design.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <numeric>
#include <vector>

#include "reisti/reisti.h"
#include "support/plain_bounds.h"
#include "support/plain_mixture.h"

namespace reisti::test {

namespace {

constexpr std::int32_t kNoLimit = 2147483647;

double sumOf(const std::vector<double>& values) {
    return std::accumulate(values.begin(), values.end(), 0.0);
}

bool allFinite(const std::vector<double>& values) {
    return std::all_of(values.begin(), values.end(), [](double x) { return std::isfinite(x); });
}

/// Checks degree, request and bounds; leaves the bounds divided.
std::int32_t checkRequest(const VerticesRequest& request, double total, MixtureOutcome& design) {
    if (static_cast<std::uint32_t>(request.degree) > request.numComponents()) return des_ErrorDegree;
    if (const std::int32_t refused = plainRefusal(request); refused != des_Success) return refused;
    const PlainBounds bounds = plainBounds(request.lowerBounds, request.upperBounds, total, false);
    design.lowerBounds = bounds.lower;
    design.upperBounds = bounds.upper;
    design.boundsAdjusted = bounds.adjusted;
    if (bounds.code != des_Success) return bounds.code;
    return allFinite(design.lowerBounds) && allFinite(design.upperBounds) ? des_Success : des_ErrorNotANumber;
}

std::vector<double> meanOf(const Table& vertices) {
    std::vector<double> mean(vertices.at(0).size(), 0.0);
    for (std::size_t j = 0; j < mean.size(); ++j) {
        for (const std::vector<double>& x : vertices)
            mean[j] += x[j];
        mean[j] /= static_cast<double>(vertices.size());
    }
    return mean;
}

/// All distinct points in the order of their runs: vertices, centroids, overall centroid, axial points.
std::vector<PlainPoint> distinctPoints(const VerticesRequest& request, const Table& vertices,
                                       const PlainCentroids& found) {
    std::vector<PlainPoint> distinct;
    for (std::size_t r = 0; r < found.points.size(); ++r)
        distinct.push_back({r < found.types.size() ? found.types[r] : 1, found.points[r]});
    if (vertices.empty()) return distinct;
    const std::vector<double> mean = meanOf(vertices);
    if (request.centerPoint != 0 && static_cast<std::uint32_t>(request.degree) % request.numComponents() != 0)
        distinct.push_back({0, mean});
    if (request.axialPoints == 0) return distinct;
    for (const std::vector<double>& vertex : vertices) {
        std::vector<double> x(vertex.size());
        for (std::size_t j = 0; j < x.size(); ++j)
            x[j] = (mean[j] + vertex[j]) * 0.5;
        distinct.push_back({-1, x});
    }
    return distinct;
}

void rescale(const VerticesRequest& request, double total, MixtureOutcome& design) {
    const double lowerSum = sumOf(design.lowerBounds);
    for (MixtureRunValue& run : design.runs) {
        for (std::size_t j = 0; j < run.proportions.size(); ++j) {
            double& x = run.proportions[j];
            if (request.outputUnits == des_UnitsPseudo) {
                x = (x - design.lowerBounds[j]) / (1 - lowerSum);
                if (x < 0) x = 0.0;
            } else if (request.outputUnits == des_UnitsAmount && !request.amounts.empty()) {
                x *= request.amounts.size() == 1 ? total : run.amount;
            }
        }
        if (request.outputUnits != des_UnitsPseudo) continue;
        const double sum = sumOf(run.proportions);
        if (sum == 1.0) continue;
        for (double& x : run.proportions)
            x /= sum;
    }
}

}  // namespace

VerticesOutcome plainVerticesDesign(const VerticesRequest& request, std::size_t patience) {
    VerticesOutcome outcome{MixtureOutcome::untouched(request), {}};
    for (const PlainConstraint& constraint : request.constraints)
        outcome.statuses.push_back(constraint.status);
    MixtureOutcome& design = outcome.design;
    const double total = request.amounts.empty() ? 1.0 : request.amounts[0];
    design.code = checkRequest(request, total, design);
    if (design.code != des_Success) return outcome;

    PlainRegion region;
    region.lower = design.lowerBounds;
    region.upper = design.upperBounds;
    region.constraints = request.constraints;
    region.total = total;
    region.boundsChanged = design.boundsAdjusted;
    region.patience = patience;
    plainExtremeVertices(region);
    design.lowerBounds = region.lower;
    design.upperBounds = region.upper;
    design.boundsAdjusted = region.boundsChanged;
    for (std::size_t c = 0; c < region.constraints.size(); ++c)
        outcome.statuses[c] = region.constraints[c].status;

    const PlainCentroids found = plainFaceCentroids(region.points, region.slack, static_cast<int>(region.planes.size()),
                                                    static_cast<int>(request.numComponents()), request.degree,
                                                    request.maxPoints >= 1 ? request.maxPoints : kNoLimit);
    if (!found.withinLimit) {
        design.code = des_ErrorTooManyPoints;
        return outcome;
    }
    const std::vector<PlainPoint> distinct = distinctPoints(request, region.points, found);
    if (!plainRunsOf(request, distinct, design.runs)) {
        design.code = des_ErrorProcessFraction;
        return outcome;
    }
    design.boundaryCounts = plainBoundaryCounts(design.lowerBounds, design.upperBounds);
    rescale(request, total, design);
    plainRestoreBounds(request, design);
    plainRandomize(request, design.runs);
    plainReportBounds(request, design);
    plainCountPoints(distinct, design);
    return outcome;
}

testing::AssertionResult sameOutcome(const VerticesOutcome& actual, const VerticesOutcome& expected) {
    if (actual.statuses != expected.statuses)
        return testing::AssertionFailure() << "statuses " << testing::PrintToString(actual.statuses) << " not "
                                           << testing::PrintToString(expected.statuses);
    return sameOutcome(actual.design, expected.design);
}

}  // namespace reisti::test
