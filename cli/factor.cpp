#include "factor.h"

#include <fmt/format.h>
#include <nlohmann/json.hpp>
#include <optional>
#include <vector>

#include "numbers.h"
#include "usage_error.h"

namespace cli {

namespace {

std::string quoted(const std::string& option, std::string_view text) {
    return fmt::format("{} \"{}\"", option, text);
}

/// Splits "name=rest"; the name is cut off into the factor, the rest returned.
std::string_view takeName(const std::string& where, std::string_view text, Factor& factor) {
    const std::size_t equals = text.find('=');
    if (equals == std::string_view::npos) throw UsageError(where, "expected NAME=LOW:HIGH[:UNIT] or NAME=WORD|WORD");
    factor.name = trimmed(text.substr(0, equals));
    if (factor.name.empty()) throw UsageError(where, "the name before \"=\" is missing");
    return trimmed(text.substr(equals + 1));
}

void readWords(const std::string& where, std::string_view rest, Factor& factor) {
    const std::vector<std::string> words = split(rest, '|');
    if (words.size() != 2) throw UsageError(where, "a categorical factor has exactly two levels, WORD|WORD");
    factor.isCategorical = true;
    factor.lowWord = trimmed(words[0]);
    factor.highWord = trimmed(words[1]);
    if (factor.lowWord.empty() || factor.highWord.empty()) throw UsageError(where, "a level is empty");
    if (factor.lowWord == factor.highWord) throw UsageError(where, "the two levels are the same");
}

void readRange(const std::string& where, std::string_view rest, Factor& factor) {
    const std::size_t first = rest.find(':');
    if (first == std::string_view::npos) throw UsageError(where, "expected LOW:HIGH[:UNIT] or WORD|WORD after \"=\"");
    const std::size_t second = rest.find(':', first + 1);
    const std::string_view lowText = trimmed(rest.substr(0, first));
    const std::string_view highText =
        trimmed(second == std::string_view::npos ? rest.substr(first + 1) : rest.substr(first + 1, second - first - 1));
    const std::optional<double> low = parseNumber(lowText);
    const std::optional<double> high = parseNumber(highText);
    if (!low) throw UsageError(where, fmt::format("\"{}\" is not a number", lowText));
    if (!high) throw UsageError(where, fmt::format("\"{}\" is not a number", highText));
    if (*low >= *high) throw UsageError(where, "the low level has to be below the high one");
    factor.low = *low;
    factor.high = *high;
    if (second != std::string_view::npos) factor.unit = trimmed(rest.substr(second + 1));
}

}  // namespace

Cell Factor::level(int coded, bool showCoded) const {
    if (showCoded || isCoded) return std::int64_t{coded};
    if (isCategorical) return coded < 0 ? lowWord : highWord;
    if (coded == 0) return withoutRoundingNoise(low / 2 + high / 2);
    return coded < 0 ? low : high;
}

nlohmann::ordered_json Factor::describe() const {
    nlohmann::ordered_json entry;
    entry["name"] = name;
    if (isCategorical) {
        entry["levels"] = {lowWord, highWord};
    } else if (!isCoded) {
        entry["low"] = low;
        entry["high"] = high;
        if (!unit.empty()) entry["unit"] = unit;
    }
    return entry;
}

Factor parseFactor(const std::string& option, std::string_view text) {
    const std::string where = quoted(option, text);
    Factor factor;
    const std::string_view rest = takeName(where, text, factor);
    if (rest.find('|') != std::string_view::npos) {
        readWords(where, rest, factor);
    } else {
        readRange(where, rest, factor);
    }
    return factor;
}

}  // namespace cli
