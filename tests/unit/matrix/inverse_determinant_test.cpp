#include <limits>

#include "support/plain_factorizations.h"
#include "unit/matrix/matrix_kinds.h"
#include "unit/matrix/solver_samples.h"

namespace reisti::test {
namespace {

using qan::matrix_library::determinant;
using qan::matrix_library::determinantWithThrow;
using qan::matrix_library::inverse;
using qan::matrix_library::inverseWithThrow;
using qan::matrix_library::LUBackSubTemplate;
using qan::matrix_library::LUDecomposition;

constexpr double kInfinity = std::numeric_limits<double>::infinity();
const double kNaN = std::numeric_limits<double>::quiet_NaN();

const Dense kSingular(Vec{1, 2, 2, 4}, 2);

TEST(Determinant, ChangesSignWithEachRowSwap) {
    double det = 0.0;
    EXPECT_TRUE(determinant(Dense(Vec{0, 1, 1, 0}, 2), &det));
    EXPECT_EQ(det, -1.0);
    EXPECT_TRUE(determinant(dense({{0, 1, 0}, {0, 0, 1}, {1, 0, 0}}), &det));
    EXPECT_EQ(det, 1.0);
    EXPECT_EQ(determinantWithThrow(Dense(Vec{0, 1, 1, 0}, 2)), -1.0);
}

TEST(Determinant, OfASingularMatrixIsZeroAndFails) {
    double det = -77.0;
    EXPECT_FALSE(determinant(kSingular, &det));
    EXPECT_EQ(det, 0.0);
    det = -77.0;
    EXPECT_FALSE(determinant(symmetric({{1, 2}, {2, 4}}), &det));
    EXPECT_EQ(det, 0.0);
    EXPECT_EQ(messageOf<MatrixSingular>([&] { static_cast<void>(determinantWithThrow(kSingular)); }),
              "Matrix is singular");
    EXPECT_EQ(messageOf<MatrixSingular>([&] {
                  static_cast<void>(determinantWithThrow(symmetric({{1, 2}, {2, 4}})));
              }),
              "Matrix is singular");
}

TEST(Determinant, OfAnIndefiniteSymmetricMatrixUsesLu) {
    double det = 0.0;
    EXPECT_TRUE(determinant(symmetric({{0, 1}, {1, 0}}), &det));
    EXPECT_EQ(det, -1.0);
    EXPECT_EQ(determinantWithThrow(symmetric({{0, 1}, {1, 0}})), -1.0);
}

TEST(Determinant, OfOrderZeroIsOne) {
    EXPECT_EQ(determinantWithThrow(Dense()), 1.0);
    EXPECT_EQ(determinantWithThrow(Symmetric(0, 0.0)), 1.0);
}

TEST(Determinant, IsTheSignedProductOfThePivots) {
    UniformNumbers random(106);
    for (const int order : {1, 2, 5, 20, 60}) {
        const PlainMatrix a = random.matrix(order, order);
        const PlainLu lu = plainLu(a);
        ASSERT_FALSE(lu.singular);
        long double expected = lu.parity;
        for (int i = 0; i < order; ++i)
            expected *= lu.factors(i, i);
        double det = 0.0;
        EXPECT_TRUE(determinant(dense(a), &det));
        EXPECT_NEAR(det, static_cast<double>(expected), order * kEpsilon * std::fabs(static_cast<double>(expected)));
    }
}

TEST(Determinant, NullResultIsAnAssertion) {
    double* const nowhere = nullptr;
    for (const Dense& a : {Dense(1, 1, 1.0), kSingular}) {
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(LUDecomposition(a).Determinant(nowhere)); }),
                    IsAssertion("result", "src/matrix/matrix_ludecomposition"));
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(determinant(a, nowhere)); }),
                    IsAssertion("result"));
    }
    EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(determinant(Symmetric(1, 1.0), nowhere)); }),
                IsAssertion("result"));
}

