#ifndef REISTI_BENCH_MIXTURE_MIXTURE_RECORD_H
#define REISTI_BENCH_MIXTURE_MIXTURE_RECORD_H

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "reisti/reisti.h"

namespace reisti::bench {

/// A record with the arrays that its caller owns: unbounded components unless the bounds are changed.
class MixtureRecord {
  public:
    explicit MixtureRecord(std::uint32_t q)
        : lower(q, 0.0),
          upper(q, 1.0),
          outputs_(4, std::vector<double>(q)),
          counts_(2, std::vector<std::uint32_t>(q)),
          design_(des_CreateMixtureDesignContainer()) {
        design_->numComponents = q;
        design_->lowerBounds = lower.data();
        design_->upperBounds = upper.data();
        design_->scaledLowerBounds = outputs_[0].data();
        design_->scaledUpperBounds = outputs_[1].data();
        design_->pseudoLowerBounds = outputs_[2].data();
        design_->pseudoUpperBounds = outputs_[3].data();
        design_->pointsPerType = counts_[0].data();
        design_->boundaryCounts = counts_[1].data();
    }
    MixtureRecord(const MixtureRecord&) = delete;
    MixtureRecord& operator=(const MixtureRecord&) = delete;
    ~MixtureRecord() { des_DeleteMixtureDesignContainer(&design_); }

    des_MixtureDesign* operator->() { return design_; }
    des_MixtureDesign* get() { return design_; }

    std::vector<double> lower;
    std::vector<double> upper;

  private:
    std::vector<std::vector<double>> outputs_;
    std::vector<std::vector<std::uint32_t>> counts_;
    des_MixtureDesign* design_;
};

/// The bound of every mixture design: its arrays from the same allocator, each filled once.
inline des_MixtureRun* allocateAndFill(std::uint32_t numRuns, std::uint32_t q, std::uint32_t p) {
    auto* const runs = new des_MixtureRun[numRuns];
    for (std::uint32_t i = 0; i < numRuns; ++i) {
        runs[i] = {i + 1, 1, 1, new double[q], 1.0, p != 0 ? new std::int32_t[p] : nullptr};
        std::fill_n(runs[i].proportions, q, 1.0 / q);
        if (p != 0) std::fill_n(runs[i].processLevels, p, -1);
    }
    return runs;
}

inline void release(des_MixtureRun* runs, std::uint32_t numRuns) {
    for (std::uint32_t i = 0; i < numRuns; ++i) {
        delete[] runs[i].proportions;
        delete[] runs[i].processLevels;
    }
    delete[] runs;
}

}  // namespace reisti::bench

#endif
