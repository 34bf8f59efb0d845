#include "mixture/simplex_centroid_design.h"

#include <algorithm>
#include <cstddef>
#include <functional>
#include <numeric>
#include <stdexcept>

#include "mixture/boundary_counts.h"
#include "mixture/component_bounds.h"
#include "mixture/process_variables.h"
#include "mixture/run_array.h"
#include "mixture/run_replication.h"

namespace reisti {

namespace {

/// Steps to the next subset of the numbers below n in lexicographic order; false when there is none. SubsetsOfNChooseK
/// lists the same subsets but counts them in 32 bits, which 34 components exceed.
bool advanceSubset(std::vector<std::uint32_t>& subset, std::uint32_t n) {
    const auto size = static_cast<std::uint32_t>(subset.size());
    for (std::uint32_t i = size; i-- > 0;) {
        if (subset[i] == n - size + i) continue;
        std::iota(subset.begin() + i, subset.end(), subset[i] + 1);
        return true;
    }
    return false;
}

}  // namespace

SimplexCentroidDesign::SimplexCentroidDesign(des_MixtureDesign* design)
    : design_(design), axialCount_(design->numComponents) {}

void SimplexCentroidDesign::Calculate(int& error) {
    error = 0;
    try {
        RunPipeline(error);
    } catch (...) {
        if (runsAllocated_) {
            releaseRuns(design_->runs, design_->numRuns);
            design_->runs = nullptr;
            design_->numRuns = 0;
        }
        throw;
    }
}

void SimplexCentroidDesign::RunPipeline(int& error) {
    CheckTotalsAndProcVars(error);
    if (error == 0) CheckProcessFraction(error);
    if (error == 0) CheckBoundsInMixtures(error);
    if (error == 0) CalculateNumVerticesEdgesFaces(error);
    if (error != 0) return;
    GenerateBaseDesign();
    GenerateOverallCenterpoint();
    GenerateAxialPoints();
    RepeatIndividualPoints();
    RepeatDesign();
    MixtureAmountExperiment();
    SetProcessVariables(error);
    if (error != 0) return;
    RequireAllRunsWritten();
    RescaleMixtureCatalogDesigns();
    RandomizeDesign();
    ComputeBounds();
    CopyResultsToContainer();
}

void SimplexCentroidDesign::CheckTotalsAndProcVars(int& error) {
    error = checkAmountsAgainstProcess(*design_);
}

void SimplexCentroidDesign::CheckProcessFraction(int& error) {
    error = reisti::checkProcessFraction(*design_);
}

void SimplexCentroidDesign::CheckBoundsInMixtures(int& error) {
    error = checkBounds(*design_, simplexCheck_);
}

void SimplexCentroidDesign::CalculateNumVerticesEdgesFaces(int& /*error*/) {
    const std::uint32_t q = design_->numComponents;
    const double* const lower = design_->lowerBounds;
    const double* const upper = design_->upperBounds;
    std::vector<double> ranges(q);
    std::transform(upper, upper + q, lower, ranges.begin(), std::minus<>());
    const double free = 1.0 - std::accumulate(lower, lower + q, 0.0);
    const double excess = std::accumulate(upper, upper + q, 0.0) - 1.0;

    const qan::matrix_library::matrix<int> binomials = binomialTable(q);
    std::vector<std::uint32_t> below;
    std::vector<std::uint32_t> equal;
    CalculateLE(free <= excess ? free : excess, ranges, below, equal);
    CalculateNumberOfBoundaries(below, equal, binomials);
}

void SimplexCentroidDesign::CalculateLE(double rStar, const std::vector<double>& ranges, std::vector<std::uint32_t>& L,
                                        std::vector<std::uint32_t>& E) const {
    reisti::CalculateLE(rStar, ranges, L, E);
}

void SimplexCentroidDesign::CalculateNumberOfBoundaries(const std::vector<std::uint32_t>& L,
                                                        const std::vector<std::uint32_t>& E,
                                                        const qan::matrix_library::matrix<int>& M) {
    reisti::CalculateNumberOfBoundaries(L, E, M, boundaryCounts_);
}

void SimplexCentroidDesign::GenerateBaseDesign() {
    const std::uint32_t q = design_->numComponents;
    std::vector<std::uint64_t> basePoints(std::size_t{q} + 1, 0);
    for (std::uint32_t size = 1; size < q; ++size)
        basePoints[size] = countSubsets(q, size);
    basePoints[des_MixturePointCentroid] = 1;
    CalculateNumPointsPerType(basePoints);
    AugmentDesign();
    for (std::uint32_t size = 1; size <= q; ++size)
        AppendSubsetCentroids(size, size < q ? static_cast<std::int32_t>(size) : des_MixturePointCentroid);
}

void SimplexCentroidDesign::AppendSubsetCentroids(std::uint32_t size, std::int32_t pointType) {
    if (!IsTypeRun(pointType)) return;
    const double share = 1.0 / size;
    std::vector<std::uint32_t> subset(size);
    std::iota(subset.begin(), subset.end(), 0U);
    do {
        double* const proportions = AppendRun(pointType).proportions;
        for (const std::uint32_t component : subset)
            proportions[component] = share;
    } while (advanceSubset(subset, design_->numComponents));
}

void SimplexCentroidDesign::CalculateNumPointsPerType() {
    std::vector<std::uint64_t> basePoints(std::size_t{design_->numComponents} + 1, 0);
    for (const int type : basePointTypes_)
        ++basePoints.at(static_cast<std::size_t>(type));
    CalculateNumPointsPerType(basePoints);
}

void SimplexCentroidDesign::CalculateNumPointsPerType(const std::vector<std::uint64_t>& basePoints) {
    if (basePoints[des_MixturePointCentroid] != 0) centerFlag_ = true;
    classes_ = classifyPoints(*design_, basePoints, centerFlag_, design_->axialPoints != 0 ? axialCount_ : 0);
}

void SimplexCentroidDesign::AugmentDesign() {
    const std::uint32_t numRuns = countRuns(*design_, classes_);
    design_->runs = nullptr;
    design_->numRuns = 0;
    design_->runs = allocateRuns(numRuns, design_->numComponents, design_->numProcessVariables);
    design_->numRuns = numRuns;
    runsAllocated_ = true;
}

void SimplexCentroidDesign::GenerateOverallCenterpoint() {}

void SimplexCentroidDesign::GenerateAxialPoints() {
    if (design_->axialPoints == 0 || !IsTypeRun(des_MixturePointAxial)) return;
    const std::uint32_t q = design_->numComponents;
    const double twice = 2.0 * q;
    for (std::uint32_t j = 0; j < axialCount_; ++j) {
        double* const proportions = AppendRun(des_MixturePointAxial).proportions;
        std::fill_n(proportions, q, 1.0 / twice);
        proportions[j] = (q + 1.0) / twice;
    }
}

void SimplexCentroidDesign::RepeatIndividualPoints() {
    repeatPoints(*design_, classes_, runCounter_);
}

void SimplexCentroidDesign::RepeatDesign() {
    repeatDesign(*design_, runCounter_);
}

void SimplexCentroidDesign::MixtureAmountExperiment() {
    runAtEveryAmount(*design_, runCounter_);
}

void SimplexCentroidDesign::SetProcessVariables(int& error) {
    error = crossWithProcessVariables(*design_, runCounter_);
    if (error == 0) return;
    // The host may read all runs that it finds in the record.
    for (std::uint32_t i = runCounter_; i < design_->numRuns; ++i) {
        allocateArrays(*design_, design_->runs[i]);
        std::fill_n(design_->runs[i].proportions, design_->numComponents, 0.0);
    }
}

void SimplexCentroidDesign::RequireAllRunsWritten() const {
    if (runCounter_ != design_->numRuns) throw std::length_error("fewer runs than counted");
}

void SimplexCentroidDesign::RescaleMixtureCatalogDesigns() {
    convertFromPseudoComponents(*design_);
    restoreBounds(*design_);
}

void SimplexCentroidDesign::RandomizeDesign() {
    if (design_->randomize != 0) randomizeRunOrder(*design_);
}

void SimplexCentroidDesign::ComputeBounds() {
    writeScaledBounds(*design_);
}

void SimplexCentroidDesign::CopyResultsToContainer() {
    const std::size_t q = design_->numComponents;
    std::copy_n(classes_.points.begin(), q, design_->pointsPerType);
    std::transform(boundaryCounts_.begin(), boundaryCounts_.end(), design_->boundaryCounts,
                   [](int count) { return static_cast<std::uint32_t>(count); });
    design_->numCenterPoints = classes_.points[q];
    design_->numAxialPoints = classes_.points[q + 1];
}

}  // namespace reisti
