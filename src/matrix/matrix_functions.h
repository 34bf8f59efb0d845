// Decompositions and solvers: Cholesky, inverses, determinants, eigen-systems.
//
// Every solver comes in two forms: one reports failure by returning false and leaves its output empty, the other throws
// MatrixSingular. An output may be the input itself. No tolerance is hidden in these functions: what counts as singular
// is said at each.
#ifndef REISTI_MATRIX_MATRIX_FUNCTIONS_H
#define REISTI_MATRIX_MATRIX_FUNCTIONS_H

#include <vector>

#include "matrix/matrix_new.h"

namespace qan::matrix_library {

// The factor U of A = U^T U, for the matrix whose upper triangle is a. Rows above `start` are taken as already
// factorised. A pivot that is not positive (exactly; no tolerance) ends the work: *failedRow gets its row, *pivot its
// magnitude; above it the columns up to its own hold U, and it and the later columns are still those of a. On success
// *failedRow is -1 and *pivot the last pivot. MatrixException when start exceeds the order.
UTmatrix<double> CholeskyDecomp(const UTmatrix<double>& a, int start, int* failedRow, double* pivot);
// False, with an empty result, when a is not positive definite.
bool CholeskyDecomp(const Smatrix<double>& a, UTmatrix<double>* result);
UTmatrix<double> CholeskyDecompWithThrow(const Smatrix<double>& a);

// The inverse of A = U^T U. A zero on the diagonal of u is not tested for and yields infinities.
Smatrix<double> CholeskyInverse(const UTmatrix<double>& u);
// Solves U^T U x = b. MatrixException when the length of b is not the order; a zero diagonal is not tested for.
std::vector<double> CholeskyBackSub(const UTmatrix<double>& u, const std::vector<double>& b);

// By Cholesky; false when a is not positive definite.
bool inverse(const Smatrix<double>& a, Smatrix<double>* result);
Smatrix<double> inverseWithThrow(const Smatrix<double>& a);
// By LUDecomposition; false when that finds the matrix singular.
bool inverse(const matrix<double>& a, matrix<double>* result);
matrix<double> inverseWithThrow(const matrix<double>& a);
// False when an element of the diagonal is exactly 0.
bool inverse(const Dmatrix<double>& a, Dmatrix<double>* result);
Dmatrix<double> inverseWithThrow(const Dmatrix<double>& a);

// By LUDecomposition; 0.0 and false when that finds the matrix singular.
bool determinant(const matrix<double>& a, double* det);
bool determinant(const Smatrix<double>& a, double* det);
double determinantWithThrow(const matrix<double>& a);
double determinantWithThrow(const Smatrix<double>& a);

// Eigenvalues, ascending, and eigenvectors, in the columns of `vectors`, of a symmetric matrix (the lower triangle is
// read). Values that differ by less than 1e-12 of the greater count as equal and keep the order in which they were
// found. Returns 0, or the index of an eigenvalue that did not converge in 30 iterations, which may be 0 as well; the
// outputs then hold what there was. Infinite or NaN elements end that way.
int EigenSystems(const matrix<double>& a, std::vector<double>& values, matrix<double>& vectors);

// Columns of the symmetric matrix, through its symmetric index, of which rows 0 to count - 1 take part:
// s(i, col) *= k, and s(i, dst) += k * s(i, src). MatrixException when count exceeds the order.
void KTimesColumn(Smatrix<double>& s, double k, int col, int count);
void KTimesColumnPlusColumn(Smatrix<double>& s, double k, int src, int dst, int count);

// The members of the kinds that call the functions above.

template <typename T>
template <std::same_as<double> U>
int matrix<T>::EigenSystems(std::vector<U>& values, matrix<U>& vectors) const {
    return matrix_library::EigenSystems(*this, values, vectors);
}

template <typename T>
Dmatrix<T> Dmatrix<T>::inverse(Dmatrix* result) const {
    return Dmatrix(matrix_library::inverse(*this, result) ? 1 : 0, T());
}

template <typename T>
UTmatrix<T> UTmatrix<T>::CholeskyDecomp(int start, int* failedRow, double* pivot) const {
    return matrix_library::CholeskyDecomp(*this, start, failedRow, pivot);
}

template <typename T>
std::vector<T> UTmatrix<T>::CholeskyBackSub(const std::vector<T>& b) const {
    return matrix_library::CholeskyBackSub(*this, b);
}

template <typename T>
Smatrix<T> UTmatrix<T>::CholeskyInverse() const {
    return matrix_library::CholeskyInverse(*this);
}

template <typename T>
bool Smatrix<T>::CholeskyDecomp(UTmatrix<T>* factor) const {
    return matrix_library::CholeskyDecomp(*this, factor);
}

}  // namespace qan::matrix_library

#endif
