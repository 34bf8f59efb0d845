#include "mixture_checks.h"
#include "mixture_request.h"

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

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider bytes(data, size);
    const fuzz::MixtureRequest request = fuzz::drawMixtureRequest(bytes, fuzz::drawNumComponents(bytes));
    fuzz::MixtureEngine engine{.run = des_RunSimplexCentroidDesign, .codes = fuzz::mixtureCodes()};
    engine.codes.push_back(des_ErrorNotSimplex);
    engine.points = countPoints(request.inputs);
    engine.cost = fuzz::costOf(request, *engine.points);
    fuzz::checkRun(request, engine);
    return 0;
}
