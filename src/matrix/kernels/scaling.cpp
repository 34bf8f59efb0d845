#include "matrix/kernels/scaling.h"

#include "matrix/kernels/level_table.h"

namespace reisti::kernels {

void scaleRow(double* row, double factor, std::size_t n) {
    bestTable().scaleRow(row, factor, n);
}

void scaleElements(double* row, const double* factors, std::size_t n) {
    bestTable().scaleElements(row, factors, n);
}

}  // namespace reisti::kernels
