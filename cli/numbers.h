#ifndef REISTI_CLI_NUMBERS_H
#define REISTI_CLI_NUMBERS_H

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace cli {

/// A finite decimal number that makes up the whole text, written with a point in every locale.
std::optional<double> parseNumber(std::string_view text);

/// The shortest text that reads back as the same double.
std::string formatExact(double value, char decimalMark);

/// Six significant digits, whole numbers whole: for people.
std::string formatShort(double value, char decimalMark);

/// The double nearest to the value's first 15 significant digits: takes off what arithmetic on typed decimals leaves in
/// the last digits (0.30000000000000004).
double withoutRoundingNoise(double value);

/// The parts between the separators, empty ones included; a text without separator is one part.
std::vector<std::string> split(std::string_view text, char separator);

/// The text without blanks at its ends.
std::string_view trimmed(std::string_view text);

}  // namespace cli

#endif
