#include "mixture_request.h"

#include <algorithm>
#include <cmath>
#include <numeric>

#include "draw.h"

namespace fuzz {

namespace {

/// Bounds for which components beyond a few would only repeat what the few have shown.
constexpr std::uint32_t kMostBoundedComponents = 12;

/// Far above what can be counted, and such that products of several do not reach infinity.
constexpr double kUncountable = 1e60;
constexpr std::uint32_t kMostExponent = 200;

void drawLowerBounds(FuzzedDataProvider& bytes, MixtureRequest& request) {
    const int most = 150 / static_cast<int>(request.lowerBounds.size());
    for (double& lower : request.lowerBounds)
        lower = drawHundredths(bytes, 0, most);
}

/// What the lower bounds of the other components leave to each.
void implyUpperBounds(MixtureRequest& request) {
    const std::vector<double>& lower = request.lowerBounds;
    const double free = 1.0 - std::accumulate(lower.begin(), lower.end(), 0.0);
    std::transform(lower.begin(), lower.end(), request.upperBounds.begin(), [=](double bound) { return bound + free; });
}

void drawBox(FuzzedDataProvider& bytes, MixtureRequest& request) {
    drawLowerBounds(bytes, request);
    for (std::size_t i = 0; i < request.upperBounds.size(); ++i) {
        const int lower = static_cast<int>(std::lround(request.lowerBounds[i] * 100));
        request.upperBounds[i] = drawHundredths(bytes, std::min(lower + 1, 100), 100);
    }
}

void drawAnyBounds(FuzzedDataProvider& bytes, MixtureRequest& request) {
    for (std::size_t i = 0; i < request.upperBounds.size(); ++i) {
        request.lowerBounds[i] = drawNumber(bytes);
        request.upperBounds[i] = drawNumber(bytes);
    }
}

void scaleBounds(MixtureRequest& request, double total) {
    for (std::vector<double>* const bounds : {&request.lowerBounds, &request.upperBounds}) {
        for (double& bound : *bounds)
            bound *= total;
    }
}

enum class Region { kWhole, kLowerBounds, kSimplex, kBox, kAny, kOneBound, kMaxValue = kOneBound };

/// Fractions of the whole, to be multiplied by the total afterwards, unless the bounds are any numbers.
void drawBounds(FuzzedDataProvider& bytes, MixtureRequest& request) {
    const std::uint32_t q = request.inputs.numComponents;
    request.lowerBounds.assign(q, 0.0);
    request.upperBounds.assign(q, 1.0);
    if (q == 0) return;
    const auto region = bytes.ConsumeEnum<Region>();
    if (q <= kMostBoundedComponents) {
        if (region == Region::kLowerBounds || region == Region::kSimplex) drawLowerBounds(bytes, request);
        if (region == Region::kSimplex) implyUpperBounds(request);
        if (region == Region::kBox) drawBox(bytes, request);
        if (region == Region::kAny) drawAnyBounds(bytes, request);
    }
    if (region == Region::kOneBound) {
        const auto at = bytes.ConsumeIntegralInRange<std::size_t>(0, q - 1);
        (bytes.ConsumeBool() ? request.lowerBounds : request.upperBounds)[at] = drawNumber(bytes);
    }
    if (region != Region::kAny && !request.amounts.empty()) scaleBounds(request, request.amounts[0]);
}

void drawProcessVariables(FuzzedDataProvider& bytes, des_MixtureDesign& inputs) {
    inputs.processFraction = 1;
    inputs.fractionIndex = 1;
    const int kind = bytes.ConsumeIntegralInRange(0, 9);
    if (kind < 4) return;
    inputs.numProcessVariables = bytes.ConsumeIntegralInRange<std::uint32_t>(1, kind < 8 ? 7 : 20);
    if (kind == 9) inputs.numProcessVariables = bytes.ConsumeIntegral<std::uint32_t>();
    if (bytes.ConsumeBool()) inputs.processFraction = 1U << bytes.ConsumeIntegralInRange(1, 4);
    if (drawRarely(bytes, 8)) inputs.processFraction = bytes.ConsumeIntegralInRange(0U, 300U);
    inputs.fractionIndex = drawCount(bytes, inputs.processFraction);
}

void drawAmounts(FuzzedDataProvider& bytes, std::vector<double>& amounts) {
    constexpr int kNone = 4;
    amounts.resize(static_cast<std::size_t>(std::max(0, bytes.ConsumeIntegralInRange(0, kNone + 4) - kNone)));
    for (double& amount : amounts)
        amount = drawRarely(bytes, 4) ? drawNumber(bytes) : bytes.ConsumeIntegralInRange(1, 200) / 2.0;
}

void drawReplicates(FuzzedDataProvider& bytes, MixtureRequest& request) {
    request.inputs.vertexReplicates = drawCount(bytes, 3);
    request.inputs.centerReplicates = drawCount(bytes, 3);
    request.inputs.axialReplicates = drawCount(bytes, 3);
    request.inputs.designReplicates = drawCount(bytes, 3);
    const std::uint32_t q = request.inputs.numComponents;
    if (q <= 2 || !bytes.ConsumeBool()) return;
    request.typeReplicates.emplace(q - 2, 1);
    for (std::uint32_t i = 0; i < std::min(q - 2, kMostBoundedComponents); ++i)
        (*request.typeReplicates)[i] = drawCount(bytes, 3);
}

}  // namespace

std::uint32_t drawNumComponents(FuzzedDataProvider& bytes) {
    constexpr std::uint32_t kMoreThanATableHolds = 46341;
    const int kind = bytes.ConsumeIntegralInRange(0, 31);
    if (kind == 31 && drawRarely(bytes, 8))
        return bytes.ConsumeIntegralInRange(kMoreThanATableHolds, kMoreThanATableHolds + 100);
    if (kind >= 30) return bytes.ConsumeIntegralInRange(13U, 200U);
    if (kind >= 26) return bytes.ConsumeIntegralInRange(0U, kMostBoundedComponents);
    return bytes.ConsumeIntegralInRange(2U, 6U);
}

MixtureRequest drawMixtureRequest(FuzzedDataProvider& bytes, std::uint32_t numComponents) {
    MixtureRequest request;
    des_MixtureDesign& inputs = request.inputs;
    inputs.numComponents = numComponents;
    inputs.axialPoints = bytes.ConsumeIntegral<std::uint8_t>();
    inputs.randomize = bytes.ConsumeIntegral<std::uint8_t>();
    inputs.seed = drawNumber(bytes);
    inputs.outputUnits = bytes.ConsumeIntegralInRange(0U, 3U);
    if (inputs.outputUnits == 3) inputs.outputUnits = bytes.ConsumeIntegral<std::uint32_t>();
    drawProcessVariables(bytes, inputs);
    drawAmounts(bytes, request.amounts);
    inputs.numAmounts = static_cast<std::uint32_t>(request.amounts.size());
    drawReplicates(bytes, request);
    drawBounds(bytes, request);
    if (drawRarely(bytes, 32)) request.missingArray = bytes.ConsumeIntegralInRange<std::size_t>(0, kAmountsArray);
    return request;
}

double totalOf(const MixtureRequest& request) {
    return request.amounts.empty() ? 1.0 : request.amounts[0];
}

bool isWholeSimplex(const MixtureRequest& request) {
    const double total = totalOf(request);
    return std::ranges::all_of(request.lowerBounds, [](double bound) { return bound == 0.0; }) &&
           std::ranges::all_of(request.upperBounds, [=](double bound) { return bound == total; });
}

double countSubsets(double n, double k) {
    if (k < 0 || k > n) return 0;
    k = std::min(k, n - k);
    double count = 1;
    for (double i = 1; i <= k && count < kUncountable; ++i)
        count = count * (n - k + i) / i;
    return count;
}

double replicatesOf(const MixtureRequest& request, std::int64_t pointType) {
    if (pointType == des_MixturePointAxial) return request.inputs.axialReplicates;
    if (pointType == des_MixturePointCentroid) return request.inputs.centerReplicates;
    if (pointType == des_MixturePointVertex) return request.inputs.vertexReplicates;
    if (!request.typeReplicates || pointType >= request.inputs.numComponents) return 1;
    return (*request.typeReplicates)[static_cast<std::size_t>(pointType) - 2];
}

double countRuns(const MixtureRequest& request, const PointCounts& points) {
    double runs = points.center * replicatesOf(request, des_MixturePointCentroid) +
                  points.axial * replicatesOf(request, des_MixturePointAxial);
    for (std::size_t i = 0; i < points.ofType.size(); ++i)
        runs += points.ofType[i] * replicatesOf(request, static_cast<std::int64_t>(i) + 1);
    return runs * countRepeats(request);
}

double countRepeats(const MixtureRequest& request) {
    const des_MixtureDesign& inputs = request.inputs;
    double repeats = inputs.designReplicates;
    if (!request.amounts.empty()) repeats *= static_cast<double>(request.amounts.size());
    if (inputs.numProcessVariables != 0 && inputs.processFraction != 0)
        repeats *= std::floor(std::exp2(std::min(inputs.numProcessVariables, kMostExponent)) / inputs.processFraction);
    return repeats;
}

}  // namespace fuzz
