#include "matrix/kernels/products.h"

#include "matrix/kernels/level_table.h"

namespace reisti::kernels {

const LevelTable& tableOf([[maybe_unused]] Level level) {
#ifdef __x86_64__
    if (level == Level::kAvx512) return kAvx512Table;
    if (level == Level::kAvx2) return kAvx2Table;
#endif
    return kBaselineTable;
}

void product(const double* a, const double* b, double* c, std::size_t m, std::size_t k, std::size_t n) {
    bestTable().product(a, b, c, m, k, n);
}

void productLeftTransposed(const double* a, const double* b, double* c, std::size_t m, std::size_t k, std::size_t n) {
    bestTable().productLeftTransposed(a, b, c, m, k, n);
}

void productRightTransposed(const double* a, const double* b, double* c, std::size_t m, std::size_t k, std::size_t n) {
    bestTable().productRightTransposed(a, b, c, m, k, n);
}

void accumulateProduct(const double* a, std::size_t aStride, const double* b, std::size_t bStride, double* c,
                       std::size_t cStride, std::size_t m, std::size_t k, std::size_t n) {
    bestTable().accumulateProduct(a, aStride, b, bStride, c, cStride, m, k, n);
}

}  // namespace reisti::kernels
