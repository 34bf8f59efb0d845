#include <CLI/Config.hpp>
#include <CLI/Formatter.hpp>
#include <CLI/Validators.hpp>
#include <fmt/format.h>
#include <memory>
#include <nlohmann/json.hpp>

#include "commands.h"
#include "factor.h"
#include "output_file.h"
#include "reisti/reisti.h"
#include "shared_options.h"
#include "usage_error.h"

namespace cli {

namespace {

struct DsdOptions {
    std::vector<std::string> factorTexts;
    std::uint32_t anonymousFactors = 0;
    std::uint32_t replicates = 1;
    std::uint32_t blocks = 1;
    bool coded = false;
    SharedOptions shared;
};

/// The library's record together with the arrays behind it.
struct ScreeningDesign {
    std::vector<std::uint32_t> categorical;
    std::vector<std::int32_t> levels;
    std::vector<des_DefinitiveScreeningRun> runs;
    des_DefinitiveScreeningDesign record{};
};

std::vector<Factor> readFactors(const DsdOptions& options) {
    std::vector<Factor> factors;
    if (options.factorTexts.empty() && options.anonymousFactors == 0) {
        throw UsageError("--factor", "give each factor with --factor, or their number with --factors");
    }
    for (const std::string& text : options.factorTexts)
        factors.push_back(parseFactor("--factor", text));
    for (std::uint32_t i = 1; i <= options.anonymousFactors; ++i) {
        Factor factor;
        factor.name = fmt::format("X{}", i);
        factor.isCoded = true;
        factors.push_back(factor);
    }
    return factors;
}

/// The option that a code of the library speaks of.
std::string optionFor(std::int32_t code) {
    switch (code) {
        case des_ErrorNumFactors:
            return "--factor";
        case des_ErrorTooManyReplicates:
            return "--replicates";
        case des_ErrorBlocks:
            return "--blocks";
        default:
            return "dsd";
    }
}

void check(std::int32_t code) {
    if (code != des_Success) throw RunError(fmt::format("{}: {}", optionFor(code), des_ErrorMessage(code)));
}

ScreeningDesign build(const DsdOptions& options, const std::vector<Factor>& factors, std::optional<double> seed) {
    ScreeningDesign design;
    for (std::uint32_t i = 0; i < factors.size(); ++i) {
        if (factors[i].isCategorical) design.categorical.push_back(i);
    }
    des_DefinitiveScreeningDesign& record = design.record;
    record.numFactors = static_cast<std::uint32_t>(factors.size());
    record.numCategorical = static_cast<std::uint32_t>(design.categorical.size());
    record.categoricalFactors = design.categorical.data();
    record.replicates = options.replicates;
    record.numBlocks = options.blocks;
    record.randomize = seed ? 1 : 0;
    record.seed = seed.value_or(1);

    std::int32_t code = des_Success;
    const std::uint32_t numRuns = des_FindDefinitiveScreeningDesignRowCount(
        static_cast<std::int32_t>(factors.size()), &code, record.numCategorical != 0 ? 1 : 0, options.replicates);
    check(code);
    options.shared.checkRunCount(numRuns);
    design.levels.resize(numRuns * factors.size());
    design.runs.resize(numRuns);
    for (std::size_t i = 0; i < numRuns; ++i)
        design.runs[i].levels = &design.levels[i * factors.size()];
    record.runs = design.runs.data();
    check(des_CreateDefinitiveScreeningDesign(&record));
    return design;
}

nlohmann::ordered_json describe(const DsdOptions& options, const std::vector<Factor>& factors) {
    nlohmann::ordered_json head;
    head["design"] = "definitive screening";
    head["replicates"] = options.replicates;
    head["blocks"] = options.blocks;
    head["factors"] = nlohmann::ordered_json::array();
    for (const Factor& factor : factors)
        head["factors"].push_back(factor.describe());
    return head;
}

void run(const DsdOptions& options) {
    checkOutputFile(options.shared.output.file, options.shared.output.force);
    const std::vector<Factor> factors = readFactors(options);
    const std::optional<double> seed = options.shared.seed();
    const ScreeningDesign design = build(options, factors, seed);
    const std::vector<des_DefinitiveScreeningRun>& runs = design.runs;

    DesignTable table = startTable(options.shared, runs.size(), [&](std::size_t i) { return runs[i].runOrder; });
    addColumn(table, {"block", "", false, [&](std::size_t i) { return Cell(std::int64_t{runs[i].block}); }});
    addColumn(table, {"point_type", "", false, [&](std::size_t i) { return Cell(std::int64_t{runs[i].pointType}); }});
    for (std::size_t j = 0; j < factors.size(); ++j) {
        const Factor& factor = factors[j];
        addColumn(table, {factor.name, options.coded ? "" : factor.unit, false,
                          [&, j](std::size_t i) { return factors[j].level(runs[i].levels[j], options.coded); }});
    }
    finishTable(options.shared, seed, table, describe(options, factors));
}

}  // namespace

void addDsdCommand(CLI::App& app) {
    CLI::App* command = app.add_subcommand("dsd", "Definitive screening design: three levels, 2 to 48 factors");
    const auto options = std::make_shared<DsdOptions>();
    auto* factor =
        command
            ->add_option("--factor", options->factorTexts,
                         "NAME=LOW:HIGH[:UNIT] (continuous) or NAME=WORD|WORD (categorical); repeat for each")
            ->allow_extra_args(false)
            ->type_name("FACTOR");
    command->add_option("--factors", options->anonymousFactors, "Number of continuous factors, named X1, X2, ...")
        ->type_name("COUNT")
        ->excludes(factor);
    command->add_option("--replicates", options->replicates, "Copies of the whole design")
        ->check(CLI::PositiveNumber)
        ->capture_default_str()
        ->type_name("COUNT");
    command->add_option("--blocks", options->blocks, "Blocks, made of whole replicates")
        ->check(CLI::PositiveNumber)
        ->capture_default_str()
        ->type_name("COUNT");
    command->add_flag("--coded", options->coded, "Show coded levels -1, 0, 1 instead of real ones");
    addSharedOptions(*command, options->shared);
    command->footer(
        "Columns: std_order, run_order, block, point_type (0 centre run, 1 no middle level, 2 one\n"
        "middle level), then the factors.\n"
        "\n"
        "Example: four factors, one of them categorical, in two blocks, ready for the laboratory:\n"
        "  reisti dsd --factor \"Temp=20:80:degC\" --factor \"Time=10:30:min\" --factor \"pH=5:9\" \\\n"
        "    --factor \"Solvent=water|ethanol\" --replicates 2 --blocks 2 --response Yield \\\n"
        "    --seed 7 --format csv --output design.csv");
    command->callback([options] { run(*options); });
}

}  // namespace cli
