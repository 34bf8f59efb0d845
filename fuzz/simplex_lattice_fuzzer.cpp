#include <algorithm>
#include <cmath>
#include <limits>
#include <span>

#include "draw.h"
#include "mixture_checks.h"
#include "mixture_request.h"
#include "require.h"

namespace {

struct LatticeRequest {
    fuzz::MixtureRequest mixture;
    std::int32_t degree;
    std::uint8_t centerPoint;
};

LatticeRequest drawLatticeRequest(FuzzedDataProvider& bytes) {
    const std::uint32_t q = fuzz::drawNumComponents(bytes);
    const auto centerPoint = bytes.ConsumeIntegral<std::uint8_t>();
    std::int32_t degree = bytes.ConsumeIntegralInRange(1, 12);
    if (fuzz::drawRarely(bytes, 16)) degree = bytes.ConsumeIntegral<std::int32_t>();
    return {fuzz::drawMixtureRequest(bytes, q), degree, centerPoint};
}

std::int32_t mostDegree(std::uint32_t q) {
    constexpr struct {
        std::uint32_t mostComponents;
        std::int32_t degree;
    } LIMITS[] = {{5, 10}, {6, 7}, {7, 6}, {8, 5}, {11, 4}, {17, 3}, {20, 2}};
    for (const auto& limit : LIMITS)
        if (q <= limit.mostComponents) return limit.degree;
    return std::numeric_limits<std::int32_t>::max();
}

fuzz::PointCounts countPoints(const LatticeRequest& request) {
    const std::uint32_t q = request.mixture.inputs.numComponents;
    fuzz::PointCounts points;
    points.ofType.assign(q, 0.0);
    for (std::uint32_t type = 1; type <= q; ++type)
        points.ofType[type - 1] = fuzz::countSubsets(q, type) * fuzz::countSubsets(request.degree - 1.0, type - 1.0);
    const bool holdsCentroid = q != 0 && static_cast<std::uint32_t>(request.degree) % q == 0;
    if (holdsCentroid) points.ofType[q - 1] -= 1;
    points.center = holdsCentroid || request.centerPoint != 0 ? 1 : 0;
    points.axial = request.mixture.inputs.axialPoints != 0 ? q : 0;
    return points;
}

/// In pseudo-components the points are those of the whole simplex, however the region is bounded.
void checkPseudoComponents(const des_MixtureDesign& design, std::int32_t degree) {
    if (design.outputUnits != des_UnitsPseudo) return;
    for (const des_MixtureRun& run : std::span(design.runs, design.numRuns)) {
        if (run.pointType < des_MixturePointVertex) continue;
        const std::span proportions(run.proportions, design.numComponents);
        const auto isMultiple = [=](double share) { return share == std::round(share * degree) / degree; };
        fuzz::require(std::ranges::all_of(proportions, isMultiple), "proportions are multiples of 1/degree");
        fuzz::require(std::ranges::count(proportions, 0.0) + run.pointType == design.numComponents,
                      "a point of type k has k proportions that are not 0");
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider bytes(data, size);
    const LatticeRequest request = drawLatticeRequest(bytes);
    fuzz::MixtureEngine engine{.run =
                                   [&](des_MixtureDesign* design) {
                                       return des_RunSimplexLatticeDesign(design, request.degree, request.centerPoint);
                                   },
                               .codes = fuzz::mixtureCodes()};
    engine.codes.push_back(des_ErrorNotSimplex);
    engine.codes.push_back(des_ErrorDegree);
    if (request.degree < 1 || request.degree > mostDegree(request.mixture.inputs.numComponents)) {
        engine.codeBeforeArrays = des_ErrorDegree;
    } else {
        engine.points = countPoints(request);
        engine.cost = fuzz::costOf(request.mixture, *engine.points);
    }
    engine.checkDesign = [&](const des_MixtureDesign& design) { checkPseudoComponents(design, request.degree); };
    fuzz::checkRun(request.mixture, engine);
    return 0;
}
