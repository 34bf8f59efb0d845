// Products with a small triangle, whose other half is never read.
#ifndef REISTI_MATRIX_KERNELS_TRIANGLES_H
#define REISTI_MATRIX_KERNELS_TRIANGLES_H

#include <cstddef>

namespace reisti::kernels {

// The greatest order of a triangle.
inline constexpr std::size_t kSmallTriangle = 8;

// c (k x n) += the upper triangle of a (k x k) * b (k x n). As in accumulateProduct each sum goes on from the value in
// c.
void accumulateUpperLeft(const double* a, std::size_t aStride, const double* b, std::size_t bStride, double* c,
                         std::size_t cStride, std::size_t k, std::size_t n);

// c (m x k) += a (m x k) * the upper triangle of b (k x k).
void accumulateUpperRight(const double* a, std::size_t aStride, const double* b, std::size_t bStride, double* c,
                          std::size_t cStride, std::size_t m, std::size_t k);

}  // namespace reisti::kernels

#endif
