#include <algorithm>
#include <array>
#include <cstddef>
#include <memory>
#include <utility>

#include "matrix/kernels/level_table.h"
#include "matrix/kernels/workspace.h"
#include "util/math_routines.h"

#ifdef __x86_64__

#define REISTI_TARGET __attribute__((target("avx512f,avx512vl,avx512dq")))

namespace reisti::kernels {

namespace {

// One vector wide and many rows high: multiplications and additions then alternate in the instruction stream, which
// keeps both kinds of units busy on processors that split these vectors.
constexpr std::size_t kLanes = 8;
constexpr std::size_t kTileRows = 16;
constexpr std::size_t kTileVectors = 1;

#include "matrix/kernels/level_body.inc"

}  // namespace

constinit const LevelTable kAvx512Table = kTable;

}  // namespace reisti::kernels

#endif
