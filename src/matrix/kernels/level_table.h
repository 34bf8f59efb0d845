// What each level offers; the public headers of this folder call the best available one.
#ifndef REISTI_MATRIX_KERNELS_LEVEL_TABLE_H
#define REISTI_MATRIX_KERNELS_LEVEL_TABLE_H

#include <cstddef>

#include "matrix/kernels/level.h"
#include "matrix/kernels/triangles.h"

namespace reisti::kernels {

struct Rotation {
    double sine;
    double cosine;
};

// A chain of rotations: the first turns rows `bottom` and `bottom` - 1, each further one the two rows above.
struct RotationSweep {
    std::size_t bottom;
    std::size_t rotations;
};

// Columns that are rotated together, and stored together while rotations go on.
inline constexpr std::size_t kStrip = 16;

struct LevelTable {
    using Product = void (*)(const double* a, const double* b, double* c, std::size_t m, std::size_t k, std::size_t n);
    using AccumulateProduct = void (*)(const double* a, std::size_t aStride, const double* b, std::size_t bStride,
                                       double* c, std::size_t cStride, std::size_t m, std::size_t k, std::size_t n);

    Product product;
    Product productLeftTransposed;
    Product productRightTransposed;
    AccumulateProduct accumulateProduct;

    // As in scaling.h.
    void (*scaleRow)(double* row, double factor, std::size_t n);
    void (*scaleElements)(double* row, const double* factors, std::size_t n);

    // As in triangles.h.
    void (*accumulateUpperLeft)(const double* a, std::size_t aStride, const double* b, std::size_t bStride, double* c,
                                std::size_t cStride, std::size_t k, std::size_t n);
    void (*accumulateUpperRight)(const double* a, std::size_t aStride, const double* b, std::size_t bStride, double* c,
                                 std::size_t cStride, std::size_t m, std::size_t k);

    // As in factorizations.h.
    bool (*factorLu)(double* a, std::size_t n, int* index, double& parity);
    void (*solveLuColumns)(const double* lu, const int* index, std::size_t n, double* b, std::size_t columns);
    void (*invertLu)(const double* lu, const int* index, std::size_t n, double* inverse);
    std::ptrdiff_t (*factorCholesky)(double* a, std::size_t n, std::size_t start, double& pivot);
    void (*invertCholesky)(const double* u, std::size_t n, double* inverse);

    // The parts of eigenSystem; documented at their definitions in eigen.inc.
    void (*reduceToTridiagonal)(double* a, std::size_t n, std::size_t stride, double* diagonal, double* below,
                                double* factors);
    void (*multiplyReflections)(const double* vectors, std::size_t n, std::size_t stride, const double* factors,
                                double* product);
    void (*rotateStrip)(double* strip, const RotationSweep* sweeps, std::size_t count, const Rotation* rotations);
};

extern const LevelTable kBaselineTable;
#ifdef __x86_64__
extern const LevelTable kAvx2Table;
extern const LevelTable kAvx512Table;
#endif

// The level must be available.
const LevelTable& tableOf(Level level);

inline const LevelTable& bestTable() {
    return tableOf(bestLevel());
}

}  // namespace reisti::kernels

#endif
