#include "mixture/extreme_vertices_design.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <numeric>

#include "mixture/component_bounds.h"
#include "mixture/extreme_vertex_util.h"
#include "mixture/face_centroids.h"

namespace reisti {

using qan::matrix_library::matrix;

ExtremeVerticesDesign::ExtremeVerticesDesign(des_MixtureDesign* design, int degree, bool centerPoint,
                                             int numConstraints, des_MixtureDesignLinearConstraint* constraints,
                                             int maxPoints)
    : SimplexLatticeDesign(design, degree, centerPoint),
      numVertices_(design->numComponents),
      numConstraints_(std::max(numConstraints, 0)),
      maxPoints_(maxPoints),
      constraints_(constraints) {
    simplexCheck_ = false;
}

void ExtremeVerticesDesign::CheckDegree(int& error) {
    // As an unsigned number a negative degree is above every q.
    if (static_cast<std::uint32_t>(degree_) > design_->numComponents) error = des_ErrorDegree;
}

bool ExtremeVerticesDesign::HasFiniteBounds() const {
    const auto isFinite = [](double bound) { return std::isfinite(bound); };
    const std::uint32_t q = design_->numComponents;
    return std::all_of(design_->lowerBounds, design_->lowerBounds + q, isFinite) &&
           std::all_of(design_->upperBounds, design_->upperBounds + q, isFinite);
}

void ExtremeVerticesDesign::CalculateNumVerticesEdgesFaces(int& error) {
    if (!HasFiniteBounds()) {
        error = des_ErrorNotANumber;
        return;
    }
    int numPlanes = 0;
    FindVertices(numPlanes);
    const bool withinLimit =
        mCalculateCentroidsControl(numPlanes, numCentroids_, degree_, static_cast<int>(design_->numComponents),
                                   static_cast<int>(numVertices_), slack_, points_, basePointTypes_, maxPoints_);
    // The runs that follow need as much memory as the slacks.
    slack_ = matrix<double>();
    if (!withinLimit) {
        error = des_ErrorTooManyPoints;
        return;
    }
    SimplexLatticeDesign::CalculateNumVerticesEdgesFaces(error);
}

void ExtremeVerticesDesign::FindVertices(int& numPlanes) {
    const auto q = static_cast<int>(design_->numComponents);
    CmExtremeVertexUtil util;
    if (numConstraints_ == 0 && degree_ < 2) {
        // Nobody would look at the slacks, which are twice as large as the vertices.
        util.mGenerateVertices(q, design_->lowerBounds, design_->upperBounds, &numVertices_, points_);
        return;
    }
    util.mExtremeVertex(q, numConstraints_, totalAmount(*design_), design_->lowerBounds, design_->upperBounds,
                        constraints_, &design_->boundsAdjusted, &numVertices_, &numPlanes, points_, slack_);
}

void ExtremeVerticesDesign::GenerateBaseDesign() {
    const auto numPoints = static_cast<std::size_t>(points_.rowCount());
    const std::uint32_t q = design_->numComponents;
    basePointTypes_.resize(numPoints, des_MixturePointVertex);
    // The counts follow what is written: a centroid among the base points sets the flag by itself.
    centerFlag_ = centerFlag_ && IsMeanOfVerticesAppended();
    axialCount_ = numVertices_;
    CalculateNumPointsPerType();
    AugmentDesign();
    for (std::size_t i = 0; i < numPoints; ++i) {
        if (IsTypeRun(basePointTypes_[i]))
            std::copy_n(points_.data() + i * q, q, AppendRun(basePointTypes_[i]).proportions);
    }
}

/// With a degree that is a multiple of q the faces include the whole region, whose centroid the mean is.
bool ExtremeVerticesDesign::IsMeanOfVerticesAppended() const {
    return numVertices_ != 0 && static_cast<std::uint32_t>(degree_) % design_->numComponents != 0;
}

std::vector<double> ExtremeVerticesDesign::MeanOfVertices() const {
    const std::size_t q = design_->numComponents;
    std::vector<double> mean(q, 0.0);
    for (std::size_t v = 0; v < numVertices_; ++v) {
        for (std::size_t j = 0; j < q; ++j)
            mean[j] += points_.data()[v * q + j];
    }
    for (double& component : mean)
        component /= numVertices_;
    return mean;
}

void ExtremeVerticesDesign::GenerateOverallCenterpoint() {
    if (!centerFlag_ || !IsMeanOfVerticesAppended() || !IsTypeRun(des_MixturePointCentroid)) return;
    const std::vector<double> mean = MeanOfVertices();
    std::copy(mean.begin(), mean.end(), AppendRun(des_MixturePointCentroid).proportions);
}

void ExtremeVerticesDesign::GenerateAxialPoints() {
    if (design_->axialPoints == 0 || !IsTypeRun(des_MixturePointAxial)) return;
    const std::size_t q = design_->numComponents;
    const std::vector<double> mean = MeanOfVertices();
    for (std::size_t v = 0; v < numVertices_; ++v) {
        double* const proportions = AppendRun(des_MixturePointAxial).proportions;
        for (std::size_t j = 0; j < q; ++j)
            proportions[j] = (mean[j] + points_.data()[v * q + j]) * 0.5;
    }
}

void ExtremeVerticesDesign::RescaleMixtureCatalogDesigns() {
    if (design_->outputUnits == des_UnitsPseudo) {
        ConvertToPseudoComponents();
    } else if (design_->outputUnits == des_UnitsAmount && design_->numAmounts != 0) {
        const double total = totalAmount(*design_);
        for (std::uint32_t r = 0; r < design_->numRuns; ++r) {
            const des_MixtureRun& run = design_->runs[r];
            const double amount = design_->numAmounts != 1 ? run.amount : total;
            for (std::uint32_t j = 0; j < design_->numComponents; ++j)
                run.proportions[j] *= amount;
        }
    }
    restoreBounds(*design_);
}

void ExtremeVerticesDesign::ConvertToPseudoComponents() {
    const std::uint32_t q = design_->numComponents;
    const double* const lower = design_->lowerBounds;
    const double free = 1.0 - std::accumulate(lower, lower + q, 0.0);
    for (std::uint32_t r = 0; r < design_->numRuns; ++r) {
        double* const proportions = design_->runs[r].proportions;
        double sum = 0.0;
        for (std::uint32_t j = 0; j < q; ++j) {
            const double share = (proportions[j] - lower[j]) / free;
            proportions[j] = share < 0.0 ? 0.0 : share;
            sum += proportions[j];
        }
        // Exactly: a sum that is off by rounding is what the division is for.
        if (sum == 1.0) continue;
        for (std::uint32_t j = 0; j < q; ++j)
            proportions[j] /= sum;
    }
}

}  // namespace reisti
