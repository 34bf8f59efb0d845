#ifndef REISTI_CLI_MIXTURE_OPTIONS_H
#define REISTI_CLI_MIXTURE_OPTIONS_H

#include <CLI/App.hpp>
#include <cstdint>
#include <nlohmann/json_fwd.hpp>
#include <string>
#include <vector>

#include "component.h"
#include "factor.h"
#include "mixture_record.h"
#include "shared_options.h"

namespace cli {

/// What every mixture command has, as typed.
struct MixtureOptions {
    std::vector<std::string> componentTexts;
    double total = 1;
    std::vector<double> amounts;
    std::vector<std::string> processTexts;
    std::uint32_t fraction = 1;
    std::uint32_t fractionIndex = 1;
    bool axial = false;
    std::string replicatesText;
    std::uint32_t designReplicates = 1;
    std::string units = "amount";
    bool coded = false;
    bool hasTotal = false;
    SharedOptions shared;
};

void addMixtureOptions(CLI::App& command, MixtureOptions& options);

/// What is asked for, as read from the options.
struct MixtureRequest {
    std::vector<Component> components;
    /// Totals; empty when the components are proportions of one.
    std::vector<double> amounts;
    std::vector<Factor> process;
    std::uint32_t fraction = 1;
    std::uint32_t fractionIndex = 1;
    bool axial = false;
    Replicates replicates;
    std::uint32_t designReplicates = 1;
    std::uint32_t units = 0;
    std::optional<double> seed;

    double total() const { return amounts.empty() ? 1.0 : amounts.front(); }
    std::vector<std::string> componentNames() const;
    /// Runs of a design with these numbers of distinct points, pointsPerType[t-1] of type t.
    double countRuns(const std::vector<double>& pointsPerType, double centerPoints, double axialPoints) const;
};

/// Throws UsageError.
MixtureRequest readRequest(const MixtureOptions& options);

/// A record with everything that the request says.
MixtureRecord makeRecord(const MixtureRequest& request);

/// Throws RunError with the option, and where possible the component, that an error code of a run speaks of.
void checkMixtureCode(std::int32_t code, const MixtureRequest& request);

/// Tells on standard error which bounds the run tightened.
void reportTightenedBounds(const MixtureRecord& record, const MixtureRequest& request);

/// Shows the finished design. `head` may hold members of the command's own.
void showMixtureDesign(const MixtureOptions& options, const MixtureRequest& request, const MixtureRecord& record,
                       nlohmann::ordered_json head);

}  // namespace cli

#endif