TEST(LuSolve, FindsTheSolutionOfATwoByTwoSystem) {
    const LUDecomposition lu(Dense(Vec{1, 8, 4, 4}, 2));
    Vec x{9, 9, 9};
    const Vec b{17, 12};
    EXPECT_TRUE(lu.Solve(b, &x));
    EXPECT_EQ(x, (Vec{1, 2}));
    EXPECT_EQ(b, (Vec{17, 12}));
}

TEST(LuSolve, KeepsLeadingZerosOfTheRightHandSideExact) {
    const LUDecomposition lu(dense({{2, 0, 0}, {0, 4, 0}, {0, 0, 8}}));
    Vec x;
    EXPECT_TRUE(lu.Solve(Vec{0, 0, 8}, &x));
    EXPECT_EQ(x, (Vec{0, 0, 1}));
    EXPECT_TRUE(lu.Solve(Vec{0, 0, 0}, &x));
    EXPECT_EQ(x, (Vec{0, 0, 0}));
}

TEST(LuSolve, TreatsEachColumnOfAMatrixSeparately) {
    UniformNumbers random(107);
    const PlainMatrix a = random.matrix(6, 6);
    const LUDecomposition lu(dense(a));
    const Dense b = dense(random.matrix(6, 4));
    Dense x(1, 1, 0.0);
    ASSERT_TRUE(lu.Solve(b, &x));
    ASSERT_EQ(x.rowCount(), 6);
    ASSERT_EQ(x.colCount(), 4);
    for (int j = 0; j < 4; ++j) {
        Vec column;
        ASSERT_TRUE(lu.Solve(b.getColVector(j), &column));
        EXPECT_TRUE(sameBits(x.getColVector(j), column));
    }
}

TEST(LuSolve, OfASingularMatrixFailsEmpty) {
    const LUDecomposition lu(kSingular);
    Vec x{1, 2, 3};
    EXPECT_FALSE(lu.Solve(Vec{1, 1}, &x));
    EXPECT_TRUE(x.empty());
    Dense many(3, 3, 1.0);
    EXPECT_FALSE(lu.Solve(Dense(2, 2, 1.0), &many));
    EXPECT_TRUE(many.empty());
    EXPECT_EQ(many.size(), 0);
}

TEST(LuSolve, BadOutputPointersAreAssertions) {
    for (const Dense& a : {Dense(1, 1, 1.0), kSingular}) {
        const LUDecomposition lu(a);
        Vec* const noVector = nullptr;
        Dense* const noMatrix = nullptr;
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(lu.Solve(Vec{1}, noVector)); }),
                    IsAssertion("x"));
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(lu.Solve(Dense(1, 1, 1.0), noMatrix)); }),
                    testing::AnyOf(IsAssertion("X"), IsAssertion("x")));
        Dense both(a.rowCount(), 1, 3.0);
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(lu.Solve(both, &both)); }),
                    IsAssertion("&B != X"));
        EXPECT_EQ(both(0, 0), 3.0);
    }
}

TEST(LuSolve, RefusesARightHandSideOfAnotherLength) {
    const LUDecomposition lu(dense(plainIdentity(2)));
    for (const int length : {0, 1, 3}) {
        Vec x;
        Dense many;
        EXPECT_THROW(static_cast<void>(lu.Solve(Vec(static_cast<std::size_t>(length), 1.0), &x)), MatrixException);
        EXPECT_THROW(static_cast<void>(lu.Solve(Dense(length, 2, 1.0), &many)), MatrixException);
    }
}

TEST(LuBackSubstitution, FollowsTheRecordedExchanges) {
    // The factors of [[1, 8], [4, 4]], whose rows were exchanged.
    Vec x{17, 12};
    LUBackSubTemplate(Dense(Vec{4, 4, 0.25, 7}, 2), {1, 1}, &x);
    EXPECT_EQ(x, (Vec{1, 2}));
}

TEST(LuBackSubstitution, LeadingZerosMeetNoMultiplier) {
    // The multiplier below the first row is infinite: times the leading zero it would spoil the solution.
    Vec x{0, 5};
    LUBackSubTemplate(Dense(Vec{1, 0, kInfinity, 1}, 2), {0, 1}, &x);
    EXPECT_EQ(x, (Vec{0, 5}));
    // Behind the first element that is not zero, every multiplier counts.
    x = {1, 5};
    LUBackSubTemplate(Dense(Vec{1, 0, kInfinity, 1}, 2), {0, 1}, &x);
    EXPECT_EQ(x[1], -kInfinity);
}

