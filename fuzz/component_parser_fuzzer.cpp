#include <cmath>
#include <fuzzer/FuzzedDataProvider.h>
#include <string>

#include "component.h"
#include "draw.h"
#include "require.h"
#include "usage_error.h"

namespace {

using fuzz::require;

void parseOneComponent(const std::string& text, double total) {
    try {
        const cli::Component component = cli::parseComponent(text, total);
        require(!component.name.empty(), "a component has a name");
        require(text.find('=') == std::string::npos ||
                    (component.lower >= 0 && component.lower < component.upper && component.upper <= total),
                "bounds lie within the total");
    } catch (const cli::UsageError& error) {
        require(std::string(error.what()).starts_with("--component \""), "a refusal names the option");
    }
}

void parseOneReplicates(const std::string& text, std::size_t numComponents) {
    try {
        const cli::Replicates replicates = cli::parseReplicates(text, numComponents);
        require(replicates.types.size() == (numComponents > 2 ? numComponents - 2 : 0),
                "the types between vertices and centroid have replicates");
    } catch (const cli::UsageError& error) {
        require(std::string(error.what()).starts_with("--replicates \""), "a refusal names the option");
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider bytes(data, size);
    const auto numComponents = bytes.ConsumeIntegralInRange<std::size_t>(0, 40);
    // The program takes no other totals than positive numbers.
    const double number = fuzz::drawNumber(bytes);
    const double total = std::isfinite(number) && number > 0 ? number : 1;
    const bool isComponent = bytes.ConsumeBool();
    const std::string text = bytes.ConsumeRemainingBytesAsString();
    if (isComponent) {
        parseOneComponent(text, total);
    } else {
        parseOneReplicates(text, numComponents);
    }
    return 0;
}
