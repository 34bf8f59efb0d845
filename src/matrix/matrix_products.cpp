#include "matrix/matrix_products.h"

#include <utility>

#include "matrix/kernels/products.h"
#include "matrix/matrix_checks.h"
#include "matrix/vector_kernels.h"

namespace qan::matrix_library {

namespace {

namespace kernels = reisti::kernels;

std::size_t length(int dimension) {
    return static_cast<std::size_t>(dimension);
}

matrix<double> denseTimesColumn(const matrix<double>& a, const double* column) {
    matrix<double> result(a.rowCount(), 1, 0.0);
    timesColumn(a.data(), length(a.rowCount()), length(a.colCount()), column, result.data());
    return result;
}

// The kind stays: what the pattern leaves out is not touched.
template <typename Kind>
Kind scaled(const Kind& a, double x, int storedElements) {
    Kind result(a);
    double* const element = result.data();
    for (int k = 0; k < storedElements; ++k) {
        element[k] *= x;
    }
    return result;
}

}  // namespace

matrix<double> operator*(const matrix<double>& a, const matrix<double>& b) {
    checkMultiplyDimensions(a, b);
    if (b.colCount() == 1) return denseTimesColumn(a, b.data());
    matrix<double> result(a.rowCount(), b.colCount(), 0.0);
    kernels::product(a.data(), b.data(), result.data(), length(a.rowCount()), length(a.colCount()),
                     length(b.colCount()));
    return result;
}

matrix<double>& operator*=(matrix<double>& a, const matrix<double>& b) {
    a = a * b;
    return a;
}

matrix<double> operator*(const matrix<double>& a, const std::vector<double>& v) {
    if (v.size() != length(a.colCount())) throw MatrixException("matrix and vector must be of same order");
    return denseTimesColumn(a, v.data());
}

matrix<double>& operator*=(matrix<double>& a, const std::vector<double>& v) {
    a = a * v;
    return a;
}

matrix<double> operator*(double x, const matrix<double>& a) {
    return a * x;
}
Smatrix<double> operator*(double x, const Smatrix<double>& a) {
    return scaled(a, x, a.size());
}
Smatrix<double> operator*(const Smatrix<double>& a, double x) {
    return scaled(a, x, a.size());
}
UTmatrix<double> operator*(double x, const UTmatrix<double>& a) {
    return a * x;
}
UTmatrix<double> operator*(const UTmatrix<double>& a, double x) {
    return scaled(a, x, UTmatrix<double>::calculate_size(a.rowCount()));
}
Dmatrix<double> operator*(double x, const Dmatrix<double>& a) {
    return scaled(a, x, a.rowCount());
}
Dmatrix<double> operator*(const Dmatrix<double>& a, double x) {
    return scaled(a, x, a.rowCount());
}

void multiplyLeftTranspose(const matrix<double>& a, const matrix<double>& b, matrix<double>& c) {
    assert(a.rowCount() == b.rowCount());
    if (&c == &a || &c == &b) {
        matrix<double> result;
        multiplyLeftTranspose(a, b, result);
        c.swap(result);
        return;
    }
    c.ResizeStorage(a.colCount(), b.colCount(), 0.0);
    kernels::productLeftTransposed(a.data(), b.data(), c.data(), length(a.colCount()), length(a.rowCount()),
                                   length(b.colCount()));
}

void multiplyRightTranspose(const matrix<double>& a, const matrix<double>& b, matrix<double>& c) {
    assert(a.colCount() == b.colCount());
    if (&c == &a || &c == &b) {
        matrix<double> result;
        multiplyRightTranspose(a, b, result);
        c.swap(result);
        return;
    }
    c.ResizeStorage(a.rowCount(), b.rowCount(), 0.0);
    kernels::productRightTransposed(a.data(), b.data(), c.data(), length(a.rowCount()), length(a.colCount()),
                                    length(b.rowCount()));
}

matrix<double> SlowMatrixMultiply(const matrix<double>& a, const matrix<double>& b) {
    checkMultiplyDimensions(a, b);
    matrix<double> result(a.rowCount(), b.colCount(), 0.0);
    for (int i = 0; i < a.rowCount(); ++i) {
        for (int j = 0; j < b.colCount(); ++j) {
            double sum = 0.0;
            for (int k = 0; k < a.colCount(); ++k) {
                sum += a(i, k) * b(k, j);
            }
            result(i, j) = sum;
        }
    }
    return result;
}

}  // namespace qan::matrix_library
