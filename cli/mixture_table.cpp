#include <nlohmann/json.hpp>

#include "mixture_options.h"

namespace cli {

namespace {

nlohmann::ordered_json describeComponents(const MixtureRequest& request, const MixtureRecord& record) {
    auto entries = nlohmann::ordered_json::array();
    for (std::size_t i = 0; i < request.components.size(); ++i) {
        const Component& component = request.components[i];
        entries.push_back({{"name", component.name},
                           {"lower", component.lower},
                           {"upper", component.upper},
                           {"implied_lower", record.lower[i]},
                           {"implied_upper", record.upper[i]}});
    }
    return entries;
}

nlohmann::ordered_json describeProcess(const MixtureRequest& request) {
    auto entries = nlohmann::ordered_json::array();
    for (const Factor& factor : request.process)
        entries.push_back(factor.describe());
    return entries;
}

}  // namespace

void showMixtureDesign(const MixtureOptions& options, const MixtureRequest& request, const MixtureRecord& record,
                       nlohmann::ordered_json head) {
    DesignTable table =
        startTable(options.shared, record->numRuns, [&](std::size_t i) { return record.run(i).runOrder; });
    addColumn(table,
              {"point_type", "", false, [&](std::size_t i) { return Cell(std::int64_t{record.run(i).pointType}); }});
    if (!request.amounts.empty()) {
        addColumn(table, {"amount", "", false, [&](std::size_t i) { return Cell(record.run(i).amount); }});
    }
    for (std::size_t j = 0; j < request.components.size(); ++j) {
        addColumn(table, {request.components[j].name, "", false,
                          [&record, j](std::size_t i) { return Cell(record.run(i).proportions[j]); }});
    }
    for (std::size_t j = 0; j < request.process.size(); ++j) {
        const Factor& factor = request.process[j];
        addColumn(table, {factor.name, options.coded ? "" : factor.unit, false, [&, j](std::size_t i) {
                              return request.process[j].level(record.run(i).processLevels[j], options.coded);
                          }});
    }

    head["units"] = options.units;
    if (!request.amounts.empty()) head["amounts"] = request.amounts;
    head["components"] = describeComponents(request, record);
    if (!request.process.empty()) {
        head["process"] = describeProcess(request);
        head["fraction"] = request.fraction;
        head["fraction_index"] = request.fractionIndex;
    }
    head["points_per_type"] = record.pointsPerType;
    head["center_points"] = record->numCenterPoints;
    head["axial_points"] = record->numAxialPoints;
    head["boundary_counts"] = record.boundaryCounts;
    finishTable(options.shared, request.seed, table, std::move(head));
}

}  // namespace cli
