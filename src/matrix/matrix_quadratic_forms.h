// Quadratic forms.
#ifndef REISTI_MATRIX_MATRIX_QUADRATIC_FORMS_H
#define REISTI_MATRIX_MATRIX_QUADRATIC_FORMS_H

#include <vector>

#include "matrix/matrix_new.h"

namespace qan::matrix_library {

// x^T a x for a square a; MatrixException when a is not square or x not as long as the order.
double mQuadraticForm(const matrix<double>& a, const std::vector<double>& x);
double mQuadraticForm(const Smatrix<double>& a, const std::vector<double>& x);

// r^T V^-1 r with r = b x - y and V = b a b^T: the squared distance of b x from y where x has the covariance a.
// MatrixSingular when V is not positive definite; MatrixException when a is not square, V not symmetric, or dimensions
// do not fit.
double mQuadraticForm(const matrix<double>& a, const matrix<double>& b, const std::vector<double>& x,
                      const std::vector<double>& y);
double mQuadraticForm(const Smatrix<double>& a, const matrix<double>& b, const std::vector<double>& x,
                      const std::vector<double>& y);

// The members of the kinds that call the functions above.

template <typename T>
template <std::same_as<double> U>
U matrix<T>::mQuadraticForm(const std::vector<U>& x) const {
    return matrix_library::mQuadraticForm(*this, x);
}

template <typename T>
template <std::same_as<double> U>
U matrix<T>::mQuadraticForm(const matrix<U>& b, const std::vector<U>& x, const std::vector<U>& y) const {
    return matrix_library::mQuadraticForm(*this, b, x, y);
}

template <typename T>
T Smatrix<T>::mQuadraticForm(const std::vector<T>& x) const {
    return matrix_library::mQuadraticForm(*this, x);
}

template <typename T>
T Smatrix<T>::mQuadraticForm(const matrix<T>& b, const std::vector<T>& x, const std::vector<T>& y) const {
    return matrix_library::mQuadraticForm(*this, b, x, y);
}

}  // namespace qan::matrix_library

#endif
