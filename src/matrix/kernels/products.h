// Dense products on row-major arrays.
//
// Every element of a product is the sum over k, ascending, of rounded products, starting from 0.0: bit for bit what
// three nested loops give, whatever the shape and the processor. Products are therefore never fused into the sum, and
// zeros are never skipped (0 times infinity is NaN). The arrays must not overlap.
#ifndef REISTI_MATRIX_KERNELS_PRODUCTS_H
#define REISTI_MATRIX_KERNELS_PRODUCTS_H

#include <cstddef>

#include "matrix/kernels/level.h"

namespace reisti::kernels {

// c (m x n) = a (m x k) * b (k x n). With k = 0 every element is 0.0.
void product(const double* a, const double* b, double* c, std::size_t m, std::size_t k, std::size_t n);

// c (m x n) = transpose of a (k x m) * b (k x n).
void productLeftTransposed(const double* a, const double* b, double* c, std::size_t m, std::size_t k, std::size_t n);

// c (m x n) = a (m x k) * transpose of b (n x k).
void productRightTransposed(const double* a, const double* b, double* c, std::size_t m, std::size_t k, std::size_t n);

// c (m x n) += a (m x k) * b (k x n), rows the given strides apart. Each sum goes on from the value in c, so that a
// product may be computed in several calls with ascending ranges of k.
void accumulateProduct(const double* a, std::size_t aStride, const double* b, std::size_t bStride, double* c,
                       std::size_t cStride, std::size_t m, std::size_t k, std::size_t n);

}  // namespace reisti::kernels

#endif
