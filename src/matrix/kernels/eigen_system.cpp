#include "matrix/kernels/eigen_system.h"

#include <algorithm>
#include <cmath>
#include <numeric>
#include <utility>
#include <vector>

#include "matrix/kernels/level_table.h"
#include "util/math_routines.h"

namespace reisti::kernels {

namespace {

constexpr int kMaxIterations = 30;

// An off-diagonal element is negligible when it would vanish in the sum with its diagonal neighbours: half a unit in
// the last place of 1.
constexpr double kNegligible = 0x1p-53;

// Relative distance below which two values count as equal.
constexpr double kValueFuzz = 1e-12;

// Sums of squares between these bounds neither overflowed nor lost digits to the subnormal range.
constexpr double kLeastSafeSquare = 0x1p-900;
constexpr double kGreatestSafeSquare = 0x1p900;

// Matrices whose greatest element lies outside these bounds are scaled, so that products of four elements stay finite.
constexpr double kLeastMagnitude = 0x1p-200;
constexpr double kGreatestMagnitude = 0x1p200;

// Powers of two beyond this have no finite reciprocal.
constexpr int kGreatestExponent = 1000;

// Rotations are recorded and applied strip by strip: with enough of them at a time a strip is loaded once for many, and
// few enough that their record stays in the cache beside it.
constexpr std::size_t kRecordedRotations = 4096;

double lengthOf(double x, double y) {
    const double squares = x * x + y * y;
    const bool isSafe = squares > kLeastSafeSquare && squares < kGreatestSafeSquare;
    return isSafe ? std::sqrt(squares) : std::hypot(x, y);
}

bool isZero(double x) {
    return mCompareWithFuzz(x, 0.0, 0.0, kValueFuzz) == 0;
}

// The power of two by which to multiply the matrix before, and its values to divide after, the work.
double scaleFor(const double* a, std::size_t n) {
    double greatest = 0.0;
    for (std::size_t i = 0; i < n; ++i) {
        for (std::size_t j = 0; j <= i; ++j)
            greatest = std::max(greatest, std::fabs(a[i * n + j]));
    }
    const bool needsScaling = greatest > 0.0 && (greatest < kLeastMagnitude || greatest > kGreatestMagnitude);
    if (!needsScaling || !std::isfinite(greatest)) return 1.0;
    return std::ldexp(1.0, -std::clamp(std::ilogb(greatest), -kGreatestExponent, kGreatestExponent));
}

// Eigenvalues by QL iteration with implicit shifts (Bowdler, Martin, Reinsch and Wilkinson, 1968), and the transposed
// eigenvectors in strips of kStrip columns.
class Solver {
  public:
    Solver(const LevelTable& table, std::size_t n)
        : table_(table), n_(n), diagonal_(n), below_(n), strips_((n + kStrip - 1) / kStrip * kStrip * n), order_(n) {
        std::iota(order_.begin(), order_.end(), std::size_t{0});
    }

    void reduce(const double* a, double scale);
    // False, with the index of the eigenvalue, when one does not converge.
    bool iterate(std::size_t& failed);
    void sort();
    void write(double scale, double* values, double* vectors) const;

  private:
    double* strip(std::size_t column) { return strips_.data() + column / kStrip * kStrip * n_; }
    void toStrips(const double* rows, std::size_t stride);
    std::size_t findSplit(std::size_t first) const;
    void sweep(std::size_t first, std::size_t last);
    void applyRotations();

