#include "matrix/kernels/triangles.h"

#include <gtest/gtest.h>

#include "kernel_levels.h"
#include "support/bit_equality.h"
#include "support/plain_linear_algebra.h"
#include "support/random_values.h"
#include "support/scale.h"

// What the products of structured matrices are put together from: products that continue sums, products with a small
// triangle, and scaling.

namespace reisti::test {
namespace {

/// A matrix inside a wider array: what lies beyond its columns must be neither read into a result nor written.
struct Embedded {
    Embedded(RandomValues& random, std::size_t rows, std::size_t cols, Draw draw)
        : whole(randomMatrix(random, rows, cols + random.index(20), draw)), width(cols) {}

    std::size_t stride() const { return whole.cols; }
    double* data() { return whole.values.data(); }

    PlainMatrix whole;
    std::size_t width;
};

/// c += a * b, for the terms that `counts` admits.
template <class Predicate>
PlainMatrix plainAccumulation(const Embedded& a, const Embedded& b, const Embedded& c, Predicate counts) {
    PlainMatrix sums = c.whole;
    for (std::size_t i = 0; i < a.whole.rows; ++i) {
        for (std::size_t j = 0; j < b.width; ++j) {
            for (std::size_t k = 0; k < b.whole.rows; ++k) {
                if (counts(i, k, j)) sums(i, j) += a.whole(i, k) * b.whole(k, j);
            }
        }
    }
    return sums;
}

class AccumulatingKernels : public KernelLevels {
  protected:
    void expectPlainSums(RandomValues& random, Draw draw) const {
        const std::size_t m = random.index(40);
        const std::size_t k = random.index(12);
        const std::size_t n = random.index(40);
        Embedded a(random, m, k, draw);
        Embedded b(random, k, n, draw);
        Embedded c(random, m, n, draw);
        const PlainMatrix expected = plainAccumulation(a, b, c, [](auto, auto, auto) { return true; });
        table().accumulateProduct(a.data(), a.stride(), b.data(), b.stride(), c.data(), c.stride(), m, k, n);
        EXPECT_TRUE(haveSameBits(c.whole.values, expected.values)) << m << " x " << k << " x " << n;
    }

    void expectPlainLeftTriangle(RandomValues& random, Draw draw) const {
        const std::size_t k = random.index(kernels::kSmallTriangle + 1);
        const std::size_t n = random.index(40);
        Embedded a(random, k, k, draw);
        Embedded b(random, k, n, draw);
        Embedded c(random, k, n, draw);
        const PlainMatrix expected = plainAccumulation(a, b, c, [](auto i, auto l, auto) { return i <= l; });
        table().accumulateUpperLeft(a.data(), a.stride(), b.data(), b.stride(), c.data(), c.stride(), k, n);
        EXPECT_TRUE(haveSameBits(c.whole.values, expected.values)) << k << " x " << n;
    }

    void expectPlainRightTriangle(RandomValues& random, Draw draw) const {
        const std::size_t m = random.index(40);
        const std::size_t k = random.index(kernels::kSmallTriangle + 1);
        Embedded a(random, m, k, draw);
        Embedded b(random, k, k, draw);
        Embedded c(random, m, k, draw);
        const PlainMatrix expected = plainAccumulation(a, b, c, [](auto, auto l, auto j) { return l <= j; });
        table().accumulateUpperRight(a.data(), a.stride(), b.data(), b.stride(), c.data(), c.stride(), m, k);
        EXPECT_TRUE(haveSameBits(c.whole.values, expected.values)) << m << " x " << k;
    }
};

TEST_P(AccumulatingKernels, ContinueTheSumsThatTheyFind) {
    RandomValues random(11);
    for (int i = 0; i < scaled(400); ++i)
        expectPlainSums(random, &RandomValues::uniform);
}

TEST_P(AccumulatingKernels, SkipWhatLiesLeftOfATriangle) {
    RandomValues random(12);
    for (int i = 0; i < scaled(400); ++i) {
        expectPlainLeftTriangle(random, &RandomValues::uniform);
        expectPlainRightTriangle(random, &RandomValues::uniform);
    }
}

TEST_P(AccumulatingKernels, KeepInfinitiesAndNansToTheirTerms) {
    RandomValues random(13);
    for (int i = 0; i < scaled(400); ++i) {
        expectPlainSums(random, &RandomValues::nasty);
        expectPlainLeftTriangle(random, &RandomValues::nasty);
        expectPlainRightTriangle(random, &RandomValues::nasty);
    }
}

TEST_P(AccumulatingKernels, KeepTheSignOfZero) {
    RandomValues random(14);
    for (int i = 0; i < scaled(400); ++i) {
        expectPlainSums(random, &RandomValues::cancelling);
        expectPlainLeftTriangle(random, &RandomValues::cancelling);
        expectPlainRightTriangle(random, &RandomValues::cancelling);
    }
}

INSTANTIATE_TEST_SUITE_P(Levels, AccumulatingKernels, testing::ValuesIn(kernels::kLevels), levelName);

class ScalingKernels : public KernelLevels {};

TEST_P(ScalingKernels, GiveSumsOfOneTerm) {
    RandomValues random(15);
    for (const Draw draw : {&RandomValues::uniform, &RandomValues::nasty, &RandomValues::cancelling}) {
        for (std::size_t n = 0; n < 70; ++n) {
            const std::vector<double> row = randomMatrix(random, 1, n, draw).values;
            const std::vector<double> factors = randomMatrix(random, 1, n, draw).values;
            const double factor = (random.*draw)();
            std::vector<double> scaledByOne = row;
            std::vector<double> scaledByEach = row;
            table().scaleRow(scaledByOne.data(), factor, n);
            table().scaleElements(scaledByEach.data(), factors.data(), n);
            for (std::size_t j = 0; j < n; ++j) {
                EXPECT_TRUE(hasSameBits(scaledByOne[j], 0.0 + factor * row[j])) << n << ", " << j;
                EXPECT_TRUE(hasSameBits(scaledByEach[j], 0.0 + row[j] * factors[j])) << n << ", " << j;
            }
        }
    }
}

INSTANTIATE_TEST_SUITE_P(Levels, ScalingKernels, testing::ValuesIn(kernels::kLevels), levelName);

}  // namespace
}  // namespace reisti::test
