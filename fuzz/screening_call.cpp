#include "screening_call.h"

#include <algorithm>
#include <span>
#include <tuple>

#include "require.h"
#include "same_bytes.h"

namespace fuzz {

namespace {

constexpr std::int32_t kPoisonLevel = 99;
constexpr std::uint32_t kPoisonCount = 0xA5A5A5A5;

/// A request for an unknown number of factors needs no levels, and as its one run only something to point at.
std::size_t countLevels(const ScreeningRequest& request) {
    return request.numRuns == 0 ? 0 : request.inputs.numFactors;
}

bool areEqual(const des_DefinitiveScreeningDesign& a, const des_DefinitiveScreeningDesign& b) {
    const auto fields = [](const des_DefinitiveScreeningDesign& d) {
        return std::tie(d.numFactors, d.numCategorical, d.replicates, d.numBlocks, d.randomize, d.categoricalFactors,
                        d.runs);
    };
    return fields(a) == fields(b) && haveSameBytes(std::span(&a.seed, 1), std::span(&b.seed, 1));
}

}  // namespace

ScreeningCall::ScreeningCall(const ScreeningRequest& request)
    : levels_(std::max(request.numRuns, std::size_t{1}), std::vector<std::int32_t>(countLevels(request), kPoisonLevel)),
      runs_(levels_.size()) {
    for (std::size_t i = 0; i < runs_.size(); ++i)
        runs_[i] = {kPoisonCount, kPoisonCount, kPoisonCount, levels_[i].data()};
    if (!request.hasFirstLevels) runs_[0].levels = nullptr;

    std::vector<std::uint32_t> categoricalFactors = request.categoricalFactors;
    des_DefinitiveScreeningDesign design = request.inputs;
    design.categoricalFactors = request.hasCategoricalList ? categoricalFactors.data() : nullptr;
    design.runs = request.hasRuns ? runs_.data() : nullptr;
    const des_DefinitiveScreeningDesign before = design;
    code_ = des_CreateDefinitiveScreeningDesign(&design);
    require(areEqual(design, before), "no input field is changed");
    require(categoricalFactors == request.categoricalFactors, "the list of categorical factors is not changed");
}

bool ScreeningCall::isUntouched(std::size_t run) const {
    const des_DefinitiveScreeningRun& record = runs_[run];
    return record.runOrder == kPoisonCount && record.block == kPoisonCount && record.pointType == kPoisonCount &&
           std::ranges::all_of(levels_[run], [](std::int32_t level) { return level == kPoisonLevel; });
}

bool ScreeningCall::isWritten(std::size_t run) const {
    const des_DefinitiveScreeningRun& record = runs_[run];
    return record.runOrder != kPoisonCount && record.block != kPoisonCount &&
           record.pointType <= des_ScreeningPointOneZero &&
           std::ranges::all_of(levels_[run], [](std::int32_t level) { return level >= -1 && level <= 1; });
}

}  // namespace fuzz
