#include <CLI/Config.hpp>
#include <CLI/Formatter.hpp>
#include <CLI/Validators.hpp>
#include <algorithm>
#include <charconv>
#include <cmath>
#include <fmt/format.h>
#include <iostream>
#include <limits>
#include <memory>
#include <nlohmann/json.hpp>

#include "commands.h"
#include "constraint.h"
#include "mixture_options.h"
#include "output_file.h"
#include "usage_error.h"

namespace cli {

namespace {

struct VerticesOptions {
    std::vector<std::string> constraintTexts;
    std::string degreeText = "vertices";
    bool center = false;
    std::int32_t maxPoints = 1'000'000;
    MixtureOptions mixture;
};

/// Values of des_MixtureDesignLinearConstraint::status: which sides do not cut the region.
constexpr std::int32_t kLowerIdle = 1;
constexpr std::int32_t kUpperIdle = 2;
constexpr std::int32_t kBothIdle = 3;

/// Within this a vertex lies on a plane, as the library sees it when it cuts the region.
constexpr double kOnPlane = 1e-6;

/// The library's constraint records, which point into the constraints that they were made from.
std::vector<des_MixtureDesignLinearConstraint> makeRecords(const std::vector<Constraint>& constraints) {
    std::vector<des_MixtureDesignLinearConstraint> records;
    for (const Constraint& constraint : constraints) {
        des_MixtureDesignLinearConstraint record{};
        record.hasLowerValue = constraint.lower ? 1 : 0;
        record.lowerValue = constraint.lower.value_or(0);
        record.hasUpperValue = constraint.upper ? 1 : 0;
        record.upperValue = constraint.upper.value_or(0);
        record.coefficients = constraint.coefficients.data();
        records.push_back(record);
    }
    return records;
}

std::int32_t parseDegree(const std::string& text, std::int32_t q) {
    if (text == "vertices") return 1;
    if (text == "edges") return 2;
    if (text == "faces") return std::min(3, q);
    if (text == "all") return q;
    std::int32_t degree = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), degree);
    const std::string where = fmt::format("--degree \"{}\"", text);
    if (error != std::errc{} || end != text.data() + text.size()) {
        throw UsageError(where, "expected vertices, edges, faces, all or a number");
    }
    if (degree < 1 || degree > q) throw UsageError(where, fmt::format("{} components allow 1 to {}", q, q));
    return degree;
}

/// What is asked for beyond the options that all mixture commands share.
struct Region {
    std::vector<Constraint> constraints;
    std::vector<des_MixtureDesignLinearConstraint> records;
    std::int32_t degree = 1;
    bool center = false;
    std::int32_t maxPoints = 0;
};

Region readRegion(const VerticesOptions& options, const MixtureRequest& request) {
    Region region;
    const std::vector<std::string> names = request.componentNames();
    for (const std::string& text : options.constraintTexts)
        region.constraints.push_back(parseConstraint(text, names));
    region.records = makeRecords(region.constraints);
    region.degree = parseDegree(options.degreeText, static_cast<std::int32_t>(names.size()));
    region.center = options.center;
    region.maxPoints = options.maxPoints;
    return region;
}

[[noreturn]] void failTooManyPoints(const Region& region) {
    throw RunError(fmt::format(
        "--max-points: the region has more than {} vertices and centroids; ask for a lower --degree or allow more",
        region.maxPoints));
}

void runRegion(const MixtureRecord& record, Region& region, const MixtureRequest& request) {
    const std::int32_t code = des_RunExtremeVerticesDesign(record.get(), region.degree, region.center ? 1 : 0,
                                                           static_cast<std::int32_t>(region.records.size()),
                                                           region.records.data(), region.maxPoints);
    if (code == des_ErrorTooManyPoints) failTooManyPoints(region);
    checkMixtureCode(code, request);
}

/// The largest value of the constraint minus its lower side (or of its upper side minus the constraint) over the
/// vertices, in proportions.
double largestSlack(const Constraint& constraint, bool isLower, const MixtureRecord& points, double total) {
    double largest = -std::numeric_limits<double>::infinity();
    for (std::uint32_t i = 0; i < points->numRuns; ++i) {
        if (points.run(i).pointType != des_MixturePointVertex) continue;
        double value = 0;
        for (std::size_t j = 0; j < constraint.coefficients.size(); ++j) {
            value += constraint.coefficients[j] * points.run(i).proportions[j];
        }
        largest = std::max(largest, isLower ? value - *constraint.lower / total : *constraint.upper / total - value);
    }
    return largest;
}

/// Tells of one side that does not cut the region; throws when it leaves nothing of it.
void reportIdleSide(const Constraint& constraint, bool isLower, const MixtureRecord& points, double total) {
    const double slack = largestSlack(constraint, isLower, points, total);
    const bool isTwoSided = constraint.lower && constraint.upper;
    const std::string side = isTwoSided ? (isLower ? " (lower side)" : " (upper side)") : "";
    const std::string name = fmt::format("--constraint \"{}\"{}", constraint.text, side);
    if (slack < -kOnPlane)
        throw RunError(name + ": excludes the whole region that the bounds and other constraints leave");
    const char* what = slack <= kOnPlane ? "leaves only a face of the region, and is ignored"
                                         : "is redundant: the whole region satisfies it";
    std::cerr << name << ' ' << what << '\n';
}

