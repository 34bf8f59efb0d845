#ifndef REISTI_CLI_SHARED_OPTIONS_H
#define REISTI_CLI_SHARED_OPTIONS_H

#include <CLI/App.hpp>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <nlohmann/json_fwd.hpp>
#include <optional>
#include <string>
#include <vector>

#include "design_table.h"

namespace cli {

/// What every design command has: how to randomize, how to show the result and where to.
struct SharedOptions {
    std::string seedText;
    bool standardOrder = false;
    std::string rowOrder = "run";
    std::string format = "table";
    std::string decimalMark = ".";
    std::string output;
    bool force = false;
    std::vector<std::string> responses;
    std::uint64_t maxRuns = 1'000'000;

    /// The seed to hand to the library: as given, or drawn. Nothing when the design is not randomized.
    std::optional<double> seed() const;
    char mark() const { return decimalMark.front(); }
    /// Throws UsageError when more runs are asked for than --max-runs.
    void checkRunCount(double runs) const;
};

void addSharedOptions(CLI::App& command, SharedOptions& options);

/// The key columns std_order and run_order, and the rows in the order that the options ask for.
DesignTable startTable(const SharedOptions& options, std::size_t numRuns,
                       const std::function<std::uint32_t(std::size_t)>& runOrder);

/// Appends the empty response columns and writes the design; `head` leads the JSON output. The seed goes to standard
/// error in every format, so that a design can be made again.
void finishTable(const SharedOptions& options, std::optional<double> seed, DesignTable& table,
                 nlohmann::ordered_json head);

}  // namespace cli

#endif