    const LevelTable& table_;
    std::size_t n_;
    std::vector<double> diagonal_;
    std::vector<double> below_;  // element i is left of diagonal element i + 1
    std::vector<double> strips_;
    std::vector<std::size_t> order_;  // row of the transposed eigenvectors that belongs to each value
    std::vector<RotationSweep> sweeps_;
    std::vector<Rotation> rotations_;
};

void Solver::reduce(const double* a, double scale) {
    const std::size_t stride = (n_ + 15) / 8 * 8;
    std::vector<double> reduced(n_ * stride);
    for (std::size_t i = 0; i < n_; ++i) {
        for (std::size_t j = 0; j <= i; ++j)
            reduced[i * stride + j] = reduced[j * stride + i] = a[i * n_ + j] * scale;
    }
    std::vector<double> factors(n_);
    table_.reduceToTridiagonal(reduced.data(), n_, stride, diagonal_.data(), below_.data(), factors.data());
    std::vector<double> product(n_ * stride);
    table_.multiplyReflections(reduced.data(), n_, stride, factors.data(), product.data());
    toStrips(product.data(), stride);
}

void Solver::toStrips(const double* rows, std::size_t stride) {
    for (std::size_t column = 0; column < n_; column += kStrip) {
        const std::size_t width = std::min(kStrip, n_ - column);
        for (std::size_t i = 0; i < n_; ++i)
            std::copy_n(rows + i * stride + column, width, strip(column) + i * kStrip);
    }
}

std::size_t Solver::findSplit(std::size_t first) const {
    std::size_t m = first;
    while (m + 1 < n_) {
        const double neighbours = std::fabs(diagonal_[m]) + std::fabs(diagonal_[m + 1]);
        if (mCompareWithFuzz(std::fabs(below_[m]), neighbours * kNegligible, 0.0, kValueFuzz) <= 0) break;
        ++m;
    }
    return m;
}

bool Solver::iterate(std::size_t& failed) {
    bool succeeds = true;
    for (std::size_t l = 0; succeeds && l < n_; ++l) {
        for (int iteration = 0;; ++iteration) {
            const std::size_t m = findSplit(l);
            if (m == l) break;
            if (iteration == kMaxIterations) {
                failed = l;
                succeeds = false;
                break;
            }
            sweep(l, m);
            if (rotations_.size() >= kRecordedRotations) applyRotations();
        }
    }
    applyRotations();
    return succeeds;
}

// One QL step on the diagonal elements first to last.
void Solver::sweep(std::size_t first, std::size_t last) {
    double* const d = diagonal_.data();
    double* const e = below_.data();
    double g = (d[first + 1] - d[first]) / (2.0 * e[first]);
    g = d[last] - d[first] + e[first] / (g + mTransferSign(lengthOf(g, 1.0), g));
    double s = 1.0;
    double c = 1.0;
    double p = 0.0;
    std::size_t i = last;
    for (; i > first; --i) {
        const double f = s * e[i - 1];
        const double b = c * e[i - 1];
        double r = lengthOf(f, g);
        e[i] = r;
        // The matrix has split here; the next search finds it.
        if (isZero(r)) break;
        s = f / r;
        c = g / r;
        g = d[i] - p;
        r = (d[i - 1] - g) * s + 2.0 * c * b;
        p = s * r;
        d[i] = g + p;
        g = c * r - b;
        rotations_.push_back({s, c});
    }
    sweeps_.push_back({last, last - i});
    d[i] -= p;
    if (i == first) e[first] = g;
    e[last] = 0.0;
}

void Solver::applyRotations() {
    for (std::size_t column = 0; column < n_; column += kStrip)
        table_.rotateStrip(strip(column), sweeps_.data(), sweeps_.size(), rotations_.data());
    sweeps_.clear();
    rotations_.clear();
}

void Solver::sort() {
    for (std::size_t i = 0; i < n_; ++i) {
        std::size_t least = i;
        for (std::size_t j = i + 1; j < n_; ++j) {
            if (mCompareWithFuzz(diagonal_[j], diagonal_[least], 0.0, kValueFuzz) < 0) least = j;
        }
        std::swap(diagonal_[i], diagonal_[least]);
        std::swap(order_[i], order_[least]);
    }
}

void Solver::write(double scale, double* values, double* vectors) const {
    for (std::size_t k = 0; k < n_; ++k)
        values[k] = diagonal_[k] / scale;
    for (std::size_t i = 0; i < n_; ++i) {
        const double* const column = strips_.data() + i / kStrip * kStrip * n_ + i % kStrip;
        for (std::size_t k = 0; k < n_; ++k)
            vectors[i * n_ + k] = column[order_[k] * kStrip];
    }
}

}  // namespace

std::size_t eigenSystem(Level level, const double* a, std::size_t n, double* values, double* vectors) {
    const double scale = scaleFor(a, n);
    Solver solver(tableOf(level), n);
    solver.reduce(a, scale);
    std::size_t failed = 0;
    if (solver.iterate(failed)) solver.sort();
    solver.write(scale, values, vectors);
    return failed;
}

std::size_t eigenSystem(const double* a, std::size_t n, double* values, double* vectors) {
    return eigenSystem(bestLevel(), a, n, values, vectors);
}

}  // namespace reisti::kernels
