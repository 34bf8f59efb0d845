#include <cmath>
#include <fuzzer/FuzzedDataProvider.h>
#include <nlohmann/json.hpp>
#include <string>
#include <variant>

#include "factor.h"
#include "require.h"
#include "usage_error.h"

namespace {

using fuzz::require;

void checkFactor(const cli::Factor& factor) {
    require(!factor.name.empty() && !factor.isCoded, "a factor that was typed has a name and levels");
    if (factor.isCategorical) {
        require(!factor.lowWord.empty() && !factor.highWord.empty() && factor.lowWord != factor.highWord,
                "a categorical factor has two words");
        require(factor.level(-1, false) == cli::Cell(factor.lowWord) &&
                    factor.level(1, false) == cli::Cell(factor.highWord),
                "a categorical factor shows its words");
    } else {
        require(std::isfinite(factor.low) && std::isfinite(factor.high) && factor.low < factor.high,
                "a range goes from low to high");
        require(factor.level(-1, false) == cli::Cell(factor.low) && factor.level(1, false) == cli::Cell(factor.high),
                "a range shows its ends");
        const double middle = std::get<double>(factor.level(0, false));
        require(std::isfinite(middle), "the middle of a range is a number");
    }
    for (const int coded : {-1, 0, 1})
        require(factor.level(coded, true) == cli::Cell(std::int64_t{coded}), "codes are shown on request");
    const nlohmann::ordered_json entry = factor.describe();
    require(entry.at("name") == factor.name, "a description begins with the name");
    require(entry.contains("levels") == factor.isCategorical, "words are described as levels");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    try {
        checkFactor(cli::parseFactor("--factor", text));
    } catch (const cli::UsageError& error) {
        require(std::string(error.what()).starts_with("--factor \""), "a refusal names the option");
    }
    return 0;
}
