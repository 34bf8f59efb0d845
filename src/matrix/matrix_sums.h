// Sums and differences across the matrix kinds and with vectors. Positions outside the pattern of a structured operand
// count as 0. A sum of two dense matrices is a member of the dense matrix.
#ifndef REISTI_MATRIX_MATRIX_SUMS_H
#define REISTI_MATRIX_MATRIX_SUMS_H

#include <vector>

#include "matrix/matrix_new.h"

namespace qan::matrix_library {

matrix<double> operator+(const matrix<double>& a, const Dmatrix<double>& b);
matrix<double> operator+(const matrix<double>& a, const Smatrix<double>& b);
matrix<double> operator+(const matrix<double>& a, const UTmatrix<double>& b);
matrix<double> operator+(const Dmatrix<double>& a, const matrix<double>& b);
matrix<double> operator+(const Smatrix<double>& a, const matrix<double>& b);
matrix<double> operator+(const UTmatrix<double>& a, const matrix<double>& b);
matrix<double> operator+(const Smatrix<double>& a, const UTmatrix<double>& b);
matrix<double> operator+(const UTmatrix<double>& a, const Smatrix<double>& b);
Smatrix<double> operator+(const Dmatrix<double>& a, const Smatrix<double>& b);
Smatrix<double> operator+(const Smatrix<double>& a, const Dmatrix<double>& b);
Smatrix<double> operator+(const Smatrix<double>& a, const Smatrix<double>& b);
UTmatrix<double> operator+(const Dmatrix<double>& a, const UTmatrix<double>& b);
UTmatrix<double> operator+(const UTmatrix<double>& a, const Dmatrix<double>& b);
UTmatrix<double> operator+(const UTmatrix<double>& a, const UTmatrix<double>& b);
Dmatrix<double> operator+(const Dmatrix<double>& a, const Dmatrix<double>& b);

matrix<double> operator-(const matrix<double>& a, const Dmatrix<double>& b);
matrix<double> operator-(const matrix<double>& a, const Smatrix<double>& b);
matrix<double> operator-(const matrix<double>& a, const UTmatrix<double>& b);
matrix<double> operator-(const Dmatrix<double>& a, const matrix<double>& b);
matrix<double> operator-(const Smatrix<double>& a, const matrix<double>& b);
matrix<double> operator-(const UTmatrix<double>& a, const matrix<double>& b);
matrix<double> operator-(const Smatrix<double>& a, const UTmatrix<double>& b);
matrix<double> operator-(const UTmatrix<double>& a, const Smatrix<double>& b);
Smatrix<double> operator-(const Dmatrix<double>& a, const Smatrix<double>& b);
Smatrix<double> operator-(const Smatrix<double>& a, const Dmatrix<double>& b);
Smatrix<double> operator-(const Smatrix<double>& a, const Smatrix<double>& b);
UTmatrix<double> operator-(const Dmatrix<double>& a, const UTmatrix<double>& b);
UTmatrix<double> operator-(const UTmatrix<double>& a, const Dmatrix<double>& b);
UTmatrix<double> operator-(const UTmatrix<double>& a, const UTmatrix<double>& b);
Dmatrix<double> operator-(const Dmatrix<double>& a, const Dmatrix<double>& b);

matrix<double>& operator+=(matrix<double>& a, const Dmatrix<double>& b);

// The matrix must be a single column as long as the vector.
matrix<double>& operator+=(matrix<double>& a, const std::vector<double>& v);
matrix<double>& operator-=(matrix<double>& a, const std::vector<double>& v);
matrix<double> operator+(const matrix<double>& a, const std::vector<double>& v);
matrix<double> operator+(const std::vector<double>& v, const matrix<double>& a);
matrix<double> operator-(const matrix<double>& a, const std::vector<double>& v);

}  // namespace qan::matrix_library

#endif
