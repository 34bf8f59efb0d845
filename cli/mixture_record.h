#ifndef REISTI_CLI_MIXTURE_RECORD_H
#define REISTI_CLI_MIXTURE_RECORD_H

#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

#include "reisti/reisti.h"

namespace cli {

/// A record of the library together with the caller's arrays that it points to.
class MixtureRecord {
  public:
    explicit MixtureRecord(std::size_t q);

    des_MixtureDesign* get() const { return record_.get(); }
    des_MixtureDesign* operator->() const { return record_.get(); }
    const des_MixtureRun& run(std::size_t i) const { return record_->runs[i]; }

    std::vector<double> lower;
    std::vector<double> upper;
    std::vector<std::uint32_t> pointsPerType;
    std::vector<std::uint32_t> boundaryCounts;
    std::vector<std::uint32_t> typeReplicates;
    std::vector<double> amounts;

  private:
    struct Deleter {
        void operator()(des_MixtureDesign* record) const { des_DeleteMixtureDesignContainer(&record); }
    };

    std::vector<double> scaled_;
    std::unique_ptr<des_MixtureDesign, Deleter> record_;
};

}  // namespace cli

#endif
