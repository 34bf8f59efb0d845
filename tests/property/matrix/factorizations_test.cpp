#include "matrix/kernels/factorizations.h"

#include <gtest/gtest.h>
#include <limits>
#include <string>
#include <vector>

#include "kernel_levels.h"
#include "support/bit_equality.h"
#include "support/plain_linear_algebra.h"
#include "support/random_values.h"
#include "support/scale.h"

namespace reisti::test {
namespace {

using kernels::LevelTable;

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNan = std::numeric_limits<double>::quiet_NaN();

// Every small order, and orders around the widths at which the kernels change their ways: vectors of 8, panels of 32
// columns, blocks of 64 rows.
std::vector<std::size_t> testedOrders() {
    std::vector<std::size_t> orders;
    for (std::size_t n = 0; n <= 40; ++n)
        orders.push_back(n);
    for (const std::size_t n : {63U, 64U, 65U, 71U, 72U, 96U, 127U, 128U, 129U, 150U})
        orders.push_back(n);
    if (scaled(20) > 1) orders.push_back(300);
    return orders;
}

// ---- LU

void expectPlainLu(const LevelTable& table, const PlainMatrix& a, const std::string& what) {
    const PlainLu expected = plainLu(a);
    std::vector<double> lu = a.values;
    std::vector<int> index(a.rows, -7);
    double parity = 7.0;
    EXPECT_EQ(table.factorLu(lu.data(), a.rows, index.data(), parity), expected.succeeds) << what;
    EXPECT_EQ(index, expected.index) << what;
    EXPECT_EQ(parity, expected.parity) << what;
    // After a failure the factors are of no use.
    if (expected.succeeds) {
        EXPECT_TRUE(haveSameBits(lu, expected.factors.values)) << what;
    }
}

class LuKernels : public KernelLevels {};

TEST_P(LuKernels, FactorLikePlainLoops) {
    RandomValues random(1);
    for (const std::size_t n : testedOrders())
        expectPlainLu(table(), randomMatrix(random, n, n, &RandomValues::uniform), "order " + std::to_string(n));
}

TEST_P(LuKernels, BreakTiesLikePlainLoops) {
    RandomValues random(2);
    for (int i = 0; i < scaled(300); ++i) {
        const std::size_t n = random.index(40);
        expectPlainLu(table(), randomMatrix(random, n, n, &RandomValues::cancelling), "case " + std::to_string(i));
    }
}

TEST_P(LuKernels, FindTheSameColumnSingular) {
    RandomValues random(3);
    for (int i = 0; i < scaled(200); ++i) {
        const std::size_t n = 2 + random.index(80);
        PlainMatrix a = randomMatrix(random, n, n, &RandomValues::uniform);
        const std::size_t copy = random.index(n);
        const std::size_t original = random.index(n);
        for (std::size_t r = 0; r < n; ++r)
            a(r, copy) = a(r, original) * 2.0;
        expectPlainLu(table(), a, "case " + std::to_string(i));
    }
}

TEST_P(LuKernels, RejectRowsOfZerosAndOfTinyValues) {
    RandomValues random(4);
    for (const double tiny : {0.0, 3.9e-12, 4.1e-12}) {
        PlainMatrix a = randomMatrix(random, 20, 20, &RandomValues::uniform);
        for (std::size_t j = 0; j < 20; ++j)
            a(7, j) = tiny;
        expectPlainLu(table(), a, std::to_string(tiny));
    }
}

TEST_P(LuKernels, CarryInfinitiesAndNansLikePlainLoops) {
    RandomValues random(5);
    for (int i = 0; i < scaled(200); ++i) {
        const std::size_t n = 1 + random.index(50);
        PlainMatrix a = randomMatrix(random, n, n, &RandomValues::uniform);
        for (int k = 0; k < 3; ++k)
            a.values[random.index(n * n)] = random.nasty();
        expectPlainLu(table(), a, "case " + std::to_string(i));
    }
}

TEST_P(LuKernels, KeepPivotsInBoundsInColumnsOfNans) {
    PlainMatrix a(12, 12, 1.0);
    for (std::size_t i = 0; i < 12; ++i)
        a(i, 3) = kNan;
    expectPlainLu(table(), a, "column of NaNs");
    expectPlainLu(table(), PlainMatrix(9, 9, kNan), "all NaN");
}

// ---- Solutions

void expectPlainSolutions(const LevelTable& table, const PlainMatrix& a, const PlainMatrix& b,
                          const std::string& what) {
    const PlainLu lu = plainLu(a);
    if (!lu.succeeds) return;
    std::vector<double> actual = b.values;
    table.solveLuColumns(lu.factors.values.data(), lu.index.data(), a.rows, actual.data(), b.cols);
    PlainMatrix expected = b;
    for (std::size_t j = 0; j < b.cols; ++j) {
        std::vector<double> column(b.rows);
        for (std::size_t i = 0; i < b.rows; ++i)
            column[i] = b(i, j);
        column = plainLuSolve(lu.factors, lu.index, column);
        for (std::size_t i = 0; i < b.rows; ++i)
            expected(i, j) = column[i];
    }
    EXPECT_TRUE(haveSameBits(actual, expected.values)) << what;
}

PlainMatrix identity(std::size_t n) {
    PlainMatrix unit(n, n);
    for (std::size_t i = 0; i < n; ++i)
        unit(i, i) = 1.0;
    return unit;
}

void expectPlainInverse(const LevelTable& table, const PlainMatrix& a, const std::string& what) {
    const PlainLu lu = plainLu(a);
    if (!lu.succeeds) return;
    PlainMatrix expected = identity(a.rows);
    for (std::size_t j = 0; j < a.rows; ++j) {
        std::vector<double> unit(a.rows);
        unit[j] = 1.0;
        unit = plainLuSolve(lu.factors, lu.index, unit);
        for (std::size_t i = 0; i < a.rows; ++i)
            expected(i, j) = unit[i];
    }
    std::vector<double> actual(a.values.size(), 1e300);
    table.invertLu(lu.factors.values.data(), lu.index.data(), a.rows, actual.data());
    EXPECT_TRUE(haveSameBits(actual, expected.values)) << what;
}

TEST_P(LuKernels, SolveLikePlainLoops) {
    RandomValues random(6);
    for (const std::size_t n : {1U, 2U, 7U, 8U, 31U, 50U, 100U}) {
        for (const std::size_t columns : {0U, 1U, 5U, 16U, 31U, 32U, 33U, 70U}) {
            const PlainMatrix a = randomMatrix(random, n, n, &RandomValues::uniform);
            const PlainMatrix b = randomMatrix(random, n, columns, &RandomValues::uniform);
            expectPlainSolutions(table(), a, b, std::to_string(n) + " rows, " + std::to_string(columns) + " columns");
        }
    }
}

TEST_P(LuKernels, SolveForColumnsOfManyZerosLikePlainLoops) {
    RandomValues random(7);
    for (int i = 0; i < scaled(100); ++i) {
        const std::size_t n = 1 + random.index(60);
        PlainMatrix a = randomMatrix(random, n, n, &RandomValues::uniform);
        if (i % 2 == 1) a.values[random.index(n * n)] = random.nasty();
        PlainMatrix b = randomMatrix(random, n, 40, &RandomValues::cancelling);
        for (double& value : b.values) {
            if (random.index(8) != 0) value *= 0.0;
        }
        expectPlainSolutions(table(), a, b, "case " + std::to_string(i));
    }
}

TEST_P(LuKernels, InvertLikePlainLoops) {
    RandomValues random(8);
    for (const std::size_t n : testedOrders())
        expectPlainInverse(table(), randomMatrix(random, n, n, &RandomValues::uniform), "order " + std::to_string(n));
}

TEST_P(LuKernels, InvertSparseMatricesWithTheSignsOfZeroOfPlainLoops) {
    RandomValues random(9);
    for (int i = 0; i < scaled(300); ++i) {
        const std::size_t n = 1 + random.index(45);
        expectPlainInverse(table(), randomMatrix(random, n, n, &RandomValues::cancelling), "case " + std::to_string(i));
    }
}

TEST_P(LuKernels, InvertFactorsWithInfinitiesAndNansLikePlainLoops) {
    RandomValues random(10);
    for (int i = 0; i < scaled(200); ++i) {
        const std::size_t n = 1 + random.index(45);
        PlainMatrix a = randomMatrix(random, n, n, &RandomValues::uniform);
        for (int k = 0; k < 2; ++k)
            a.values[random.index(n * n)] = random.nasty();
        expectPlainInverse(table(), a, "case " + std::to_string(i));
    }
}

INSTANTIATE_TEST_SUITE_P(Levels, LuKernels, testing::ValuesIn(kernels::kLevels), levelName);

// ---- Cholesky

/// Positive definite, and by `weight` further or less far from not being so.
PlainMatrix positiveMatrix(RandomValues& random, std::size_t n, double weight) {
    const PlainMatrix root = randomMatrix(random, n, n, &RandomValues::uniform);
    PlainMatrix a = plainProduct(root, plainTranspose(root));
    for (std::size_t i = 0; i < n; ++i)
        a(i, i) += weight;
    return a;
}

void expectPlainCholesky(const LevelTable& table, const PlainMatrix& a, std::size_t start, const std::string& what) {
    const PlainCholesky expected = plainCholesky(a, start);
    std::vector<double> actual = packUpper(a);
    double pivot = 0.0;
    EXPECT_EQ(table.factorCholesky(actual.data(), a.rows, start, pivot), expected.failedRow) << what;
    EXPECT_TRUE(hasSameBits(pivot, expected.pivot)) << what;
    EXPECT_TRUE(haveSameBits(actual, packUpper(expected.factor))) << what;
}

class CholeskyKernels : public KernelLevels {};

TEST_P(CholeskyKernels, FactorLikePlainLoops) {
    RandomValues random(11);
    for (const std::size_t n : testedOrders())
        expectPlainCholesky(table(), positiveMatrix(random, n, 1.0), 0, "order " + std::to_string(n));
}

TEST_P(CholeskyKernels, StopAtTheSameRowAndLeaveTheColumnsBeyondAlone) {
    RandomValues random(12);
    for (int i = 0; i < scaled(300); ++i) {
        const std::size_t n = 1 + random.index(100);
        PlainMatrix a = positiveMatrix(random, n, 1.0);
        const std::size_t bad = random.index(n);
        a(bad, bad) = i % 3 == 0 ? 0.0 : -1.0 + 0.1 * static_cast<double>(random.index(20));
        expectPlainCholesky(table(), a, 0, "case " + std::to_string(i));
    }
}

TEST_P(CholeskyKernels, StopAtPivotsThatAreExactlyZero) {
    // The rows repeat, so the second of two equal ones leaves nothing.
    for (const std::size_t n : {2U, 9U, 20U, 70U}) {
        PlainMatrix a(n, n);
        for (std::size_t i = 0; i < n; ++i) {
            for (std::size_t j = 0; j < n; ++j)
                a(i, j) = i / 2 == j / 2 ? 4.0 : 0.0;
        }
        expectPlainCholesky(table(), a, 0, "order " + std::to_string(n));
    }
}

TEST_P(CholeskyKernels, ContinueFromAnyRowLikePlainLoops) {
    RandomValues random(13);
    for (int i = 0; i < scaled(200); ++i) {
        const std::size_t n = 1 + random.index(90);
        const std::size_t start = random.index(n);
        PlainMatrix a = positiveMatrix(random, n, 1.0);
        const PlainMatrix done = plainCholesky(a, 0).factor;
        for (std::size_t r = 0; r < start; ++r) {
            for (std::size_t c = r; c < n; ++c)
                a(r, c) = done(r, c);
        }
        if (i % 4 == 0) a(n - 1, n - 1) = -1.0;
        expectPlainCholesky(table(), a, start, "case " + std::to_string(i));
    }
}

TEST_P(CholeskyKernels, CarryInfinitiesAndNansLikePlainLoops) {
    RandomValues random(14);
    for (int i = 0; i < scaled(200); ++i) {
        const std::size_t n = 1 + random.index(80);
        PlainMatrix a = positiveMatrix(random, n, 1.0);
        a.values[random.index(n * n)] = random.nasty();
        expectPlainCholesky(table(), a, 0, "case " + std::to_string(i));
    }
}

void expectPlainCholeskyInverse(const LevelTable& table, const PlainMatrix& u, const std::string& what) {
    std::vector<double> actual(u.rows * (u.rows + 1) / 2, 1e300);
    table.invertCholesky(packUpper(u).data(), u.rows, actual.data());
    EXPECT_TRUE(haveSameBits(actual, packLower(plainCholeskyInverse(u)))) << what;
}

TEST_P(CholeskyKernels, InvertLikePlainLoops) {
    RandomValues random(15);
    for (const std::size_t n : testedOrders()) {
        PlainMatrix u = randomMatrix(random, n, n, &RandomValues::uniform);
        for (std::size_t i = 0; i < n; ++i)
            u(i, i) += 3.0;
        expectPlainCholeskyInverse(table(), u, "order " + std::to_string(n));
    }
}

TEST_P(CholeskyKernels, InvertSparseFactorsWithTheSignsOfZeroOfPlainLoops) {
    RandomValues random(16);
    for (int i = 0; i < scaled(300); ++i) {
        const std::size_t n = 1 + random.index(75);
        PlainMatrix u = randomMatrix(random, n, n, &RandomValues::cancelling);
        for (double& value : u.values) {
            if (random.index(4) != 0) value *= 0.0;
        }
        // Without a positive diagonal the zeros become infinities: both are wanted.
        for (std::size_t k = 0; i % 3 != 0 && k < n; ++k)
            u(k, k) = 1.0 + random.cancelling() * 0.25;
        expectPlainCholeskyInverse(table(), u, "case " + std::to_string(i));
    }
}

TEST_P(CholeskyKernels, InvertFactorsWithInfinitiesAndNansLikePlainLoops) {
    RandomValues random(17);
    for (int i = 0; i < scaled(200); ++i) {
        const std::size_t n = 1 + random.index(75);
        PlainMatrix u = randomMatrix(random, n, n, &RandomValues::uniform);
        u.values[random.index(n * n)] = random.nasty();
        u(random.index(n), n - 1) = i % 2 == 0 ? kInfinity : 0.0;
        expectPlainCholeskyInverse(table(), u, "case " + std::to_string(i));
    }
}

INSTANTIATE_TEST_SUITE_P(Levels, CholeskyKernels, testing::ValuesIn(kernels::kLevels), levelName);

}  // namespace
}  // namespace reisti::test
