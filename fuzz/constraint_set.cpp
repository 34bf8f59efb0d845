#include "constraint_set.h"

#include <algorithm>
#include <cmath>
#include <numbers>
#include <numeric>
#include <span>
#include <utility>

#include "draw.h"
#include "mixture_checks.h"
#include "require.h"
#include "same_bytes.h"

namespace fuzz {

namespace {

constexpr std::int32_t kUntouched = 77;
constexpr std::int32_t kLowerIdle = 1;
constexpr std::int32_t kUpperIdle = 2;
constexpr std::int32_t kBothIdle = 3;

/// A vertex this far outside a plane still counts as on it; the documented tolerance is a little smaller.
constexpr double kOutsideAbsolute = 2e-6;

/// Larger numbers in a constraint leave too few digits of a proportion.
constexpr double kModerate = 1e3;

using Constraint = des_MixtureDesignLinearConstraint;

std::vector<double> drawCoefficients(FuzzedDataProvider& bytes, std::uint32_t numComponents) {
    std::vector<double> coefficients(numComponents);
    const bool isAwkward = drawRarely(bytes, 4);
    for (double& coefficient : coefficients)
        coefficient = isAwkward ? drawNumber(bytes) : bytes.ConsumeIntegralInRange(-4, 4) / 2.0;
    return coefficients;
}

double drawSide(FuzzedDataProvider& bytes, double total) {
    return drawRarely(bytes, 8) ? drawNumber(bytes) : drawHundredths(bytes, -100, 100) * total;
}

bool hasUpperSide(const Constraint& constraint) {
    return constraint.hasLowerValue == 0 || constraint.hasUpperValue != 0;
}

bool isModerate(const Constraint& constraint, std::uint32_t numComponents, double total) {
    const auto isSmall = [](double number) { return std::fabs(number) <= kModerate; };
    return std::all_of(constraint.coefficients, constraint.coefficients + numComponents, isSmall) &&
           (constraint.hasLowerValue == 0 || isSmall(constraint.lowerValue / total)) &&
           (!hasUpperSide(constraint) || isSmall(constraint.upperValue / total));
}

/// The half-space normal . x >= offset.
struct Plane {
    std::vector<double> normal;
    double offset;
};

Plane opposite(const std::vector<double>& normal, double offset) {
    Plane plane{normal, -offset};
    for (double& component : plane.normal)
        component = -component;
    return plane;
}

/// The sides that the call has not found idle.
void appendCuttingPlanes(const Constraint& constraint, std::uint32_t numComponents, double total,
                         std::vector<Plane>& planes) {
    const std::vector<double> normal(constraint.coefficients, constraint.coefficients + numComponents);
    const bool isLowerIdle = constraint.status == kLowerIdle || constraint.status == kBothIdle;
    const bool isUpperIdle = constraint.status == kUpperIdle || constraint.status == kBothIdle;
    if (constraint.hasLowerValue != 0 && !isLowerIdle) planes.push_back({normal, constraint.lowerValue / total});
    if (hasUpperSide(constraint) && !isUpperIdle) planes.push_back(opposite(normal, constraint.upperValue / total));
}

void appendBounds(const des_MixtureDesign& design, std::vector<Plane>& planes) {
    for (std::uint32_t j = 0; j < design.numComponents; ++j) {
        std::vector<double> normal(design.numComponents, 0.0);
        normal[j] = 1;
        planes.push_back({normal, design.scaledLowerBounds[j]});
        planes.push_back(opposite(normal, design.scaledUpperBounds[j]));
    }
}

bool hasSameInputs(const Constraint& a, const Constraint& b) {
    const double left[] = {a.lowerValue, a.upperValue};
    const double right[] = {b.lowerValue, b.upperValue};
    return a.hasLowerValue == b.hasLowerValue && a.hasUpperValue == b.hasUpperValue &&
           a.coefficients == b.coefficients && haveSameBytes(left, right);
}

std::vector<std::int32_t> allowedStatuses(const Constraint& constraint) {
    if (constraint.hasLowerValue == 0) return {kUntouched, kUpperIdle};
    if (constraint.hasUpperValue == 0) return {kUntouched, kLowerIdle};
    return {kUntouched, kLowerIdle, kUpperIdle, kBothIdle};
}

}  // namespace

ConstraintSet::ConstraintSet(FuzzedDataProvider& bytes, std::uint32_t numComponents, std::size_t count, double total) {
    for (std::size_t i = 0; i < count; ++i) {
        const std::uint8_t flags = bytes.ConsumeIntegral<std::uint8_t>();
        Constraint constraint{};
        constraint.hasLowerValue = flags & 0x2C;
        constraint.hasUpperValue = flags & 0xD1;
        std::vector<double> coefficients = drawCoefficients(bytes, numComponents);
        constraint.lowerValue = drawSide(bytes, total);
        constraint.upperValue = drawSide(bytes, total);
        add(constraint, std::move(coefficients));
        if (drawRarely(bytes, 64)) requested_.back().coefficients = nullptr;
    }
}

ConstraintSet ConstraintSet::drawPolygon(FuzzedDataProvider& bytes, std::size_t count, double total) {
    ConstraintSet polygon;
    Constraint side{};
    side.upperValue = drawHundredths(bytes, 5, 40) * total;
    for (std::size_t i = 0; i < count; ++i) {
        const double angle = 2 * std::numbers::pi * static_cast<double>(i) / static_cast<double>(count);
        // Two orthogonal directions within the triangle of mixtures.
        const double u = std::cos(angle) / std::sqrt(2.0);
        const double v = std::sin(angle) / std::sqrt(6.0);
        polygon.add(side, {u + v, v - u, -2 * v});
    }
    return polygon;
}

void ConstraintSet::add(const Constraint& constraint, std::vector<double> coefficients) {
    coefficients_.push_back(std::move(coefficients));
    requested_.push_back(constraint);
    requested_.back().coefficients = coefficients_.back().data();
    requested_.back().status = kUntouched;
}

Constraint* ConstraintSet::prepare() {
    records_ = requested_;
    return records_.data();
}

bool ConstraintSet::hasAllCoefficients() const {
    return std::ranges::all_of(requested_, [](const Constraint& one) { return one.coefficients != nullptr; });
}

bool ConstraintSet::hasNumbers() const {
    const auto isFinite = [](double number) { return std::isfinite(number); };
    const auto hasNaN = [](const Constraint& one) { return std::isnan(one.lowerValue) || std::isnan(one.upperValue); };
    return std::ranges::none_of(requested_, hasNaN) &&
           std::ranges::all_of(coefficients_, [&](const auto& row) { return std::ranges::all_of(row, isFinite); });
}

bool ConstraintSet::areStatusesUntouched() const {
    return std::ranges::all_of(records_, [](const Constraint& one) { return one.status == kUntouched; });
}

void ConstraintSet::checkRecords() const {
    for (std::size_t i = 0; i < records_.size(); ++i) {
        const auto allowed = allowedStatuses(requested_[i]);
        require(std::ranges::find(allowed, records_[i].status) != allowed.end(),
                "a status speaks of a side that the constraint has");
        require(hasSameInputs(records_[i], requested_[i]), "a run changes no constraint but its status");
    }
}

void ConstraintSet::checkRuns(const des_MixtureDesign& design, double total) const {
    const std::uint32_t q = design.numComponents;
    std::vector<Plane> planes;
    for (const Constraint& constraint : records_) {
        if (!isModerate(constraint, q, total)) return;
        appendCuttingPlanes(constraint, q, total, planes);
    }
    appendBounds(design, planes);
    for (const des_MixtureRun& run : std::span(design.runs, design.numRuns)) {
        const double sum = sumOfProportions(design, run);
        if (!isTotalModerate(sum)) continue;
        std::size_t touched = 0;
        for (const Plane& plane : planes) {
            const double inside =
                std::inner_product(plane.normal.begin(), plane.normal.end(), run.proportions, 0.0) / sum - plane.offset;
            require(inside >= -kOutsideAbsolute, "runs are within the sides that cut");
            if (inside <= kOutsideAbsolute) ++touched;
        }
        if (run.pointType == des_MixturePointVertex) require(touched + 1 >= q, "a vertex is where enough planes meet");
    }
}

}  // namespace fuzz
