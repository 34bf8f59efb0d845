#include <fuzzer/FuzzedDataProvider.h>

#include "base_runs.h"
#include "draw.h"
#include "reisti/reisti.h"
#include "require.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider bytes(data, size);
    const std::int32_t numFactors =
        fuzz::drawRarely(bytes, 8) ? bytes.ConsumeIntegral<std::int32_t>() : bytes.ConsumeIntegralInRange(-1, 50);
    const auto hasCategorical = bytes.ConsumeIntegral<std::uint8_t>();
    // Around the largest numbers that can be counted, and any.
    const bool isNearLimit = bytes.ConsumeBool();
    const std::uint32_t baseRuns = fuzz::countBaseRuns(numFactors, hasCategorical != 0);
    std::uint32_t replicates = fuzz::drawCount(bytes, 100);
    if (isNearLimit && baseRuns != 0)
        replicates = UINT32_MAX / baseRuns - 2 + bytes.ConsumeIntegralInRange<std::uint32_t>(0, 4);

    constexpr std::int32_t kPoison = 4711;
    std::int32_t error = kPoison;
    const std::uint32_t rows =
        des_FindDefinitiveScreeningDesignRowCount(numFactors, &error, hasCategorical, replicates);
    fuzz::require(des_FindDefinitiveScreeningDesignRowCount(numFactors, nullptr, hasCategorical, replicates) == rows,
                  "the count does not depend on the error's place");

    const std::uint64_t expected = std::uint64_t{baseRuns} * (replicates == 0 ? 1 : replicates);
    if (baseRuns == 0) {
        fuzz::require(error == des_ErrorNumFactors && rows == 0, "2 to 48 factors are known");
    } else if (expected > UINT32_MAX) {
        fuzz::require(error == des_ErrorTooManyReplicates && rows == 0, "uncountable runs are refused");
    } else {
        fuzz::require(error == des_Success && rows == expected, "the count is that of the replicated base design");
    }
    return 0;
}
