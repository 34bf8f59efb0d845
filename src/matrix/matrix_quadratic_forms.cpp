#include "matrix/matrix_quadratic_forms.h"

#include "matrix/matrix_exceptions.h"
#include "matrix/matrix_functions.h"
#include "matrix/matrix_products.h"
#include "matrix/matrix_sums.h"

namespace qan::matrix_library {

namespace {

void checkSquare(const matrix<double>& a) {
    if (a.rowCount() != a.colCount()) {
        throw MatrixException("matrix::quadratic form is only defined for square matrices");
    }
}

double dotProduct(const double* x, const double* y, std::size_t length) {
    double sum = 0.0;
    for (std::size_t i = 0; i < length; ++i) {
        sum += x[i] * y[i];
    }
    return sum;
}

template <typename Kind>
double formOf(const Kind& a, const std::vector<double>& x) {
    if (x.size() != static_cast<std::size_t>(a.rowCount())) {
        throw MatrixException("matrix::matrix and vector have incompatible dimensions");
    }
    const matrix<double> image = a * x;
    return dotProduct(x.data(), image.data(), x.size());
}

template <typename Kind>
double distanceOf(const Kind& a, const matrix<double>& b, const std::vector<double>& x, const std::vector<double>& y) {
    const std::vector<double> residual = b * x - y;
    matrix<double> covariance;
    multiplyRightTranspose(b * a, b, covariance);
    const UTmatrix<double> factor = CholeskyDecompWithThrow(Smatrix<double>(covariance));
    const std::vector<double> solution = CholeskyBackSub(factor, residual);
    return dotProduct(residual.data(), solution.data(), residual.size());
}

}  // namespace

double mQuadraticForm(const matrix<double>& a, const std::vector<double>& x) {
    checkSquare(a);
    return formOf(a, x);
}

double mQuadraticForm(const Smatrix<double>& a, const std::vector<double>& x) {
    return formOf(a, x);
}

double mQuadraticForm(const matrix<double>& a, const matrix<double>& b, const std::vector<double>& x,
                      const std::vector<double>& y) {
    checkSquare(a);
    return distanceOf(a, b, x, y);
}

double mQuadraticForm(const Smatrix<double>& a, const matrix<double>& b, const std::vector<double>& x,
                      const std::vector<double>& y) {
    return distanceOf(a, b, x, y);
}

}  // namespace qan::matrix_library