TEST(LuBackSubstitution, ZeroOnTheDiagonalIsAnAssertion) {
    Vec x{1, 1};
    EXPECT_THAT(messageOf<AllegeException>([&] {
                    LUBackSubTemplate(Dense(Vec{1, 2, 0, 0}, 2), {0, 1}, &x);
                }),
                IsAssertion("lhs( i, i )", "src/matrix/matrix_ludecomposition"));
    x = {1, 1};
    EXPECT_THAT(messageOf<AllegeException>([&] {
                    LUBackSubTemplate(Dense(Vec{0, 2, 0, 1}, 2), {0, 1}, &x);
                }),
                IsAssertion("lhs( i, i )", "src/matrix/matrix_ludecomposition"));
}

TEST(LuBackSubstitution, NullOutputIsAnAssertion) {
    EXPECT_THAT(messageOf<AllegeException>([] { LUBackSubTemplate(Dense(1, 1, 1.0), {0}, nullptr); }),
                IsAssertion("x", "src/matrix/matrix_ludecomposition"));
}

/// |L| |U|: what the rounding errors of a solution grow with.
double growthNorm(const PlainLu& lu) {
    const int n = lu.factors.rows;
    PlainMatrix lower = plainIdentity(n);
    PlainMatrix upperPart(n, n);
    for (int i = 0; i < n; ++i)
        for (int j = 0; j < n; ++j)
            (j < i ? lower : upperPart)(i, j) = std::fabs(lu.factors(i, j));
    return frobeniusNorm(plainProduct(lower, upperPart));
}

void expectSmallResiduals(const PlainMatrix& a, UniformNumbers& random) {
    const PlainLu plainFactors = plainLu(a);
    ASSERT_FALSE(plainFactors.singular) << "order " << a.rows;
    // Higham (2002), Theorem 9.4: the solution solves a system perturbed by 3 n u |L| |U|; multiplying by the
    // reciprocal of the pivot rounds once more, and forming the residual here adds n u norm(A).
    const double relative = (4.0 * a.rows + 4.0) * kEpsilon * (growthNorm(plainFactors) + frobeniusNorm(a));

    const LUDecomposition lu(dense(a));
    const Vec b = random.vector(a.rows);
    Vec x;
    ASSERT_TRUE(lu.Solve(b, &x));
    EXPECT_LE(frobeniusNorm(plainDifference(plainProduct(a, plainVector(x)), plainVector(b))),
              relative * frobeniusNorm(plainVector(x)))
        << "order " << a.rows;

    Dense inverted;
    ASSERT_TRUE(lu.Inverse(&inverted));
    EXPECT_LE(frobeniusNorm(plainDifference(plainProduct(a, plain(inverted)), plainIdentity(a.rows))),
              relative * frobeniusNorm(plain(inverted)))
        << "order " << a.rows;
    Dense viaFunction(1, 1, 0.0);
    ASSERT_TRUE(inverse(dense(a), &viaFunction));
    EXPECT_TRUE(sameBits(plain(viaFunction), plain(inverted)));
    EXPECT_TRUE(sameBits(plain(inverseWithThrow(dense(a))), plain(inverted)));
}

TEST(LuResiduals, AreSmallForRandomMatrices) {
    UniformNumbers random(108);
    for (const int order : {1, 2, 3, 9, 33, 64, 120})
        expectSmallResiduals(random.matrix(order, order), random);
}

TEST(LuResiduals, AreSmallForIllConditionedMatrices) {
    UniformNumbers random(109);
    for (const int order : {2, 4, 6, 8})
        expectSmallResiduals(hilbert(order), random);
    for (const int order : {2, 5, 11})
        expectSmallResiduals(graded(order, random), random);
}

