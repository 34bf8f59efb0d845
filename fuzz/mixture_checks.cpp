#include "mixture_checks.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numeric>
#include <span>

#include "require.h"
#include "same_bytes.h"

namespace fuzz {

namespace {

constexpr double kMostCountable = std::numeric_limits<std::uint32_t>::max();

/// What an input may cost, in runs and in numbers written.
constexpr double kMostRuns = 1'000;
constexpr double kMostNumbers = 10'000;

/// Proportions are formed by a few operations on numbers of about their size.
constexpr double kProportionAbsolute = 1e-9;

/// Beyond this size of bounds, what is left of a proportion says little.
constexpr double kModerate = 1e4;

std::span<const des_MixtureRun> runsOf(const des_MixtureDesign& design) {
    return {design.runs, design.numRuns};
}

std::span<const double> proportionsOf(const des_MixtureDesign& design, const des_MixtureRun& run) {
    return {run.proportions, design.numComponents};
}

std::span<const std::int32_t> processLevelsOf(const des_MixtureDesign& design, const des_MixtureRun& run) {
    return {run.processLevels, design.numProcessVariables};
}

/// The code of the checks that come first, which change nothing; des_Success where they pass.
std::int32_t expectedCode(const MixtureRequest& request, const MixtureEngine& engine) {
    if (engine.codeBeforeArrays != des_Success) return engine.codeBeforeArrays;
    const bool hasEntries =
        request.missingArray == kAmountsArray ? !request.amounts.empty() : request.inputs.numComponents != 0;
    if (request.missingArray && hasEntries) return des_ErrorNullPointer;
    if (engine.codeAfterArrays != des_Success) return engine.codeAfterArrays;
    if (request.amounts.size() >= 2 && request.inputs.numProcessVariables != 0) return des_ErrorAmountsAndProcess;
    return des_Success;
}

void checkCode(std::int32_t code, const MixtureEngine& engine) {
    require(std::ranges::find(engine.codes, code) != engine.codes.end(), "only documented codes are returned");
    if (engine.cost == Cost::kSmall) require(code != des_ErrorOutOfMemory, "a small design fits the memory");
    if (engine.cost == Cost::kUncountable) require(code != des_Success, "what 32 bits cannot count is refused");
}

void checkLateProcessFraction(const MixtureCall& call) {
    const des_MixtureDesign& design = call.design();
    require(design.numProcessVariables > 7, "only the catalog refuses a fraction late");
    for (const des_MixtureRun& run : runsOf(design)) {
        require(std::ranges::all_of(processLevelsOf(design, run), [](std::int32_t level) { return level == 0; }),
                "runs without a fraction have process levels 0");
        require(std::ranges::all_of(proportionsOf(design, run), [](double share) { return std::isfinite(share); }),
                "every run has proportions that can be read");
    }
}

void checkFailure(const MixtureRequest& request, const MixtureEngine& engine, const MixtureCall& call) {
    const std::int32_t expected = expectedCode(request, engine);
    if (expected != des_Success) {
        require(call.code() == expected, "the first check that fails decides");
        require(call.isNothingChanged(), "a request that is refused at once changes nothing");
    } else if (call.code() == des_ErrorProcessFraction && !call.areRunsUntouched()) {
        checkLateProcessFraction(call);
    } else if (call.code() == des_ErrorOutOfMemory && !call.areRunsUntouched()) {
        require(call.design().runs == nullptr && call.design().numRuns == 0, "late missing memory leaves no runs");
    } else {
        require(call.areRunsUntouched(), "an error before the runs are counted leaves the runs alone");
    }
}

void checkPointCounts(const MixtureRequest& request, const MixtureEngine& engine, const des_MixtureDesign& design) {
    const std::size_t q = design.numComponents;
    PointCounts points;
    points.ofType.assign(design.pointsPerType, design.pointsPerType + q);
    points.center = design.numCenterPoints;
    points.axial = design.numAxialPoints;
    require(points.center <= 1, "there is one overall centroid or none");
    require(design.axialPoints != 0 || points.axial == 0, "axial points come on request only");
    require(countRuns(request, points) == design.numRuns, "the runs are the replicated points");
    if (engine.points) {
        require(points.ofType == engine.points->ofType, "the points of each type are those of the design");
        require(points.center == engine.points->center, "the centroid is counted where it is a point");
        require(points.axial == engine.points->axial, "the axial points are counted");
    }

    // Entry 0: axial points; 1: the centroid; t + 1: type t.
    const auto placeOf = [](std::int64_t type) { return static_cast<std::size_t>(type + 1); };
    std::vector<double> runs(q + 2, 0.0);
    for (const des_MixtureRun& run : runsOf(design)) {
        require(run.pointType >= -1 && run.pointType <= static_cast<std::int64_t>(q), "point types are -1 to q");
        ++runs[placeOf(run.pointType)];
    }
    const double repeats = countRepeats(request);
    const auto check = [&](double distinct, std::int32_t type) {
        require(runs[placeOf(type)] == distinct * replicatesOf(request, type) * repeats,
                "each point is run as often as asked");
    };
    check(points.axial, des_MixturePointAxial);
    check(points.center, des_MixturePointCentroid);
    for (std::size_t type = 1; type <= q; ++type)
        check(points.ofType[type - 1], static_cast<std::int32_t>(type));
}

void checkRunOrders(const des_MixtureDesign& design) {
    std::vector<bool> taken(design.numRuns, false);
    for (std::uint32_t i = 0; i < design.numRuns; ++i) {
        const std::uint32_t order = design.runs[i].runOrder;
        require(order >= 1 && order <= design.numRuns, "run orders are 1 to the number of runs");
        require(!taken[order - 1], "no two runs have the same order");
        taken[order - 1] = true;
        require(design.randomize != 0 || order == i + 1, "runs are in standard order unless randomized");
        require(design.runs[i].reserved == 1, "the reserved field of a run is 1");
    }
}

/// Standard order repeats the points as a whole: replicate after replicate, amount after amount, setting after setting.
void checkRepetitions(const MixtureRequest& request, const des_MixtureDesign& design) {
    if (design.numRuns == 0) return;
    const auto points = static_cast<std::uint32_t>(design.numRuns / countRepeats(request));
    const std::uint32_t mixtures = points * request.inputs.designReplicates;
    const bool isScaled = design.outputUnits != des_UnitsProportion && design.outputUnits != des_UnitsPseudo;
    const bool isScaledByRun = isScaled && request.amounts.size() > 1;
    for (std::uint32_t i = 0; i < design.numRuns; ++i) {
        const des_MixtureRun& run = design.runs[i];
        const des_MixtureRun& first = design.runs[i % points];
        require(run.pointType == first.pointType, "every repetition has the same points");
        require(isScaledByRun || haveSameBytes(proportionsOf(design, run), proportionsOf(design, first)),
                "every repetition has the same mixtures");
        const double amount =
            request.amounts.empty() ? 1.0 : request.amounts[request.amounts.size() == 1 ? 0 : i / mixtures];
        require(haveSameBytes(std::span(&run.amount, 1), std::span(&amount, 1)), "a run has the amount of its turn");

        if (design.numProcessVariables == 0) {
            require(run.processLevels == nullptr, "without process variables there are no levels");
            continue;
        }
        const auto levels = processLevelsOf(design, run);
        require(std::ranges::all_of(levels, [](std::int32_t level) { return level == 1 || level == -1; }),
                "process levels are -1 or +1");
        require(std::ranges::equal(levels, processLevelsOf(design, design.runs[i / mixtures * mixtures])),
                "all mixtures are run at each setting");
    }
}

/// A face of a simplex is a subset of its vertices.
void checkBoundaryCounts(const MixtureRequest& request, const des_MixtureDesign& design) {
    if (!isWholeSimplex(request) || design.boundsAdjusted != 0) return;
    for (std::uint32_t d = 0; d < design.numComponents; ++d) {
        const double faces = countSubsets(design.numComponents, d + 1);
        require(faces > kMostCountable || design.boundaryCounts[d] == faces, "the faces of a simplex are counted");
    }
}

/// Every column of a regular fraction has as many -1 as +1.
void checkSettings(const des_MixtureDesign& design) {
    constexpr std::uint32_t kMostTabled = 7;
    if (design.numProcessVariables > kMostTabled) return;
    for (std::uint32_t variable = 0; variable < design.numProcessVariables; ++variable) {
        const auto sum = std::accumulate(
            design.runs, design.runs + design.numRuns, std::int64_t{0},
            [=](std::int64_t total, const des_MixtureRun& run) { return total + run.processLevels[variable]; });
        require(sum == 0, "process levels are balanced");
    }
}

bool isModerate(double number) {
    return std::fabs(number) <= kModerate;
}

void checkBounds(const MixtureRequest& request, const des_MixtureDesign& design) {
    const double total = totalOf(request);
    for (std::uint32_t i = 0; i < design.numComponents; ++i) {
        const double scaled[] = {design.lowerBounds[i] / total, design.upperBounds[i] / total};
        require(haveSameBytes(std::span(scaled).first(1), std::span(design.scaledLowerBounds + i, 1)) &&
                    haveSameBytes(std::span(scaled).last(1), std::span(design.scaledUpperBounds + i, 1)),
                "scaled bounds are the bounds divided by the total");
        require(design.pseudoLowerBounds[i] == 0.0, "pseudo-components begin at 0");
    }
    require(design.boundsAdjusted <= 1, "the library writes flags as 0 or 1");
    if (!isTotalModerate(total) || !areBoundsModerate(design)) return;
    for (std::uint32_t i = 0; i < design.numComponents; ++i) {
        const double raised = design.lowerBounds[i] - request.lowerBounds[i];
        const double lowered = request.upperBounds[i] - design.upperBounds[i];
        const double tolerance = kProportionAbsolute * total;
        require(raised >= -tolerance && lowered >= -tolerance, "bounds are tightened only");
        require(design.boundsAdjusted != 0 || (raised <= tolerance && lowered <= tolerance),
                "the flag tells when a bound was tightened");
    }
}

/// A region that constraints shrink to a point has no pseudo-components.
constexpr double kLeastFree = 1e-9;

void checkProportions(const des_MixtureDesign& design) {
    const std::size_t q = design.numComponents;
    const bool isPseudo = design.outputUnits == des_UnitsPseudo;
    const double free = 1 - std::accumulate(design.scaledLowerBounds, design.scaledLowerBounds + q, 0.0);
    if (design.outputUnits > des_UnitsPseudo || (isPseudo && free < kLeastFree)) return;
    for (const des_MixtureRun& run : runsOf(design)) {
        require(!isTotalModerate(sumOfProportions(design, run)) ||
                    std::ranges::all_of(proportionsOf(design, run), [](double share) { return std::isfinite(share); }),
                "proportions are finite, whatever the bounds");
    }
    if (!areBoundsModerate(design)) return;

    const double* const lower = isPseudo ? design.pseudoLowerBounds : design.scaledLowerBounds;
    const double* const upper = isPseudo ? design.pseudoUpperBounds : design.scaledUpperBounds;
    double size = 1;
    for (std::size_t j = 0; j < q; ++j)
        size += std::fabs(lower[j]) + std::fabs(upper[j]);
    // Dividing by what the lower bounds leave free takes as many digits as that is small.
    const double tolerance = kProportionAbsolute * size * (isPseudo ? std::max(1.0, 1 / free) : 1.0);
    for (const des_MixtureRun& run : runsOf(design)) {
        const double total = sumOfProportions(design, run);
        if (!isTotalModerate(total)) continue;
        const auto proportions = proportionsOf(design, run);
        const double sum = std::accumulate(proportions.begin(), proportions.end(), 0.0);
        require(std::fabs(sum / total - 1) <= tolerance, "the proportions sum to the total");
        for (std::size_t j = 0; j < q; ++j) {
            const double share = proportions[j] / total;
            require(share >= lower[j] - tolerance && share <= upper[j] + tolerance, "proportions are within bounds");
        }
    }
}

void checkDesign(const MixtureRequest& request, const MixtureEngine& engine, const des_MixtureDesign& design) {
    require(design.runs != nullptr, "a design has an array of runs");
    checkPointCounts(request, engine, design);
    checkRunOrders(design);
    checkRepetitions(request, design);
    checkSettings(design);
    checkBoundaryCounts(request, design);
    checkBounds(request, design);
    if (isTotalModerate(totalOf(request))) checkProportions(design);
    engine.checkDesign(design);
}

bool areSameRuns(const des_MixtureDesign& a, const des_MixtureDesign& b) {
    return std::ranges::equal(runsOf(a), runsOf(b), [&](const des_MixtureRun& left, const des_MixtureRun& right) {
        return left.runOrder == right.runOrder && left.pointType == right.pointType &&
               haveSameBytes(std::span(&left.amount, 1), std::span(&right.amount, 1)) &&
               haveSameBytes(proportionsOf(a, left), proportionsOf(b, right)) &&
               std::ranges::equal(processLevelsOf(a, left), processLevelsOf(b, right));
    });
}

/// The length of the arrays of one run.
double numbersOf(const des_MixtureDesign& inputs) {
    return static_cast<double>(inputs.numComponents) + inputs.numProcessVariables;
}

bool isRepeatable(const des_MixtureDesign& inputs) {
    // Seed 0 asks for a fresh one each time.
    return inputs.randomize == 0 || inputs.seed != 0.0;
}

}  // namespace

Cost costOf(const MixtureRequest& request, const PointCounts& points) {
    double distinct = points.center + points.axial;
    double most = 0;
    for (const double count : points.ofType) {
        most = std::max(most, count);
        distinct += count;
    }
    const double runs = countRuns(request, points);
    if (std::max(most, runs) > kMostCountable) return Cost::kUncountable;
    // Points are visited even where they are not run.
    return std::max(distinct, runs) > kMostRuns || runs * numbersOf(request.inputs) > kMostNumbers ? Cost::kTooLarge
                                                                                                   : Cost::kSmall;
}

std::vector<std::int32_t> mixtureCodes() {
    return {des_Success,
            des_ErrorNullPointer,
            des_ErrorAmountsAndProcess,
            des_ErrorProcessFraction,
            des_ErrorLowerBoundSum,
            des_ErrorUpperBoundSum,
            des_ErrorUpperBound,
            des_ErrorEmptyRange,
            des_ErrorOutOfMemory};
}

void checkRun(const MixtureRequest& request, const MixtureEngine& engine) {
    if (engine.cost == Cost::kTooLarge) return;
    const MixtureCall call(request, engine.run);
    checkCode(call.code(), engine);
    call.checkInputsUnchanged();
    if (call.code() != des_Success) {
        checkFailure(request, engine, call);
        return;
    }
    require(expectedCode(request, engine) == des_Success, "a request that has to be refused is refused");
    if (engine.cost == Cost::kNoneOrUncountable) require(call.design().numRuns == 0, "uncountable runs are refused");
    checkDesign(request, engine, call.design());
    if (!isRepeatable(request.inputs)) return;
    const MixtureCall again(request, engine.run);
    require(again.code() == des_Success && areSameRuns(call.design(), again.design()),
            "the same request, the same runs");
}

bool isTotalModerate(double total) {
    return total >= 1 / kModerate && total <= kModerate;
}

bool areBoundsModerate(const des_MixtureDesign& design) {
    return std::all_of(design.scaledLowerBounds, design.scaledLowerBounds + design.numComponents, isModerate) &&
           std::all_of(design.scaledUpperBounds, design.scaledUpperBounds + design.numComponents, isModerate);
}

double sumOfProportions(const des_MixtureDesign& design, const des_MixtureRun& run) {
    return design.outputUnits == des_UnitsAmount && design.numAmounts != 0 ? run.amount : 1.0;
}

}  // namespace fuzz
