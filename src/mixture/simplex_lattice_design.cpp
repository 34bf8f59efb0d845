#include "mixture/simplex_lattice_design.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <vector>

#include "mixture/run_counts.h"

namespace reisti {

namespace {

struct DegreeLimit {
    std::uint32_t mostComponents;
    std::int32_t mostDegree;
};

/// Ascending by components. There is no limit for more components than the last row has.
constexpr std::array<DegreeLimit, 7> DEGREE_LIMITS = {{
    {5, 10},
    {6, 7},
    {7, 6},
    {8, 5},
    {11, 4},
    {17, 3},
    {20, 2},
}};

/// The compositions of `degree` into q parts that may be 0, in decreasing lexicographic order from (degree, 0, .., 0).
class Compositions {
  public:
    Compositions(std::uint32_t q, std::int32_t degree) : parts_(q, 0), positive_(1) { parts_[0] = degree; }

    const std::vector<std::int32_t>& parts() const { return parts_; }
    std::int32_t countPositive() const { return positive_; }

    /// False when the last composition, (0, .., 0, degree), has been reached.
    bool advance() {
        // The last part and one unit of the rightmost positive part before it move to the place behind that part.
        std::int32_t& last = parts_.back();
        const std::int32_t carry = last + 1;
        std::size_t from = parts_.size() - 1;
        while (from > 0 && parts_[from - 1] == 0)
            --from;
        if (from == 0) return false;
        if (last != 0) --positive_;
        last = 0;
        if (--parts_[from - 1] == 0) --positive_;
        parts_[from] = carry;
        ++positive_;
        return true;
    }

  private:
    std::vector<std::int32_t> parts_;
    std::int32_t positive_;
};

}  // namespace

bool isLatticeDegreeAllowed(std::uint32_t numComponents, std::int32_t degree) {
    if (degree < 1) return false;
    const auto* const limit = std::ranges::lower_bound(DEGREE_LIMITS, numComponents, {}, &DegreeLimit::mostComponents);
    return limit == DEGREE_LIMITS.end() || degree <= limit->mostDegree;
}

SimplexLatticeDesign::SimplexLatticeDesign(des_MixtureDesign* design, int degree, bool centerPoint)
    : SimplexCentroidDesign(design), degree_(degree) {
    centerFlag_ = centerPoint;
}

void SimplexLatticeDesign::Calculate(int& error) {
    error = 0;
    CheckDegree(error);
    if (error == 0) SimplexCentroidDesign::Calculate(error);
}

void SimplexLatticeDesign::CheckDegree(int& error) {
    if (!isLatticeDegreeAllowed(design_->numComponents, degree_)) error = des_ErrorDegree;
}

bool SimplexLatticeDesign::HoldsCentroid() const {
    return static_cast<std::uint32_t>(degree_) % design_->numComponents == 0;
}

void SimplexLatticeDesign::GenerateBaseDesign() {
    const std::uint32_t q = design_->numComponents;
    const auto degree = static_cast<std::uint32_t>(degree_);
    // t components share the degree, at least one unit each: degree - 1 gaps between the units, t - 1 of them cut.
    std::vector<std::uint64_t> basePoints(std::size_t{q} + 1, 0);
    for (std::uint32_t t = 1; t <= q; ++t)
        basePoints[t] = saturatingProduct(countSubsets(q, t), countSubsets(degree - 1, t - 1));
    if (HoldsCentroid()) {
        --basePoints[q];
        basePoints[des_MixturePointCentroid] = 1;
    }
    CalculateNumPointsPerType(basePoints);
    AugmentDesign();

    std::vector<double> proportionOf(std::size_t{degree} + 1);
    for (std::uint32_t c = 0; c <= degree; ++c)
        proportionOf[c] = c / static_cast<double>(degree);
    const std::int32_t equalPart = HoldsCentroid() ? degree_ / static_cast<std::int32_t>(q) : 0;
    Compositions compositions(q, degree_);
    do {
        const std::vector<std::int32_t>& parts = compositions.parts();
        const bool isCentroid = std::ranges::all_of(parts, [&](std::int32_t part) { return part == equalPart; });
        const std::int32_t type = isCentroid ? des_MixturePointCentroid : compositions.countPositive();
        if (!IsTypeRun(type)) continue;
        double* const proportions = AppendRun(type).proportions;
        for (std::uint32_t j = 0; j < q; ++j)
            proportions[j] = proportionOf[static_cast<std::size_t>(parts[j])];
    } while (compositions.advance());
}

void SimplexLatticeDesign::GenerateOverallCenterpoint() {
    if (!centerFlag_ || HoldsCentroid() || !IsTypeRun(des_MixturePointCentroid)) return;
    const std::uint32_t q = design_->numComponents;
    std::fill_n(AppendRun(des_MixturePointCentroid).proportions, q, 1.0 / q);
}

}  // namespace reisti
