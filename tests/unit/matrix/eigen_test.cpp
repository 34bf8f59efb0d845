#include <algorithm>
#include <limits>
#include <numeric>

#include "unit/matrix/matrix_kinds.h"
#include "unit/matrix/solver_samples.h"

namespace reisti::test {
namespace {

using qan::matrix_library::EigenSystems;

constexpr double kInfinity = std::numeric_limits<double>::infinity();
const double kNaN = std::numeric_limits<double>::quiet_NaN();

/// Eigenvalues closer than this, relative to the larger, may stand in either order.
constexpr double kOrderingFuzz = 1e-12;

/// How far eigenvalues may be off: the tridiagonal form and the rotations are orthogonal up to a small multiple of n u
/// each, so that the computed values belong to a matrix within that multiple of norm(A).
double eigenvalueBound(const PlainMatrix& a) {
    return 10.0 * std::max(1, a.rows) * kEpsilon * frobeniusNorm(a);
}

void expectEigenSystem(const PlainMatrix& a) {
    const int n = a.rows;
    Vec values{-7, -7};
    Dense vectors(1, 2, 9.0);
    ASSERT_EQ(EigenSystems(dense(a), values, vectors), 0);
    ASSERT_EQ(values.size(), static_cast<std::size_t>(n));
    ASSERT_EQ(vectors.rowCount(), n);
    ASSERT_EQ(vectors.colCount(), n);
    const PlainMatrix v = plain(vectors);

    EXPECT_LE(largestMagnitude(plainDifference(plainProduct(plainTranspose(v), v), plainIdentity(n))),
              10.0 * std::max(1, n) * kEpsilon)
        << "the vectors are orthonormal";
    PlainMatrix scaledVectors = v;
    for (int i = 0; i < n; ++i)
        for (int j = 0; j < n; ++j)
            scaledVectors(i, j) *= values[static_cast<std::size_t>(j)];
    EXPECT_LE(frobeniusNorm(plainDifference(plainProduct(a, v), scaledVectors)), 2.0 * eigenvalueBound(a))
        << "each vector belongs to its value";
    for (std::size_t k = 1; k < values.size(); ++k) {
        const double fuzz = std::max(std::fabs(values[k - 1]), std::fabs(values[k])) * kOrderingFuzz;
        EXPECT_GE(values[k], values[k - 1] - fuzz) << "ascending at " << k;
    }
}

/// Additionally compares the eigenvalues with known ones.
void expectEigenvalues(const PlainMatrix& a, Vec expected) {
    expectEigenSystem(a);
    std::sort(expected.begin(), expected.end());
    Vec values;
    Dense vectors;
    ASSERT_EQ(dense(a).EigenSystems(values, vectors), 0);
    ASSERT_EQ(values.size(), expected.size());
    std::sort(values.begin(), values.end());
    for (std::size_t k = 0; k < values.size(); ++k)
        EXPECT_NEAR(values[k], expected[k], eigenvalueBound(a)) << k;
}

TEST(EigenSystem, OfATwoByTwoMatrixIsAscending) {
    Vec values;
    Dense vectors;
    ASSERT_EQ(EigenSystems(Dense(Vec{2, 1, 1, 2}, 2), values, vectors), 0);
    ASSERT_EQ(values.size(), 2U);
    EXPECT_DOUBLE_EQ(values[0], 1.0);
    EXPECT_DOUBLE_EQ(values[1], 3.0);
    EXPECT_NEAR(vectors(0, 0), -vectors(1, 0), 4 * kEpsilon);
    EXPECT_NEAR(vectors(0, 1), vectors(1, 1), 4 * kEpsilon);
}

TEST(EigenSystem, OfOrderZeroIsEmpty) {
    Vec values{1, 2};
    Dense vectors(2, 2, 1.0);
    EXPECT_EQ(EigenSystems(Dense(), values, vectors), 0);
    EXPECT_TRUE(values.empty());
    EXPECT_EQ(vectors.rowCount(), 0);
    EXPECT_EQ(vectors.colCount(), 0);
}

TEST(EigenSystem, OfOrderOneIsItsElement) {
    for (const double element : {-3.5, 0.0, 1e-300, 1e300}) {
        Vec values;
        Dense vectors;
        ASSERT_EQ(EigenSystems(Dense(1, 1, element), values, vectors), 0);
        EXPECT_EQ(values, (Vec{element}));
        EXPECT_EQ(std::fabs(vectors(0, 0)), 1.0);
    }
}

TEST(EigenSystem, OfEveryKindOfTwoByTwoMatrix) {
    expectEigenvalues({{0, 1}, {1, 0}}, {-1, 1});
    expectEigenvalues({{1, 1}, {1, 1}}, {0, 2});
    expectEigenvalues({{5, 0}, {0, -2}}, {-2, 5});
    expectEigenvalues({{0, 0}, {0, 0}}, {0, 0});
    expectEigenvalues({{3, 0}, {0, 3}}, {3, 3});
    expectEigenvalues({{1e8, 1}, {1, 1e-8}}, {0, 1e8 + 1e-8});
}

TEST(EigenSystem, OfADiagonalMatrixSortsTheDiagonal) {
    const Vec elements{3, -1, 7, 0, 2, -1e-9, 1e9};
    PlainMatrix a(7, 7);
    for (int i = 0; i < 7; ++i)
        a(i, i) = elements[static_cast<std::size_t>(i)];
    Vec values;
    Dense vectors;
    ASSERT_EQ(EigenSystems(dense(a), values, vectors), 0);
    EXPECT_EQ(values, (Vec{-1, -1e-9, 0, 2, 3, 7, 1e9}));
    for (int k = 0; k < 7; ++k)
        for (int i = 0; i < 7; ++i)
            EXPECT_EQ(std::fabs(vectors(i, k)), a(i, i) == values[static_cast<std::size_t>(k)] ? 1.0 : 0.0);
}

TEST(EigenSystem, OfTheIdentityAndOfZeroIsExact) {
    for (const int order : {1, 2, 3, 10, 50}) {
        for (const double element : {0.0, 1.0}) {
            Vec values;
            Dense vectors;
            ASSERT_EQ(EigenSystems(dense(plainScaled(plainIdentity(order), element)), values, vectors), 0);
            EXPECT_EQ(values, Vec(static_cast<std::size_t>(order), element));
            expectEigenSystem(plainScaled(plainIdentity(order), element));
        }
    }
}

TEST(EigenSystem, OfRandomSymmetricMatrices) {
    UniformNumbers random(121);
    for (int order = 1; order <= 24; ++order)
        expectEigenSystem(randomSymmetric(order, random));
    for (const int order : {40, 65, 100})
        expectEigenSystem(randomSymmetric(order, random));
}

TEST(EigenSystem, OfRandomPositiveDefiniteMatricesHasPositiveValues) {
    UniformNumbers random(122);
    for (const int order : {2, 5, 20, 60}) {
        const PlainMatrix a = positiveDefinite(order, random);
        expectEigenSystem(a);
        Vec values;
        Dense vectors;
        EigenSystems(dense(a), values, vectors);
        EXPECT_GT(*std::min_element(values.begin(), values.end()), 0.4);
    }
}

TEST(EigenSystem, OfRepeatedEigenvalues) {
    UniformNumbers random(123);
    expectEigenvalues(withSpectrum({2, 2, 2, 5, 5, -1}, random), {2, 2, 2, 5, 5, -1});
    expectEigenvalues(withSpectrum(Vec(12, 1.0), random), Vec(12, 1.0));
    expectEigenvalues(withSpectrum({1, 1 + 1e-13, 1 + 2e-13, 3}, random), {1, 1 + 1e-13, 1 + 2e-13, 3});
}

TEST(EigenSystem, OfZeroEigenvalues) {
    UniformNumbers random(124);
    expectEigenvalues(withSpectrum({0, 0, 0, 1, 2}, random), {0, 0, 0, 1, 2});
    expectEigenvalues(withSpectrum({0, 0, 0, 0, 0, 0, 0, 4}, random), {0, 0, 0, 0, 0, 0, 0, 4});
    for (const int order : {2, 3, 8, 30}) {
        PlainMatrix ones(order, order);
        for (double& cell : ones.cells)
            cell = 1.0;
        Vec expected(static_cast<std::size_t>(order), 0.0);
        expected.back() = order;
        expectEigenvalues(ones, expected);
    }
}

TEST(EigenSystem, OfLowRankMatricesConverges) {
    UniformNumbers random(125);
    for (const int order : {5, 20, 60, 120}) {
        for (const int rank : {1, 2, 3, order / 2}) {
            const PlainMatrix factor = random.matrix(order, rank);
            PlainMatrix a = plainProduct(factor, plainTranspose(factor));
            expectEigenSystem(a);
        }
    }
}

TEST(EigenSystem, OfWidelySpreadEigenvalues) {
    UniformNumbers random(126);
    expectEigenvalues(withSpectrum({1e-12, 1e-6, 1, 1e6, 1e12}, random), {1e-12, 1e-6, 1, 1e6, 1e12});
    expectEigenvalues(withSpectrum({-1e10, -1, 1e-10, 1, 1e10}, random), {-1e10, -1, 1e-10, 1, 1e10});
    for (const int order : {3, 10, 40})
        expectEigenSystem(graded(order, random));
}

TEST(EigenSystem, OfGradedMatricesWithTheLargeEndFirstOrLast) {
    UniformNumbers random(127);
    for (const int order : {4, 16, 50}) {
        const PlainMatrix falling = graded(order, random);
        PlainMatrix rising(order, order);
        for (int i = 0; i < order; ++i)
            for (int j = 0; j < order; ++j)
                rising(i, j) = falling(order - 1 - i, order - 1 - j);
        expectEigenSystem(falling);
        expectEigenSystem(rising);
    }
}

TEST(EigenSystem, OfHilbertMatrices) {
    for (int order = 1; order <= 14; ++order)
        expectEigenSystem(hilbert(order));
}

TEST(EigenSystem, OfTheSecondDifferenceMatrixHasTheClosedForm) {
    for (const int order : {1, 2, 5, 30, 100}) {
        PlainMatrix a(order, order);
        Vec expected;
        for (int i = 0; i < order; ++i) {
            a(i, i) = 2.0;
            if (i > 0) a(i, i - 1) = a(i - 1, i) = -1.0;
            const double half = std::sin((i + 1) * 3.14159265358979323846 / (2 * (order + 1)));
            expected.push_back(4.0 * half * half);
        }
        expectEigenvalues(a, expected);
    }
}

TEST(EigenSystem, OfMagnitudesFarFromOne) {
    UniformNumbers random(128);
    for (const double magnitude : {1e-140, 1e-60, 1e60, 1e140})
        expectEigenSystem(plainScaled(randomSymmetric(12, random), magnitude));
}

TEST(EigenSystem, OfBlockDiagonalMatricesSplits) {
    UniformNumbers random(129);
    const PlainMatrix first = randomSymmetric(5, random);
    const PlainMatrix second = randomSymmetric(4, random);
    PlainMatrix a(10, 10);
    for (int i = 0; i < 5; ++i)
        for (int j = 0; j < 5; ++j)
            a(i, j) = first(i, j);
    for (int i = 0; i < 4; ++i)
        for (int j = 0; j < 4; ++j)
            a(i + 6, j + 6) = second(i, j);
    expectEigenSystem(a);
}

TEST(EigenSystem, MemberGivesTheSameAsTheFunction) {
    UniformNumbers random(130);
    const Dense a = dense(randomSymmetric(17, random));
    Vec values;
    Vec memberValues;
    Dense vectors;
    Dense memberVectors;
    ASSERT_EQ(EigenSystems(a, values, vectors), 0);
    ASSERT_EQ(a.EigenSystems(memberValues, memberVectors), 0);
    EXPECT_TRUE(sameBits(values, memberValues));
    EXPECT_TRUE(sameBits(plain(vectors), plain(memberVectors)));
}

TEST(EigenSystem, RepeatsBitForBit) {
    UniformNumbers random(131);
    const Dense a = dense(randomSymmetric(33, random));
    Vec first;
    Vec second;
    Dense vectors;
    Dense secondVectors;
    EigenSystems(a, first, vectors);
    EigenSystems(a, second, secondVectors);
    EXPECT_TRUE(sameBits(first, second));
    EXPECT_TRUE(sameBits(plain(vectors), plain(secondVectors)));
}

TEST(EigenSystem, LeavesTheMatrix) {
    UniformNumbers random(132);
    const PlainMatrix source = randomSymmetric(9, random);
    const Dense a = dense(source);
    Vec values;
    Dense vectors;
    EigenSystems(a, values, vectors);
    EXPECT_TRUE(sameBits(plain(a), source));
}

TEST(EigenSystem, OfANonSquareMatrixIsAnAssertion) {
    for (const Dense& a : {Dense(2, 3, 1.0), Dense(3, 2, 1.0), Dense(0, 1, 1.0)}) {
        Vec values;
        Dense vectors;
        EXPECT_THAT(messageOf<AllegeException>([&] { EigenSystems(a, values, vectors); }),
                    IsAssertion("iNumRows == lhs.colCount()", "src/matrix/matrix_functions"));
        EXPECT_THAT(messageOf<AllegeException>([&] { a.EigenSystems(values, vectors); }),
                    IsAssertion("iNumRows == lhs.colCount()"));
    }
}

TEST(EigenSystem, OfNonFiniteElementsEnds) {
    UniformNumbers random(133);
    for (const int order : {1, 2, 3, 5, 20}) {
        for (const double extreme : {kNaN, kInfinity, -kInfinity}) {
            for (int i = 0; i < order; i += 1 + order / 4) {
                for (int j = 0; j <= i; j += 1 + order / 4) {
                    PlainMatrix a = randomSymmetric(order, random);
                    a(i, j) = a(j, i) = extreme;
                    Vec values;
                    Dense vectors;
                    const int outcome = EigenSystems(dense(a), values, vectors);
                    EXPECT_GE(outcome, 0);
                    EXPECT_LT(outcome, order);
                }
            }
            PlainMatrix everywhere(order, order);
            for (double& cell : everywhere.cells)
                cell = extreme;
            Vec values;
            Dense vectors;
            EXPECT_GE(EigenSystems(dense(everywhere), values, vectors), 0);
        }
    }
}

}  // namespace
}  // namespace reisti::test