void reportIdleConstraints(const Region& region, const MixtureRecord& points, double total) {
    for (std::size_t i = 0; i < region.records.size(); ++i) {
        const std::int32_t status = region.records[i].status;
        const Constraint& constraint = region.constraints[i];
        if (status == kLowerIdle || status == kBothIdle) reportIdleSide(constraint, true, points, total);
        if (status == kUpperIdle || status == kBothIdle) reportIdleSide(constraint, false, points, total);
    }
}

/// What the lower bounds leave free, by which pseudo-components are divided, is 0 where the constraints leave one
/// point.
void checkPseudoComponents(const MixtureRecord& record) {
    if (record->outputUnits != des_UnitsPseudo || record->numRuns == 0) return;
    const double* const proportions = record.run(0).proportions;
    const auto isFinite = [](double proportion) { return std::isfinite(proportion); };
    if (!std::all_of(proportions, proportions + record->numComponents, isFinite))
        throw RunError("--units pseudo: the constraints leave a single mixture, which has no pseudo-components");
}

/// The distinct points of the region as proportions, each once, without process variables or further totals: what idle
/// constraints are judged by and runs are counted from before the design itself is built.
MixtureRequest distinctPointsOf(const MixtureRequest& request) {
    MixtureRequest points;
    points.components = request.components;
    if (!request.amounts.empty()) points.amounts = {request.amounts.front()};
    points.replicates.types.assign(request.replicates.types.size(), 1);
    points.axial = request.axial;
    points.units = des_UnitsProportion;
    return points;
}

double countRuns(const MixtureRequest& request, const MixtureRecord& points) {
    const std::vector<double> perType(points.pointsPerType.begin(), points.pointsPerType.end());
    return request.countRuns(perType, points->numCenterPoints, points->numAxialPoints);
}

nlohmann::ordered_json describe(const Region& region) {
    nlohmann::ordered_json head;
    head["design"] = "extreme vertices";
    head["degree"] = region.degree;
    head["constraints"] = nlohmann::ordered_json::array();
    for (std::size_t i = 0; i < region.constraints.size(); ++i) {
        const Constraint& constraint = region.constraints[i];
        nlohmann::ordered_json entry;
        entry["text"] = constraint.text;
        entry["coefficients"] = constraint.coefficients;
        if (constraint.lower) entry["lower"] = *constraint.lower;
        if (constraint.upper) entry["upper"] = *constraint.upper;
        entry["status"] = region.records[i].status;
        head["constraints"].push_back(entry);
    }
    return head;
}

void runVertices(const VerticesOptions& options) {
    checkOutputFile(options.mixture.shared.output.file, options.mixture.shared.output.force);
    const MixtureRequest request = readRequest(options.mixture);
    Region region = readRegion(options, request);
    {
        const MixtureRequest distinct = distinctPointsOf(request);
        const MixtureRecord points = makeRecord(distinct);
        runRegion(points, region, distinct);
        // The library counts against the limit only what it adds to the vertices.
        if (points.pointsPerType[0] > static_cast<std::uint32_t>(region.maxPoints)) failTooManyPoints(region);
        reportIdleConstraints(region, points, request.total());
        options.mixture.shared.checkRunCount(countRuns(request, points));
    }
    const MixtureRecord record = makeRecord(request);
    runRegion(record, region, request);
    checkPseudoComponents(record);
    reportTightenedBounds(record, request);
    showMixtureDesign(options.mixture, request, record, describe(region));
}

}  // namespace

void addVerticesCommand(CLI::App& app) {
    CLI::App* command =
        app.add_subcommand("vertices", "Extreme vertices design: a region cut by bounds and linear constraints");
    const auto options = std::make_shared<VerticesOptions>();
    command
        ->add_option("--constraint", options->constraintTexts,
                     "Linear constraint such as \"0.1 <= 2*A - B <= 0.4\" or \"A >= 2*B\", in the units of the total; "
                     "repeat for each")
        ->allow_extra_args(false)
        ->type_name("CONSTRAINT");
    command
        ->add_option("--degree", options->degreeText,
                     "vertices (1), edges (2: with edge centroids), faces (3), all, or a number")
        ->capture_default_str()
        ->type_name("DEGREE");
    command->add_flag("--center", options->center, "Add the overall centroid");
    command->add_option("--max-points", options->maxPoints, "Refuse regions with more vertices and centroids than this")
        ->check(CLI::PositiveNumber)
        ->capture_default_str()
        ->type_name("COUNT");
    addMixtureOptions(*command, options->mixture);
    command->footer(
        "Columns: std_order, run_order, point_type (1 vertex, k centroid of a face of dimension\n"
        "k-1, 0 overall centroid, -1 axial point), amount with --total or --amount, components,\n"
        "process variables.\n"
        "\n"
        "Example: a flare of four ingredients, its vertices and face centroids, and the centroid twice:\n"
        "  reisti vertices --component \"magnesium=0.4:0.6\" --component \"nitrate=0.1:0.5\" \\\n"
        "    --component \"strontium=0.1:0.5\" --component \"binder=0.03:0.08\" \\\n"
        "    --constraint \"magnesium >= 1.2*nitrate\" --degree faces --center \\\n"
        "    --replicates center=2 --response Illumination --seed 7");
    command->callback([options] { runVertices(*options); });
}

}  // namespace cli
