#include "matrix/kernels/eigen_system.h"

#include <algorithm>
#include <cmath>
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

using kernels::Level;

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNan = std::numeric_limits<double>::quiet_NaN();

// Rounding errors grow with the order; measured ones stay below a tenth of this, relative to the greatest eigenvalue.
double tolerance(std::size_t n) {
    return 4e-15 * static_cast<double>(n + 1);
}

struct EigenSystem {
    std::size_t failed;
    std::vector<double> values;
    PlainMatrix vectors;
};

EigenSystem solve(Level level, const PlainMatrix& a) {
    EigenSystem system{7, std::vector<double>(a.rows, 1e300), PlainMatrix(a.rows, a.rows, 1e300)};
    system.failed =
        kernels::eigenSystem(level, a.values.data(), a.rows, system.values.data(), system.vectors.values.data());
    return system;
}

/// NaN when one of the values is.
double greatestMagnitude(const std::vector<double>& values) {
    double greatest = 0.0;
    for (const double value : values) {
        if (!(std::fabs(value) <= greatest)) greatest = std::fabs(value);
        if (std::isnan(greatest)) break;
    }
    return greatest;
}

/// Ascending values (up to near ties), orthonormal vectors, and A V = V D.
void expectEigenSystem(const PlainMatrix& a, const EigenSystem& system, const std::string& what) {
    const std::size_t n = a.rows;
    EXPECT_EQ(system.failed, 0U) << what;
    // Values that agree in the first twelve digits count as equal and stay in the order in which they were found.
    for (std::size_t k = 1; k < n; ++k) {
        const double slack = 1e-11 * std::fabs(system.values[k]);
        EXPECT_GE(system.values[k] + slack, system.values[k - 1]) << what << ", value " << k;
    }

    PlainMatrix gram = plainProduct(plainTranspose(system.vectors), system.vectors);
    for (std::size_t i = 0; i < n; ++i)
        gram(i, i) -= 1.0;
    EXPECT_LE(greatestMagnitude(gram.values), tolerance(n)) << what << ": vectors not orthonormal";

    const double scale = greatestMagnitude(system.values);
    PlainMatrix residual = plainProduct(a, system.vectors);
    for (std::size_t i = 0; i < n; ++i) {
        for (std::size_t k = 0; k < n; ++k)
            residual(i, k) -= system.vectors(i, k) * system.values[k];
    }
    EXPECT_LE(greatestMagnitude(residual.values), tolerance(n) * scale) << what << ": residual";
}

PlainMatrix randomSymmetric(RandomValues& random, std::size_t n, Draw draw) {
    PlainMatrix a(n, n);
    for (std::size_t i = 0; i < n; ++i) {
        for (std::size_t j = 0; j <= i; ++j)
            a(i, j) = a(j, i) = (random.*draw)();
    }
    return a;
}

/// Q D Q^T with a random orthogonal Q (from the eigenvectors of a random matrix) and the given spectrum.
PlainMatrix withSpectrum(RandomValues& random, const std::vector<double>& spectrum) {
    const std::size_t n = spectrum.size();
    const PlainMatrix q = solve(Level::kBaseline, randomSymmetric(random, n, &RandomValues::uniform)).vectors;
    PlainMatrix scaled = q;
    for (std::size_t i = 0; i < n; ++i) {
        for (std::size_t k = 0; k < n; ++k)
            scaled(i, k) *= spectrum[k];
    }
    PlainMatrix a = plainProduct(scaled, plainTranspose(q));
    for (std::size_t i = 0; i < n; ++i) {
        for (std::size_t j = 0; j < i; ++j)
            a(j, i) = a(i, j);
    }
    return a;
}

void expectSpectrum(const EigenSystem& system, std::vector<double> spectrum, const std::string& what) {
    std::sort(spectrum.begin(), spectrum.end());
    const double bound = tolerance(spectrum.size()) * greatestMagnitude(spectrum);
    for (std::size_t k = 0; k < spectrum.size(); ++k)
        EXPECT_NEAR(system.values[k], spectrum[k], bound) << what << ", value " << k;
}

class EigenKernels : public KernelLevels {};

TEST_P(EigenKernels, SolveRandomMatricesOfAllSmallOrders) {
    RandomValues random(1);
    for (std::size_t n = 0; n <= 70; ++n) {
        const PlainMatrix a = randomSymmetric(random, n, &RandomValues::uniform);
        expectEigenSystem(a, solve(GetParam(), a), "order " + std::to_string(n));
    }
}

