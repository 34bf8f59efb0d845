#include "matrix/kernels/triangles.h"

#include "matrix/kernels/level_table.h"

namespace reisti::kernels {

void accumulateUpperLeft(const double* a, std::size_t aStride, const double* b, std::size_t bStride, double* c,
                         std::size_t cStride, std::size_t k, std::size_t n) {
    bestTable().accumulateUpperLeft(a, aStride, b, bStride, c, cStride, k, n);
}

void accumulateUpperRight(const double* a, std::size_t aStride, const double* b, std::size_t bStride, double* c,
                          std::size_t cStride, std::size_t m, std::size_t k) {
    bestTable().accumulateUpperRight(a, aStride, b, bStride, c, cStride, m, k);
}

}  // namespace reisti::kernels
