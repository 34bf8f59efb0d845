// Products across the matrix kinds, with vectors and with scalars.
//
// Every element of a product is a sum over k, ascending, from 0.0, of rounded products: the value of three nested
// loops, bit for bit. Zeros of a dense operand count (0 times infinity is no number); positions outside the pattern of
// a structured operand contribute nothing.
#ifndef REISTI_MATRIX_MATRIX_PRODUCTS_H
#define REISTI_MATRIX_MATRIX_PRODUCTS_H

#include <vector>

#include "matrix/matrix_new.h"

namespace qan::matrix_library {

matrix<double> operator*(const matrix<double>& a, const matrix<double>& b);
matrix<double> operator*(const matrix<double>& a, const Smatrix<double>& b);
matrix<double> operator*(const matrix<double>& a, const UTmatrix<double>& b);
matrix<double> operator*(const matrix<double>& a, const Dmatrix<double>& b);
matrix<double> operator*(const Smatrix<double>& a, const matrix<double>& b);
matrix<double> operator*(const Smatrix<double>& a, const Smatrix<double>& b);
matrix<double> operator*(const Smatrix<double>& a, const UTmatrix<double>& b);
matrix<double> operator*(const Smatrix<double>& a, const Dmatrix<double>& b);
matrix<double> operator*(const UTmatrix<double>& a, const matrix<double>& b);
matrix<double> operator*(const UTmatrix<double>& a, const Smatrix<double>& b);
UTmatrix<double> operator*(const UTmatrix<double>& a, const UTmatrix<double>& b);
UTmatrix<double> operator*(const UTmatrix<double>& a, const Dmatrix<double>& b);
matrix<double> operator*(const Dmatrix<double>& a, const matrix<double>& b);
matrix<double> operator*(const Dmatrix<double>& a, const Smatrix<double>& b);
UTmatrix<double> operator*(const Dmatrix<double>& a, const UTmatrix<double>& b);
Dmatrix<double> operator*(const Dmatrix<double>& a, const Dmatrix<double>& b);

matrix<double>& operator*=(matrix<double>& a, const matrix<double>& b);
Dmatrix<double>& operator*=(Dmatrix<double>& a, const Dmatrix<double>& b);

// The vector is a column.
matrix<double> operator*(const matrix<double>& a, const std::vector<double>& v);
matrix<double> operator*(const Smatrix<double>& a, const std::vector<double>& v);
matrix<double>& operator*=(matrix<double>& a, const std::vector<double>& v);

// A dense matrix times a scalar is a member of the dense matrix.
matrix<double> operator*(double x, const matrix<double>& a);
Smatrix<double> operator*(double x, const Smatrix<double>& a);
Smatrix<double> operator*(const Smatrix<double>& a, double x);
UTmatrix<double> operator*(double x, const UTmatrix<double>& a);
UTmatrix<double> operator*(const UTmatrix<double>& a, double x);
Dmatrix<double> operator*(double x, const Dmatrix<double>& a);
Dmatrix<double> operator*(const Dmatrix<double>& a, double x);

// c = transpose of a, times b; and c = a times the transpose of b. c may be a or b. That the shared dimensions agree is
// deliberately not checked.
void multiplyLeftTranspose(const matrix<double>& a, const matrix<double>& b, matrix<double>& c);
void multiplyRightTranspose(const matrix<double>& a, const matrix<double>& b, matrix<double>& c);

// a * b by three nested loops: what the other products are measured against.
matrix<double> SlowMatrixMultiply(const matrix<double>& a, const matrix<double>& b);

}  // namespace qan::matrix_library

#endif
