#include <algorithm>
#include <fuzzer/FuzzedDataProvider.h>
#include <map>
#include <numeric>
#include <set>
#include <utility>

#include "base_runs.h"
#include "draw.h"
#include "reisti/reisti.h"
#include "require.h"
#include "screening_call.h"

namespace {

using fuzz::require;
using fuzz::ScreeningCall;
using fuzz::ScreeningRequest;

constexpr std::uint32_t kMostListed = 64;
constexpr std::uint32_t kMostRuns = 400;

void drawCategoricalFactors(FuzzedDataProvider& bytes, ScreeningRequest& request) {
    const std::uint32_t n = request.inputs.numFactors;
    std::vector<std::uint32_t>& list = request.categoricalFactors;
    if (bytes.ConsumeBool()) {
        // Each factor is one or not: the list of a careful caller.
        for (std::uint32_t factor = 0; factor < std::min(n, kMostListed); ++factor)
            if (bytes.ConsumeBool()) list.push_back(factor);
    } else {
        list.resize(bytes.ConsumeIntegralInRange(0U, kMostListed));
        for (std::uint32_t& factor : list) {
            factor = fuzz::drawRarely(bytes, 64) ? bytes.ConsumeIntegral<std::uint32_t>()
                                                 : bytes.ConsumeIntegralInRange(0U, std::max(n, 1U) - 1);
        }
        if (bytes.ConsumeBool() && list.size() > n) list.resize(n);
    }
    request.inputs.numCategorical = static_cast<std::uint32_t>(list.size());
    request.hasCategoricalList = !fuzz::drawRarely(bytes, 16);
    if (request.hasCategoricalList) return;
    list.clear();
    request.inputs.numCategorical = fuzz::drawCount(bytes, 50);
}

ScreeningRequest drawScreeningRequest(FuzzedDataProvider& bytes) {
    ScreeningRequest request;
    des_DefinitiveScreeningDesign& inputs = request.inputs;
    inputs.numFactors = bytes.ConsumeIntegralInRange(0U, 50U);
    inputs.replicates = fuzz::drawCount(bytes, 8);
    inputs.numBlocks = fuzz::drawCount(bytes, 8);
    inputs.randomize = bytes.ConsumeIntegral<std::uint8_t>();
    inputs.seed = fuzz::drawNumber(bytes);
    request.hasRuns = !fuzz::drawRarely(bytes, 64);
    request.hasFirstLevels = !fuzz::drawRarely(bytes, 64);
    if (bytes.ConsumeBool()) drawCategoricalFactors(bytes, request);
    // Nothing may be written for an unknown number of factors, so that no level is needed.
    if (fuzz::drawRarely(bytes, 32)) inputs.numFactors = bytes.ConsumeIntegralInRange(51U, UINT32_MAX);
    return request;
}

bool hasCategorical(const ScreeningRequest& request) {
    return request.inputs.numCategorical != 0;
}

std::uint64_t countRuns(const ScreeningRequest& request) {
    return std::uint64_t{fuzz::countBaseRuns(request.inputs.numFactors, hasCategorical(request))} *
           std::max(request.inputs.replicates, 1U);
}

bool isCategoricalListValid(const ScreeningRequest& request) {
    return std::ranges::all_of(request.categoricalFactors,
                               [&](std::uint32_t factor) { return factor < request.inputs.numFactors; });
}

/// The code that the documented order of the tests gives.
std::int32_t expectedCode(const ScreeningRequest& request) {
    const des_DefinitiveScreeningDesign& inputs = request.inputs;
    if (!request.hasRuns) return des_ErrorNullRuns;
    if (fuzz::conferenceOrder(inputs.numFactors) == 0) return des_ErrorNumFactors;
    if (!request.hasFirstLevels) return des_ErrorNullLevels;
    if (inputs.numCategorical > inputs.numFactors) return des_ErrorTooManyCategorical;
    if (hasCategorical(request) && !request.hasCategoricalList) return des_ErrorNullPointer;
    if (!isCategoricalListValid(request)) return des_ErrorCategoricalIndex;
    if (countRuns(request) > UINT32_MAX) return des_ErrorTooManyReplicates;
    if (inputs.replicates >= 2 && inputs.numBlocks != 0 && inputs.replicates % inputs.numBlocks != 0)
        return des_ErrorBlocks;
    return des_Success;
}

/// What is written after each error: nothing, the even base runs, or the base runs.
void checkFailure(const ScreeningRequest& request, const ScreeningCall& call) {
    const bool hasBase = call.code() == des_ErrorTooManyReplicates || call.code() == des_ErrorBlocks;
    const bool hasEvenRuns = call.code() == des_ErrorTooManyCategorical || call.code() == des_ErrorNullPointer ||
                             call.code() == des_ErrorCategoricalIndex;
    const std::uint32_t order = fuzz::conferenceOrder(request.inputs.numFactors);
    const std::uint32_t baseRuns = fuzz::countBaseRuns(request.inputs.numFactors, hasCategorical(request));
    for (std::size_t i = 0; i < call.runs().size(); ++i) {
        if ((hasBase && i < baseRuns) || (hasEvenRuns && i < std::size_t{2} * order && i % 2 == 0)) {
            require(call.isWritten(i), "the runs are written that the error leaves");
        } else {
            require(call.isUntouched(i), "no other run is written");
        }
    }
}

bool isNegation(const ScreeningCall& call, std::size_t a, std::size_t b, std::uint32_t n) {
    return std::equal(call.levels(a), call.levels(a) + n, call.levels(b),
                      [](std::int32_t left, std::int32_t right) { return left == -right; });
}

/// Fold-over pairs, and the centre run or runs.
void checkBaseRuns(const ScreeningRequest& request, const ScreeningCall& call) {
    const std::uint32_t n = request.inputs.numFactors;
    const std::uint32_t baseRuns = fuzz::countBaseRuns(n, hasCategorical(request));
    for (std::size_t i = 0; i + 1 < baseRuns; i += 2) {
        require(isNegation(call, i, i + 1, n), "odd runs are the negations of the even ones");
        require(call.runs()[i].pointType == call.runs()[i + 1].pointType, "a pair has one point type");
    }
    std::vector<bool> isCategorical(n, false);
    for (const std::uint32_t factor : request.categoricalFactors)
        isCategorical[factor] = true;
    const std::size_t centre = std::size_t{2} * fuzz::conferenceOrder(n);
    for (std::uint32_t j = 0; j < n; ++j) {
        require((call.levels(centre)[j] == 0) == !isCategorical[j], "the centre run has level 0 in continuous factors");
        for (std::size_t i = 0; isCategorical[j] && i < baseRuns; ++i)
            require(call.levels(i)[j] != 0, "categorical factors have two levels");
    }
}

/// The documented point types, for a list that is ascending: in others the order of the factors has a say.
void checkPointTypes(const ScreeningRequest& request, const ScreeningCall& call) {
    const std::vector<std::uint32_t>& list = request.categoricalFactors;
    if (std::ranges::adjacent_find(list, std::ranges::greater_equal()) != list.end()) return;
    const std::uint32_t n = request.inputs.numFactors;
    const std::size_t continuous = n - list.size();
    for (std::size_t i = 0; i < call.runs().size(); ++i) {
        const auto zeros = static_cast<std::size_t>(std::count(call.levels(i), call.levels(i) + n, 0));
        const std::uint32_t type = call.runs()[i].pointType;
        require((zeros == 0) == (type == des_ScreeningPointNoZero), "the type tells runs without a zero");
        const bool isCentre = zeros == continuous && zeros != 0;
        require(isCentre == (type == des_ScreeningPointCenter), "the type tells centre runs");
        require(zeros <= 1 || isCentre, "a run has one zero at most");
    }
}

void checkReplicates(const ScreeningRequest& request, const ScreeningCall& call) {
    const des_DefinitiveScreeningDesign& inputs = request.inputs;
    const std::uint32_t baseRuns = fuzz::countBaseRuns(inputs.numFactors, hasCategorical(request));
    const bool hasBlocks = inputs.replicates >= 2 && inputs.numBlocks != 0;
    const std::uint32_t replicatesPerBlock = hasBlocks ? inputs.replicates / inputs.numBlocks : UINT32_MAX;
    for (std::size_t i = 0; i < call.runs().size(); ++i)
        require(call.isWritten(i), "every run is written");
    for (std::uint32_t replicate = 0; replicate < std::max(inputs.replicates, 1U); ++replicate) {
        for (std::size_t base = 0; base < baseRuns; ++base) {
            const std::size_t i = std::size_t{replicate} * baseRuns + base;
            require(call.runs()[i].block == replicate / replicatesPerBlock + 1, "blocks are made of whole replicates");
            require(std::equal(call.levels(i), call.levels(i) + inputs.numFactors, call.levels(base)),
                    "replicates repeat the base runs");
            require(call.runs()[i].pointType == call.runs()[base].pointType, "replicates repeat the point types");
        }
    }
}

void checkRunOrders(const ScreeningRequest& request, const ScreeningCall& call) {
    const std::vector<des_DefinitiveScreeningRun>& runs = call.runs();
    std::vector<bool> taken(runs.size(), false);
    std::map<std::uint32_t, std::pair<std::uint32_t, std::uint32_t>> rangeOfBlock;
    std::map<std::uint32_t, std::uint32_t> runsOfBlock;
    for (std::size_t i = 0; i < runs.size(); ++i) {
        const std::uint32_t order = runs[i].runOrder;
        require(order >= 1 && order <= runs.size() && !taken[order - 1], "run orders are a permutation");
        taken[order - 1] = true;
        require(request.inputs.randomize != 0 || order == i + 1, "runs are in standard order unless randomized");
        auto [range, isNew] = rangeOfBlock.try_emplace(runs[i].block, order, order);
        range->second = {std::min(range->second.first, order), std::max(range->second.second, order)};
        ++runsOfBlock[runs[i].block];
    }
    for (const auto& [block, range] : rangeOfBlock)
        require(range.second - range.first + 1 == runsOfBlock[block], "the runs of a block follow each other");
}

void checkRepeatable(const ScreeningRequest& request, const ScreeningCall& call) {
    // Seed 0 asks for a fresh one each time.
    if (request.inputs.randomize != 0 && request.inputs.seed == 0.0) return;
    const ScreeningCall again(request);
    require(again.code() == des_Success, "a request that succeeded succeeds again");
    for (std::size_t i = 0; i < call.runs().size(); ++i) {
        require(again.runs()[i].runOrder == call.runs()[i].runOrder, "a seed gives one run order");
        require(std::equal(call.levels(i), call.levels(i) + request.inputs.numFactors, again.levels(i)),
                "the same request, the same levels");
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider bytes(data, size);
    ScreeningRequest request = drawScreeningRequest(bytes);
    const std::int32_t expected = expectedCode(request);
    const std::uint64_t runs = countRuns(request);
    if (runs > kMostRuns && expected != des_ErrorTooManyReplicates) return 0;
    // The base runs are all that is written before the others are found to be too many.
    const bool isCountable = expected != des_ErrorTooManyReplicates;
    request.numRuns = static_cast<std::size_t>(
        isCountable ? runs : fuzz::countBaseRuns(request.inputs.numFactors, hasCategorical(request)));
    const ScreeningCall call(request);
    require(call.code() == expected, "the first test that fails decides");
    if (call.code() != des_Success) {
        checkFailure(request, call);
        return 0;
    }
    checkReplicates(request, call);
    checkBaseRuns(request, call);
    checkPointTypes(request, call);
    checkRunOrders(request, call);
    checkRepeatable(request, call);
    return 0;
}
