#include <limits>
#include <type_traits>

#include "support/plain_factorizations.h"
#include "unit/matrix/matrix_kinds.h"
#include "unit/matrix/solver_samples.h"

namespace reisti::test {
namespace {

using qan::matrix_library::CholeskyBackSub;
using qan::matrix_library::CholeskyDecomp;
using qan::matrix_library::CholeskyDecompWithThrow;
using qan::matrix_library::CholeskyInverse;
using qan::matrix_library::inverse;
using qan::matrix_library::inverseWithThrow;

static_assert(std::is_same_v<decltype(CholeskyInverse(std::declval<const Upper&>())), Symmetric>);
static_assert(std::is_same_v<decltype(CholeskyDecompWithThrow(std::declval<const Symmetric&>())), Upper>);

constexpr double kUntouched = -12345.0;

TEST(CholeskyDecomposition, OfATwoByTwoMatrix) {
    Upper u;
    ASSERT_TRUE(CholeskyDecomp(symmetric({{4, 2}, {2, 3}}), &u));
    EXPECT_EQ(plain(u), (PlainMatrix{{2, 1}, {0, std::sqrt(2.0)}}));
    EXPECT_EQ(plain(CholeskyDecompWithThrow(symmetric({{4, 2}, {2, 3}}))), plain(u));
    Upper fromMember;
    EXPECT_TRUE(symmetric({{4, 2}, {2, 3}}).CholeskyDecomp(&fromMember));
    EXPECT_EQ(plain(fromMember), plain(u));
}

TEST(CholeskyDecomposition, OfASingularMatrixFailsAtTheExactZeroPivot) {
    const Symmetric s = symmetric({{1, 2}, {2, 4}});
    Upper u(3, 9.0);
    EXPECT_FALSE(CholeskyDecomp(s, &u));
    EXPECT_EQ(u.rowCount(), 0);
    Upper fromMember(3, 9.0);
    EXPECT_FALSE(s.CholeskyDecomp(&fromMember));
    EXPECT_EQ(fromMember.rowCount(), 0);
    EXPECT_EQ(messageOf<MatrixSingular>([&] { static_cast<void>(CholeskyDecompWithThrow(s)); }), "Matrix is singular");

    int failedRow = -7;
    double pivot = kUntouched;
    static_cast<void>(CholeskyDecomp(Upper(2, Vec{1, 2, 4}), 0, &failedRow, &pivot));
    EXPECT_EQ(failedRow, 1);
    EXPECT_EQ(pivot, 0.0);
}

TEST(CholeskyDecomposition, PivotsHaveNoTolerance) {
    Upper u;
    EXPECT_TRUE(CholeskyDecomp(Symmetric(1, std::numeric_limits<double>::denorm_min()), &u));
    EXPECT_FALSE(CholeskyDecomp(Symmetric(1, 0.0), &u));
    EXPECT_FALSE(CholeskyDecomp(Symmetric(1, -0.0), &u));
    EXPECT_FALSE(CholeskyDecomp(Symmetric(1, -1e-300), &u));
}

TEST(CholeskyDecomposition, FailureReportsTheRowThePivotsMagnitudeAndTheWorkSoFar) {
    // Row 0 is done, row 1 has pivot 1 - 4 = -3, row 2 is as it was.
    int failedRow = -7;
    double pivot = kUntouched;
    const Upper u = CholeskyDecomp(Upper(3, Vec{1, 2, 3, 1, 5, 6}), 0, &failedRow, &pivot);
    EXPECT_EQ(failedRow, 1);
    EXPECT_EQ(pivot, 3.0);
    EXPECT_EQ(plain(u), (PlainMatrix{{1, 2, 3}, {0, 1, 5}, {0, 0, 6}}));
}

TEST(CholeskyDecomposition, OfOrderZeroSucceedsWithoutAPivot) {
    int failedRow = -7;
    double pivot = kUntouched;
    EXPECT_EQ(CholeskyDecomp(Upper(), 0, &failedRow, &pivot).rowCount(), 0);
    EXPECT_EQ(failedRow, -1);
    EXPECT_EQ(pivot, kUntouched);
    Upper u(2, 1.0);
    EXPECT_TRUE(CholeskyDecomp(Symmetric(0, 0.0), &u));
    EXPECT_EQ(u.rowCount(), 0);
}

TEST(CholeskyDecomposition, StartingAtTheOrderCopies) {
    int failedRow = -7;
    double pivot = kUntouched;
    const Upper a(2, Vec{-1, 2, -3});
    EXPECT_EQ(plain(CholeskyDecomp(a, 2, &failedRow, &pivot)), plain(a));
    EXPECT_EQ(failedRow, -1);
    EXPECT_EQ(pivot, kUntouched);
}

TEST(CholeskyDecomposition, StartingBeyondTheOrderIsRefused) {
    int failedRow = -7;
    double pivot = kUntouched;
    EXPECT_EQ(
        messageOf<MatrixException>([&] { static_cast<void>(CholeskyDecomp(Upper(2, 1.0), 3, &failedRow, &pivot)); }),
        "UTmatrix: starting row greater than dimension");
    EXPECT_EQ(
        messageOf<MatrixException>([&] { static_cast<void>(Upper(2, 1.0).CholeskyDecomp(3, &failedRow, &pivot)); }),
        "UTmatrix: starting row greater than dimension");
}

TEST(CholeskyDecomposition, NullResultIsAnAssertion) {
    Upper* const nowhere = nullptr;
    EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(CholeskyDecomp(Symmetric(1, 1.0), nowhere)); }),
                IsAssertion("result", "src/matrix/matrix_functions"));
    EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(Symmetric(1, 1.0).CholeskyDecomp(nowhere)); }),
                IsAssertion("result", "src/matrix/matrix_functions"));
}

