#include "component.h"

#include <charconv>
#include <fmt/format.h>
#include <optional>

#include "numbers.h"
#include "usage_error.h"

namespace cli {

namespace {

double parseBound(const std::string& where, std::string_view text, double missing) {
    const std::string_view number = trimmed(text);
    if (number.empty()) return missing;
    const std::optional<double> bound = parseNumber(number);
    if (!bound) throw UsageError(where, fmt::format("\"{}\" is not a number", number));
    return *bound;
}

std::uint32_t parseCount(const std::string& where, std::string_view text) {
    std::uint32_t count = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), count);
    if (error != std::errc{} || end != text.data() + text.size()) {
        throw UsageError(where, fmt::format("\"{}\" is not a count", text));
    }
    return count;
}

/// The count that a word of --replicates speaks of.
std::uint32_t& countFor(const std::string& where, std::string_view key, Replicates& replicates) {
    if (key == "vertex") return replicates.vertex;
    if (key == "center") return replicates.center;
    if (key == "axial") return replicates.axial;
    const std::size_t last = replicates.types.size() + 1;
    const std::string expected =
        last >= 2 ? fmt::format("vertex, center, axial or a point type from 2 to {}", last) : "vertex, center or axial";
    std::uint32_t type = 0;
    const auto [end, error] = std::from_chars(key.data(), key.data() + key.size(), type);
    if (error != std::errc{} || end != key.data() + key.size() || type < 2 || type > last) {
        throw UsageError(where, fmt::format("\"{}\" is not {}", key, expected));
    }
    return replicates.types[type - 2];
}

}  // namespace

Component parseComponent(std::string_view text, double total) {
    const std::string where = fmt::format("--component \"{}\"", text);
    Component component{"", 0, total};
    const std::size_t equals = text.find('=');
    component.name = trimmed(text.substr(0, equals));
    if (component.name.empty()) throw UsageError(where, "the name is missing");
    if (equals == std::string_view::npos) return component;
    const std::vector<std::string> bounds = split(text.substr(equals + 1), ':');
    if (bounds.size() != 2) throw UsageError(where, "expected NAME=LOWER:UPPER");
    component.lower = parseBound(where, bounds[0], 0);
    component.upper = parseBound(where, bounds[1], total);
    if (component.lower < 0) throw UsageError(where, "the lower bound is negative");
    if (component.lower >= component.upper) throw UsageError(where, "the lower bound has to be below the upper one");
    if (component.upper > total) throw UsageError(where, fmt::format("the upper bound is above the total {}", total));
    return component;
}

Replicates parseReplicates(const std::string& text, std::size_t q) {
    Replicates replicates;
    replicates.types.assign(q > 2 ? q - 2 : 0, 1);
    if (text.empty()) return replicates;
    const std::string where = fmt::format("--replicates \"{}\"", text);
    for (const std::string& part : split(text, ',')) {
        const std::size_t equals = part.find('=');
        if (equals == std::string::npos) throw UsageError(where, "expected KIND=COUNT, separated by commas");
        const std::string_view view = part;
        std::uint32_t& count = countFor(where, trimmed(view.substr(0, equals)), replicates);
        count = parseCount(where, trimmed(view.substr(equals + 1)));
    }
    return replicates;
}

}  // namespace cli
