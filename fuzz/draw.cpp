#include "draw.h"

#include <bit>
#include <cmath>
#include <limits>

namespace fuzz {

namespace {

using Limits = std::numeric_limits<double>;

constexpr double AWKWARD_NUMBERS[] = {
    -0.0,
    1.0,
    -1.0,
    1e-5,
    1e-10,
    1e-12,
    100.0,
    1e15,
    -1e15,
    1e300,
    -1e300,
    Limits::epsilon(),
    Limits::min(),
    Limits::denorm_min(),
    -Limits::denorm_min(),
    Limits::max(),
    Limits::lowest(),
    Limits::infinity(),
    -Limits::infinity(),
    Limits::quiet_NaN(),
};

double drawFraction(FuzzedDataProvider& bytes) {
    const int denominator = bytes.ConsumeIntegralInRange(1, 12);
    return bytes.ConsumeIntegralInRange(-1, 12) / static_cast<double>(denominator);
}

/// A few units in the last place beside a typed number.
double drawNeighbour(FuzzedDataProvider& bytes) {
    double number = drawHundredths(bytes, 0, 100);
    const int steps = bytes.ConsumeIntegralInRange(-4, 4);
    for (int i = 0; i < std::abs(steps); ++i)
        number = std::nextafter(number, steps < 0 ? -Limits::infinity() : Limits::infinity());
    return number;
}

}  // namespace

bool drawRarely(FuzzedDataProvider& bytes, int parts) {
    return bytes.ConsumeIntegralInRange(1, parts) == parts;
}

std::uint32_t drawCount(FuzzedDataProvider& bytes, std::uint32_t usualMost) {
    switch (bytes.ConsumeIntegralInRange(0, 7)) {
        case 0:
        case 1:
            return 1;
        case 7:
            return bytes.ConsumeIntegral<std::uint32_t>();
        default:
            return bytes.ConsumeIntegralInRange<std::uint32_t>(0, usualMost);
    }
}

double drawHundredths(FuzzedDataProvider& bytes, int least, int most) {
    return bytes.ConsumeIntegralInRange(least, most) / 100.0;
}

double drawNumber(FuzzedDataProvider& bytes) {
    switch (bytes.ConsumeIntegralInRange(0, 5)) {
        case 0:
            return drawHundredths(bytes, 0, 100);
        case 1:
            return drawFraction(bytes);
        case 2:
            return drawNeighbour(bytes);
        case 3:
            return std::bit_cast<double>(bytes.ConsumeIntegral<std::uint64_t>());
        case 4:
            return bytes.PickValueInArray(AWKWARD_NUMBERS);
        default:
            return bytes.ConsumeFloatingPointInRange(-2.0, 2.0);
    }
}

}  // namespace fuzz
