#ifndef REISTI_CLI_CONSTRAINT_H
#define REISTI_CLI_CONSTRAINT_H

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace cli {

/// lower <= coefficients . components <= upper, in the units of the total; a missing side has no limit.
struct Constraint {
    std::string text;
    std::vector<double> coefficients;
    std::optional<double> lower;
    std::optional<double> upper;
};

/// Reads one inequality, or a two-sided one with numbers on the outside, over the component names: numbers, names, +,
/// -, *, <=, >= and =>. Terms may stand on either side. Throws UsageError with what is wrong and where.
Constraint parseConstraint(std::string_view text, const std::vector<std::string>& names);

}  // namespace cli

#endif
