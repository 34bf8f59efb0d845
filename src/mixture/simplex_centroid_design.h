#ifndef REISTI_MIXTURE_SIMPLEX_CENTROID_DESIGN_H
#define REISTI_MIXTURE_SIMPLEX_CENTROID_DESIGN_H

#include <algorithm>
#include <cstdint>
#include <stdexcept>
#include <vector>

#include "matrix/matrix_library.h"
#include "mixture/run_array.h"
#include "mixture/run_counts.h"
#include "reisti/reisti.h"

namespace reisti {

/// Builds a simplex centroid design in a record, and carries the steps that all mixture designs share. An engine serves
/// one run on one record: it is constructed, calculates and is destroyed. What it leaves is in the record.
///
/// While it calculates:
/// 1. the bounds in the record are divided by the total, from the check of the bounds until the rescaling;
/// 2. the record's `runs` and `numRuns` are the caller's until AugmentDesign() has allocated all runs, and then final
/// in
///    size;
/// 3. runs 0 .. runCounter_-1 are written, those behind have no arrays yet;
/// 4. a class of points with 0 replicates is in the counts of the distinct points and in no run.
class SimplexCentroidDesign {
  public:
    explicit SimplexCentroidDesign(des_MixtureDesign* design);
    SimplexCentroidDesign(const SimplexCentroidDesign&) = delete;
    SimplexCentroidDesign& operator=(const SimplexCentroidDesign&) = delete;
    virtual ~SimplexCentroidDesign() = default;

    /// The whole construction. Stops at the first step that sets an error.
    /// @throw std::bad_alloc or std::length_error when memory or the 32-bit counts do not suffice. What was allocated
    /// is freed: `runs` is null and `numRuns` 0 when the runs had been counted before, else both are as they were.
    virtual void Calculate(int& error);

  protected:
    virtual void CheckBoundsInMixtures(int& error);
    /// Sets boundaryCounts_ from the divided bounds.
    virtual void CalculateNumVerticesEdgesFaces(int& error);
    /// Counts the points, has the runs allocated and writes the base runs.
    virtual void GenerateBaseDesign();
    /// Appends the overall centroid where it is asked for and no base point. Here it always is a base point.
    virtual void GenerateOverallCenterpoint();
    virtual void GenerateAxialPoints();
    /// Gives the proportions the units that the record asks for, and the bounds those of the total.
    virtual void RescaleMixtureCatalogDesigns();

    void CheckTotalsAndProcVars(int& error);
    void CheckProcessFraction(int& error);
    void CalculateLE(double rStar, const std::vector<double>& ranges, std::vector<std::uint32_t>& L,
                     std::vector<std::uint32_t>& E) const;
    void CalculateNumberOfBoundaries(const std::vector<std::uint32_t>& L, const std::vector<std::uint32_t>& E,
                                     const qan::matrix_library::matrix<int>& M);
    /// Fills classes_ from basePointTypes_, centerFlag_ and axialCount_; a base point of type 0 sets centerFlag_.
    void CalculateNumPointsPerType();
    /// The same from the number of base points of each type: entry t counts type t, for t = 0..q. For designs whose
    /// counts are known without listing the points, since the list alone can exceed the memory.
    void CalculateNumPointsPerType(const std::vector<std::uint64_t>& basePoints);
    /// Counts the runs of the whole design and allocates them. Call after CalculateNumPointsPerType().
    void AugmentDesign();
    void RepeatIndividualPoints();
    void RepeatDesign();
    void MixtureAmountExperiment();
    void SetProcessVariables(int& error);
    void RandomizeDesign();
    void ComputeBounds();
    void CopyResultsToContainer();

    /// Whether points of this type are run at all; a class replicated 0 times is left out of the design.
    bool IsTypeRun(std::int32_t pointType) const;
    /// The next run behind those written, numbered and typed, with all proportions 0.
    des_MixtureRun& AppendRun(std::int32_t pointType);

    des_MixtureDesign* design_;
    std::uint32_t runCounter_ = 0;
    /// Number of axial points: q on the simplex; where axial points belong to vertices, the number of vertices.
    std::uint32_t axialCount_;
    /// Whether the design holds the overall centroid.
    bool centerFlag_ = false;
    /// Whether the bounds have to leave a simplex.
    bool simplexCheck_ = true;
    /// Number of faces of the bounded region by dimension, [q].
    std::vector<int> boundaryCounts_;
    /// Type of each base point in base order, for CalculateNumPointsPerType() without argument.
    std::vector<int> basePointTypes_;
    PointClasses classes_;

  private:
    void RunPipeline(int& error);
    void RequireAllRunsWritten() const;
    void AppendSubsetCentroids(std::uint32_t size, std::int32_t pointType);

    bool runsAllocated_ = false;
};

// Defined here so that the loops over all points, which may be millions, call nothing but the allocator.

inline bool SimplexCentroidDesign::IsTypeRun(std::int32_t pointType) const {
    return design_->designReplicates != 0 && classes_.replicates[classOfType(pointType, design_->numComponents)] != 0;
}

inline des_MixtureRun& SimplexCentroidDesign::AppendRun(std::int32_t pointType) {
    // The runs were counted by formula and are written by enumeration. Should the two ever differ, nothing may be
    // written behind the array, nor may a run stay unwritten.
    if (runCounter_ == design_->numRuns) throw std::length_error("more runs than counted");
    des_MixtureRun& run = design_->runs[runCounter_++];
    run.runOrder = runCounter_;
    run.pointType = pointType;
    allocateArrays(*design_, run);
    std::fill_n(run.proportions, design_->numComponents, 0.0);
    return run;
}

}  // namespace reisti

#endif
