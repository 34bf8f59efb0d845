#include <algorithm>
#include <array>
#include <cstddef>
#include <memory>
#include <utility>

#include "matrix/kernels/level_table.h"
#include "matrix/kernels/workspace.h"
#include "util/math_routines.h"

#ifdef __x86_64__

#define REISTI_TARGET __attribute__((target("avx2")))

namespace reisti::kernels {

namespace {

// Sixteen vector registers: twelve hold sums, two a row of b, one an element of a and one a product.
constexpr std::size_t kLanes = 4;
constexpr std::size_t kTileRows = 6;
constexpr std::size_t kTileVectors = 2;

#include "matrix/kernels/level_body.inc"

}  // namespace

constinit const LevelTable kAvx2Table = kTable;

}  // namespace reisti::kernels

#endif
