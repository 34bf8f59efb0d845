#include <cstring>
#include <fuzzer/FuzzedDataProvider.h>

#include "draw.h"
#include "reisti/reisti.h"
#include "require.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider bytes(data, size);
    const std::int32_t code = bytes.ConsumeBool() ? bytes.ConsumeIntegralInRange<std::int32_t>(des_ErrorNumFactors - 2,
                                                                                               des_ErrorNotANumber + 2)
                                                  : bytes.ConsumeIntegral<std::int32_t>();
    const char* const message = des_ErrorMessage(code);
    fuzz::require(message != nullptr && std::strlen(message) > 1, "every code has a message");
    fuzz::require(message[std::strlen(message) - 1] == '.', "a message is a sentence");
    fuzz::require(des_ErrorMessage(code) == message, "a message stays where it is");
    const bool isKnown = code == des_Success || (code >= des_ErrorNumFactors && code <= des_ErrorNotANumber);
    const bool isUnknownText = std::strcmp(message, des_ErrorMessage(-1)) == 0;
    fuzz::require(isKnown != isUnknownText, "known codes have messages of their own");
    return 0;
}
