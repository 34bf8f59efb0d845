// Linear algebra in the plainest loops that compute it: the oracle of the fast kernels. Each sum starts from 0.0 and
// takes its products in ascending order of the inner index.
#ifndef REISTI_TESTS_SUPPORT_PLAIN_LINEAR_ALGEBRA_H
#define REISTI_TESTS_SUPPORT_PLAIN_LINEAR_ALGEBRA_H

#include <cstddef>
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

}  // namespace reisti::test

#endif
