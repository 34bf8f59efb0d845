#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

using qan::matrix_library::mQuadraticForm;

const char* const kNotSquare = "matrix::quadratic form is only defined for square matrices";
const char* const kOtherLength = "matrix::matrix and vector have incompatible dimensions";

TEST(QuadraticForm, OfTheIdentityIsTheSquaredLength) {
    EXPECT_EQ(mQuadraticForm(dense(plainIdentity(2)), Vec{3, 4}), 25.0);
    EXPECT_EQ(mQuadraticForm(symmetric(plainIdentity(2)), Vec{3, 4}), 25.0);
}

TEST(QuadraticForm, UsesEveryElement) {
    const Dense a(Vec{1, 2, 3, 4}, 2);
    EXPECT_EQ(mQuadraticForm(a, Vec{1, 10}), 1.0 + 20.0 + 30.0 + 400.0);
    EXPECT_EQ(a.mQuadraticForm(Vec{1, 10}), 451.0);
    const Symmetric s = symmetric({{1, 2}, {2, 4}});
    EXPECT_EQ(mQuadraticForm(s, Vec{1, 10}), 441.0);
    EXPECT_EQ(s.mQuadraticForm(Vec{1, 10}), 441.0);
}

TEST(QuadraticForm, OfOrderZeroIsZero) {
    EXPECT_EQ(mQuadraticForm(Dense(), Vec{}), 0.0);
    EXPECT_EQ(mQuadraticForm(Symmetric(0, 0.0), Vec{}), 0.0);
}

TEST(QuadraticForm, OfANonSquareMatrixIsRefusedWhateverTheLength) {
    const Dense a(2, 3, 1.0);
    for (const Vec& x : {Vec{}, Vec{1, 2}, Vec{1, 2, 3}}) {
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(mQuadraticForm(a, x)); }), kNotSquare);
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(a.mQuadraticForm(x)); }), kNotSquare);
    }
}

TEST(QuadraticForm, WithAVectorOfAnotherLengthIsRefused) {
    for (const Vec& x : {Vec{}, Vec{1}, Vec{1, 2, 3}}) {
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(mQuadraticForm(Dense(2, 2, 1.0), x)); }),
                  kOtherLength);
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(mQuadraticForm(Symmetric(2, 1.0), x)); }),
                  kOtherLength);
    }
}

TEST(QuadraticForm, StaysWithinTheRoundingOfItsTerms) {
    UniformNumbers random(81);
    for (int trial = 0; trial < scaled(100); ++trial) {
        const int order = random.integer(1, 30);
        const PlainMatrix source = random.matrix(order, order);
        const Vec x = random.vector(order);
        const auto exactForm = [&](const PlainMatrix& a, long double& magnitudes) {
            long double sum = 0.0L;
            magnitudes = 0.0L;
            for (int i = 0; i < order; ++i)
                for (int j = 0; j < order; ++j) {
                    const long double term = static_cast<long double>(x[static_cast<std::size_t>(i)]) * a(i, j) *
                                             x[static_cast<std::size_t>(j)];
                    sum += term;
                    magnitudes += std::fabs(term);
                }
            return static_cast<double>(sum);
        };
        // Every term takes part in at most 2 n + 2 roundings, whatever the order of summation by rows or columns.
        long double magnitudes = 0.0L;
        const double expected = exactForm(source, magnitudes);
        EXPECT_NEAR(mQuadraticForm(dense(source), x), expected,
                    static_cast<double>(magnitudes) * (2 * order + 2) * kEpsilon);
        const Symmetric s = symmetric(source);
        const double expectedSymmetric = exactForm(plain(s), magnitudes);
        EXPECT_NEAR(mQuadraticForm(s, x), expectedSymmetric,
                    static_cast<double>(magnitudes) * (2 * order + 2) * kEpsilon);
    }
}

TEST(WeightedResidualForm, SolvesWithTheTransformedMatrix) {
    // b a b^T = diag(4, 9) and b x - y = (2, 3): 4 / 4 + 9 / 9.
    const Dense b(Vec{2, 0, 0, 3}, 2);
    EXPECT_DOUBLE_EQ(mQuadraticForm(dense(plainIdentity(2)), b, Vec{2, 2}, Vec{2, 3}), 2.0);
    EXPECT_DOUBLE_EQ(mQuadraticForm(symmetric(plainIdentity(2)), b, Vec{2, 2}, Vec{2, 3}), 2.0);
}

TEST(WeightedResidualForm, IsAMemberOfBothKinds) {
    const Dense b(Vec{2, 0, 0, 3}, 2);
    EXPECT_DOUBLE_EQ(dense(plainIdentity(2)).mQuadraticForm(b, Vec{2, 2}, Vec{2, 3}), 2.0);
    EXPECT_DOUBLE_EQ(symmetric(plainIdentity(2)).mQuadraticForm(b, Vec{2, 2}, Vec{2, 3}), 2.0);
}

TEST(WeightedResidualForm, WorksWithAWideTransformation) {
    // b a b^T = 1 * 2 * 1 + 1 * 3 * 1 = 5 and b x - y = 1 + 2 - 13 = -10: 100 / 5.
    const Dense b(1, 2, 1.0);
    const PlainMatrix a{{2, 0}, {0, 3}};
    EXPECT_DOUBLE_EQ(mQuadraticForm(dense(a), b, Vec{1, 2}, Vec{13}), 20.0);
    EXPECT_DOUBLE_EQ(mQuadraticForm(symmetric(a), b, Vec{1, 2}, Vec{13}), 20.0);
}

