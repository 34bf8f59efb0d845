#ifndef REISTI_CLI_FACTOR_H
#define REISTI_CLI_FACTOR_H

#include <nlohmann/json_fwd.hpp>
#include <string>
#include <string_view>

#include "design_table.h"

namespace cli {

/// A factor as typed: a name and either a range in real units or two words.
struct Factor {
    std::string name;
    std::string unit;
    bool isCategorical = false;
    double low = -1;
    double high = 1;
    std::string lowWord;
    std::string highWord;
    /// Anonymous factors have no real levels.
    bool isCoded = false;

    /// What a run shows for the coded level -1, 0 or 1.
    Cell level(int coded, bool showCoded) const;

    /// Name, levels and unit, as the JSON output tells them.
    nlohmann::ordered_json describe() const;
};

/// Reads "name=low:high", "name=low:high:unit" or "name=word|word". Throws UsageError naming `option`.
Factor parseFactor(const std::string& option, std::string_view text);

}  // namespace cli

#endif
