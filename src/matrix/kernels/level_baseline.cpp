#include <algorithm>
#include <array>
#include <cstddef>
#include <memory>
#include <utility>

#include "matrix/kernels/level_table.h"
#include "matrix/kernels/workspace.h"
#include "util/math_routines.h"

#define REISTI_TARGET

namespace reisti::kernels {

namespace {

// Sixteen vector registers: eight hold sums, two a row of b, and the rest what is being multiplied.
constexpr std::size_t kLanes = 2;
constexpr std::size_t kTileRows = 4;
constexpr std::size_t kTileVectors = 2;

#include "matrix/kernels/level_body.inc"

}  // namespace

constinit const LevelTable kBaselineTable = kTable;

}  // namespace reisti::kernels
