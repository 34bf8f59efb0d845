// Products of stored rows with one vector, element by element in the order of the plain loops.
#ifndef REISTI_MATRIX_VECTOR_KERNELS_H
#define REISTI_MATRIX_VECTOR_KERNELS_H

#include <cstddef>

namespace qan::matrix_library {

// y (rows) = a (rows x cols, row by row) * x.
void timesColumn(const double* a, std::size_t rows, std::size_t cols, const double* x, double* y);

// y = s * x for the packed lower triangle s of a symmetric matrix; every stored element is read once.
void symmetricTimesColumn(const double* s, std::size_t order, const double* x, double* y);

// y = u * x, and y = x * u for x as a row, for the packed upper triangle u.
void upperTimesColumn(const double* u, std::size_t order, const double* x, double* y);
void rowTimesUpper(const double* x, const double* u, std::size_t order, double* y);

}  // namespace qan::matrix_library

#endif
