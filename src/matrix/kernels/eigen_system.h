// Eigenvalues and eigenvectors of a symmetric array.
#ifndef REISTI_MATRIX_KERNELS_EIGEN_SYSTEM_H
#define REISTI_MATRIX_KERNELS_EIGEN_SYSTEM_H

#include <cstddef>

#include "matrix/kernels/level.h"

namespace reisti::kernels {

// a: row-major n x n, of which the lower triangle is read. values gets the eigenvalues, ascending; column k of vectors
// (row-major n x n) the eigenvector of values[k]. Returns 0, or the index of an eigenvalue that did not converge in 30
// iterations (possibly 0). The outputs must not overlap with a.
std::size_t eigenSystem(const double* a, std::size_t n, double* values, double* vectors);

// The same at a level that must be available; to the same bits.
std::size_t eigenSystem(Level level, const double* a, std::size_t n, double* values, double* vectors);

}  // namespace reisti::kernels

#endif
