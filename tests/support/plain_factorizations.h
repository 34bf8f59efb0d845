#ifndef REISTI_TESTS_SUPPORT_PLAIN_FACTORIZATIONS_H
#define REISTI_TESTS_SUPPORT_PLAIN_FACTORIZATIONS_H

#include <cmath>
#include <cstddef>
#include <optional>
#include <utility>
#include <vector>

#include "support/plain_matrix.h"

namespace reisti::test {

/// The plain loops of the triangular factorizations. Every sum is formed from zero over ascending k and then
/// subtracted, so that a pivot, and with it the verdict "singular", does not depend on how faster loops are blocked.

struct PlainCholesky {
    PlainMatrix factor;           ///< upper triangle; partly factorized after a failure
    int failedRow = -1;           ///< -1: success
    std::optional<double> pivot;  ///< the last one formed, its magnitude after a failure; none when there was no column
};

/// Factorizes the matrix whose upper triangle is `a`; the rows above `start` are taken as already factorized.
inline PlainCholesky plainCholesky(const PlainMatrix& a, int start = 0) {
    PlainCholesky result;
    result.factor = a;
    PlainMatrix& u = result.factor;
    for (int i = 0; i < a.rows; ++i)
        for (int j = 0; j < i; ++j)
            u(i, j) = 0.0;
    for (int j = start; j < a.rows; ++j) {
        double squares = 0.0;
        for (int i = 0; i < j; ++i) {
            if (i >= start) {
                double sum = 0.0;
                for (int k = 0; k < i; ++k)
                    sum += u(k, i) * u(k, j);
                u(i, j) = (a(i, j) - sum) / u(i, i);
            }
            squares += u(i, j) * u(i, j);
        }
        const double pivot = a(j, j) - squares;
        result.pivot = pivot;
        if (0.0 >= pivot) {
            result.failedRow = j;
            result.pivot = std::fabs(pivot);
            return result;
        }
        u(j, j) = std::sqrt(pivot);
    }
    return result;
}

/// Whether LU decomposition takes `value` for zero.
inline bool plainLuZero(double value) {
    constexpr double kFuzz = 4e-12;
    const double magnitude = std::fabs(value);
    return magnitude < kFuzz || magnitude * kFuzz + kFuzz > magnitude;
}

struct PlainLu {
    PlainMatrix factors;     ///< unit lower and upper triangle in one square; 0 by 0 when singular
    std::vector<int> index;  ///< row swapped with row j at step j
    double parity = 1.0;
    bool singular = false;

    static PlainLu failed() {
        PlainLu result;
        result.singular = true;
        return result;
    }
};

/// Crout's method with implicit scaling of the rows.
inline PlainLu plainLu(const PlainMatrix& source) {
    const int n = source.rows;
    PlainLu result;
    result.factors = source;
    result.index.assign(static_cast<std::size_t>(n), 0);
    PlainMatrix& a = result.factors;
    std::vector<double> scale(static_cast<std::size_t>(n));
    for (int i = 0; i < n; ++i) {
        double largest = 0.0;
        for (int j = 0; j < n; ++j)
            largest = std::fmax(largest, std::fabs(a(i, j)));
        if (plainLuZero(largest)) return PlainLu::failed();
        scale[static_cast<std::size_t>(i)] = 1.0 / largest;
    }
    for (int j = 0; j < n; ++j) {
        const auto subtractProducts = [&](int i, int terms) {
            double sum = 0.0;
            for (int k = 0; k < terms; ++k)
                sum += a(i, k) * a(k, j);
            a(i, j) -= sum;
        };
        for (int i = 0; i < j; ++i)
            subtractProducts(i, i);
        int chosen = j;
        double best = 0.0;
        for (int i = j; i < n; ++i) {
            subtractProducts(i, j);
            const double candidate = scale[static_cast<std::size_t>(i)] * std::fabs(a(i, j));
            if (candidate >= best) {
                best = candidate;
                chosen = i;
            }
        }
        if (chosen != j) {
            for (int k = 0; k < n; ++k)
                std::swap(a(chosen, k), a(j, k));
            result.parity = -result.parity;
            scale[static_cast<std::size_t>(chosen)] = scale[static_cast<std::size_t>(j)];
        }
        result.index[static_cast<std::size_t>(j)] = chosen;
        if (plainLuZero(a(j, j))) return PlainLu::failed();
        if (j < n - 1) {
            const double reciprocal = 1.0 / a(j, j);
            for (int i = j + 1; i < n; ++i)
                a(i, j) *= reciprocal;
        }
    }
    return result;
}

}  // namespace reisti::test

#endif
