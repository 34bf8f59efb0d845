// The vector units that the kernels are compiled for. All levels give the same bits: they differ in the number of
// elements that travel together, never in the order in which one element is computed.
#ifndef REISTI_MATRIX_KERNELS_LEVEL_H
#define REISTI_MATRIX_KERNELS_LEVEL_H

#include <array>

namespace reisti::kernels {

enum class Level {
    kBaseline,  // what every processor of the architecture has
    kAvx2,
    kAvx512,
};

inline constexpr std::array<Level, 3> kLevels = {Level::kBaseline, Level::kAvx2, Level::kAvx512};

const char* name(Level level);

// Whether this build holds the level and this processor and system can run it.
bool isAvailable(Level level);

// The widest available level.
Level bestLevel();

}  // namespace reisti::kernels

#endif
