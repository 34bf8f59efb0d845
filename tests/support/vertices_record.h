#ifndef REISTI_TESTS_SUPPORT_VERTICES_RECORD_H
#define REISTI_TESTS_SUPPORT_VERTICES_RECORD_H

#include <cstdint>
#include <vector>

#include "reisti/reisti.h"
#include "support/mixture_record.h"
#include "support/vertices_request.h"

namespace reisti::test {

/// A record with the arrays of its caller and his constraints around it, run as an extreme vertices design.
class VerticesRecord : public MixtureRecord {
  public:
    explicit VerticesRecord(const VerticesRequest& request);

    std::int32_t run();
    VerticesOutcome outcome(std::int32_t code) const;

    /// The arguments of the run, for tests to change.
    std::int32_t degree;
    std::uint8_t centerPoint;
    std::int32_t numConstraints;
    std::vector<des_MixtureDesignLinearConstraint> constraints;
    std::int32_t maxPoints;

  private:
    std::vector<PlainConstraint> given_;
};

/// Runs a request through the C interface.
VerticesOutcome builtVertices(const VerticesRequest& request);

}  // namespace reisti::test

#endif
