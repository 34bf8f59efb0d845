// Products with a diagonal, on rows that lie in the cache. A product of one term is still a sum that starts from 0.0:
// minus zero becomes zero.
#ifndef REISTI_MATRIX_KERNELS_SCALING_H
#define REISTI_MATRIX_KERNELS_SCALING_H

#include <cstddef>

namespace reisti::kernels {

// row[j] = 0.0 + factor * row[j].
void scaleRow(double* row, double factor, std::size_t n);

// row[j] = 0.0 + row[j] * factors[j].
void scaleElements(double* row, const double* factors, std::size_t n);

}  // namespace reisti::kernels

#endif
