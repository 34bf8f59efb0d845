#include <CLI/Config.hpp>
#include <CLI/Formatter.hpp>
#include <memory>
#include <nlohmann/json.hpp>

#include "commands.h"
#include "output_file.h"
#include "reisti/reisti.h"
#include "shared_options.h"

namespace cli {

namespace {

Cell wordsOf(const char* words) {
    return std::string(words);
}

void runCatalog(const OutputOptions& options) {
    checkOutputFile(options.file, options.force);
    std::uint32_t count = 0;
    const des_FractionalFactorial* entries = des_FractionalFactorialCatalog(&count);
    const auto integer = [entries](std::int32_t des_FractionalFactorial::*field) {
        return [entries, field](std::size_t i) { return Cell(std::int64_t{entries[i].*field}); };
    };
    DesignTable table;
    for (std::size_t i = 0; i < count; ++i)
        table.rows.push_back(i);
    addColumn(table, {"factors", "", true, integer(&des_FractionalFactorial::numFactors)});
    addColumn(table, {"runs", "", true, integer(&des_FractionalFactorial::numRuns)});
    addColumn(table, {"resolution", "", false, integer(&des_FractionalFactorial::resolution)});
    addColumn(table, {"max_blocks", "", false, integer(&des_FractionalFactorial::maxBlocks)});
    addColumn(table, {"generators", "", false, [entries](std::size_t i) { return wordsOf(entries[i].generators); }});
    addColumn(table, {"block_generators", "", false,
                      [entries](std::size_t i) { return wordsOf(entries[i].blockGenerators); }});
    writeTable(options, table, nlohmann::ordered_json::object({{"catalog", "two-level fractional factorials"}}));
}

}  // namespace

void addCatalogCommand(CLI::App& app) {
    CLI::App* command = app.add_subcommand("catalog", "List the two-level designs that process fractions come from");
    const auto options = std::make_shared<OutputOptions>();
    addOutputOptions(*command, *options);
    command->footer(
        "Columns: factors, runs, resolution (0 full factorial), max_blocks, generators (one word\n"
        "for each factor behind the base factors; factors are A to H and J to P), block_generators.\n"
        "\n"
        "Example: the catalog as a spreadsheet:\n"
        "  reisti catalog --format csv --output catalog.csv");
    command->callback([options] { runCatalog(*options); });
}

}  // namespace cli
