#include "matrix/kernels/eigen_system.h"

#include <algorithm>
#include <cmath>
#include <numeric>
#include <utility>
#include <vector>

#include "util/math_routines.h"

namespace reisti::kernels {

namespace {

constexpr int kMaxIterations = 30;

// An off-diagonal element is negligible when it would vanish in the sum with its diagonal neighbours: half a unit in
// the last place of 1.
constexpr double kNegligible = 0x1p-53;

// Relative distance below which two values count as equal.
constexpr double kValueFuzz = 1e-12;

// The matrix as it is reduced: diagonal, element i of `below` left of diagonal i + 1, and the transposed orthogonal
// matrix of the similarity, one row for each vector.
struct Tridiagonal {
    std::vector<double> diagonal;
    std::vector<double> below;
    std::vector<double> rows;
};

// Householder reduction from the last row up, so that the part still to be reduced is a leading block of short rows.
// Afterwards row i of `a` left of the diagonal holds the reflection vector of that row, and norms[i] half its squared
// length, 0 where the row needed no reflection.
void reduce(std::vector<double>& a, std::size_t n, Tridiagonal& t, std::vector<double>& norms) {
    std::vector<double> p(n);
    for (std::size_t i = n; i-- > 1;) {
        double* const v = a.data() + i * n;
        const double beyond = std::inner_product(v, v + i - 1, v, 0.0);
        const double last = v[i - 1];
        if (beyond == 0.0) {
            t.below[i - 1] = last;
            continue;
        }
        const double squares = beyond + last * last;
        const double target = -mTransferSign(std::sqrt(squares), last);
        const double half = squares - last * target;
        t.below[i - 1] = target;
        norms[i] = half;
        v[i - 1] = last - target;

        std::fill_n(p.begin(), i, 0.0);
        for (std::size_t r = 0; r < i; ++r) {
            const double* const row = a.data() + r * n;
            for (std::size_t k = 0; k < r; ++k)
                p[k] += row[k] * v[r];
            p[r] += std::inner_product(row, row + r + 1, v, 0.0);
        }
        double common = 0.0;
        for (std::size_t k = 0; k < i; ++k) {
            p[k] /= half;
            common += p[k] * v[k];
        }
        common /= 2.0 * half;
        for (std::size_t k = 0; k < i; ++k)
            p[k] -= common * v[k];
        for (std::size_t r = 0; r < i; ++r) {
            double* const row = a.data() + r * n;
            for (std::size_t k = 0; k <= r; ++k)
                row[k] -= v[r] * p[k] + p[r] * v[k];
        }
    }
    for (std::size_t i = 0; i < n; ++i)
        t.diagonal[i] = a[i * n + i];
}

// Multiplies the reflections, first to last, into t.rows: with each the leading block grows by one.
void accumulate(const std::vector<double>& a, std::size_t n, const std::vector<double>& norms, Tridiagonal& t) {
    for (std::size_t i = 0; i < n; ++i) {
        t.rows[i * n + i] = 1.0;
        if (norms[i] == 0.0) continue;
        const double* const v = a.data() + i * n;
        for (std::size_t r = 0; r < i; ++r) {
            double* const row = t.rows.data() + r * n;
            const double factor = std::inner_product(v, v + i, row, 0.0) / norms[i];
            for (std::size_t k = 0; k < i; ++k)
                row[k] -= factor * v[k];
        }
    }
}

bool isZero(double x) {
    return mCompareWithFuzz(x, 0.0, 0.0, kValueFuzz) == 0;
}

// One QL sweep with implicit shift over diagonal elements l to m.
void sweep(Tridiagonal& t, std::size_t n, std::size_t l, std::size_t m) {
    double* const d = t.diagonal.data();
    double* const e = t.below.data();
    double g = (d[l + 1] - d[l]) / (2.0 * e[l]);
    g = d[m] - d[l] + e[l] / (g + mTransferSign(std::hypot(g, 1.0), g));
    double s = 1.0;
    double c = 1.0;
    double p = 0.0;
    for (std::size_t i = m; i-- > l;) {
        const double f = s * e[i];
        const double b = c * e[i];
        double r = std::hypot(f, g);
        e[i + 1] = r;
        if (isZero(r)) {
            // The matrix has split at i + 1; the next search finds it.
            d[i + 1] -= p;
            e[m] = 0.0;
            return;
        }
        s = f / r;
        c = g / r;
        g = d[i + 1] - p;
        r = (d[i] - g) * s + 2.0 * c * b;
        p = s * r;
        d[i + 1] = g + p;
        g = c * r - b;
        double* const upper = t.rows.data() + i * n;
        double* const lower = upper + n;
        for (std::size_t k = 0; k < n; ++k) {
            const double high = upper[k];
            const double low = lower[k];
            lower[k] = s * high + c * low;
            upper[k] = c * high - s * low;
        }
    }
    d[l] -= p;
    e[l] = g;
    e[m] = 0.0;
}

std::size_t findSplit(const Tridiagonal& t, std::size_t n, std::size_t l) {
    std::size_t m = l;
    while (m + 1 < n) {
        const double neighbours = std::fabs(t.diagonal[m]) + std::fabs(t.diagonal[m + 1]);
        if (mCompareWithFuzz(std::fabs(t.below[m]), neighbours * kNegligible, 0.0, kValueFuzz) <= 0) break;
        ++m;
    }
    return m;
}

// 0, or the index of the eigenvalue that did not converge.
bool diagonalize(Tridiagonal& t, std::size_t n, std::size_t& failed) {
    for (std::size_t l = 0; l < n; ++l) {
        for (int iteration = 0;; ++iteration) {
            const std::size_t m = findSplit(t, n, l);
            if (m == l) break;
            if (iteration == kMaxIterations) {
                failed = l;
                return false;
            }
            sweep(t, n, l, m);
        }
    }
    return true;
}

void sort(Tridiagonal& t, std::size_t n) {
    for (std::size_t i = 0; i < n; ++i) {
        std::size_t least = i;
        for (std::size_t j = i + 1; j < n; ++j) {
            if (mCompareWithFuzz(t.diagonal[j], t.diagonal[least], 0.0, kValueFuzz) < 0) least = j;
        }
        if (least == i) continue;
        std::swap(t.diagonal[i], t.diagonal[least]);
        double* const row = t.rows.data() + i * n;
        std::swap_ranges(row, row + n, t.rows.data() + least * n);
    }
}

}  // namespace

std::size_t eigenSystem(const double* a, std::size_t n, double* values, double* vectors) {
    Tridiagonal t{std::vector<double>(n), std::vector<double>(n), std::vector<double>(n * n)};
    std::vector<double> reduced(a, a + n * n);
    std::vector<double> norms(n);
    reduce(reduced, n, t, norms);
    accumulate(reduced, n, norms, t);
    std::size_t failed = 0;
    if (diagonalize(t, n, failed)) sort(t, n);
    std::copy(t.diagonal.begin(), t.diagonal.end(), values);
    for (std::size_t i = 0; i < n; ++i) {
        for (std::size_t k = 0; k < n; ++k)
            vectors[i * n + k] = t.rows[k * n + i];
    }
    return failed;
}

}  // namespace reisti::kernels
