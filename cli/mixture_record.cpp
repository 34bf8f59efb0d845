#include "mixture_record.h"

#include <new>

namespace cli {

MixtureRecord::MixtureRecord(std::size_t q)
    : lower(q, 0.0),
      upper(q, 1.0),
      pointsPerType(q),
      boundaryCounts(q),
      typeReplicates(q > 2 ? q - 2 : 0, 1),
      scaled_(4 * q),
      record_(des_CreateMixtureDesignContainer()) {
    if (record_ == nullptr) throw std::bad_alloc();
    record_->numComponents = static_cast<std::uint32_t>(q);
    record_->lowerBounds = lower.data();
    record_->upperBounds = upper.data();
    record_->scaledLowerBounds = scaled_.data();
    record_->scaledUpperBounds = scaled_.data() + q;
    record_->pseudoLowerBounds = scaled_.data() + 2 * q;
    record_->pseudoUpperBounds = scaled_.data() + 3 * q;
    record_->pointsPerType = pointsPerType.data();
    record_->boundaryCounts = boundaryCounts.data();
}

}  // namespace cli
