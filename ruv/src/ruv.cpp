#include "ruv/ruv.h"

#include <bit>
#include <chrono>
#include <cmath>
#include <new>
#include <random>

struct ruv_ISampler {
    std::mt19937_64 generator;
};

namespace {

/// std::seed_seq and std::mt19937_64 are defined to the bit by the C++ standard, so a seed gives the same sequence with
/// every compiler. All 64 bits of the double enter: neighbouring seeds, NaN and infinities have sequences of their own.
std::mt19937_64 makeGenerator(double seed) {
    const auto bits = std::bit_cast<std::uint64_t>(seed);
    std::seed_seq words{static_cast<std::uint32_t>(bits), static_cast<std::uint32_t>(bits >> 32)};
    return std::mt19937_64(words);
}

/// A multiple of 2^-53 in [0, 1), each equally likely.
double nextUnit(std::mt19937_64& generator) {
    return static_cast<double>(generator() >> 11) * 0x1p-53;
}

}  // namespace

double ruv_Seeder(void) {
    std::uint64_t word = static_cast<std::uint64_t>(std::chrono::steady_clock::now().time_since_epoch().count());
    try {
        std::random_device device;
        word ^= (static_cast<std::uint64_t>(device()) << 32) | device();
    } catch (...) {
        // Without an entropy source the clock alone still makes the seed differ from call to call.
        word *= 0x9E3779B97F4A7C15U;
    }
    // 53 bits, each value of [1, 2^53] an exact double: a seed that is reported can be typed in again.
    return static_cast<double>((word >> 11) + 1);
}

ruv_ISampler* ruv_MakeISampler(int32_t* status, int32_t kind, double seed) {
    int32_t outcome = ruv_StatusOk;
    ruv_ISampler* sampler = nullptr;
    if (kind != ruv_KindMersenneTwister64) {
        outcome = ruv_StatusUnknownKind;
    } else {
        try {
            sampler = new ruv_ISampler{makeGenerator(seed)};
        } catch (...) {
            outcome = ruv_StatusNoMemory;
        }
    }
    if (status != nullptr) *status = outcome;
    return sampler;
}

void ruv_GetUniformSample(ruv_ISampler* sampler, double* values, uint32_t count, double lower, double upper) {
    if (sampler == nullptr) return;
    // In halves, so that bounds as far apart as the whole range of doubles do not overflow.
    const double halfWidth = upper / 2 - lower / 2;
    const double last = std::nextafter(upper, lower);
    for (uint32_t i = 0; i < count; ++i) {
        const double unit = nextUnit(sampler->generator);
        const double value = lower + unit * halfWidth + unit * halfWidth;
        // Rounding may reach the upper bound, which is excluded.
        values[i] = value < upper ? value : last;
    }
}

void ruv_DeleteISampler(ruv_ISampler** sampler) {
    if (sampler == nullptr) return;
    delete *sampler;
    *sampler = nullptr;
}
