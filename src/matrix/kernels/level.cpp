#include "matrix/kernels/level.h"

namespace reisti::kernels {

const char* name(Level level) {
    switch (level) {
        case Level::kBaseline:
            return "baseline";
        case Level::kAvx2:
            return "avx2";
        case Level::kAvx512:
            return "avx512";
    }
    return "unknown";
}

bool isAvailable(Level level) {
#ifdef __x86_64__
    // Reads flags that the runtime set at load, so asking on every call costs a few instructions.
    if (level == Level::kAvx2) return __builtin_cpu_supports("avx2") != 0;
    if (level == Level::kAvx512) {
        return __builtin_cpu_supports("avx512f") != 0 && __builtin_cpu_supports("avx512vl") != 0 &&
               __builtin_cpu_supports("avx512dq") != 0;
    }
#endif
    return level == Level::kBaseline;
}

Level bestLevel() {
    if (isAvailable(Level::kAvx512)) return Level::kAvx512;
    return isAvailable(Level::kAvx2) ? Level::kAvx2 : Level::kBaseline;
}

}  // namespace reisti::kernels