/// Compares factor, failed row and pivot with the plain loops, bit by bit.
void expectPlainBits(const PlainMatrix& upperTriangle, int start) {
    const PlainCholesky expected = plainCholesky(upperTriangle, start);
    int failedRow = -7;
    double pivot = kUntouched;
    const Upper a = upper(upperTriangle);
    const Upper u = CholeskyDecomp(a, start, &failedRow, &pivot);
    EXPECT_TRUE(sameBits(plain(u), expected.factor)) << "order " << upperTriangle.rows << ", start " << start;
    EXPECT_EQ(failedRow, expected.failedRow);
    EXPECT_TRUE(sameBits(pivot, expected.pivot.value_or(kUntouched)));

    failedRow = -7;
    EXPECT_TRUE(sameBits(plain(a.CholeskyDecomp(start, &failedRow, &pivot)), expected.factor));
    EXPECT_EQ(failedRow, expected.failedRow);
}

TEST(CholeskyDecomposition, HasTheBitsOfThePlainLoops) {
    UniformNumbers random(91);
    for (const int order : {1, 2, 3, 5, 8, 13, 16, 31, 32, 33, 64, 65, 96, 100, 130, 200})
        expectPlainBits(positiveDefinite(order, random), 0);
}

TEST(CholeskyDecomposition, HasTheBitsOfThePlainLoopsUpToAFailure) {
    UniformNumbers random(92);
    for (int trial = 0; trial < scaled(60); ++trial) {
        const int order = random.integer(2, 90);
        PlainMatrix a = positiveDefinite(order, random);
        const int spoiled = random.integer(0, order - 1);
        a(spoiled, spoiled) = random.between(-1.0, 1.0);
        expectPlainBits(a, 0);
    }
}

TEST(CholeskyDecomposition, HasTheBitsOfThePlainLoopsOnIllConditionedMatrices) {
    for (int order = 1; order <= 20; ++order)
        expectPlainBits(hilbert(order), 0);
    UniformNumbers random(93);
    for (int order = 1; order <= 40; ++order)
        expectPlainBits(graded(order, random), 0);
}

TEST(CholeskyDecomposition, FromALaterRowTakesTheRowsAboveAsTheyAre) {
    UniformNumbers random(94);
    for (const int order : {1, 2, 5, 20, 70}) {
        for (int start = 0; start <= order; start += 1 + order / 7)
            expectPlainBits(positiveDefinite(order, random), start);
    }
}

