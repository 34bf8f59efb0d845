#ifndef REISTI_FUZZ_MIXTURE_CALL_H
#define REISTI_FUZZ_MIXTURE_CALL_H

#include <cstdint>
#include <functional>
#include <vector>

#include "mixture_request.h"
#include "reisti/reisti.h"

namespace fuzz {

/// The arrays that a caller owns, each exactly as long as the interface asks, so that the address sanitizer sees every
/// access beyond. The outputs hold poison before a run.
struct CallerArrays {
    std::vector<double> lowerBounds;
    std::vector<double> upperBounds;
    std::vector<double> scaledLowerBounds;
    std::vector<double> scaledUpperBounds;
    std::vector<double> pseudoLowerBounds;
    std::vector<double> pseudoUpperBounds;
    std::vector<std::uint32_t> pointsPerType;
    std::vector<std::uint32_t> boundaryCounts;
    std::vector<double> amounts;
    std::vector<std::uint32_t> typeReplicates;
};

/// One call of a run function on a record of its own. `runs` and `numRuns` hold poison before it, as they would after
/// an earlier run on the same record.
class MixtureCall {
  public:
    using Function = std::function<std::int32_t(des_MixtureDesign*)>;

    MixtureCall(const MixtureRequest& request, const Function& function);
    ~MixtureCall();
    MixtureCall(const MixtureCall&) = delete;
    MixtureCall& operator=(const MixtureCall&) = delete;

    std::int32_t code() const { return code_; }
    const des_MixtureDesign& design() const { return *design_; }

    bool isNothingChanged() const;
    bool areRunsUntouched() const;
    void checkInputsUnchanged() const;

  private:
    void pointAtArrays();
    void leaveOut(std::size_t array);

    CallerArrays arrays_;
    CallerArrays arraysBefore_;
    des_MixtureDesign* design_;
    des_MixtureDesign designBefore_;
    std::int32_t code_;
};

}  // namespace fuzz

#endif
