#include "shared_options.h"

#include <CLI/Config.hpp>
#include <CLI/Formatter.hpp>
#include <CLI/Validators.hpp>
#include <fmt/format.h>
#include <iostream>
#include <nlohmann/json.hpp>
#include <numeric>
#include <random>

#include "numbers.h"
#include "output_file.h"
#include "usage_error.h"

namespace cli {

namespace {

constexpr const char* kOutputGroup = "Output";

}  // namespace

std::optional<double> SharedOptions::seed() const {
    if (standardOrder) return std::nullopt;
    double seed = 0;
    if (!seedText.empty()) {
        const std::optional<double> given = parseNumber(seedText);
        if (!given) throw UsageError(fmt::format("--seed \"{}\"", seedText), "not a number");
        seed = *given;
    }
    // The library takes zero as a wish for a fresh seed; drawn here, it can be told. Short enough to be typed again.
    std::random_device device;
    while (seed == 0)
        seed = device();
    return seed;
}

void SharedOptions::checkRunCount(double runs) const {
    if (runs > static_cast<double>(maxRuns)) {
        throw UsageError("--max-runs",
                         fmt::format("the design has {:.0f} runs, more than the {} allowed", runs, maxRuns));
    }
}

void addOutputOptions(CLI::App& command, OutputOptions& options) {
    command.add_option("--format", options.format, "table, csv or json")
        ->check(CLI::IsMember({"table", "csv", "json"}))
        ->capture_default_str()
        ->type_name("FORMAT")
        ->group(kOutputGroup);
    command
        .add_flag_callback(
            "--json", [&options] { options.format = "json"; }, "The same as --format json")
        ->group(kOutputGroup);
    command.add_option("--decimal-mark", options.decimalMark, "Decimal mark of tables and CSV: . or ,")
        ->check(CLI::IsMember({".", ","}))
        ->capture_default_str()
        ->type_name("MARK")
        ->group(kOutputGroup);
    command.add_option("--output", options.file, "Write to a file instead of standard output")
        ->type_name("FILE")
        ->group(kOutputGroup);
    command.add_flag("--force", options.force, "Replace an existing output file")->group(kOutputGroup);
}

void addSharedOptions(CLI::App& command, SharedOptions& options) {
    command.add_option("--seed", options.seedText, "Seed of the random run order; drawn and reported if not given")
        ->type_name("NUMBER")
        ->group("Randomization");
    command.add_flag("--standard-order", options.standardOrder, "Do not randomize")->group("Randomization");
    command.add_option("--order", options.rowOrder, "Order of the rows: run or standard")
        ->check(CLI::IsMember({"run", "standard"}))
        ->capture_default_str()
        ->type_name("ORDER")
        ->group(kOutputGroup);
    command.add_option("--response", options.responses, "Add an empty column for a response; may be repeated")
        ->allow_extra_args(false)
        ->type_name("NAME")
        ->group(kOutputGroup);
    addOutputOptions(command, options.output);
    command.add_option("--max-runs", options.maxRuns, "Refuse designs with more runs than this")
        ->capture_default_str()
        ->type_name("COUNT")
        ->group(kOutputGroup);
}

void writeTable(const OutputOptions& options, const DesignTable& table, const nlohmann::ordered_json& head) {
    writeOutput(options.file, options.force, [&](std::ostream& out) {
        const char mark = options.decimalMark.front();
        if (options.format == "json") {
            writeJson(out, table, head);
        } else if (options.format == "csv") {
            writeCsv(out, table, mark);
        } else {
            writeText(out, table, mark);
        }
    });
}

DesignTable startTable(const SharedOptions& options, std::size_t numRuns,
                       const std::function<std::uint32_t(std::size_t)>& runOrder) {
    DesignTable table;
    table.rows.resize(numRuns);
    std::iota(table.rows.begin(), table.rows.end(), std::size_t{0});
    if (options.rowOrder == "run") {
        for (std::size_t i = 0; i < numRuns; ++i)
            table.rows[runOrder(i) - 1] = i;
    }
    addColumn(table, {"std_order", "", true, [](std::size_t i) { return Cell(static_cast<std::int64_t>(i + 1)); }});
    addColumn(table, {"run_order", "", true, [runOrder](std::size_t i) { return Cell(std::int64_t{runOrder(i)}); }});
    return table;
}

void finishTable(const SharedOptions& options, std::optional<double> seed, DesignTable& table,
                 nlohmann::ordered_json head) {
    for (const std::string& response : options.responses) {
        addColumn(table, {response, "", false, [](std::size_t) { return Cell(); }});
    }
    head["seed"] = seed ? nlohmann::ordered_json(*seed) : nlohmann::ordered_json(nullptr);
    if (seed) std::cerr << "seed " << formatExact(*seed, '.') << '\n';
    writeTable(options.output, table, head);
}

}  // namespace cli
