// Linear algebra in the plainest loops that compute it: the oracle of the fast kernels. Each sum starts from 0.0 and
// takes its products in ascending order of the inner index.
#ifndef REISTI_TESTS_SUPPORT_PLAIN_LINEAR_ALGEBRA_H
#define REISTI_TESTS_SUPPORT_PLAIN_LINEAR_ALGEBRA_H

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <utility>
#include <vector>

namespace reisti::test {

/// Row-major.
struct PlainMatrix {
    PlainMatrix() = default;
    PlainMatrix(std::size_t rowCount, std::size_t colCount, double fill = 0.0)
        : rows(rowCount), cols(colCount), values(rowCount * colCount, fill) {}

    double& operator()(std::size_t i, std::size_t j) { return values[i * cols + j]; }
    double operator()(std::size_t i, std::size_t j) const { return values[i * cols + j]; }

    std::size_t rows = 0;
    std::size_t cols = 0;
    std::vector<double> values;
};

inline PlainMatrix plainTranspose(const PlainMatrix& a) {
    PlainMatrix t(a.cols, a.rows);
    for (std::size_t i = 0; i < a.rows; ++i) {
        for (std::size_t j = 0; j < a.cols; ++j)
            t(j, i) = a(i, j);
    }
    return t;
}

inline PlainMatrix plainProduct(const PlainMatrix& a, const PlainMatrix& b) {
    PlainMatrix c(a.rows, b.cols);
    for (std::size_t i = 0; i < a.rows; ++i) {
        for (std::size_t j = 0; j < b.cols; ++j) {
            double sum = 0.0;
            for (std::size_t k = 0; k < a.cols; ++k)
                sum += a(i, k) * b(k, j);
            c(i, j) = sum;
        }
    }
    return c;
}

struct PlainLu {
    bool succeeds = false;
    PlainMatrix factors;
    std::vector<int> index;
    double parity = 1.0;
};

inline bool isPlainlyZero(double x) {
    return std::fabs(x) < 4e-12 || std::fabs(x) * 4e-12 + 4e-12 > std::fabs(x);
}

/// Crout's method, column by column, with the rows scaled implicitly.
inline PlainLu plainLu(const PlainMatrix& matrix) {
    const std::size_t n = matrix.rows;
    PlainLu lu{false, matrix, std::vector<int>(n), 1.0};
    PlainMatrix& a = lu.factors;
    std::vector<double> scale(n);
    for (std::size_t i = 0; i < n; ++i) {
        double greatest = 0.0;
        for (std::size_t j = 0; j < n; ++j) {
            if (std::fabs(a(i, j)) > greatest) greatest = std::fabs(a(i, j));
        }
        if (isPlainlyZero(greatest)) return lu;
        scale[i] = 1.0 / greatest;
    }
    for (std::size_t j = 0; j < n; ++j) {
        for (std::size_t i = 0; i < n; ++i) {
            double sum = 0.0;
            for (std::size_t k = 0; k < std::min(i, j); ++k)
                sum += a(i, k) * a(k, j);
            a(i, j) -= sum;
        }
        double greatest = 0.0;
        std::size_t pivot = j;
        for (std::size_t i = j; i < n; ++i) {
            if (scale[i] * std::fabs(a(i, j)) >= greatest) {
                greatest = scale[i] * std::fabs(a(i, j));
                pivot = i;
            }
        }
        if (pivot != j) {
            for (std::size_t k = 0; k < n; ++k)
                std::swap(a(pivot, k), a(j, k));
            lu.parity = -lu.parity;
            scale[pivot] = scale[j];
        }
        lu.index[j] = static_cast<int>(pivot);
        if (isPlainlyZero(a(j, j))) return lu;
        if (j + 1 == n) break;
        const double reciprocal = 1.0 / a(j, j);
        for (std::size_t i = j + 1; i < n; ++i)
            a(i, j) *= reciprocal;
    }
    lu.succeeds = true;
    return lu;
}

inline std::vector<double> plainLuSolve(const PlainMatrix& lu, const std::vector<int>& index, std::vector<double> b) {
    const std::size_t n = lu.rows;
    bool hasStarted = false;
    std::size_t first = 0;
    for (std::size_t i = 0; i < n; ++i) {
        const auto pivot = static_cast<std::size_t>(index[i]);
        double sum = b[pivot];
        b[pivot] = b[i];
        if (hasStarted) {
            for (std::size_t k = first; k < i; ++k)
                sum -= lu(i, k) * b[k];
        } else if (sum != 0.0) {
            hasStarted = true;
            first = i;
        }
        b[i] = sum;
    }
    for (std::size_t i = n; i-- > 0;) {
        double sum = 0.0;
        for (std::size_t k = i + 1; k < n; ++k)
            sum += lu(i, k) * b[k];
        b[i] = (b[i] - sum) / lu(i, i);
    }
    return b;
}

struct PlainCholesky {
    std::ptrdiff_t failedRow = -1;
    double pivot = 0.0;
    PlainMatrix factor;  // upper triangle
};

/// Column by column on the upper triangle; rows above `start` are factorised already.
inline PlainCholesky plainCholesky(const PlainMatrix& upper, std::size_t start) {
    PlainCholesky result{-1, 0.0, upper};
    PlainMatrix& u = result.factor;
    for (std::size_t j = start; j < u.rows; ++j) {
        double squares = 0.0;
        for (std::size_t i = 0; i < j; ++i) {
            if (i >= start) {
                double sum = 0.0;
                for (std::size_t k = 0; k < i; ++k)
                    sum += u(k, i) * u(k, j);
                u(i, j) = (u(i, j) - sum) / u(i, i);
            }
            squares += u(i, j) * u(i, j);
        }
        result.pivot = u(j, j) - squares;
        if (0.0 >= result.pivot) {
            result.pivot = std::fabs(result.pivot);
            result.failedRow = static_cast<std::ptrdiff_t>(j);
            return result;
        }
        u(j, j) = std::sqrt(result.pivot);
    }
    return result;
}

/// The inverse of U^T U in two sweeps over one triangle: first U is inverted column by column, then multiplied by its
/// transpose.
inline PlainMatrix plainCholeskyInverse(const PlainMatrix& u) {
    const std::size_t n = u.rows;
    PlainMatrix s(n, n);
    // Element (i, j) of the symmetric matrix, wherever it is looked up.
    const auto at = [&s](std::size_t i, std::size_t j) -> double& { return s(std::min(i, j), std::max(i, j)); };
    const auto scaleColumn = [&at](double k, std::size_t column, std::size_t count) {
        for (std::size_t i = 0; i < count; ++i)
            at(i, column) *= k;
    };
    const auto addColumn = [&at](double k, std::size_t from, std::size_t to, std::size_t count) {
        for (std::size_t i = 0; i < count; ++i)
            at(i, to) += k * at(i, from);
    };
    for (std::size_t i = 0; i < n; ++i) {
        for (std::size_t j = i; j < n; ++j)
            at(i, j) = u(i, j);
    }
    for (std::size_t j = 0; j < n; ++j) {
        const double reciprocal = 1.0 / at(j, j);
        at(j, j) = reciprocal;
        scaleColumn(-reciprocal, j, j);
        for (std::size_t m = j + 1; m < n; ++m) {
            const double factor = at(j, m);
            at(j, m) = 0.0;
            addColumn(factor, j, m, j + 1);
        }
    }
    for (std::size_t j = 0; j < n; ++j) {
        for (std::size_t i = 0; i < j; ++i)
            addColumn(at(i, j), j, i, i + 1);
        scaleColumn(at(j, j), j, j + 1);
    }
    for (std::size_t i = 0; i < n; ++i) {
        for (std::size_t j = 0; j < i; ++j)
            s(i, j) = s(j, i);
    }
    return s;
}

/// The upper triangle row by row, as packed storage holds it.
inline std::vector<double> packUpper(const PlainMatrix& a) {
    std::vector<double> packed;
    for (std::size_t i = 0; i < a.rows; ++i)
        packed.insert(packed.end(), &a.values[i * a.cols + i], &a.values[i * a.cols] + a.cols);
    return packed;
}

/// The lower triangle row by row.
inline std::vector<double> packLower(const PlainMatrix& a) {
    std::vector<double> packed;
    for (std::size_t i = 0; i < a.rows; ++i)
        packed.insert(packed.end(), &a.values[i * a.cols], &a.values[i * a.cols] + i + 1);
    return packed;
}

}  // namespace reisti::test

#endif
