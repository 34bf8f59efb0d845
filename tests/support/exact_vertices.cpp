#include "support/exact_vertices.h"

#include <utility>

namespace reisti::test {

namespace {

Int128 magnitude(Int128 x) {
    return x < 0 ? -x : x;
}

Int128 commonDivisor(Int128 a, Int128 b) {
    a = magnitude(a);
    b = magnitude(b);
    while (b != 0)
        a = std::exchange(b, a % b);
    return a;
}

// An equation coefficients . x = value; the value is the last entry.
using Equation = std::vector<Int128>;

void reduce(Equation& row) {
    Int128 divisor = 0;
    for (const Int128 x : row)
        divisor = commonDivisor(divisor, x);
    if (divisor == 0) return;
    for (Int128& x : row)
        x /= divisor;
}

// Takes column `pivot` out of `row` by means of `with`.
void eliminate(Equation& row, const Equation& with, std::size_t pivot) {
    const Int128 factor = row[pivot];
    if (factor == 0) return;
    const Int128 keep = with[pivot];
    for (std::size_t j = 0; j < row.size(); ++j)
        row[j] = row[j] * keep - with[j] * factor;
    reduce(row);
}

class Enumeration {
  public:
    explicit Enumeration(const ExactRegion& region) : q_(region.lower.size()) {
        for (std::size_t j = 0; j < q_; ++j) {
            Equation lower(q_ + 1, 0);
            lower[j] = 1;
            lower[q_] = region.lower[j];
            planes_.push_back(lower);
            Equation upper(q_ + 1, 0);
            upper[j] = -1;
            upper[q_] = -region.upper[j];
            planes_.push_back(upper);
        }
        for (const ExactHalfSpace& half : region.halfSpaces) {
            Equation plane(half.coefficients.begin(), half.coefficients.end());
            plane.push_back(half.value);
            planes_.push_back(plane);
        }
        Equation sum(q_, 1);
        sum.push_back(region.scale);
        push(sum);
        extend(0);
    }

    std::set<ExactPoint> found;

  private:
    // Adds an equation to the chosen ones, which stay fully reduced against each other; false if it depends on them.
    bool push(Equation row) {
        for (const auto& [pivot, chosen] : chosen_)
            eliminate(row, chosen, pivot);
        std::size_t pivot = 0;
        while (pivot < q_ && row[pivot] == 0)
            ++pivot;
        if (pivot == q_) return false;
        reduce(row);
        for (auto& [other, chosen] : chosen_)
            eliminate(chosen, row, pivot);
        chosen_.emplace_back(pivot, row);
        return true;
    }

    void extend(std::size_t first) {
        if (chosen_.size() == q_) {
            keepIfFeasible();
            return;
        }
        for (std::size_t p = first; p < planes_.size(); ++p) {
            const auto before = chosen_;
            if (push(planes_[p])) extend(p + 1);
            chosen_ = before;
        }
    }

    void keepIfFeasible() {
        // Each chosen equation now holds one unknown: a x_pivot = b.
        Int128 denominator = 1;
        for (const auto& [pivot, row] : chosen_)
            denominator = denominator / commonDivisor(denominator, row[pivot]) * magnitude(row[pivot]);
        ExactPoint point;
        point.numerators.assign(q_, 0);
        for (const auto& [pivot, row] : chosen_)
            point.numerators[pivot] = row[q_] * (denominator / row[pivot]);
        for (const Equation& plane : planes_) {
            Int128 value = -plane[q_] * denominator;
            for (std::size_t j = 0; j < q_; ++j)
                value += plane[j] * point.numerators[j];
            if (value < 0) return;
        }
        Int128 divisor = denominator;
        for (const Int128 x : point.numerators)
            divisor = commonDivisor(divisor, x);
        for (Int128& x : point.numerators)
            x /= divisor;
        point.denominator = denominator / divisor;
        found.insert(point);
    }

    std::size_t q_;
    std::vector<Equation> planes_;
    std::vector<std::pair<std::size_t, Equation>> chosen_;
};

}  // namespace

std::set<std::vector<std::int64_t>> exactBoxVertices(std::int64_t scale, const std::vector<std::int64_t>& lower,
                                                     const std::vector<std::int64_t>& upper) {
    const std::size_t q = lower.size();
    std::set<std::vector<std::int64_t>> found;
    for (std::size_t free = 0; free < q; ++free) {
        for (std::uint64_t choice = 0; choice < (std::uint64_t{1} << q); ++choice) {
            if ((choice >> free) % 2 == 1) continue;
            std::vector<std::int64_t> x(q);
            std::int64_t rest = scale;
            for (std::size_t j = 0; j < q; ++j) {
                if (j == free) continue;
                x[j] = (choice >> j) % 2 == 0 ? lower[j] : upper[j];
                rest -= x[j];
            }
            if (rest < lower[free] || rest > upper[free]) continue;
            x[free] = rest;
            found.insert(x);
        }
    }
    return found;
}

std::set<ExactPoint> exactVertices(const ExactRegion& region) {
    return Enumeration(region).found;
}

}  // namespace reisti::test
