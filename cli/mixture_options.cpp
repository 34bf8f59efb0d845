#include "mixture_options.h"

#include <CLI/Config.hpp>
#include <CLI/Formatter.hpp>
#include <CLI/Validators.hpp>
#include <array>
#include <cmath>
#include <fmt/format.h>
#include <iostream>

#include "numbers.h"
#include "usage_error.h"

namespace cli {

namespace {

constexpr std::array UNITS = {"amount", "proportion", "pseudo"};

void checkTotal(const std::string& option, double total) {
    if (!std::isfinite(total) || total <= 0)
        throw UsageError(option, fmt::format("{} is not a positive number", total));
}

/// The option that a code of the library speaks of.
std::string optionFor(std::int32_t code) {
    switch (code) {
        case des_ErrorLowerBoundSum:
        case des_ErrorUpperBoundSum:
        case des_ErrorUpperBound:
        case des_ErrorEmptyRange:
        case des_ErrorNotSimplex:
            return "--component";
        case des_ErrorProcessFraction:
            return "--fraction";
        case des_ErrorAmountsAndProcess:
            return "--amount";
        case des_ErrorDegree:
            return "--degree";
        case des_ErrorTooManyPoints:
            return "--max-points";
        default:
            return "design";
    }
}

/// The component without range, which the code alone does not name.
std::string emptyComponent(const MixtureRequest& request) {
    for (const Component& component : request.components) {
        if (component.upper - component.lower <= component.upper * 1e-5) return fmt::format(" ({})", component.name);
    }
    return "";
}

}  // namespace

void addMixtureOptions(CLI::App& command, MixtureOptions& options) {
    command
        .add_option("--component", options.componentTexts,
                    "NAME or NAME=LOWER:UPPER, in the units of the total; repeat for each")
        ->required()
        ->allow_extra_args(false)
        ->type_name("COMPONENT");
    auto* total = command.add_option("--total", options.total, "Total amount of the mixture")
                      ->capture_default_str()
                      ->type_name("AMOUNT")
                      ->each([&options](const std::string&) { options.hasTotal = true; });
    command
        .add_option(
            "--amount", options.amounts,
            "One of several total amounts, each run with every mixture; repeat for each. Bounds are in units of "
            "the first")
        ->allow_extra_args(false)
        ->type_name("AMOUNT")
        ->excludes(total);
    command
        .add_option(
            "--process", options.processTexts,
            "Process variable to cross the mixtures with, NAME=LOW:HIGH[:UNIT] or NAME=WORD|WORD; repeat for each")
        ->allow_extra_args(false)
        ->type_name("VARIABLE");
    command.add_option("--fraction", options.fraction, "Run one half, 4th, 8th or 16th of the process settings")
        ->check(CLI::IsMember({1, 2, 4, 8, 16}))
        ->capture_default_str()
        ->type_name("DENOMINATOR");
    command
        .add_option("--fraction-index", options.fractionIndex, "Which of the fractions; the last is the principal one")
        ->check(CLI::PositiveNumber)
        ->capture_default_str()
        ->type_name("INDEX");
    command.add_flag("--axial", options.axial, "Add axial points");
    command
        .add_option(
            "--replicates", options.replicatesText,
            "How often each kind of point is run, e.g. vertex=2,center=3,axial=1,2=1; the number is a point type")
        ->type_name("COUNTS");
    command.add_option("--design-replicates", options.designReplicates, "How often the whole set of points is run")
        ->check(CLI::PositiveNumber)
        ->capture_default_str()
        ->type_name("COUNT");
    command
        .add_option("--units", options.units,
                    "What to show for components: amount, proportion or pseudo (L-pseudo-components)")
        ->check(CLI::IsMember(std::vector<std::string>(UNITS.begin(), UNITS.end())))
        ->capture_default_str()
        ->type_name("UNITS");
    command.add_flag("--coded", options.coded, "Show coded levels -1, 1 of the process variables");
    addSharedOptions(command, options.shared);
}

std::vector<std::string> MixtureRequest::componentNames() const {
    std::vector<std::string> names;
    for (const Component& component : components)
        names.push_back(component.name);
    return names;
}

double MixtureRequest::countRuns(const std::vector<double>& pointsPerType, double centerPoints,
                                 double axialPoints) const {
    double points = centerPoints * replicates.center + axialPoints * replicates.axial;
    for (std::size_t i = 0; i < pointsPerType.size(); ++i) {
        const bool isTyped = i > 0 && i - 1 < replicates.types.size();
        points += pointsPerType[i] * (i == 0 ? replicates.vertex : isTyped ? replicates.types[i - 1] : 1);
    }
    const double settings = std::floor(std::ldexp(1.0, static_cast<int>(process.size())) / fraction);
    return points * designReplicates * std::max<double>(1.0, static_cast<double>(amounts.size())) * settings;
}

MixtureRequest readRequest(const MixtureOptions& options) {
    MixtureRequest request;
    checkTotal("--total", options.total);
    for (const double amount : options.amounts)
        checkTotal("--amount", amount);
    request.amounts = options.amounts;
    if (options.hasTotal) request.amounts = {options.total};
    for (const std::string& text : options.componentTexts) {
        request.components.push_back(parseComponent(text, request.total()));
    }
    if (request.components.size() < 2) throw UsageError("--component", "a mixture has at least two components");
    for (const std::string& text : options.processTexts)
        request.process.push_back(parseFactor("--process", text));
    if (request.amounts.size() > 1 && !request.process.empty()) {
        throw UsageError("--amount", "several amounts cannot be combined with process variables");
    }
    request.fraction = options.fraction;
    request.fractionIndex = options.fractionIndex;
    if (request.fractionIndex > request.fraction) {
        throw UsageError("--fraction-index", fmt::format("there are only {} fractions", request.fraction));
    }
    request.axial = options.axial;
    request.replicates = parseReplicates(options.replicatesText, request.components.size());
    request.designReplicates = options.designReplicates;
    request.units = static_cast<std::uint32_t>(std::find(UNITS.begin(), UNITS.end(), options.units) - UNITS.begin());
    request.seed = options.shared.seed();
    return request;
}

MixtureRecord makeRecord(const MixtureRequest& request) {
    MixtureRecord record(request.components.size());
    for (std::size_t i = 0; i < request.components.size(); ++i) {
        record.lower[i] = request.components[i].lower;
        record.upper[i] = request.components[i].upper;
    }
    record.typeReplicates = request.replicates.types;
    record.amounts = request.amounts;
    record->vertexReplicates = request.replicates.vertex;
    record->typeReplicates = record.typeReplicates.data();
    record->centerReplicates = request.replicates.center;
    record->axialReplicates = request.replicates.axial;
    record->designReplicates = request.designReplicates;
    record->numProcessVariables = static_cast<std::uint32_t>(request.process.size());
    record->processFraction = request.fraction;
    record->fractionIndex = request.fractionIndex;
    record->numAmounts = static_cast<std::uint32_t>(request.amounts.size());
    record->amounts = record.amounts.data();
    record->axialPoints = request.axial ? 1 : 0;
    record->outputUnits = request.units;
    record->randomize = request.seed ? 1 : 0;
    record->seed = request.seed.value_or(1);
    return record;
}

void checkMixtureCode(std::int32_t code, const MixtureRequest& request) {
    if (code == des_Success) return;
    const std::string component = code == des_ErrorEmptyRange ? emptyComponent(request) : "";
    throw RunError(fmt::format("{}{}: {}", optionFor(code), component, des_ErrorMessage(code)));
}

void reportTightenedBounds(const MixtureRecord& record, const MixtureRequest& request) {
    if (record->boundsAdjusted == 0) return;
    // A bound is divided by the total and multiplied back: what differs less than this was not tightened.
    const double noise = 1e-9 * request.total();
    const auto report = [noise](const char* side, const std::string& name, double before, double after) {
        if (std::abs(after - before) <= noise) return;
        std::cerr << fmt::format("{} bound of {} tightened from {} to {}\n", side, name, formatShort(before, '.'),
                                 formatShort(after, '.'));
    };
    for (std::size_t i = 0; i < request.components.size(); ++i) {
        const Component& component = request.components[i];
        report("lower", component.name, component.lower, record.lower[i]);
        report("upper", component.name, component.upper, record.upper[i]);
    }
}

}  // namespace cli
