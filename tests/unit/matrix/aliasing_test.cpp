#include "support/plain_factorizations.h"
#include "unit/matrix/matrix_kinds.h"
#include "unit/matrix/solver_samples.h"

// Every operation that takes an operand by reference has to give the same when that operand is, or lies in, the object
// that it changes.

namespace reisti::test {
namespace {

using qan::matrix_library::inverse;
using qan::matrix_library::multiplyLeftTranspose;
using qan::matrix_library::multiplyRightTranspose;

Dense four() {
    return Dense(Vec{2, 3, 5, 7}, 2);
}

TEST(DenseAliasing, ProductWithItself) {
    Dense a = four();
    a *= a;
    EXPECT_EQ(plain(a), (PlainMatrix{{19, 27}, {45, 64}}));
}

TEST(DenseAliasing, ProductWithItselfAtBlockedSizes) {
    UniformNumbers random(151);
    for (const int order : {1, 9, 64, 130}) {
        const PlainMatrix source = random.matrix(order, order);
        Dense a = dense(source);
        a *= a;
        EXPECT_TRUE(sameBits(plain(a), plainProduct(source, source)));
    }
}

TEST(DenseAliasing, SumAndDifferenceWithItself) {
    Dense a = four();
    a += a;
    EXPECT_EQ(plain(a), (PlainMatrix{{4, 6}, {10, 14}}));
    // Through another name: clang warns of a plain self-assignment.
    const Dense& same = a;
    a -= same;
    EXPECT_EQ(plain(a), PlainMatrix(2, 2));
}

TEST(DenseAliasing, ScalarFromTheMatrix) {
    Dense a = four();
    a *= a(0, 0);
    EXPECT_EQ(plain(a), (PlainMatrix{{4, 6}, {10, 14}}));
    a /= a(0, 0);
    EXPECT_EQ(plain(a), (PlainMatrix{{1, 1.5}, {2.5, 3.5}}));
    a *= a(1, 1);
    EXPECT_EQ(plain(a), (PlainMatrix{{3.5, 5.25}, {8.75, 12.25}}));
}

TEST(DenseAliasing, FillFromTheMatrix) {
    Dense a = four();
    a = a(1, 1);
    EXPECT_EQ(plain(a), (PlainMatrix{{7, 7}, {7, 7}}));
    a = four();
    a.set(a(0, 1));
    EXPECT_EQ(plain(a), (PlainMatrix{{3, 3}, {3, 3}}));
    for (const auto& resize : {+[](Dense&m, const double&x) { m.resize(3, 3, x); },
                               +[](Dense&m, const double&x) { m.ResizeStorage(3, 3, x); },
                               +[](Dense&m, const double&x) { m.Initialize(3, 3, x); }}) {
        Dense m = four();
        resize(m, m(1, 1));
        EXPECT_EQ(plain(m), plain(Dense(3, 3, 7.0)));
    }
    Dense smaller = four();
    smaller.resize(1, 1, smaller(1, 1));
    EXPECT_EQ(plain(smaller), (PlainMatrix{{7}}));
}

TEST(DenseAliasing, AppendedOrInsertedScalarFromTheMatrix) {
    for (int i = 0; i < 2; ++i) {
        for (int j = 0; j < 2; ++j) {
            const double x = four()(i, j);
            Dense a = four();
            a.addRow(a(i, j));
            EXPECT_EQ(plain(a), (PlainMatrix{{2, 3}, {5, 7}, {x, x}}));
            a = four();
            a.addCol(a(i, j));
            EXPECT_EQ(plain(a), (PlainMatrix{{2, 3, x}, {5, 7, x}}));
            a = four();
            a.insertRow(0, a(i, j));
            EXPECT_EQ(plain(a), (PlainMatrix{{x, x}, {2, 3}, {5, 7}}));
            a = four();
            a.insertCol(0, a(i, j));
            EXPECT_EQ(plain(a), (PlainMatrix{{x, 2, 3}, {x, 5, 7}}));
            a = four();
            a.insertCol(1, a(i, j));
            EXPECT_EQ(plain(a), (PlainMatrix{{2, x, 3}, {5, x, 7}}));
        }
    }
}

TEST(DenseAliasing, InsertedScalarFromAMatrixWithSpareRoom) {
    // After a removal the storage need not move, so that the inserted element shifts its own source.
    Dense a(Vec{2, 3, 5, 7, 11, 13, 17, 19, 23}, 3);
    a.removeRow(2);
    a.insertCol(0, a(1, 2));
    EXPECT_EQ(plain(a), (PlainMatrix{{13, 2, 3, 5}, {13, 7, 11, 13}}));
    Dense b(Vec{2, 3, 5, 7, 11, 13, 17, 19, 23}, 3);
    b.removeRow(2);
    b.insertRow(0, b(1, 2));
    EXPECT_EQ(plain(b), (PlainMatrix{{13, 13, 13}, {2, 3, 5}, {7, 11, 13}}));
    Dense c(Vec{2, 3, 5, 7, 11, 13, 17, 19, 23}, 3);
    c.removeRow(2);
    c.addCol(c(1, 0));
    EXPECT_EQ(plain(c), (PlainMatrix{{2, 3, 5, 7}, {7, 11, 13, 7}}));
}

TEST(DenseAliasing, RowOrColumnTakenFromTheMatrix) {
    Dense a = four();
    a.addRow(a.getRowVector(0));
    EXPECT_EQ(plain(a), (PlainMatrix{{2, 3}, {5, 7}, {2, 3}}));
    a.addCol(a.getColVector(1));
    EXPECT_EQ(plain(a), (PlainMatrix{{2, 3, 3}, {5, 7, 7}, {2, 3, 3}}));
    a.insertRow(1, a.getRowVector(2));
    EXPECT_EQ(plain(a), (PlainMatrix{{2, 3, 3}, {2, 3, 3}, {5, 7, 7}, {2, 3, 3}}));
}

TEST(DenseAliasing, MatrixAsItsOwnRowOrColumnSource) {
    Dense a = four();
    a.setRow(1, a);
    EXPECT_EQ(plain(a), (PlainMatrix{{2, 3}, {2, 3}}));
    Dense b = four();
    b.setRow(0, b);
    EXPECT_EQ(plain(b), plain(four()));
    // The source of a column is the first stored elements 2 and 3, as they were before the call.
    Dense c = four();
    c.setCol(0, c);
    EXPECT_EQ(plain(c), (PlainMatrix{{2, 3}, {3, 7}}));
    Dense d = four();
    d.setCol(1, d);
    EXPECT_EQ(plain(d), (PlainMatrix{{2, 2}, {5, 3}}));
}

TEST(DenseAliasing, MatrixAsItsOwnBlock) {
    Dense a = four();
    a.setSubmatrix(0, 0, a);
    EXPECT_EQ(plain(a), plain(four()));
}

TEST(DenseAliasing, TransposedProductsIntoAnOperand) {
    UniformNumbers random(152);
    for (const int order : {1, 2, 9, 40}) {
        const PlainMatrix left = random.matrix(order, order);
        const PlainMatrix right = random.matrix(order, order);
        const PlainMatrix leftTransposed = plainProduct(plainTranspose(left), right);
        const PlainMatrix rightTransposed = plainProduct(left, plainTranspose(right));
        const PlainMatrix gram = plainProduct(plainTranspose(left), left);
        const Dense fixedLeft = dense(left);
        const Dense fixedRight = dense(right);

        Dense a = dense(left);
        multiplyLeftTranspose(a, fixedRight, a);
        EXPECT_TRUE(sameBits(plain(a), leftTransposed));
        Dense b = dense(right);
        multiplyLeftTranspose(fixedLeft, b, b);
        EXPECT_TRUE(sameBits(plain(b), leftTransposed));
        a = dense(left);
        multiplyRightTranspose(a, fixedRight, a);
        EXPECT_TRUE(sameBits(plain(a), rightTransposed));
        b = dense(right);
        multiplyRightTranspose(fixedLeft, b, b);
        EXPECT_TRUE(sameBits(plain(b), rightTransposed));
        a = dense(left);
        multiplyLeftTranspose(a, a, a);
        EXPECT_TRUE(sameBits(plain(a), gram));
        a = dense(left);
        multiplyRightTranspose(a, a, a);
        EXPECT_TRUE(sameBits(plain(a), plainProduct(left, plainTranspose(left))));
    }
}

TEST(DenseAliasing, TransposedProductOfARectangleIntoAnOperand) {
    Dense a(Vec{1, 2, 3, 4, 5, 6}, 3);
    multiplyLeftTranspose(a, a, a);
    EXPECT_EQ(plain(a), (PlainMatrix{{17, 22, 27}, {22, 29, 36}, {27, 36, 45}}));
}

TEST(DenseAliasing, InverseIntoItsSource) {
    Dense a(Vec{0, 2, 4, 0}, 2);
    EXPECT_TRUE(inverse(a, &a));
    EXPECT_EQ(plain(a), (PlainMatrix{{0, 0.25}, {0.5, 0}}));
    Dense singular(2, 2, 1.0);
    EXPECT_FALSE(inverse(singular, &singular));
    EXPECT_TRUE(singular.empty());
}

TEST(SymmetricAliasing, InverseIntoItsSource) {
    UniformNumbers random(153);
    const PlainMatrix source = positiveDefinite(7, random);
    Symmetric separate(0, 0.0);
    ASSERT_TRUE(inverse(symmetric(source), &separate));
    Symmetric s = symmetric(source);
    EXPECT_TRUE(inverse(s, &s));
    EXPECT_TRUE(sameBits(plain(s), plain(separate)));
    Symmetric singular(2, 1.0);
    EXPECT_FALSE(inverse(singular, &singular));
    EXPECT_TRUE(singular.isEmpty());
}

TEST(DiagonalAliasing, InverseIntoItsSource) {
    Diagonal d = diagonal(Vec{2, 4});
    EXPECT_TRUE(inverse(d, &d));
    EXPECT_EQ(plain(d), (PlainMatrix{{0.5, 0}, {0, 0.25}}));
    Diagonal viaMember = diagonal(Vec{2, 4});
    EXPECT_EQ(viaMember.inverse(&viaMember).rowCount(), 1);
    EXPECT_EQ(plain(viaMember), (PlainMatrix{{0.5, 0}, {0, 0.25}}));
    // The zero stands last, so that a careless loop has overwritten the others by then.
    Diagonal singular = diagonal(Vec{2, 4, 0});
    EXPECT_FALSE(inverse(singular, &singular));
    EXPECT_EQ(singular.rowCount(), 0);
}

TEST(DiagonalAliasing, ProductWithItself) {
    Diagonal d = diagonal(Vec{2, 3});
    d *= d;
    EXPECT_EQ(plain(d), (PlainMatrix{{4, 0}, {0, 9}}));
}

TEST(DiagonalAliasing, FillAndBlockFromTheMatrix) {
    Diagonal d = diagonal(Vec{2, 3});
    d.set(d(1, 1));
    EXPECT_EQ(plain(d), (PlainMatrix{{3, 0}, {0, 3}}));
    d = diagonal(Vec{2, 3});
    d.resize(40, d(1, 1));
    EXPECT_EQ(plain(d), plainScaled(plainIdentity(40), 3.0));
    d = diagonal(Vec{2, 3});
    d.setSubmatrix(0, 0, d);
    EXPECT_EQ(plain(d), (PlainMatrix{{2, 0}, {0, 3}}));
}

TEST(UpperAliasing, FillFromTheMatrix) {
    Upper u(2, Vec{2, 3, 5});
    u.set(u(1, 1));
    EXPECT_EQ(plain(u), (PlainMatrix{{5, 5}, {0, 5}}));
    u = Upper(2, Vec{2, 3, 5});
    u.resize(30, u(0, 1));
    EXPECT_EQ(u(29, 29), 3.0);
    EXPECT_EQ(u(0, 0), 3.0);
}

TEST(SymmetricAliasing, FillAndInsertionFromTheMatrix) {
    const PlainMatrix source{{2, 3}, {3, 5}};
    Symmetric s = symmetric(source);
    s.set(s(1, 1));
    EXPECT_EQ(plain(s), plain(Symmetric(2, 5.0)));
    s = symmetric(source);
    s.resize(30, s(0, 1));
    EXPECT_EQ(plain(s), plain(Symmetric(30, 3.0)));
    s = symmetric(source);
    s.insertColRow(0, s(1, 1));
    EXPECT_EQ(plain(s), (PlainMatrix{{5, 5, 5}, {5, 2, 3}, {5, 3, 5}}));
    s = symmetric({{2, 3, 7}, {3, 5, 11}, {7, 11, 13}});
    s.removeColRow(2);
    s.insertColRow(1, s(1, 1));
    EXPECT_EQ(plain(s), (PlainMatrix{{2, 5, 3}, {5, 5, 5}, {3, 5, 5}}));
}

TEST(CholeskyAliasing, FactorIntoTheSourceOfTheTriangle) {
    UniformNumbers random(154);
    const PlainMatrix source = positiveDefinite(9, random);
    Upper u = upper(source);
    int failedRow = 0;
    double pivot = 0.0;
    u = qan::matrix_library::CholeskyDecomp(u, 0, &failedRow, &pivot);
    EXPECT_TRUE(sameBits(plain(u), plainCholesky(source).factor));
}

TEST(LuAliasing, SolutionIntoTheRightHandSide) {
    const qan::matrix_library::LUDecomposition lu(Dense(Vec{1, 8, 4, 4}, 2));
    Vec b{17, 12};
    EXPECT_TRUE(lu.Solve(b, &b));
    EXPECT_EQ(b, (Vec{1, 2}));
}

TEST(EigenAliasing, VectorsIntoTheMatrix) {
    UniformNumbers random(155);
    const PlainMatrix source = randomSymmetric(8, random);
    Vec values;
    Dense vectors;
    ASSERT_EQ(qan::matrix_library::EigenSystems(dense(source), values, vectors), 0);
    Dense a = dense(source);
    Vec valuesInPlace;
    ASSERT_EQ(qan::matrix_library::EigenSystems(a, valuesInPlace, a), 0);
    EXPECT_TRUE(sameBits(valuesInPlace, values));
    EXPECT_TRUE(sameBits(plain(a), plain(vectors)));
}

}  // namespace
}  // namespace reisti::test
