#include "matrix/kernels/products.h"

#include <gtest/gtest.h>

#include "kernel_levels.h"
#include "support/bit_equality.h"
#include "support/plain_linear_algebra.h"
#include "support/random_values.h"
#include "support/scale.h"

namespace reisti::test {
namespace {

using kernels::LevelTable;

struct Shape {
    std::size_t m;
    std::size_t k;
    std::size_t n;
};

std::ostream& operator<<(std::ostream& os, const Shape& shape) {
    return os << shape.m << " x " << shape.k << " times " << shape.k << " x " << shape.n;
}

/// All three products of one level against the plain loops. The results are computed over garbage, which must not show.
void expectPlainProducts(const LevelTable& table, RandomValues& random, Shape shape, Draw draw) {
    const auto [m, k, n] = shape;
    const PlainMatrix a = randomMatrix(random, m, k, draw);
    const PlainMatrix b = randomMatrix(random, k, n, draw);
    const PlainMatrix expected = plainProduct(a, b);
    std::vector<double> c(m * n, 1e300);
    table.product(a.values.data(), b.values.data(), c.data(), m, k, n);
    EXPECT_TRUE(haveSameBits(c, expected.values)) << shape;
    c.assign(m * n, 1e300);
    table.productLeftTransposed(plainTranspose(a).values.data(), b.values.data(), c.data(), m, k, n);
    EXPECT_TRUE(haveSameBits(c, expected.values)) << "left transposed, " << shape;
    c.assign(m * n, 1e300);
    table.productRightTransposed(a.values.data(), plainTranspose(b).values.data(), c.data(), m, k, n);
    EXPECT_TRUE(haveSameBits(c, expected.values)) << "right transposed, " << shape;
}

class ProductKernels : public KernelLevels {};

TEST_P(ProductKernels, MatchPlainLoopsForAllSmallShapes) {
    RandomValues random(1);
    for (std::size_t m = 0; m <= 9; ++m) {
        for (std::size_t k = 0; k <= 9; ++k) {
            for (std::size_t n = 0; n <= 9; ++n)
                expectPlainProducts(table(), random, {m, k, n}, &RandomValues::uniform);
        }
    }
}

TEST_P(ProductKernels, MatchPlainLoopsForRandomShapes) {
    RandomValues random(2);
    for (int i = 0; i < scaled(400); ++i) {
        const Shape shape{random.index(80), random.index(80), random.index(80)};
        expectPlainProducts(table(), random, shape, &RandomValues::uniform);
    }
}

TEST_P(ProductKernels, MatchPlainLoopsAroundTheBlockSizes) {
    RandomValues random(3);
    // The kernels change their ways at 16 and 32, and cut blocks at 96 rows, 256 products and 1024 columns.
    for (const Shape shape : {Shape{17, 33, 33}, Shape{33, 32, 32}, Shape{32, 33, 65}, Shape{96, 40, 40},
                              Shape{97, 255, 41}, Shape{95, 256, 40}, Shape{98, 257, 39}, Shape{7, 513, 9},
                              Shape{34, 300, 1023}, Shape{33, 260, 1025}, Shape{5, 257, 1030}, Shape{200, 3, 1032}}) {
        expectPlainProducts(table(), random, shape, &RandomValues::uniform);
    }
}

TEST_P(ProductKernels, MatchPlainLoopsForVectorsAndOuterProducts) {
    RandomValues random(4);
    for (const std::size_t length : {std::size_t{100}, std::size_t{1000}}) {
        expectPlainProducts(table(), random, {1, length, 1}, &RandomValues::uniform);
        expectPlainProducts(table(), random, {length, 1, length}, &RandomValues::uniform);
        expectPlainProducts(table(), random, {1, length, length}, &RandomValues::uniform);
        expectPlainProducts(table(), random, {length, length, 1}, &RandomValues::uniform);
    }
}

TEST_P(ProductKernels, KeepInfinitiesNansAndSubnormals) {
    RandomValues random(5);
    for (int i = 0; i < scaled(300); ++i) {
        const Shape shape{random.index(40), random.index(6), random.index(40)};
        expectPlainProducts(table(), random, shape, &RandomValues::nasty);
    }
}

TEST_P(ProductKernels, KeepTheSignOfZero) {
    RandomValues random(6);
    for (int i = 0; i < scaled(300); ++i) {
        const Shape shape{random.index(40), random.index(5), random.index(40)};
        expectPlainProducts(table(), random, shape, &RandomValues::cancelling);
    }
}

INSTANTIATE_TEST_SUITE_P(Levels, ProductKernels, testing::ValuesIn(kernels::kLevels), levelName);

TEST(BestLevel, IsAvailable) {
    EXPECT_TRUE(kernels::isAvailable(kernels::bestLevel()));
}

TEST(Products, UseTheBestLevel) {
    RandomValues random(7);
    const PlainMatrix a = randomMatrix(random, 40, 50, &RandomValues::uniform);
    const PlainMatrix b = randomMatrix(random, 50, 60, &RandomValues::uniform);
    const std::vector<double> expected = plainProduct(a, b).values;
    std::vector<double> c(40 * 60);
    kernels::product(a.values.data(), b.values.data(), c.data(), 40, 50, 60);
    EXPECT_TRUE(haveSameBits(c, expected));
    kernels::productLeftTransposed(plainTranspose(a).values.data(), b.values.data(), c.data(), 40, 50, 60);
    EXPECT_TRUE(haveSameBits(c, expected));
    kernels::productRightTransposed(a.values.data(), plainTranspose(b).values.data(), c.data(), 40, 50, 60);
    EXPECT_TRUE(haveSameBits(c, expected));
}

}  // namespace
}  // namespace reisti::test
