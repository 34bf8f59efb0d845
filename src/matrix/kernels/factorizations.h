// Factorizations on plain arrays, and what is computed from the factors.
//
// Every sum is formed from 0.0 in ascending order of its inner index and then subtracted, whatever the order of the
// matrix and the processor: bit for bit what the plain loops give, so that no pivot and no verdict of singularity
// depends on how the work was cut into blocks.
#ifndef REISTI_MATRIX_KERNELS_FACTORIZATIONS_H
#define REISTI_MATRIX_KERNELS_FACTORIZATIONS_H

#include <cstddef>

namespace reisti::kernels {

// Replaces the row-major n x n array a by its factors, Crout's method with implicit row scaling: L without its unit
// diagonal, and U. At step j rows j and index[j] are swapped; parity becomes +1.0 or -1.0. False when a row or a pivot
// is zero within 4e-12; a is of no use then.
bool factorLu(double* a, std::size_t n, int* index, double& parity);

// Solves for one right-hand side, in place. The diagonal is not tested.
void solveLu(const double* lu, const int* index, std::size_t n, double* b);

// Solves for the columns of b (row-major n x columns), in place, each to the same bits as solveLu gives.
void solveLuColumns(const double* lu, const int* index, std::size_t n, double* b, std::size_t columns);

// The inverse: the solutions for the unit columns.
void invertLu(const double* lu, const int* index, std::size_t n, double* inverse);

// Replaces the packed upper triangle a (row i holds columns i to n - 1) by the factor U of A = U^T U. Rows above start
// are factorised already. Returns -1 and the last pivot, or, when a pivot is not positive, its row and its magnitude;
// then the columns up to its own are done above it, and it and the later columns are as they were.
std::ptrdiff_t factorCholesky(double* a, std::size_t n, std::size_t start, double& pivot);

// The inverse of U^T U as a packed lower triangle (row i holds columns 0 to i), for the packed upper triangle u. The
// two arrays must not overlap.
void invertCholesky(const double* u, std::size_t n, double* inverse);

// Solves U^T U x = b for the packed upper triangle u, in place. The diagonal is not tested.
void solveCholesky(const double* u, std::size_t n, double* b);

}  // namespace reisti::kernels

#endif