TEST(WeightedResidualForm, AgreesWithTheSolutionOfTheNormalEquations) {
    UniformNumbers random(82);
    for (int trial = 0; trial < scaled(60); ++trial) {
        const int outer = random.integer(1, 6);
        const int inner = outer + random.integer(0, 4);
        // Diagonally dominant, hence well conditioned: the bound stays near machine precision.
        PlainMatrix a = plainIdentity(inner);
        for (int i = 0; i < inner; ++i)
            for (int j = 0; j < i; ++j)
                a(i, j) = a(j, i) = random.between(-0.05, 0.05);
        PlainMatrix b(outer, inner);
        for (int i = 0; i < outer; ++i)
            for (int j = 0; j < inner; ++j)
                b(i, j) = (i == j ? 1.0 : 0.0) + random.between(-0.05, 0.05);
        const Vec x = random.vector(inner);
        const Vec y = random.vector(outer);

        const PlainMatrix residual = plainDifference(plainProduct(b, plainVector(x)), plainVector(y));
        const PlainMatrix v = plainProduct(plainProduct(b, a), plainTranspose(b));
        // Gaussian elimination of a diagonally dominant matrix needs no pivots.
        PlainMatrix work = v;
        PlainMatrix solution = residual;
        for (int k = 0; k < outer; ++k)
            for (int i = k + 1; i < outer; ++i) {
                const double factor = work(i, k) / work(k, k);
                for (int j = k; j < outer; ++j)
                    work(i, j) -= factor * work(k, j);
                solution(i, 0) -= factor * solution(k, 0);
            }
        for (int i = outer - 1; i >= 0; --i) {
            for (int j = i + 1; j < outer; ++j)
                solution(i, 0) -= work(i, j) * solution(j, 0);
            solution(i, 0) /= work(i, i);
        }
        const double expected = plainProduct(plainTranspose(residual), solution)(0, 0);
        const double bound = 1000.0 * kEpsilon * (1.0 + std::fabs(expected));
        EXPECT_NEAR(mQuadraticForm(dense(a), dense(b), x, y), expected, bound);
        EXPECT_NEAR(mQuadraticForm(symmetric(a), dense(b), x, y), expected, bound);
    }
}

TEST(WeightedResidualForm, OfANonSquareMatrixIsRefused) {
    EXPECT_EQ(messageOf<MatrixException>([] {
                  static_cast<void>(mQuadraticForm(Dense(2, 3, 1.0), Dense(1, 2, 1.0), Vec{1, 1}, Vec{1}));
              }),
              kNotSquare);
}

TEST(WeightedResidualForm, RefusesVectorsThatDoNotMatch) {
    const Dense a = dense(plainIdentity(2));
    const Dense b(1, 2, 1.0);
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(mQuadraticForm(a, b, Vec{1}, Vec{1})); }),
              "matrix and vector must be of same order");
    EXPECT_EQ(messageOf<MatrixException>([&] {
                  static_cast<void>(mQuadraticForm(a, b, Vec{1, 1}, Vec{1, 1}));
              }),
              "op-= matrix and vector must be of same order");
    const Symmetric s = symmetric(plainIdentity(2));
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(mQuadraticForm(s, b, Vec{1}, Vec{1})); }),
              "matrix and vector must be of same order");
    EXPECT_EQ(messageOf<MatrixException>([&] {
                  static_cast<void>(mQuadraticForm(s, b, Vec{1, 1}, Vec{1, 1}));
              }),
              "op-= matrix and vector must be of same order");
}

TEST(WeightedResidualForm, RefusesATransformationOfAnotherOrder) {
    // b x - y is well defined, b a is not.
    const Dense b(1, 3, 1.0);
    EXPECT_EQ(messageOf<MatrixException>([&] {
                  static_cast<void>(mQuadraticForm(dense(plainIdentity(2)), b, Vec{1, 1, 1}, Vec{1}));
              }),
              "Matrix multiplication: incompatible orders");
    EXPECT_EQ(messageOf<MatrixException>([&] {
                  static_cast<void>(mQuadraticForm(symmetric(plainIdentity(2)), b, Vec{1, 1, 1}, Vec{1}));
              }),
              "Matrix multiplication: incompatible orders");
}

TEST(WeightedResidualForm, OfAnAsymmetricMatrixIsRefused) {
    EXPECT_EQ(messageOf<MatrixException>([] {
                  static_cast<void>(
                      mQuadraticForm(Dense(Vec{1, 0.5, 0, 1}, 2), dense(plainIdentity(2)), Vec{1, 1}, Vec{0, 0}));
              }),
              "Smatrix cast: result not a symmetric matrix");
}

TEST(WeightedResidualForm, OfAMatrixThatIsNotPositiveDefiniteIsSingular) {
    const PlainMatrix indefinite{{1, 2}, {2, 1}};
    const Dense b = dense(plainIdentity(2));
    EXPECT_EQ(messageOf<MatrixSingular>([&] {
                  static_cast<void>(mQuadraticForm(dense(indefinite), b, Vec{1, 1}, Vec{0, 0}));
              }),
              "Matrix is singular");
    EXPECT_EQ(messageOf<MatrixSingular>([&] {
                  static_cast<void>(mQuadraticForm(symmetric(indefinite), b, Vec{1, 1}, Vec{0, 0}));
              }),
              "Matrix is singular");
}

}  // namespace
}  // namespace reisti::test
