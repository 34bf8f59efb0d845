#include "mixture_call.h"

#include <iterator>
#include <span>
#include <tuple>

#include "require.h"
#include "same_bytes.h"

namespace fuzz {

namespace {

constexpr double kPoisonNumber = -987654.321;
constexpr std::uint32_t kPoisonCount = 0xA5A5A5A5;

des_MixtureRun* poisonRuns() {
    static des_MixtureRun run{};
    return &run;
}

CallerArrays makeArrays(const MixtureRequest& request) {
    const std::size_t q = request.inputs.numComponents;
    const std::vector<double> numbers(q, kPoisonNumber);
    const std::vector<std::uint32_t> counts(q, kPoisonCount);
    return {.lowerBounds = request.lowerBounds,
            .upperBounds = request.upperBounds,
            .scaledLowerBounds = numbers,
            .scaledUpperBounds = numbers,
            .pseudoLowerBounds = numbers,
            .pseudoUpperBounds = numbers,
            .pointsPerType = counts,
            .boundaryCounts = counts,
            .amounts = request.amounts,
            .typeReplicates = request.typeReplicates.value_or(std::vector<std::uint32_t>())};
}

bool areEqual(const des_MixtureDesign& a, const des_MixtureDesign& b) {
    const auto fields = [](const des_MixtureDesign& d) {
        return std::tie(d.numComponents, d.lowerBounds, d.upperBounds, d.scaledLowerBounds, d.scaledUpperBounds,
                        d.pseudoLowerBounds, d.pseudoUpperBounds, d.pointsPerType, d.numCenterPoints, d.numAxialPoints,
                        d.boundaryCounts, d.vertexReplicates, d.typeReplicates, d.centerReplicates, d.axialReplicates,
                        d.designReplicates, d.reserved, d.numProcessVariables, d.processFraction, d.fractionIndex,
                        d.numAmounts, d.amounts, d.axialPoints, d.boundsAdjusted, d.outputUnits, d.randomize, d.numRuns,
                        d.runs);
    };
    return fields(a) == fields(b) && haveSameBytes(std::span(&a.seed, 1), std::span(&b.seed, 1));
}

}  // namespace

MixtureCall::MixtureCall(const MixtureRequest& request, const Function& function)
    : arrays_(makeArrays(request)), arraysBefore_(arrays_), design_(des_CreateMixtureDesignContainer()) {
    require(design_ != nullptr, "a container is created while there is memory");
    *design_ = request.inputs;
    pointAtArrays();
    if (request.missingArray) leaveOut(*request.missingArray);
    designBefore_ = *design_;
    code_ = function(design_);
}

MixtureCall::~MixtureCall() {
    if (design_->runs == poisonRuns()) {
        design_->runs = nullptr;
        design_->numRuns = 0;
    }
    des_DeleteMixtureDesignContainer(&design_);
    require(design_ == nullptr, "deleting sets the caller's pointer to null");
}

void MixtureCall::pointAtArrays() {
    design_->lowerBounds = arrays_.lowerBounds.data();
    design_->upperBounds = arrays_.upperBounds.data();
    design_->scaledLowerBounds = arrays_.scaledLowerBounds.data();
    design_->scaledUpperBounds = arrays_.scaledUpperBounds.data();
    design_->pseudoLowerBounds = arrays_.pseudoLowerBounds.data();
    design_->pseudoUpperBounds = arrays_.pseudoUpperBounds.data();
    design_->pointsPerType = arrays_.pointsPerType.data();
    design_->boundaryCounts = arrays_.boundaryCounts.data();
    design_->amounts = arrays_.amounts.data();
    design_->typeReplicates = arrays_.typeReplicates.data();
    design_->numCenterPoints = kPoisonCount;
    design_->numAxialPoints = kPoisonCount;
    design_->boundsAdjusted = 0xA5;
    design_->numRuns = kPoisonCount;
    design_->runs = poisonRuns();
}

void MixtureCall::leaveOut(std::size_t array) {
    double** const numbers[] = {&design_->lowerBounds,       &design_->upperBounds,       &design_->scaledLowerBounds,
                                &design_->scaledUpperBounds, &design_->pseudoLowerBounds, &design_->pseudoUpperBounds};
    std::uint32_t** const counts[] = {&design_->pointsPerType, &design_->boundaryCounts};
    static_assert(std::size(numbers) + std::size(counts) == kAmountsArray);
    if (array == kAmountsArray) {
        design_->amounts = nullptr;
    } else if (array < std::size(numbers)) {
        *numbers[array] = nullptr;
    } else {
        *counts[array - std::size(numbers)] = nullptr;
    }
}

bool MixtureCall::isNothingChanged() const {
    return areEqual(*design_, designBefore_) && haveSameBytes(arrays_.lowerBounds, arraysBefore_.lowerBounds) &&
           haveSameBytes(arrays_.upperBounds, arraysBefore_.upperBounds) &&
           haveSameBytes(arrays_.scaledLowerBounds, arraysBefore_.scaledLowerBounds) &&
           haveSameBytes(arrays_.scaledUpperBounds, arraysBefore_.scaledUpperBounds) &&
           haveSameBytes(arrays_.pseudoLowerBounds, arraysBefore_.pseudoLowerBounds) &&
           haveSameBytes(arrays_.pseudoUpperBounds, arraysBefore_.pseudoUpperBounds) &&
           haveSameBytes(arrays_.pointsPerType, arraysBefore_.pointsPerType) &&
           haveSameBytes(arrays_.boundaryCounts, arraysBefore_.boundaryCounts);
}

bool MixtureCall::areRunsUntouched() const {
    return design_->runs == designBefore_.runs && design_->numRuns == designBefore_.numRuns;
}

void MixtureCall::checkInputsUnchanged() const {
    // Everything that a run may change put back, the rest has to be what it was.
    des_MixtureDesign inputs = *design_;
    inputs.numCenterPoints = designBefore_.numCenterPoints;
    inputs.numAxialPoints = designBefore_.numAxialPoints;
    inputs.boundsAdjusted = designBefore_.boundsAdjusted;
    inputs.numRuns = designBefore_.numRuns;
    inputs.runs = designBefore_.runs;
    require(areEqual(inputs, designBefore_), "a run changes no input field");
    require(haveSameBytes(arrays_.amounts, arraysBefore_.amounts), "a run changes no amount");
    require(arrays_.typeReplicates == arraysBefore_.typeReplicates, "a run changes no replicates");
}

}  // namespace fuzz
