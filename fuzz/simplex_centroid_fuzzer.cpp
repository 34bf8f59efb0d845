#include <algorithm>
#include <span>

#include "mixture_checks.h"
#include "mixture_request.h"
#include "require.h"

namespace {

fuzz::PointCounts countPoints(const des_MixtureDesign& inputs) {
    const std::uint32_t q = inputs.numComponents;
    fuzz::PointCounts points;
    points.ofType.assign(q, 0.0);
    for (std::uint32_t size = 1; size < q; ++size)
        points.ofType[size - 1] = fuzz::countSubsets(q, size);
    points.center = 1;
    points.axial = inputs.axialPoints != 0 ? q : 0;
    return points;
}

/// In pseudo-components the points are those of the whole simplex, however the region is bounded.
void checkPseudoComponents(const des_MixtureDesign& design) {
    if (design.outputUnits != des_UnitsPseudo) return;
    const std::uint32_t q = design.numComponents;
    for (const des_MixtureRun& run : std::span(design.runs, design.numRuns)) {
        if (run.pointType == des_MixturePointAxial) continue;
        const std::uint32_t size =
            run.pointType == des_MixturePointCentroid ? q : static_cast<std::uint32_t>(run.pointType);
        const std::span proportions(run.proportions, q);
        fuzz::require(
            std::ranges::count(proportions, 1.0 / size) == size && std::ranges::count(proportions, 0.0) == q - size,
            "a point of type k has k equal proportions and no other");
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider bytes(data, size);
    const fuzz::MixtureRequest request = fuzz::drawMixtureRequest(bytes, fuzz::drawNumComponents(bytes));
    fuzz::MixtureEngine engine{.run = des_RunSimplexCentroidDesign, .codes = fuzz::mixtureCodes()};
    engine.codes.push_back(des_ErrorNotSimplex);
    engine.points = countPoints(request.inputs);
    engine.cost = fuzz::costOf(request, *engine.points);
    engine.checkDesign = checkPseudoComponents;
    fuzz::checkRun(request, engine);
    return 0;
}
