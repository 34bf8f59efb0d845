#ifndef REISTI_TESTS_SUPPORT_RANDOM_REGIONS_H
#define REISTI_TESTS_SUPPORT_RANDOM_REGIONS_H

#include <cstddef>
#include <cstdint>
#include <random>
#include <string>
#include <vector>

#include "support/plain_extreme_vertices.h"

// Random regions that aim at trouble: decimals whose sums tie, ranges that nearly vanish, bounds one ulp apart,
// constraints that repeat, oppose or touch. The sequence for a seed is the same on every platform.

namespace reisti::test {

class RegionMaker {
  public:
    explicit RegionMaker(std::uint64_t seed) : engine_(seed) {}

    /// Bounds of one of the kinds below, chosen at random. Most, not all, leave a region.
    void bounds(std::size_t q, std::vector<double>& lower, std::vector<double>& upper);
    /// Typed with so many decimals.
    void decimalBounds(std::size_t q, int decimals, std::vector<double>& lower, std::vector<double>& upper);
    /// A nominal mixture plus and minus a fraction of each component.
    void nominalBounds(std::size_t q, double fraction, std::vector<double>& lower, std::vector<double>& upper);
    /// Lower bounds 0 to 0.1, upper bounds 0.2 to 0.6.
    void typicalBounds(std::size_t q, std::vector<double>& lower, std::vector<double>& upper);

    /// Decimals moved by a few quarters of the tolerance within which bounds are met.
    void besideTies(std::size_t q, std::vector<double>& lower, std::vector<double>& upper);
    /// Some components hardly matter: upper bounds from 1e-3 down to 1e-13.
    void withTinyComponents(std::size_t q, std::vector<double>& lower, std::vector<double>& upper);
    /// All ranges a few 1e-5, where points that differ are one to the search for centroids.
    void tinyRegion(std::size_t q, std::vector<double>& lower, std::vector<double>& upper);

    /// A constraint on the region within the bounds; `earlier` ones may be repeated or opposed.
    PlainConstraint constraint(const std::vector<double>& lower, const std::vector<double>& upper, double total,
                               const std::vector<PlainConstraint>& earlier);

    std::uint64_t below(std::uint64_t n) { return engine_() % n; }
    bool oneIn(std::uint64_t n) { return below(n) == 0; }
    /// In [0, 1).
    double uniform() { return static_cast<double>(engine_() >> 11) * 0x1p-53; }
    /// A mixture inside the bounds as far as that is easily found: it may miss them slightly.
    std::vector<double> inside(const std::vector<double>& lower, const std::vector<double>& upper);

  private:
    void unsortedBounds(std::size_t q, std::vector<double>& lower, std::vector<double>& upper);
    void roundedBounds(std::size_t q, std::vector<double>& lower, std::vector<double>& upper);
    void nudgeByUlps(std::vector<double>& bounds);
    std::vector<double> coefficients(std::size_t q);

    std::mt19937_64 engine_;
};

/// The region as text that can be pasted into a test.
std::string describe(const std::vector<double>& lower, const std::vector<double>& upper,
                     const std::vector<PlainConstraint>& constraints, double total);

}  // namespace reisti::test

#endif