TEST_P(EigenKernels, SolveALargerMatrix) {
    RandomValues random(2);
    const std::size_t n = scaled(20) > 1 ? 260 : 130;
    const PlainMatrix a = randomSymmetric(random, n, &RandomValues::uniform);
    expectEigenSystem(a, solve(GetParam(), a), "order " + std::to_string(n));
}

TEST_P(EigenKernels, GiveTheSameBitsAsTheBaseline) {
    RandomValues random(3);
    for (const std::size_t n : {1U, 2U, 3U, 5U, 8U, 13U, 16U, 17U, 31U, 33U, 40U, 65U, 100U}) {
        const PlainMatrix a =
            randomSymmetric(random, n, n % 2 == 0 ? &RandomValues::uniform : &RandomValues::cancelling);
        const EigenSystem actual = solve(GetParam(), a);
        const EigenSystem expected = solve(Level::kBaseline, a);
        EXPECT_TRUE(haveSameBits(actual.values, expected.values)) << "order " << n;
        EXPECT_TRUE(haveSameBits(actual.vectors.values, expected.vectors.values)) << "order " << n;
    }
}

TEST_P(EigenKernels, FindRepeatedAndZeroEigenvalues) {
    RandomValues random(4);
    for (const std::vector<double>& spectrum :
         {std::vector<double>(12, 3.0), std::vector<double>{0, 0, 0, 1, 1, 1, 1, 2, 2, -5, -5},
          std::vector<double>{1e-3, 1e-3, 1e3, 1e3}, std::vector<double>(20, 0.0)}) {
        const PlainMatrix a = withSpectrum(random, spectrum);
        const EigenSystem system = solve(GetParam(), a);
        expectEigenSystem(a, system, "order " + std::to_string(a.rows));
        expectSpectrum(system, spectrum, "order " + std::to_string(a.rows));
    }
}

TEST_P(EigenKernels, FindWidelySpreadEigenvalues) {
    RandomValues random(5);
    std::vector<double> spectrum;
    for (int k = 0; k < 30; ++k)
        spectrum.push_back((k % 2 == 0 ? 1.0 : -1.0) * std::pow(10.0, k - 20));
    const PlainMatrix a = withSpectrum(random, spectrum);
    const EigenSystem system = solve(GetParam(), a);
    expectEigenSystem(a, system, "spread");
    expectSpectrum(system, spectrum, "spread");
}

TEST_P(EigenKernels, TakeDiagonalMatricesExactly) {
    PlainMatrix a(9, 9);
    const std::vector<double> diagonal = {5, -2, 0, 7, 7, 1e-9, -1e9, 3, 0};
    for (std::size_t i = 0; i < 9; ++i)
        a(i, i) = diagonal[i];
    const EigenSystem system = solve(GetParam(), a);
    expectEigenSystem(a, system, "diagonal");
    std::vector<double> sorted = diagonal;
    std::sort(sorted.begin(), sorted.end());
    EXPECT_EQ(system.values, sorted);
}

TEST_P(EigenKernels, KeepTheOrderOfEqualValues) {
    PlainMatrix a(4, 4);
    for (std::size_t i = 0; i < 4; ++i)
        a(i, i) = i == 2 ? 1.0 : 2.0;
    const EigenSystem system = solve(GetParam(), a);
    // Selection swaps the first value with the least one and leaves the others where they are.
    const std::vector<std::size_t> expectedRow = {2, 1, 0, 3};
    for (std::size_t k = 0; k < 4; ++k)
        EXPECT_EQ(std::fabs(system.vectors(expectedRow[k], k)), 1.0) << k;
}

TEST_P(EigenKernels, SolveTridiagonalMatricesWithKnownSpectrum) {
    const std::size_t n = 50;
    PlainMatrix a(n, n);
    std::vector<double> spectrum;
    for (std::size_t i = 0; i < n; ++i) {
        a(i, i) = 2.0;
        if (i > 0) a(i, i - 1) = a(i - 1, i) = -1.0;
        // Eigenvalues of the second difference.
        spectrum.push_back(2.0 - 2.0 * std::cos(static_cast<double>(i + 1) * std::acos(-1.0) / (n + 1.0)));
    }
    const EigenSystem system = solve(GetParam(), a);
    expectEigenSystem(a, system, "second difference");
    expectSpectrum(system, spectrum, "second difference");
}

