// Seeded test data for numeric kernels, ordinary and nasty.
#ifndef REISTI_TESTS_SUPPORT_RANDOM_VALUES_H
#define REISTI_TESTS_SUPPORT_RANDOM_VALUES_H

#include <array>
#include <cstddef>
#include <limits>
#include <random>
#include <vector>

namespace reisti::test {

class RandomValues {
  public:
    explicit RandomValues(std::uint64_t seed) : engine_(seed) {}

    /// Below `limit`, which is positive.
    std::size_t index(std::size_t limit) { return static_cast<std::size_t>(engine_() % limit); }

    /// From -1 to 1.
    double uniform() { return 2.0 * static_cast<double>(engine_() >> 11U) * 0x1p-53 - 1.0; }

    /// One in four is zero of either sign, infinite, NaN, subnormal or near the ends of the range.
    double nasty() {
        static constexpr double kInfinity = std::numeric_limits<double>::infinity();
        static constexpr std::array kSpecial = {
            0.0,       -0.0,    kInfinity, -kInfinity, std::numeric_limits<double>::quiet_NaN(),
            0x1p-1074, -3e-310, 1e308,     -1e308,     2.2250738585072014e-308};
        return index(4) == 0 ? kSpecial[index(kSpecial.size())] : uniform();
    }

    /// Zeros of either sign among small integers: their sums cancel exactly, which brings out wrong signs of zero.
    double cancelling() {
        static constexpr std::array kValues = {0.0, -0.0, 1.0, -1.0, 2.0};
        return kValues[index(kValues.size())];
    }

  private:
    std::mt19937_64 engine_;
};

}  // namespace reisti::test

#endif
