#include "support/vertices_record.h"

namespace reisti::test {

VerticesRecord::VerticesRecord(const VerticesRequest& request)
    : MixtureRecord(request),
      degree(request.degree),
      centerPoint(request.centerPoint),
      numConstraints(static_cast<std::int32_t>(request.constraints.size())),
      maxPoints(request.maxPoints),
      given_(request.constraints) {
    for (const PlainConstraint& c : given_) {
        des_MixtureDesignLinearConstraint record = {};
        record.hasLowerValue = c.hasLower ? 1 : 0;
        record.lowerValue = c.lower;
        record.hasUpperValue = c.hasUpper ? 1 : 0;
        record.upperValue = c.upper;
        record.coefficients = c.coefficients.data();
        record.status = c.status;
        constraints.push_back(record);
    }
}

std::int32_t VerticesRecord::run() {
    return des_RunExtremeVerticesDesign(get(), degree, centerPoint, numConstraints,
                                        constraints.empty() ? nullptr : constraints.data(), maxPoints);
}

VerticesOutcome VerticesRecord::outcome(std::int32_t code) const {
    VerticesOutcome all{MixtureRecord::outcome(code), {}};
    for (const auto& constraint : constraints)
        all.statuses.push_back(constraint.status);
    return all;
}

VerticesOutcome builtVertices(const VerticesRequest& request) {
    VerticesRecord record(request);
    return record.outcome(record.run());
}

}  // namespace reisti::test