TEST(CholeskyDecomposition, ContinuedFromAPartFactorizedMatrixGivesTheWholeFactor) {
    UniformNumbers random(95);
    for (const int order : {2, 5, 20, 70}) {
        const PlainMatrix a = positiveDefinite(order, random);
        const PlainMatrix whole = plainCholesky(a).factor;
        for (int start = 1; start < order; start += 1 + order / 5) {
            PlainMatrix part = a;
            for (int i = 0; i < start; ++i)
                for (int j = i; j < order; ++j)
                    part(i, j) = whole(i, j);
            int failedRow = -7;
            double pivot = kUntouched;
            EXPECT_TRUE(sameBits(plain(CholeskyDecomp(upper(part), start, &failedRow, &pivot)), whole))
                << order << ", " << start;
            EXPECT_EQ(failedRow, -1);
        }
    }
}

TEST(CholeskyDecomposition, OfNaNIsNoFailureSinceTheComparisonIsFalse) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    PlainMatrix a{{4, 2, nan}, {2, 3, 1}, {nan, 1, 5}};
    expectPlainBits(a, 0);
    Upper u;
    EXPECT_TRUE(CholeskyDecomp(symmetric(a), &u));
    EXPECT_TRUE(std::isnan(u(2, 2)));
}

TEST(CholeskyDecomposition, OfInfinityEndsWithoutALoop) {
    const double infinity = std::numeric_limits<double>::infinity();
    expectPlainBits({{infinity, 1}, {1, 2}}, 0);
    expectPlainBits({{1, infinity}, {infinity, 2}}, 0);
}

TEST(CholeskyDecomposition, ReproducesTheMatrix) {
    UniformNumbers random(96);
    for (const int order : {1, 2, 10, 50}) {
        for (const PlainMatrix& a : {positiveDefinite(order, random), graded(order, random)}) {
            Upper u;
            ASSERT_TRUE(CholeskyDecomp(symmetric(a), &u));
            const PlainMatrix residual = plainDifference(plainProduct(plainTranspose(plain(u)), plain(u)), a);
            // Higham (2002), Theorem 10.3: |A - U^T U| <= (n + 1) u |U^T| |U|, whose elements are at most the largest
            // diagonal element of A up to rounding.
            EXPECT_LE(largestMagnitude(residual), (order + 2) * kEpsilon * largestMagnitude(a)) << "order " << order;
        }
    }
}

TEST(CholeskyBackSubstitution, SolvesTheTwoByTwoSystem) {
    const Upper u(2, Vec{2, 1, 4});
    // U^T U = [[4, 2], [2, 17]].
    const Vec x = CholeskyBackSub(u, Vec{8, 36});
    EXPECT_EQ(x, (Vec{1, 2}));
    EXPECT_EQ(u.CholeskyBackSub(Vec{8, 36}), (Vec{1, 2}));
}

TEST(CholeskyBackSubstitution, OfOrderZeroIsEmpty) {
    EXPECT_TRUE(CholeskyBackSub(Upper(), Vec{}).empty());
}

TEST(CholeskyBackSubstitution, WithAnotherLengthIsRefused) {
    const std::string text = "UTmatrix: matrix and vector have incompatible dimensions";
    for (const Vec& b : {Vec{}, Vec{1}, Vec{1, 2, 3}}) {
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(CholeskyBackSub(Upper(2, 1.0), b)); }), text);
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(Upper(2, 1.0).CholeskyBackSub(b)); }), text);
    }
}

TEST(CholeskyBackSubstitution, DoesNotTestForAZeroDiagonal) {
    const Vec x = CholeskyBackSub(Upper(1, 0.0), Vec{1});
    ASSERT_EQ(x.size(), 1U);
    EXPECT_FALSE(std::isfinite(x[0]));
}

