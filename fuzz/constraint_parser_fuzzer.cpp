#include <algorithm>
#include <cmath>
#include <fuzzer/FuzzedDataProvider.h>
#include <string>
#include <vector>

#include "component.h"
#include "constraint.h"
#include "require.h"
#include "usage_error.h"

namespace {

using fuzz::require;

constexpr double kTotal = 1;

/// Names as the program takes them from its --component options.
std::vector<std::string> drawNames(FuzzedDataProvider& bytes) {
    std::vector<std::string> names;
    const int count = bytes.ConsumeIntegralInRange(0, 6);
    for (int i = 0; i < count; ++i) {
        try {
            names.push_back(cli::parseComponent(bytes.ConsumeRandomLengthString(8), kTotal).name);
        } catch (const cli::UsageError&) {
            names.emplace_back(1, static_cast<char>('A' + i));
        }
    }
    return names;
}

void checkConstraint(const cli::Constraint& constraint, const std::vector<std::string>& names,
                     const std::string& text) {
    const std::vector<double>& coefficients = constraint.coefficients;
    require(constraint.text == text, "a constraint keeps its text");
    require(coefficients.size() == names.size(), "each component has a coefficient");
    require(std::ranges::all_of(coefficients, [](double number) { return std::isfinite(number); }),
            "coefficients are finite");
    require(std::ranges::any_of(coefficients, [](double number) { return number != 0; }), "a component is left");
    require(constraint.lower || constraint.upper, "there is a side");
    require(std::isfinite(constraint.lower.value_or(0)) && std::isfinite(constraint.upper.value_or(0)),
            "sides are finite");
    require(constraint.lower.value_or(0) <= constraint.upper.value_or(constraint.lower.value_or(0)) ||
                !constraint.lower || !constraint.upper,
            "the lower side is not above the upper one");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider bytes(data, size);
    const std::vector<std::string> names = drawNames(bytes);
    const std::string text = bytes.ConsumeRemainingBytesAsString();
    try {
        checkConstraint(cli::parseConstraint(text, names), names, text);
        // Blanks at the ends have no meaning, so the same constraint comes out.
        const cli::Constraint blank = cli::parseConstraint(" " + text + "\t", names);
        require(blank.coefficients == cli::parseConstraint(text, names).coefficients,
                "blanks at the ends do not count");
    } catch (const cli::UsageError& error) {
        require(std::string(error.what()).starts_with("--constraint \""), "a refusal names the option");
    }
    return 0;
}
