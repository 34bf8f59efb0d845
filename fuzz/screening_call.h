#ifndef REISTI_FUZZ_SCREENING_CALL_H
#define REISTI_FUZZ_SCREENING_CALL_H

#include <cstddef>
#include <cstdint>
#include <vector>

#include "reisti/reisti.h"

namespace fuzz {

/// Everything that a caller sets before a screening design is made.
struct ScreeningRequest {
    /// The inputs that are no arrays.
    des_DefinitiveScreeningDesign inputs{};
    std::vector<std::uint32_t> categoricalFactors;
    bool hasCategoricalList = true;
    bool hasRuns = true;
    bool hasFirstLevels = true;
    /// Number of run records behind `runs`.
    std::size_t numRuns = 0;
};

/// One call on arrays of its own, as long as the interface asks, whose outputs hold poison before it.
class ScreeningCall {
  public:
    explicit ScreeningCall(const ScreeningRequest& request);
    ScreeningCall(const ScreeningCall&) = delete;
    ScreeningCall& operator=(const ScreeningCall&) = delete;

    std::int32_t code() const { return code_; }
    const std::vector<des_DefinitiveScreeningRun>& runs() const { return runs_; }
    const std::int32_t* levels(std::size_t run) const { return levels_[run].data(); }

    /// Whether nothing was written into a run, and whether all of it was.
    bool isUntouched(std::size_t run) const;
    bool isWritten(std::size_t run) const;

  private:
    std::vector<std::vector<std::int32_t>> levels_;
    std::vector<des_DefinitiveScreeningRun> runs_;
    std::int32_t code_;
};

}  // namespace fuzz

#endif
