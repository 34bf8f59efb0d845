#include "dsd/construction.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <optional>

#include "dsd/categorical_signs.h"
#include "dsd/conference_matrices.h"
#include "dsd/run_order.h"

namespace reisti {

namespace {

constexpr std::int64_t kFewestFactors = 2;
constexpr std::int64_t kMostFactors = 48;

bool isNumFactorsValid(std::int64_t numFactors) {
    return numFactors >= kFewestFactors && numFactors <= kMostFactors;
}

/// Whether the runs of this many replicates of a base design can be counted in 32 bits.
bool replicatesFit(std::uint32_t replicates, std::uint32_t baseRuns) {
    return static_cast<double>(replicates) <= 4294967295.0 / baseRuns;
}

/// Column of the only continuous factor, where there is just one: the walk follows the list as the caller ordered it
/// and finds the first index missing from it when it is ascending. Reads the list only where its length is below
/// numFactors.
std::optional<std::uint32_t> onlyContinuousFactor(const des_DefinitiveScreeningDesign& design) {
    const std::uint32_t k = design.numCategorical;
    if (k == 0 || design.categoricalFactors == nullptr || design.numFactors - k != 1) return std::nullopt;
    std::uint32_t p = 0;
    while (p < k && p >= design.categoricalFactors[p])
        ++p;
    return p;
}

void writeNegation(const des_DefinitiveScreeningRun& run, std::uint32_t numFactors, des_DefinitiveScreeningRun& out) {
    for (std::uint32_t j = 0; j < numFactors; ++j)
        out.levels[j] = -run.levels[j];
    out.block = run.block;
    out.pointType = run.pointType;
    out.runOrder = run.runOrder + 1;
}

}  // namespace

std::int32_t fillInitialDesign(des_DefinitiveScreeningDesign& design) {
    if (!isNumFactorsValid(design.numFactors)) return des_ErrorNumFactors;
    const std::uint32_t s = baseOrder(design.numFactors);
    const std::int32_t* table = conferenceMatrix(s);
    return table != nullptr ? copyFromArrayToDesign(table, s, design) : des_Success;
}

std::int32_t copyFromArrayToDesign(const std::int32_t* table, std::uint32_t s, des_DefinitiveScreeningDesign& design) {
    const std::optional<std::uint32_t> centreRow = onlyContinuousFactor(design);
    if (design.runs[0].levels == nullptr) return des_ErrorNullLevels;
    const std::uint32_t n = design.numFactors;
    for (std::uint32_t i = 0; i < s; ++i) {
        des_DefinitiveScreeningRun& run = design.runs[2 * i];
        std::copy_n(table + static_cast<std::size_t>(i) * s, n, run.levels);
        run.block = 1;
        // Row i has its zero on the diagonal, which lies in a used column only for i < n. With one continuous factor
        // the other zeros will be replaced by signs, so its row alone stays a centre run in the continuous factors.
        if (centreRow == i) {
            run.pointType = des_ScreeningPointCenter;
        } else {
            run.pointType = i < n ? des_ScreeningPointOneZero : des_ScreeningPointNoZero;
        }
        run.runOrder = 2 * i + 1;
    }
    return des_Success;
}

void addTrueCenterpoint(des_DefinitiveScreeningDesign& design) {
    const std::uint32_t s = baseOrder(design.numFactors);
    des_DefinitiveScreeningRun& centre = design.runs[2 * s];
    std::fill_n(centre.levels, design.numFactors, 0);
    centre.block = 1;
    centre.pointType = des_ScreeningPointCenter;
    centre.runOrder = 2 * s + 1;
}

void addFlippedRows(des_DefinitiveScreeningDesign& design, bool withoutCentre) {
    const std::uint32_t s = baseOrder(design.numFactors);
    const std::uint32_t pairs = withoutCentre ? s : s + 1;
    for (std::uint32_t i = 0; i < pairs; ++i) {
        writeNegation(design.runs[2 * i], design.numFactors, design.runs[2 * i + 1]);
    }
}

std::int32_t addReplicates(des_DefinitiveScreeningDesign& design) {
    const std::uint32_t baseRuns = baseRunCount(design.numFactors, design.numCategorical != 0);
    if (!replicatesFit(design.replicates, baseRuns)) return des_ErrorTooManyReplicates;
    if (design.replicates < 2) return des_Success;
    // Zero blocks give infinity, which is whole and puts every replicate into block 1.
    const double replicatesPerBlock = static_cast<double>(design.replicates) / static_cast<double>(design.numBlocks);
    if (replicatesPerBlock != std::trunc(replicatesPerBlock)) return des_ErrorBlocks;

    std::uint32_t index = baseRuns;
    for (std::uint32_t r = 1; r < design.replicates; ++r) {
        const std::uint32_t block = static_cast<std::uint32_t>(r / replicatesPerBlock) + 1;
        for (std::uint32_t j = 0; j < baseRuns; ++j, ++index) {
            const des_DefinitiveScreeningRun& base = design.runs[j];
            des_DefinitiveScreeningRun& copy = design.runs[index];
            std::copy_n(base.levels, design.numFactors, copy.levels);
            copy.block = block;
            copy.pointType = base.pointType;
            copy.runOrder = index + 1;
        }
    }
    return des_Success;
}

std::uint32_t findRowCount(std::int32_t numFactors, std::int32_t* error, bool hasCategorical,
                           std::uint32_t replicates) {
    const auto fail = [error](std::int32_t code) {
        if (error != nullptr) *error = code;
        return 0U;
    };
    if (!isNumFactorsValid(numFactors)) return fail(des_ErrorNumFactors);
    const std::uint32_t baseRuns = baseRunCount(static_cast<std::uint32_t>(numFactors), hasCategorical);
    if (!replicatesFit(replicates, baseRuns)) return fail(des_ErrorTooManyReplicates);
    if (error != nullptr) *error = des_Success;
    return baseRuns * std::max(replicates, 1U);
}

std::int32_t createDesign(des_DefinitiveScreeningDesign& design) {
    if (design.runs == nullptr) return des_ErrorNullRuns;
    if (const std::int32_t code = fillInitialDesign(design); code != des_Success) return code;

    const bool hasCategorical = design.numCategorical != 0;
    if (hasCategorical) {
        if (design.numCategorical > design.numFactors) return des_ErrorTooManyCategorical;
        if (design.categoricalFactors == nullptr) return des_ErrorNullPointer;
        if (const std::int32_t code = assignCategoricalSigns(design); code != des_Success) return code;
    } else {
        addTrueCenterpoint(design);
    }
    // The negation of an all-zero centre run would be a second one; only a centre run with signs needs its mirror
    // image.
    addFlippedRows(design, !hasCategorical);
    if (const std::int32_t code = addReplicates(design); code != des_Success) return code;
    randomizeDesign(design);
    return des_Success;
}

}  // namespace reisti
