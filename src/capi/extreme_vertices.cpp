#include <algorithm>
#include <cmath>
#include <limits>
#include <span>

#include "capi/guard.h"
#include "capi/required_arrays.h"
#include "mixture/extreme_vertices_design.h"
#include "reisti/reisti.h"

namespace {

using Constraints = std::span<const des_MixtureDesignLinearConstraint>;

bool hasCoefficients(Constraints constraints) {
    return std::ranges::all_of(constraints, [](const auto& constraint) { return constraint.coefficients != nullptr; });
}

/// Whether the constraints bound a region: a side may be infinite, which is no limit, a coefficient may not.
bool hasNumbers(Constraints constraints, std::uint32_t numComponents) {
    return std::ranges::all_of(constraints, [numComponents](const auto& constraint) {
        return !std::isnan(constraint.lowerValue) && !std::isnan(constraint.upperValue) &&
               std::all_of(constraint.coefficients, constraint.coefficients + numComponents,
                           [](double coefficient) { return std::isfinite(coefficient); });
    });
}

}  // namespace

extern "C" std::int32_t des_RunExtremeVerticesDesign(des_MixtureDesign* design, std::int32_t degree,
                                                     std::uint8_t centerPoint, std::int32_t numConstraints,
                                                     des_MixtureDesignLinearConstraint* constraints,
                                                     std::int32_t maxPoints) {
    if (design == nullptr) return des_ErrorNullPointer;
    return reisti::guard([=] {
        const int limit = maxPoints >= 1 ? maxPoints : std::numeric_limits<std::int32_t>::max();
        reisti::ExtremeVerticesDesign engine(design, degree, centerPoint != 0, numConstraints, constraints, limit);
        int error = 0;
        engine.CheckDegree(error);
        if (error != 0) return error;

        if (!reisti::hasRequiredArrays(*design)) return int{des_ErrorNullPointer};
        if (numConstraints > 0) {
            if (constraints == nullptr) return int{des_ErrorNullPointer};
            const Constraints all(constraints, static_cast<std::size_t>(numConstraints));
            if (!hasCoefficients(all)) return int{des_ErrorNullPointer};
            if (!hasNumbers(all, design->numComponents)) return int{des_ErrorNotANumber};
        }
        engine.SimplexCentroidDesign::Calculate(error);
        return error;
    });
}