TEST(CholeskyBackSubstitution, LeavesASmallResidual) {
    UniformNumbers random(97);
    for (const int order : {1, 2, 9, 40, 120}) {
        for (const PlainMatrix& a :
             {positiveDefinite(order, random), graded(order, random), hilbert(std::min(order, 9))}) {
            const Vec b = random.vector(a.rows);
            const Vec x = CholeskyBackSub(CholeskyDecompWithThrow(symmetric(a)), b);
            const PlainMatrix residual = plainDifference(plainProduct(a, plainVector(x)), plainVector(b));
            // Higham (2002), Theorem 10.4: the computed solution solves a system perturbed by 4 n (3 n + 1) u norm(A).
            const double bound =
                4.0 * a.rows * (3 * a.rows + 1) * kEpsilon * frobeniusNorm(a) * frobeniusNorm(plainVector(x));
            EXPECT_LE(frobeniusNorm(residual), bound) << "order " << a.rows;
        }
    }
}

TEST(CholeskyInverse, OfATwoByTwoFactor) {
    // U^T U = [[4, 4], [4, 8]], exact in binary throughout.
    const Upper u(2, Vec{2, 2, 2});
    EXPECT_EQ(plain(CholeskyInverse(u)), (PlainMatrix{{0.5, -0.25}, {-0.25, 0.25}}));
    EXPECT_EQ(plain(u.CholeskyInverse()), (PlainMatrix{{0.5, -0.25}, {-0.25, 0.25}}));
}

TEST(CholeskyInverse, OfOrderZeroIsEmpty) {
    EXPECT_TRUE(CholeskyInverse(Upper()).isEmpty());
}

TEST(CholeskyInverse, OfAZeroDiagonalGivesNonFiniteElementsAndNoFailure) {
    const Symmetric s = CholeskyInverse(Upper(1, 0.0));
    ASSERT_EQ(s.rowCount(), 1);
    EXPECT_FALSE(std::isfinite(s(0, 0)));
}

TEST(CholeskyInverse, LeavesASmallResidual) {
    UniformNumbers random(98);
    for (const int order : {1, 2, 3, 9, 40, 120}) {
        for (const PlainMatrix& a :
             {positiveDefinite(order, random), graded(order, random), hilbert(std::min(order, 8))}) {
            const Upper u = CholeskyDecompWithThrow(symmetric(a));
            const PlainMatrix x = plain(CholeskyInverse(u));
            const PlainMatrix residual = plainDifference(plainProduct(a, x), plainIdentity(a.rows));
            // The inverse of a triangular factor and its product with its transpose have residuals of order n u cond(U)
            // norm(U^-1), which norm(A) norm(X) bounds after multiplication by A.
            const double bound = 10.0 * a.rows * a.rows * kEpsilon * frobeniusNorm(a) * frobeniusNorm(x);
            EXPECT_LE(frobeniusNorm(residual), bound) << "order " << a.rows;
        }
    }
}

TEST(SymmetricInverse, GoesThroughTheCholeskyFactor) {
    UniformNumbers random(99);
    for (const int order : {0, 1, 2, 7, 40}) {
        const Symmetric s = symmetric(positiveDefinite(order, random));
        Symmetric result(3, 1.0);
        ASSERT_TRUE(inverse(s, &result));
        EXPECT_TRUE(sameBits(plain(result), plain(CholeskyInverse(CholeskyDecompWithThrow(s)))));
        EXPECT_TRUE(sameBits(plain(inverseWithThrow(s)), plain(result)));
    }
}

TEST(SymmetricInverse, OfAnIndefiniteMatrixFailsEmptyAlthoughAnInverseExists) {
    const Symmetric s = symmetric({{0, 1}, {1, 0}});
    Symmetric result(3, 1.0);
    EXPECT_FALSE(inverse(s, &result));
    EXPECT_TRUE(result.isEmpty());
    EXPECT_EQ(result.size(), 0);
    EXPECT_EQ(messageOf<MatrixSingular>([&] { static_cast<void>(inverseWithThrow(s)); }), "Matrix is singular");
}

TEST(SymmetricInverse, NullResultIsAnAssertion) {
    Symmetric* const nowhere = nullptr;
    EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(inverse(Symmetric(1, 1.0), nowhere)); }),
                IsAssertion("result", "src/matrix/matrix_functions"));
}

}  // namespace
}  // namespace reisti::test
