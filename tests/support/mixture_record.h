#ifndef REISTI_TESTS_SUPPORT_MIXTURE_RECORD_H
#define REISTI_TESTS_SUPPORT_MIXTURE_RECORD_H

#include <cstdint>
#include <vector>

#include "reisti/reisti.h"
#include "support/mixture_request.h"

namespace reisti::test {

/// A record from des_CreateMixtureDesignContainer() with the arrays of its caller around it: filled from a request, run
/// through the C interface, deleted at the end. Output arrays start poisoned and hold exactly q entries, so that
/// address sanitizers see a write behind them.
class MixtureRecord {
  public:
    explicit MixtureRecord(const MixtureRequest& request);
    MixtureRecord(const MixtureRecord&) = delete;
    MixtureRecord& operator=(const MixtureRecord&) = delete;
    ~MixtureRecord() { des_DeleteMixtureDesignContainer(&design_); }

    des_MixtureDesign* operator->() { return design_; }
    des_MixtureDesign* get() { return design_; }
    des_MixtureDesign** address() { return &design_; }

    /// Calls the run function that the request names.
    std::int32_t run();
    MixtureOutcome outcome(std::int32_t code) const;
    std::vector<MixtureRunValue> runs() const;

    /// All bytes that a run may change: the record and the caller's arrays.
    std::vector<unsigned char> bytes() const;

    std::vector<double> lowerBounds, upperBounds, scaledLowerBounds, scaledUpperBounds, pseudoLowerBounds,
        pseudoUpperBounds, amounts;
    std::vector<std::uint32_t> pointsPerType, boundaryCounts, typeReplicates;

  private:
    void pointAtArrays(bool withTypeReplicates);

    des_MixtureDesign* design_ = des_CreateMixtureDesignContainer();
    std::uint32_t numComponents_;
    bool lattice_;
    std::int32_t degree_;
    std::uint8_t centerPoint_;
};

/// Runs a request through the C interface.
MixtureOutcome builtDesign(const MixtureRequest& request);

}  // namespace reisti::test

#endif
