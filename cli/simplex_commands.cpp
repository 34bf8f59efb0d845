#include <CLI/Config.hpp>
#include <CLI/Formatter.hpp>
#include <cmath>
#include <memory>
#include <nlohmann/json.hpp>

#include "commands.h"
#include "mixture_options.h"
#include "output_file.h"
#include "usage_error.h"

namespace cli {

namespace {

struct LatticeOptions {
    std::int32_t degree = 0;
    bool center = false;
    MixtureOptions mixture;
};

/// A binomial coefficient as a double: a count may exceed every integer before it is refused.
double choose(std::size_t n, std::size_t k) {
    double count = 1;
    for (std::size_t i = 1; i <= k; ++i)
        count = count * static_cast<double>(n - k + i) / static_cast<double>(i);
    return std::round(count);
}

/// Runs of a centroid design: C(q, t) points of type t, the last of which is the overall centroid.
double countCentroidRuns(const MixtureRequest& request) {
    const std::size_t q = request.components.size();
    std::vector<double> points;
    for (std::size_t t = 1; t < q; ++t)
        points.push_back(choose(q, t));
    return request.countRuns(points, 1, request.axial ? static_cast<double>(q) : 0);
}

/// Runs of a lattice design: C(q, t) C(m-1, t-1) mixtures of degree m have t nonzero proportions.
double countLatticeRuns(const MixtureRequest& request, std::size_t degree, bool center) {
    const std::size_t q = request.components.size();
    std::vector<double> points;
    for (std::size_t t = 1; t <= q && t <= degree; ++t)
        points.push_back(choose(q, t) * choose(degree - 1, t - 1));
    const bool holdsCentroid = q != 0 && degree % q == 0;
    if (holdsCentroid) points.back() -= 1;
    return request.countRuns(points, holdsCentroid || center ? 1 : 0, request.axial ? static_cast<double>(q) : 0);
}

void runCentroid(const MixtureOptions& options) {
    checkOutputFile(options.shared.output.file, options.shared.output.force);
    const MixtureRequest request = readRequest(options);
    options.shared.checkRunCount(countCentroidRuns(request));
    const MixtureRecord record = makeRecord(request);
    checkMixtureCode(des_RunSimplexCentroidDesign(record.get()), request);
    reportTightenedBounds(record, request);
    showMixtureDesign(options, request, record, nlohmann::ordered_json::object({{"design", "simplex centroid"}}));
}

void runLattice(const LatticeOptions& options) {
    checkOutputFile(options.mixture.shared.output.file, options.mixture.shared.output.force);
    const MixtureRequest request = readRequest(options.mixture);
    if (options.degree < 1) throw UsageError("--degree", "the degree of a lattice is at least 1");
    options.mixture.shared.checkRunCount(
        countLatticeRuns(request, static_cast<std::size_t>(options.degree), options.center));
    const MixtureRecord record = makeRecord(request);
    checkMixtureCode(des_RunSimplexLatticeDesign(record.get(), options.degree, options.center ? 1 : 0), request);
    reportTightenedBounds(record, request);
    showMixtureDesign(options.mixture, request, record,
                      nlohmann::ordered_json::object({{"design", "simplex lattice"}, {"degree", options.degree}}));
}

}  // namespace

void addCentroidCommand(CLI::App& app) {
    CLI::App* command =
        app.add_subcommand("centroid", "Simplex centroid design: the centroids of all subsets of components");
    const auto options = std::make_shared<MixtureOptions>();
    // Every mixture command takes it, so that a script can change the kind of design and nothing else.
    command->add_flag_callback(
        "--center", [] {}, "Changes nothing: the overall centroid is always a point of this design");
    addMixtureOptions(*command, *options);
    command->footer(
        "Columns: std_order, run_order, point_type (1 vertex, k blend of k components, 0 overall\n"
        "centroid, -1 axial point), amount with --total or --amount, components, process variables.\n"
        "\n"
        "Example: a fruit punch of three juices, at least 30 of 100 parts watermelon, centroid three times:\n"
        "  reisti centroid --component \"watermelon=30:100\" --component \"pineapple=0:100\" \\\n"
        "    --component \"orange=0:100\" --total 100 --replicates center=3 --response Taste --seed 7");
    command->callback([options] { runCentroid(*options); });
}

void addLatticeCommand(CLI::App& app) {
    CLI::App* command = app.add_subcommand("lattice", "Simplex lattice design: all mixtures in steps of 1/degree");
    const auto options = std::make_shared<LatticeOptions>();
    command->add_option("--degree", options->degree, "Steps between nothing and all of a component")
        ->required()
        ->type_name("M");
    command->add_flag("--center", options->center, "Add the overall centroid where the lattice does not hold it");
    addMixtureOptions(*command, options->mixture);
    command->footer(
        "Columns: std_order, run_order, point_type (number of nonzero proportions, 0 overall\n"
        "centroid, -1 axial point), amount with --total or --amount, components, process variables.\n"
        "\n"
        "Example: three polymers blended in halves, pure ones spun twice and blends three times:\n"
        "  reisti lattice --degree 2 --component polyethylene --component polystyrene \\\n"
        "    --component polypropylene --replicates vertex=2,2=3 --response Elongation --seed 7");
    command->callback([options] { runLattice(*options); });
}

}  // namespace cli
