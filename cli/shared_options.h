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

/// How to show a table and where to.
struct OutputOptions {
    std::string format = "table";
    std::string decimalMark = ".";
    std::string file;
    bool force = false;
};

/// What every design command has: how to randomize, and how to show the result.
struct SharedOptions {
    std::string seedText;
    bool standardOrder = false;
    std::string rowOrder = "run";
    std::vector<std::string> responses;
    std::uint64_t maxRuns = 1'000'000;
    OutputOptions output;

    /// The seed to hand to the library: as given, or drawn. Nothing when the design is not randomized.
    std::optional<double> seed() const;
    /// Throws UsageError when more runs are asked for than --max-runs.
    void checkRunCount(double runs) const;
};

void addOutputOptions(CLI::App& command, OutputOptions& options);

void addSharedOptions(CLI::App& command, SharedOptions& options);

/// Writes a table as the options say; `head` leads the JSON output.
void writeTable(const OutputOptions& options, const DesignTable& table, const nlohmann::ordered_json& head);

/// The key columns std_order and run_order, and the rows in the order that the options ask for.
DesignTable startTable(const SharedOptions& options, std::size_t numRuns,
                       const std::function<std::uint32_t(std::size_t)>& runOrder);

/// Appends the empty response columns and writes the design; `head` leads the JSON output. The seed goes to standard
/// error in every format, so that a design can be made again.
void finishTable(const SharedOptions& options, std::optional<double> seed, DesignTable& table,
                 nlohmann::ordered_json head);

}  // namespace cli

#endif
