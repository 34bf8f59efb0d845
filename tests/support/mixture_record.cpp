#include "support/mixture_record.h"

#include <cstring>

namespace reisti::test {

namespace {

/// Without components there is nothing to hold, but a required array is still not null.
template <typename Entry>
std::vector<Entry> notNull(std::vector<Entry> entries) {
    if (entries.empty()) entries.reserve(1);
    return entries;
}

template <typename Entry>
void append(std::vector<unsigned char>& bytes, const std::vector<Entry>& entries) {
    const std::size_t old = bytes.size();
    bytes.resize(old + entries.size() * sizeof(Entry));
    if (!entries.empty()) std::memcpy(bytes.data() + old, entries.data(), entries.size() * sizeof(Entry));
}

std::vector<double> poisonedNumbers(std::uint32_t count) {
    return notNull(std::vector<double>(count, POISON_NUMBER));
}

std::vector<std::uint32_t> poisonedCounts(std::uint32_t count) {
    return notNull(std::vector<std::uint32_t>(count, POISON_COUNT));
}

}  // namespace

MixtureRecord::MixtureRecord(const MixtureRequest& request)
    : lowerBounds(notNull(request.lowerBounds)),
      upperBounds(notNull(request.upperBounds)),
      scaledLowerBounds(poisonedNumbers(request.numComponents())),
      scaledUpperBounds(poisonedNumbers(request.numComponents())),
      pseudoLowerBounds(poisonedNumbers(request.numComponents())),
      pseudoUpperBounds(poisonedNumbers(request.numComponents())),
      amounts(request.amounts),
      pointsPerType(poisonedCounts(request.numComponents())),
      boundaryCounts(poisonedCounts(request.numComponents())),
      typeReplicates(notNull(request.typeReplicates.value_or(std::vector<std::uint32_t>{}))),
      numComponents_(request.numComponents()),
      lattice_(request.lattice),
      degree_(request.degree),
      centerPoint_(request.centerPoint) {
    pointAtArrays(request.typeReplicates.has_value());
    design_->numComponents = numComponents_;
    design_->vertexReplicates = request.vertexReplicates;
    design_->centerReplicates = request.centerReplicates;
    design_->axialReplicates = request.axialReplicates;
    design_->designReplicates = request.designReplicates;
    design_->numProcessVariables = request.numProcessVariables;
    design_->processFraction = request.processFraction;
    design_->fractionIndex = request.fractionIndex;
    design_->numAmounts = static_cast<std::uint32_t>(amounts.size());
    design_->axialPoints = request.axialPoints;
    design_->outputUnits = request.outputUnits;
    design_->randomize = request.randomize;
    design_->seed = request.seed;
}

void MixtureRecord::pointAtArrays(bool withTypeReplicates) {
    design_->lowerBounds = lowerBounds.data();
    design_->upperBounds = upperBounds.data();
    design_->scaledLowerBounds = scaledLowerBounds.data();
    design_->scaledUpperBounds = scaledUpperBounds.data();
    design_->pseudoLowerBounds = pseudoLowerBounds.data();
    design_->pseudoUpperBounds = pseudoUpperBounds.data();
    design_->pointsPerType = pointsPerType.data();
    design_->boundaryCounts = boundaryCounts.data();
    design_->typeReplicates = withTypeReplicates ? typeReplicates.data() : nullptr;
    design_->amounts = amounts.empty() ? nullptr : amounts.data();
}

std::int32_t MixtureRecord::run() {
    return lattice_ ? des_RunSimplexLatticeDesign(design_, degree_, centerPoint_)
                    : des_RunSimplexCentroidDesign(design_);
}

std::vector<MixtureRunValue> MixtureRecord::runs() const {
    std::vector<MixtureRunValue> values(design_->runs != nullptr ? design_->numRuns : 0);
    for (std::size_t i = 0; i < values.size(); ++i) {
        const des_MixtureRun& run = design_->runs[i];
        values[i] = {run.runOrder, run.pointType, {run.proportions, run.proportions + numComponents_}, run.amount, {}};
        if (run.processLevels != nullptr)
            values[i].processLevels.assign(run.processLevels, run.processLevels + design_->numProcessVariables);
    }
    return values;
}

MixtureOutcome MixtureRecord::outcome(std::int32_t code) const {
    return {code,
            lowerBounds,
            upperBounds,
            design_->boundsAdjusted != 0,
            scaledLowerBounds,
            scaledUpperBounds,
            pseudoLowerBounds,
            pseudoUpperBounds,
            pointsPerType,
            design_->numCenterPoints,
            design_->numAxialPoints,
            boundaryCounts,
            runs()};
}

std::vector<unsigned char> MixtureRecord::bytes() const {
    const auto* record = reinterpret_cast<const unsigned char*>(design_);
    std::vector<unsigned char> all(record, record + sizeof(des_MixtureDesign));
    for (const auto* numbers : {&lowerBounds, &upperBounds, &scaledLowerBounds, &scaledUpperBounds, &pseudoLowerBounds,
                                &pseudoUpperBounds, &amounts})
        append(all, *numbers);
    for (const auto* counts : {&pointsPerType, &boundaryCounts, &typeReplicates})
        append(all, *counts);
    return all;
}

MixtureOutcome builtDesign(const MixtureRequest& request) {
    MixtureRecord record(request);
    return record.outcome(record.run());
}

}  // namespace reisti::test