TEST_P(EigenKernels, SolveBlocksThatFallApart) {
    RandomValues random(6);
    for (int i = 0; i < scaled(60); ++i) {
        const std::size_t n = 1 + random.index(40);
        PlainMatrix a = randomSymmetric(random, n, &RandomValues::cancelling);
        for (std::size_t r = 0; r < n; ++r) {
            for (std::size_t c = 0; c < n; ++c) {
                // Three blocks, interleaved.
                if (r % 3 != c % 3) a(r, c) = 0.0;
            }
        }
        expectEigenSystem(a, solve(GetParam(), a), "case " + std::to_string(i));
    }
}

TEST_P(EigenKernels, ReadTheLowerTriangleOnly) {
    RandomValues random(7);
    PlainMatrix a = randomSymmetric(random, 20, &RandomValues::uniform);
    const EigenSystem expected = solve(GetParam(), a);
    for (std::size_t i = 0; i < 20; ++i) {
        for (std::size_t j = i + 1; j < 20; ++j)
            a(i, j) = kNan;
    }
    EXPECT_TRUE(haveSameBits(solve(GetParam(), a).values, expected.values));
}

TEST_P(EigenKernels, SolveHugeAndTinyMatricesLikeOrdinaryOnes) {
    RandomValues random(8);
    const PlainMatrix a = randomSymmetric(random, 25, &RandomValues::uniform);
    const EigenSystem ordinary = solve(GetParam(), a);
    // Powers of two only move the exponent.
    for (const int exponent : {-900, -400, 400, 1000}) {
        PlainMatrix scaledMatrix = a;
        for (double& value : scaledMatrix.values)
            value = std::ldexp(value, exponent);
        const EigenSystem system = solve(GetParam(), scaledMatrix);
        EXPECT_EQ(system.failed, 0U) << exponent;
        for (std::size_t k = 0; k < 25; ++k)
            EXPECT_NEAR(std::ldexp(system.values[k], -exponent), ordinary.values[k], tolerance(25) * 10.0) << exponent;
        EXPECT_LE(greatestMagnitude(plainProduct(plainTranspose(system.vectors), system.vectors).values), 1.0 + 1e-13);
    }
}

TEST_P(EigenKernels, SolveMatricesWithOneHugeElementAnywhere) {
    for (std::size_t i = 0; i < 5; ++i) {
        for (std::size_t j = 0; j <= i; ++j) {
            PlainMatrix a(5, 5, 1.0);
            a(i, j) = a(j, i) = 1e200;
            expectEigenSystem(a, solve(GetParam(), a), "row " + std::to_string(i) + ", column " + std::to_string(j));
        }
    }
}

TEST_P(EigenKernels, SolveGradedMatricesWithoutLosingOrthogonality) {
    // Rows so small that their squares are subnormal or 0.
    for (const double step : {1e-3, 1e-20, 1e-60, 1e-100, 1e-150}) {
        RandomValues random(9);
        PlainMatrix a = randomSymmetric(random, 12, &RandomValues::uniform);
        for (std::size_t i = 0; i < 12; ++i) {
            for (std::size_t j = 0; j < 12; ++j)
                a(i, j) *= std::pow(step, static_cast<double>(i / 4 + j / 4) / 2.0);
        }
        expectEigenSystem(a, solve(GetParam(), a), "step " + std::to_string(-std::log10(step)));
    }
}

TEST_P(EigenKernels, EndOnInfinitiesAndNans) {
    RandomValues random(10);
    for (const double value : {kNan, kInfinity, -kInfinity}) {
        for (const std::size_t place : {0U, 5U, 100U, 399U}) {
            PlainMatrix a = randomSymmetric(random, 20, &RandomValues::uniform);
            a.values[place] = value;
            a(place % 20, place / 20) = value;
            const EigenSystem system = solve(GetParam(), a);
            EXPECT_LT(system.failed, 20U);
        }
    }
    const EigenSystem all = solve(GetParam(), PlainMatrix(6, 6, kNan));
    EXPECT_LT(all.failed, 6U);
}

INSTANTIATE_TEST_SUITE_P(Levels, EigenKernels, testing::ValuesIn(kernels::kLevels), levelName);

}  // namespace
}  // namespace reisti::test
