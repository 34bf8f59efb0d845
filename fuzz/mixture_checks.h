#ifndef REISTI_FUZZ_MIXTURE_CHECKS_H
#define REISTI_FUZZ_MIXTURE_CHECKS_H

#include <cstdint>
#include <functional>
#include <optional>
#include <vector>

#include "mixture_call.h"
#include "mixture_request.h"

namespace fuzz {

/// What a call costs, as far as it can be told before it.
enum class Cost {
    /// The design is small: memory cannot be what it fails for.
    kSmall,
    /// The design would be too large for a fuzzer, though the library might make it.
    kTooLarge,
    /// 32 bits cannot count the runs, so that the library has to refuse.
    kUncountable,
    /// Either there is no run at all, or more than 32 bits can count.
    kNoneOrUncountable
};

/// The cost of a design whose points are known.
Cost costOf(const MixtureRequest& request, const PointCounts& points);

/// One of the run functions, with what is known about its results.
struct MixtureEngine {
    MixtureCall::Function run;
    /// The codes that its documentation lists.
    std::vector<std::int32_t> codes;
    /// The code of the function's own checks before and after those of the record's arrays, as far as a failure is
    /// known to leave everything alone; des_Success where they pass.
    std::int32_t codeBeforeArrays = des_Success;
    std::int32_t codeAfterArrays = des_Success;
    Cost cost = Cost::kSmall;
    /// The points of the design where they follow from the request.
    std::optional<PointCounts> points;
    /// What holds for the finished designs of this function only.
    std::function<void(const des_MixtureDesign&)> checkDesign = [](const des_MixtureDesign&) {};
};

/// The codes that all run functions share.
std::vector<std::int32_t> mixtureCodes();

/// Runs the request, checks the code, the state left behind and the design, and where the result does not depend on
/// the time runs it again and compares.
void checkRun(const MixtureRequest& request, const MixtureEngine& engine);

/// Whether a total multiplies and divides proportions without taking digits away.
bool isTotalModerate(double total);

/// Whether rounding leaves the bounds of a finished design enough digits to compare proportions with them.
bool areBoundsModerate(const des_MixtureDesign& design);

/// What the proportions of a run sum to in the units that were asked for.
double sumOfProportions(const des_MixtureDesign& design, const des_MixtureRun& run);

}  // namespace fuzz

#endif
