#include "support/plain_mixture.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <numeric>
#include <sstream>
#include <utility>

#include "random/random_numbers.h"
#include "reisti/reisti.h"
#include "support/plain_bounds.h"
#include "support/plain_points.h"
#include "support/plain_process.h"

namespace reisti::test {

namespace {

double sum(const std::vector<double>& values) {
    return std::accumulate(values.begin(), values.end(), 0.0);
}

/// Times each class of points is run: types 1..q, the centroid (type 0), the axial points (type -1).
std::uint32_t replicatesOf(const MixtureRequest& request, std::int32_t pointType) {
    const auto q = static_cast<std::int32_t>(request.numComponents());
    if (pointType == 0) return request.centerReplicates;
    if (pointType == -1) return request.axialReplicates;
    if (pointType == 1) return request.vertexReplicates;
    if (pointType == q || !request.typeReplicates) return 1;
    return request.typeReplicates->at(static_cast<std::size_t>(pointType) - 2);
}

std::vector<PlainPoint> distinctPoints(const MixtureRequest& request) {
    const std::uint32_t q = request.numComponents();
    auto points = request.lattice ? plainLatticePoints(q, request.degree) : plainCentroidPoints(q);
    if (request.lattice && request.centerPoint != 0 && request.degree % static_cast<std::int32_t>(q) != 0)
        points.push_back({0, std::vector<double>(q, 1.0 / q)});
    if (request.axialPoints != 0) {
        const auto axial = plainAxialPoints(q);
        points.insert(points.end(), axial.begin(), axial.end());
    }
    return points;
}

/// The distinct points that are run at all, then the further replicates class by class, then the further blocks.
std::vector<PlainPoint> replicated(const MixtureRequest& request, const std::vector<PlainPoint>& distinct) {
    std::vector<PlainPoint> points;
    for (const auto& point : distinct)
        if (replicatesOf(request, point.pointType) > 0) points.push_back(point);
    std::vector<std::int32_t> classes(request.numComponents());
    std::iota(classes.begin(), classes.end(), 1);
    classes.push_back(0);
    classes.push_back(-1);
    for (const std::int32_t pointType : classes) {
        for (const auto& point : distinct) {
            if (point.pointType == pointType) {
                for (std::uint32_t copy = 1; copy < replicatesOf(request, pointType); ++copy)
                    points.push_back(point);
            }
        }
    }
    std::vector<PlainPoint> blocks;
    for (std::uint32_t block = 0; block < request.designReplicates; ++block)
        blocks.insert(blocks.end(), points.begin(), points.end());
    return blocks;
}

MixtureRunValue runAt(std::size_t index, const PlainPoint& point, double amount) {
    return {static_cast<std::uint32_t>(index + 1), point.pointType, point.proportions, amount, {}};
}

std::vector<MixtureRunValue> withAmounts(const MixtureRequest& request, const std::vector<PlainPoint>& points) {
    std::vector<double> amounts = request.amounts;
    if (amounts.empty()) amounts.push_back(1.0);
    std::vector<MixtureRunValue> runs;
    for (const double amount : amounts) {
        for (const auto& point : points)
            runs.push_back(runAt(runs.size(), point, amount));
    }
    return runs;
}

/// All runs at the first setting, then all at the second and so on. Without settings to cross in, the runs of the first
/// block are there and those of the others are blank.
bool crossWithSettings(const MixtureRequest& request, std::vector<MixtureRunValue>& runs) {
    const std::uint32_t p = request.numProcessVariables;
    if (p == 0) return true;
    const auto settings = plainProcessSettings(p, request.processFraction, request.fractionIndex);
    const auto numSettings = static_cast<std::size_t>(std::ldexp(1.0, static_cast<int>(p)) / request.processFraction);
    const std::vector<MixtureRunValue> block = runs;
    for (std::size_t setting = 0; setting < numSettings; ++setting) {
        for (std::size_t i = 0; i < block.size(); ++i) {
            if (setting > 0) runs.push_back(block[i]);
            MixtureRunValue& run = runs[setting * block.size() + i];
            run.processLevels = settings ? settings->at(setting) : std::vector<std::int32_t>(p, 0);
            run.runOrder = static_cast<std::uint32_t>(setting * block.size() + i + 1);
            if (!settings && setting > 0) {
                run.runOrder = 0;
                run.pointType = 0;
                std::fill(run.proportions.begin(), run.proportions.end(), 0.0);
            }
        }
    }
    return settings.has_value();
}

void rescale(const MixtureRequest& request, MixtureOutcome& outcome) {
    const double free = 1.0 - sum(outcome.lowerBounds);
    if (request.outputUnits != 2) {
        for (auto& run : outcome.runs) {
            for (std::size_t i = 0; i < run.proportions.size(); ++i) {
                double& x = run.proportions[i];
                x = x * free + outcome.lowerBounds[i];
                if (request.outputUnits != 1 && !request.amounts.empty())
                    x = x * (request.amounts.size() > 1 ? run.amount : request.amounts[0]);
            }
        }
    }
}

}  // namespace

std::int32_t plainRefusal(const MixtureRequest& request) {
    const std::uint32_t p = request.numProcessVariables;
    if (request.amounts.size() >= 2 && p >= 1) return des_ErrorAmountsAndProcess;
    if (p == 0) return des_Success;
    const bool noSettings =
        request.processFraction == 0 || request.processFraction > std::ldexp(1.0, static_cast<int>(p));
    return noSettings || !plainFractionAllowed(p, request.processFraction) ? des_ErrorProcessFraction : des_Success;
}

void plainCountPoints(const std::vector<PlainPoint>& points, MixtureOutcome& outcome) {
    std::fill(outcome.pointsPerType.begin(), outcome.pointsPerType.end(), 0);
    outcome.numCenterPoints = outcome.numAxialPoints = 0;
    for (const auto& point : points) {
        if (point.pointType == 0) {
            ++outcome.numCenterPoints;
        } else if (point.pointType == -1) {
            ++outcome.numAxialPoints;
        } else {
            ++outcome.pointsPerType.at(static_cast<std::size_t>(point.pointType) - 1);
        }
    }
}

bool plainRunsOf(const MixtureRequest& request, const std::vector<PlainPoint>& distinct,
                 std::vector<MixtureRunValue>& runs) {
    runs = withAmounts(request, replicated(request, distinct));
    return crossWithSettings(request, runs);
}

void plainRandomize(const MixtureRequest& request, std::vector<MixtureRunValue>& runs) {
    if (request.randomize == 0) return;
    std::vector<double> keys;
    generateRandomNumbers(static_cast<std::uint32_t>(runs.size()), request.seed, keys);
    std::vector<std::size_t> order(runs.size());
    std::iota(order.begin(), order.end(), std::size_t{0});
    std::stable_sort(order.begin(), order.end(), [&](std::size_t a, std::size_t b) { return keys[a] < keys[b]; });
    for (std::size_t k = 0; k < order.size(); ++k)
        runs[order[k]].runOrder = static_cast<std::uint32_t>(k + 1);
}

void plainRestoreBounds(const MixtureRequest& request, MixtureOutcome& outcome) {
    if (request.amounts.empty()) return;
    for (double& bound : outcome.lowerBounds)
        bound = bound * request.amounts[0];
    for (double& bound : outcome.upperBounds)
        bound = bound * request.amounts[0];
}

void plainReportBounds(const MixtureRequest& request, MixtureOutcome& outcome) {
    const double total = request.amounts.empty() ? 1.0 : request.amounts[0];
    const double lowerSum = sum(outcome.lowerBounds);
    for (std::size_t i = 0; i < outcome.lowerBounds.size(); ++i) {
        outcome.scaledLowerBounds[i] = outcome.lowerBounds[i] / total;
        outcome.scaledUpperBounds[i] = outcome.upperBounds[i] / total;
        outcome.pseudoLowerBounds[i] = 0.0;
        outcome.pseudoUpperBounds[i] =
            (outcome.scaledUpperBounds[i] - outcome.scaledLowerBounds[i]) / (1.0 - lowerSum / total);
    }
}

MixtureOutcome plainDesign(const MixtureRequest& request) {
    MixtureOutcome outcome = MixtureOutcome::untouched(request);
    const bool degreeAllowed =
        !request.lattice || (request.degree >= 1 && request.degree <= plainDegreeLimit(request.numComponents()));
    outcome.code = degreeAllowed ? plainRefusal(request) : std::int32_t{des_ErrorDegree};
    if (outcome.code != des_Success) return outcome;

    const PlainBounds bounds =
        plainBounds(request.lowerBounds, request.upperBounds, request.amounts.empty() ? 1.0 : request.amounts[0]);
    outcome.code = bounds.code;
    outcome.boundsAdjusted = bounds.adjusted;
    outcome.lowerBounds = bounds.lower;
    outcome.upperBounds = bounds.upper;
    if (outcome.code != des_Success) return outcome;

    const auto distinct = distinctPoints(request);
    if (!plainRunsOf(request, distinct, outcome.runs)) {
        outcome.code = des_ErrorProcessFraction;
        return outcome;
    }
    outcome.boundaryCounts = plainBoundaryCounts(outcome.lowerBounds, outcome.upperBounds);
    rescale(request, outcome);
    plainRestoreBounds(request, outcome);
    plainRandomize(request, outcome.runs);
    plainReportBounds(request, outcome);
    plainCountPoints(distinct, outcome);
    return outcome;
}

namespace {

bool sameNumber(double a, double b) {
    return std::bit_cast<std::uint64_t>(a) == std::bit_cast<std::uint64_t>(b);
}

testing::AssertionResult sameRun(const MixtureRunValue& actual, const MixtureRunValue& expected) {
    if (actual.runOrder != expected.runOrder)
        return testing::AssertionFailure() << "run order " << actual.runOrder << " not " << expected.runOrder;
    if (actual.pointType != expected.pointType)
        return testing::AssertionFailure() << "point type " << actual.pointType << " not " << expected.pointType;
    if (!sameNumber(actual.amount, expected.amount))
        return testing::AssertionFailure() << "amount " << actual.amount << " not " << expected.amount;
    if (actual.processLevels != expected.processLevels) {
        return testing::AssertionFailure() << "process levels " << testing::PrintToString(actual.processLevels)
                                           << " not " << testing::PrintToString(expected.processLevels);
    }
    return sameBits(actual.proportions, expected.proportions);
}

testing::AssertionResult sameRuns(const MixtureOutcome& actual, const MixtureOutcome& expected) {
    if (actual.runs.size() != expected.runs.size())
        return testing::AssertionFailure() << actual.runs.size() << " runs, not " << expected.runs.size();
    for (std::size_t i = 0; i < actual.runs.size(); ++i) {
        if (const auto same = sameRun(actual.runs[i], expected.runs[i]); !same)
            return testing::AssertionFailure() << "run " << i << ": " << same.message();
    }
    return testing::AssertionSuccess();
}

testing::AssertionResult sameCounts(const MixtureOutcome& actual, const MixtureOutcome& expected) {
    const auto differ = [](const char* what, const auto& a, const auto& b) {
        return testing::AssertionFailure()
               << what << ' ' << testing::PrintToString(a) << " not " << testing::PrintToString(b);
    };
    if (actual.code != expected.code) return differ("code", actual.code, expected.code);
    if (actual.boundsAdjusted != expected.boundsAdjusted)
        return differ("boundsAdjusted", actual.boundsAdjusted, expected.boundsAdjusted);
    if (actual.pointsPerType != expected.pointsPerType)
        return differ("pointsPerType", actual.pointsPerType, expected.pointsPerType);
    if (actual.numCenterPoints != expected.numCenterPoints)
        return differ("numCenterPoints", actual.numCenterPoints, expected.numCenterPoints);
    if (actual.numAxialPoints != expected.numAxialPoints)
        return differ("numAxialPoints", actual.numAxialPoints, expected.numAxialPoints);
    if (actual.boundaryCounts != expected.boundaryCounts)
        return differ("boundaryCounts", actual.boundaryCounts, expected.boundaryCounts);
    return testing::AssertionSuccess();
}

}  // namespace

testing::AssertionResult sameBits(const std::vector<double>& actual, const std::vector<double>& expected) {
    if (std::equal(actual.begin(), actual.end(), expected.begin(), expected.end(), sameNumber))
        return testing::AssertionSuccess();
    std::ostringstream text;
    text << std::hexfloat;
    for (const double number : actual)
        text << number << ' ';
    text << "not";
    for (const double number : expected)
        text << ' ' << number;
    return testing::AssertionFailure() << text.str();
}

testing::AssertionResult sameOutcome(const MixtureOutcome& actual, const MixtureOutcome& expected) {
    if (const auto same = sameCounts(actual, expected); !same) return same;
    using Member = std::vector<double> MixtureOutcome::*;
    const std::pair<const char*, Member> bounds[] = {{"lowerBounds", &MixtureOutcome::lowerBounds},
                                                     {"upperBounds", &MixtureOutcome::upperBounds},
                                                     {"scaledLowerBounds", &MixtureOutcome::scaledLowerBounds},
                                                     {"scaledUpperBounds", &MixtureOutcome::scaledUpperBounds},
                                                     {"pseudoLowerBounds", &MixtureOutcome::pseudoLowerBounds},
                                                     {"pseudoUpperBounds", &MixtureOutcome::pseudoUpperBounds}};
    for (const auto& [name, member] : bounds) {
        if (const auto same = sameBits(actual.*member, expected.*member); !same)
            return testing::AssertionFailure() << name << ": " << same.message();
    }
    return sameRuns(actual, expected);
}

}  // namespace reisti::test
