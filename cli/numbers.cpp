#include "numbers.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <fmt/format.h>
#include <system_error>

namespace cli {

namespace {

std::string withMark(std::string text, char decimalMark) {
    std::replace(text.begin(), text.end(), '.', decimalMark);
    return text;
}

}  // namespace

std::optional<double> parseNumber(std::string_view text) {
    // from_chars takes no plus sign, people do.
    if (text.size() > 1 && text[0] == '+' && text[1] != '-') text.remove_prefix(1);
    double value = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
    if (error != std::errc{} || end != text.data() + text.size() || !std::isfinite(value)) return std::nullopt;
    return value;
}

std::string formatExact(double value, char decimalMark) {
    return withMark(fmt::format("{}", value + 0.0), decimalMark);
}

std::string formatShort(double value, char decimalMark) {
    constexpr double kWholeBelow = 1e15;
    if (value == std::trunc(value) && std::abs(value) < kWholeBelow) return fmt::format("{:.0f}", value + 0.0);
    return withMark(fmt::format("{:.6g}", value), decimalMark);
}

double withoutRoundingNoise(double value) {
    return parseNumber(fmt::format("{:.15g}", value)).value_or(value);
}

std::vector<std::string> split(std::string_view text, char separator) {
    std::vector<std::string> parts;
    for (;;) {
        const std::size_t end = text.find(separator);
        parts.emplace_back(text.substr(0, end));
        if (end == std::string_view::npos) return parts;
        text.remove_prefix(end + 1);
    }
}

std::string_view trimmed(std::string_view text) {
    const std::size_t first = text.find_first_not_of(" \t");
    if (first == std::string_view::npos) return {};
    return text.substr(first, text.find_last_not_of(" \t") - first + 1);
}

}  // namespace cli
