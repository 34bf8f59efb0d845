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

/// What a component has of the degree.
struct Part {
    std::uint32_t component;
    std::int32_t units;
};

/// The compositions of `degree` into q parts that may be 0, in decreasing lexicographic order from (degree, 0, .., 0).
/// Only positive parts are kept, by component: a lattice of many components and low degree consists of zeros.
class Compositions {
  public:
    Compositions(std::uint32_t q, std::int32_t degree) : lastComponent_(q - 1), parts_{{0, degree}} {}

    const std::vector<Part>& parts() const { return parts_; }

    /// False when the last composition, (0, .., 0, degree), has been reached.
    bool advance() {
        // All of the last component and one unit of the rightmost part before it move to the place behind that part.
        std::int32_t carry = 1;
        if (parts_.back().component == lastComponent_) {
            carry += parts_.back().units;
            parts_.pop_back();
            if (parts_.empty()) return false;
        }
        Part& from = parts_.back();
        const std::uint32_t next = from.component + 1;
        if (--from.units == 0) parts_.pop_back();
        parts_.push_back({next, carry});
        return true;
    }

  private:
    std::uint32_t lastComponent_;
    std::vector<Part> parts_;
};

/// Type 0 for the composition with all q parts equal, else the number of positive parts.
std::int32_t typeOf(const std::vector<Part>& parts, std::uint32_t q) {
    const auto differs = [&parts](const Part& part) { return part.units != parts.front().units; };
    if (parts.size() == q && std::ranges::none_of(parts, differs)) return des_MixturePointCentroid;
    return static_cast<std::int32_t>(parts.size());
}

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
    const std::uint32_t q = design_->numComponents;
    return q != 0 && static_cast<std::uint32_t>(degree_) % q == 0;
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
    Compositions compositions(q, degree_);
    do {
        const std::vector<Part>& parts = compositions.parts();
        const std::int32_t type = typeOf(parts, q);
        if (!IsTypeRun(type)) continue;
        double* const proportions = AppendRun(type).proportions;
        for (const Part& part : parts)
            proportions[part.component] = proportionOf[static_cast<std::size_t>(part.units)];
    } while (compositions.advance());
}

void SimplexLatticeDesign::GenerateOverallCenterpoint() {
    if (!centerFlag_ || HoldsCentroid() || !IsTypeRun(des_MixturePointCentroid)) return;
    const std::uint32_t q = design_->numComponents;
    std::fill_n(AppendRun(des_MixturePointCentroid).proportions, q, 1.0 / q);
}

}  // namespace reisti