TEST(LuResiduals, AreSmallForStructuredMatrices) {
    UniformNumbers random(110);
    for (const int order : {1, 2, 9, 33}) {
        PlainMatrix source = random.matrix(order, order);
        for (int i = 0; i < order; ++i)
            source(i, i) += 3.0;
        expectSmallResiduals(plain(diagonal(source)), random);
        expectSmallResiduals(plain(upper(source)), random);
        expectSmallResiduals(plainTranspose(plain(upper(source))), random);
        expectSmallResiduals(plain(symmetric(source)), random);
        PlainMatrix permutation(order, order);
        for (int i = 0; i < order; ++i)
            permutation(i, (i + 1) % order) = 1.0;
        expectSmallResiduals(permutation, random);
    }
}

TEST(DenseInverse, OfATwoByTwoMatrix) {
    Dense result;
    EXPECT_TRUE(inverse(Dense(Vec{0, 2, 4, 0}, 2), &result));
    EXPECT_EQ(plain(result), (PlainMatrix{{0, 0.25}, {0.5, 0}}));
    EXPECT_EQ(plain(inverseWithThrow(Dense(Vec{0, 2, 4, 0}, 2))), plain(result));
}

TEST(DenseInverse, OfASingularMatrixFailsEmpty) {
    Dense result(3, 3, 1.0);
    EXPECT_FALSE(inverse(kSingular, &result));
    EXPECT_EQ(result.rowCount(), 0);
    EXPECT_EQ(result.colCount(), 0);
    EXPECT_EQ(result.size(), 0);
    EXPECT_EQ(messageOf<MatrixSingular>([&] { static_cast<void>(inverseWithThrow(kSingular)); }), "Matrix is singular");
}

TEST(DenseInverse, NullResultIsAnAssertion) {
    Dense* const nowhere = nullptr;
    for (const Dense& a : {Dense(1, 1, 1.0), kSingular}) {
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(LUDecomposition(a).Inverse(nowhere)); }),
                    IsAssertion("result"));
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(inverse(a, nowhere)); }), IsAssertion("result"));
    }
}

TEST(DiagonalInverse, DividesOneByEachElement) {
    const Diagonal d = diagonal(Vec{2, 4, -3});
    Diagonal result;
    EXPECT_TRUE(inverse(d, &result));
    EXPECT_EQ(plain(result), plain(diagonal(Vec{0.5, 0.25, 1.0 / -3.0})));
    EXPECT_EQ(plain(inverseWithThrow(d)), plain(result));
}

TEST(DiagonalInverse, HasNoTolerance) {
    Diagonal result;
    EXPECT_TRUE(inverse(diagonal(Vec{1e-300}), &result));
    EXPECT_EQ(result(0, 0), 1.0 / 1e-300);
    EXPECT_TRUE(inverse(diagonal(Vec{std::numeric_limits<double>::denorm_min()}), &result));
    EXPECT_EQ(result(0, 0), kInfinity);
    EXPECT_TRUE(inverse(diagonal(Vec{kNaN}), &result));
    EXPECT_TRUE(std::isnan(result(0, 0)));
}

TEST(DiagonalInverse, OfAZeroElementOfEitherSignFailsEmpty) {
    for (const double zero : {0.0, -0.0}) {
        const Diagonal d = diagonal(Vec{2, zero, 3});
        Diagonal result = diagonal(Vec{1, 1});
        EXPECT_FALSE(inverse(d, &result));
        EXPECT_EQ(result.rowCount(), 0);
        EXPECT_EQ(messageOf<MatrixSingular>([&] { static_cast<void>(inverseWithThrow(d)); }), "Matrix is singular");
    }
}

TEST(DiagonalInverse, OfOrderZeroSucceeds) {
    Diagonal result = diagonal(Vec{1});
    EXPECT_TRUE(inverse(Diagonal(), &result));
    EXPECT_EQ(result.rowCount(), 0);
}

TEST(DiagonalInverse, NullResultIsAnAssertion) {
    Diagonal* const nowhere = nullptr;
    EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(inverse(diagonal(Vec{1}), nowhere)); }),
                IsAssertion("result"));
}

}  // namespace
}  // namespace reisti::test
