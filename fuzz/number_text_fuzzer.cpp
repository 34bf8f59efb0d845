#include <bit>
#include <cmath>
#include <fuzzer/FuzzedDataProvider.h>
#include <numeric>
#include <optional>
#include <string>
#include <vector>

#include "draw.h"
#include "numbers.h"
#include "require.h"

namespace {

using fuzz::require;

void checkFormats(double number) {
    const std::string exact = cli::formatExact(number, '.');
    require(cli::parseNumber(exact) == number, "an exact text reads back as the same number");
    std::string withComma = cli::formatExact(number, ',');
    require(withComma.find('.') == std::string::npos, "a decimal mark takes the place of the point");
    const std::optional<double> shortened = cli::parseNumber(cli::formatShort(number, '.'));
    // Six digits of the largest numbers may round up beyond them.
    if (shortened) require(std::fabs(*shortened - number) <= 1e-5 * std::fabs(number), "a short text is near");
    const double typed = cli::withoutRoundingNoise(number);
    require(std::fabs(typed - number) <= 1e-14 * std::fabs(number), "noise is in the last digits");
    require(cli::withoutRoundingNoise(typed) == typed, "a number without noise stays");
}

void checkSplit(const std::string& text, char separator) {
    const std::vector<std::string> parts = cli::split(text, separator);
    require(!parts.empty(), "every text has a part");
    const std::string joined =
        std::accumulate(parts.begin() + 1, parts.end(), parts[0],
                        [=](const std::string& whole, const std::string& part) { return whole + separator + part; });
    require(joined == text, "the parts make up the text");
}

void checkTrimmed(const std::string& text) {
    const std::string_view inner = cli::trimmed(text);
    require(cli::trimmed(inner) == inner, "nothing is left to trim");
    require(text.find(inner) != std::string::npos, "trimming takes from the ends only");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider bytes(data, size);
    const double drawn = fuzz::drawNumber(bytes);
    const char separator = bytes.PickValueInArray({',', ':', '|', 'a', '\0'});
    const std::string text = bytes.ConsumeRemainingBytesAsString();
    if (std::isfinite(drawn)) checkFormats(drawn);
    if (const std::optional<double> number = cli::parseNumber(text)) {
        require(std::isfinite(*number), "numbers are finite");
        checkFormats(*number);
    }
    checkSplit(text, separator);
    checkTrimmed(text);
    return 0;
}
