#include "mixture/component_bounds.h"

#include <algorithm>
#include <numeric>

#include "util/math_routines.h"

namespace reisti {

namespace {

/// A range of at most this part of the upper bound is no range to experiment in.
constexpr double kNegligibleRange = 1e-5;

double sumOfBounds(const double* bounds, std::uint32_t count) {
    return std::accumulate(bounds, bounds + count, 0.0);
}

/// What the sums of all bounds leave to each component: no mixture takes it further than `free` above its lower bound
/// or than `excess` below its upper bound.
struct Room {
    double free;
    double excess;
};

/// The tests of one component that do not compare it with the others.
std::int32_t checkComponent(double lower, double upper, const Room& room, bool requireSimplex) {
    if (equalWithinFuzz(upper, 1.0, 0.0) == 1) return des_ErrorUpperBound;
    const double range = upper - lower;
    if (range <= upper * kNegligibleRange) return des_ErrorEmptyRange;
    if (requireSimplex && equalWithinFuzz(room.free + range, room.excess, 0.0) == 1) return des_ErrorNotSimplex;
    return des_Success;
}

/// @return whether a bound was tightened
bool tightenComponent(double& lower, double& upper, const Room& room) {
    const double statedUpper = upper;
    const double range = upper - lower;
    bool tightened = false;
    if (equalWithinFuzz(range, room.free, 1.0) == 1) {
        upper = lower + room.free;
        tightened = true;
    }
    if (equalWithinFuzz(range, room.excess, 1.0) == 1) {
        // From the bound as it was stated: the excess is a sum over the stated bounds.
        lower = statedUpper - room.excess;
        tightened = true;
    }
    return tightened;
}

}  // namespace

double totalAmount(const des_MixtureDesign& design) {
    return design.numAmounts != 0 ? design.amounts[0] : 1.0;
}

std::int32_t checkBounds(des_MixtureDesign& design, bool requireSimplex) {
    const std::uint32_t q = design.numComponents;
    const double total = totalAmount(design);
    design.boundsAdjusted = 0;
    for (std::uint32_t i = 0; i < q; ++i) {
        design.lowerBounds[i] /= total;
        design.upperBounds[i] /= total;
    }
    const double lowerSum = sumOfBounds(design.lowerBounds, q);
    const double upperSum = sumOfBounds(design.upperBounds, q);
    if (equalWithinFuzz(lowerSum, 1.0, 0.0) != -1) return des_ErrorLowerBoundSum;
    if (equalWithinFuzz(upperSum, 1.0, 0.0) != 1) return des_ErrorUpperBoundSum;

    const Room room{1.0 - lowerSum, upperSum - 1.0};
    double referenceRange = 0.0;
    for (std::uint32_t i = 0; i < q; ++i) {
        double& lower = design.lowerBounds[i];
        double& upper = design.upperBounds[i];
        // With two components every region is a segment, which is a simplex.
        if (const std::int32_t code = checkComponent(lower, upper, room, requireSimplex && q > 2)) return code;
        if (tightenComponent(lower, upper, room)) design.boundsAdjusted = 1;
        const double range = upper - lower;
        if (i == 0) referenceRange = range;
        if (requireSimplex && equalWithinFuzz(range, referenceRange, 1.0) != 0) return des_ErrorNotSimplex;
    }
    // Equal ranges make a simplex only when each of them is all that the lower bounds leave free.
    if (requireSimplex && equalWithinFuzz(referenceRange, 1.0 - sumOfBounds(design.lowerBounds, q), 1.0) != 0)
        return des_ErrorNotSimplex;
    return des_Success;
}

void convertFromPseudoComponents(des_MixtureDesign& design) {
    if (design.outputUnits == des_UnitsPseudo) return;
    const std::uint32_t q = design.numComponents;
    const double* const lower = design.lowerBounds;
    const double free = 1.0 - sumOfBounds(lower, q);
    const bool inAmounts = design.outputUnits != des_UnitsProportion && design.numAmounts != 0;
    const bool unbounded = std::all_of(lower, lower + q, [](double bound) { return bound == 0.0; });
    // Without lower bounds the map is x * 1 + 0, which changes no bit of a proportion: the runs need not be read again.
    if (unbounded && !inAmounts) return;

    const double total = totalAmount(design);
    for (std::uint32_t r = 0; r < design.numRuns; ++r) {
        double* const proportions = design.runs[r].proportions;
        for (std::uint32_t i = 0; i < q; ++i)
            proportions[i] = proportions[i] * free + lower[i];
        if (!inAmounts) continue;
        const double amount = design.numAmounts > 1 ? design.runs[r].amount : total;
        for (std::uint32_t i = 0; i < q; ++i)
            proportions[i] *= amount;
    }
}

void restoreBounds(des_MixtureDesign& design) {
    if (design.numAmounts == 0) return;
    for (std::uint32_t i = 0; i < design.numComponents; ++i) {
        design.lowerBounds[i] *= design.amounts[0];
        design.upperBounds[i] *= design.amounts[0];
    }
}

void writeScaledBounds(des_MixtureDesign& design) {
    const std::uint32_t q = design.numComponents;
    const double total = totalAmount(design);
    const double lowerSum = sumOfBounds(design.lowerBounds, q);
    for (std::uint32_t i = 0; i < q; ++i) {
        design.scaledLowerBounds[i] = design.lowerBounds[i] / total;
        design.scaledUpperBounds[i] = design.upperBounds[i] / total;
        design.pseudoLowerBounds[i] = 0.0;
        design.pseudoUpperBounds[i] =
            (design.scaledUpperBounds[i] - design.scaledLowerBounds[i]) / (1.0 - lowerSum / total);
    }
}

}  // namespace reisti
