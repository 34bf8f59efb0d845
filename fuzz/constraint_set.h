#ifndef REISTI_FUZZ_CONSTRAINT_SET_H
#define REISTI_FUZZ_CONSTRAINT_SET_H

#include <cstddef>
#include <cstdint>
#include <fuzzer/FuzzedDataProvider.h>
#include <vector>

#include "reisti/reisti.h"

namespace fuzz {

/// Linear constraints as a caller holds them: records, and arrays of exactly q coefficients.
class ConstraintSet {
  public:
    ConstraintSet(FuzzedDataProvider& bytes, std::uint32_t numComponents, std::size_t count, double total);

    /// A polygon around the centroid of three components, each side of which cuts.
    static ConstraintSet drawPolygon(FuzzedDataProvider& bytes, std::size_t count, double total);

    ~ConstraintSet() = default;
    ConstraintSet(const ConstraintSet&) = delete;
    ConstraintSet& operator=(const ConstraintSet&) = delete;
    ConstraintSet(ConstraintSet&&) = default;
    ConstraintSet& operator=(ConstraintSet&&) = default;

    /// The records for a new call, with poisoned statuses.
    des_MixtureDesignLinearConstraint* prepare();

    std::size_t size() const { return requested_.size(); }
    bool hasAllCoefficients() const;
    /// Whether no constraint holds NaN or an infinite coefficient.
    bool hasNumbers() const;
    bool areStatusesUntouched() const;

    /// Checks that a call has written nothing but allowed statuses.
    void checkRecords() const;

    /// Checks that every run is within the sides that cut the region, and each vertex on as many planes as make one.
    void checkRuns(const des_MixtureDesign& design, double total) const;

  private:
    ConstraintSet() = default;
    void add(const des_MixtureDesignLinearConstraint& constraint, std::vector<double> coefficients);

    std::vector<std::vector<double>> coefficients_;
    std::vector<des_MixtureDesignLinearConstraint> requested_;
    std::vector<des_MixtureDesignLinearConstraint> records_;
};

}  // namespace fuzz

#endif
