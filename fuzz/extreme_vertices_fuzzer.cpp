#include <algorithm>
#include <cmath>
#include <limits>
#include <numeric>
#include <utility>

#include "constraint_set.h"
#include "draw.h"
#include "mixture_checks.h"
#include "mixture_request.h"
#include "require.h"

namespace {

struct VerticesRequest {
    fuzz::MixtureRequest mixture;
    std::int32_t degree;
    std::uint8_t centerPoint;
    std::int32_t numConstraints;
    bool hasConstraintArray;
    std::int32_t maxPoints;
    fuzz::ConstraintSet constraints;
};

std::int32_t drawDegree(FuzzedDataProvider& bytes, std::uint32_t q) {
    if (fuzz::drawRarely(bytes, 16)) return bytes.ConsumeIntegral<std::int32_t>();
    return bytes.ConsumeIntegralInRange(0, static_cast<std::int32_t>(q) + 1);
}

std::int32_t drawMaxPoints(FuzzedDataProvider& bytes) {
    if (bytes.ConsumeBool()) return bytes.ConsumeIntegralInRange(1, 60);
    return fuzz::drawRarely(bytes, 8) ? bytes.ConsumeIntegral<std::int32_t>() : 0;
}

/// A call on a request and constraints that fit it.
VerticesRequest drawCall(FuzzedDataProvider& bytes, fuzz::MixtureRequest mixture, std::int32_t degree,
                         fuzz::ConstraintSet constraints) {
    const auto centerPoint = bytes.ConsumeIntegral<std::uint8_t>();
    const std::int32_t maxPoints = drawMaxPoints(bytes);
    const bool hasArray = !fuzz::drawRarely(bytes, 32);
    std::int32_t numConstraints = static_cast<std::int32_t>(constraints.size());
    if (numConstraints == 0 || !hasArray) numConstraints = bytes.ConsumeIntegralInRange(-2, hasArray ? 0 : 100);
    return {std::move(mixture), degree, centerPoint, numConstraints, hasArray, maxPoints, std::move(constraints)};
}

VerticesRequest drawOrdinary(FuzzedDataProvider& bytes) {
    const std::uint32_t q = bytes.ConsumeIntegralInRange(0, 8) != 0 ? bytes.ConsumeIntegralInRange(2U, 5U)
                                                                    : bytes.ConsumeIntegralInRange(0U, 8U);
    const std::int32_t degree = drawDegree(bytes, q);
    fuzz::MixtureRequest mixture = fuzz::drawMixtureRequest(bytes, q);
    const auto count = bytes.ConsumeIntegralInRange<std::size_t>(0, 5);
    fuzz::ConstraintSet constraints(bytes, q, count, fuzz::totalOf(mixture));
    return drawCall(bytes, std::move(mixture), degree, std::move(constraints));
}

/// More planes than there are bits in a word.
VerticesRequest drawManyPlanes(FuzzedDataProvider& bytes) {
    constexpr std::uint32_t kTriangle = 3;
    const std::int32_t degree = drawDegree(bytes, kTriangle);
    fuzz::MixtureRequest mixture = fuzz::drawMixtureRequest(bytes, kTriangle);
    const auto count = bytes.ConsumeIntegralInRange<std::size_t>(40, 150);
    fuzz::ConstraintSet polygon = fuzz::ConstraintSet::drawPolygon(bytes, count, fuzz::totalOf(mixture));
    return drawCall(bytes, std::move(mixture), degree, std::move(polygon));
}

/// So many vertices that trying all pairs of them would take long.
VerticesRequest drawManyVertices(FuzzedDataProvider& bytes) {
    const auto q = bytes.ConsumeIntegralInRange(8U, 10U);
    fuzz::MixtureRequest mixture = fuzz::drawMixtureRequest(bytes, q);
    mixture.lowerBounds.assign(q, 0.0);
    mixture.upperBounds.assign(q, fuzz::drawHundredths(bytes, 15, 40) * fuzz::totalOf(mixture));
    const auto count = bytes.ConsumeIntegralInRange<std::size_t>(1, 2);
    fuzz::ConstraintSet constraints(bytes, q, count, fuzz::totalOf(mixture));
    return drawCall(bytes, std::move(mixture), 1, std::move(constraints));
}

VerticesRequest drawVerticesRequest(FuzzedDataProvider& bytes) {
    switch (bytes.ConsumeIntegralInRange(0, 15)) {
        case 14:
            return drawManyPlanes(bytes);
        case 15:
            return drawManyVertices(bytes);
        default:
            return drawOrdinary(bytes);
    }
}

/// Only a rough bound on the number of points is known before the vertices are.
double mostPoints(const VerticesRequest& request) {
    constexpr double kMostVertices = 4096;
    if (request.constraints.size() > 5) return 2.0 * static_cast<double>(request.constraints.size());
    const double faces = std::exp2(2.0 * request.mixture.inputs.numComponents);
    return request.degree <= 1 ? std::min(faces, kMostVertices) : faces;
}

fuzz::Cost costOf(const VerticesRequest& request) {
    constexpr double kMostRuns = 65'536;
    const fuzz::MixtureRequest& mixture = request.mixture;
    const double repeats = fuzz::countRepeats(mixture);
    if (repeats > std::numeric_limits<std::uint32_t>::max()) return fuzz::Cost::kNoneOrUncountable;
    double replicates = 1;
    for (std::int64_t type = des_MixturePointAxial; type <= mixture.inputs.numComponents; ++type)
        replicates = std::max(replicates, fuzz::replicatesOf(mixture, type));
    return mostPoints(request) * replicates * repeats > kMostRuns ? fuzz::Cost::kTooLarge : fuzz::Cost::kSmall;
}

std::int32_t codeOfConstraints(const VerticesRequest& request) {
    if (request.numConstraints <= 0) return des_Success;
    if (!request.hasConstraintArray || !request.constraints.hasAllCoefficients()) return des_ErrorNullPointer;
    return request.constraints.hasNumbers() ? des_Success : des_ErrorNotANumber;
}

/// Calls the function with fresh constraints and checks what it leaves in them.
std::int32_t run(VerticesRequest& request, des_MixtureDesign* design) {
    des_MixtureDesignLinearConstraint* const constraints = request.constraints.prepare();
    const std::int32_t code =
        des_RunExtremeVerticesDesign(design, request.degree, request.centerPoint, request.numConstraints,
                                     request.hasConstraintArray ? constraints : nullptr, request.maxPoints);
    request.constraints.checkRecords();
    if (code == des_ErrorDegree || code == des_ErrorNullPointer || codeOfConstraints(request) != des_Success)
        fuzz::require(request.constraints.areStatusesUntouched(), "refused constraints have no status");
    return code;
}

void checkDesign(const VerticesRequest& request, const des_MixtureDesign& design) {
    const std::uint32_t q = design.numComponents;
    const std::uint32_t vertices = design.pointsPerType[0];
    fuzz::require(design.numAxialPoints == (design.axialPoints != 0 ? vertices : 0),
                  "there is an axial point for each vertex");
    const auto lastType = static_cast<std::uint32_t>(std::max(request.degree, 1));
    const double points = std::accumulate(design.pointsPerType, design.pointsPerType + q, 0.0);
    for (std::uint32_t type = lastType + 1; type <= q; ++type)
        fuzz::require(design.pointsPerType[type - 1] == 0, "no centroids of more dimensions than asked for");
    if (request.maxPoints >= 1 && request.degree >= 2)
        fuzz::require(points <= std::max<double>(vertices, request.maxPoints), "no more points than accepted");

    const double total = fuzz::totalOf(request.mixture);
    if (request.numConstraints > 0 && design.outputUnits <= des_UnitsProportion && fuzz::areBoundsModerate(design) &&
        fuzz::isTotalModerate(total))
        request.constraints.checkRuns(design, total);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider bytes(data, size);
    VerticesRequest request = drawVerticesRequest(bytes);
    fuzz::MixtureEngine engine{.run = [&](des_MixtureDesign* design) { return run(request, design); },
                               .codes = fuzz::mixtureCodes()};
    engine.codes.insert(engine.codes.end(), {des_ErrorDegree, des_ErrorNotANumber, des_ErrorTooManyPoints});
    if (static_cast<std::uint32_t>(request.degree) > request.mixture.inputs.numComponents)
        engine.codeBeforeArrays = des_ErrorDegree;
    engine.codeAfterArrays = codeOfConstraints(request);
    engine.cost = costOf(request);
    engine.checkDesign = [&](const des_MixtureDesign& design) { checkDesign(request, design); };
    fuzz::checkRun(request.mixture, engine);
    return 0;
}
