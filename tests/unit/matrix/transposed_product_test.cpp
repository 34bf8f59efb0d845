#include <limits>

#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

using qan::matrix_library::multiplyLeftTranspose;
using qan::matrix_library::multiplyRightTranspose;

TEST(LeftTransposeProduct, MultipliesTheTransposeOfTheLeftOperand) {
    const Dense a(Vec{1, 2, 3, 4, 5, 6}, 3);
    const Dense b(Vec{1, 10, 100, 1000}, 2);
    Dense c(7, 7, 9.0);
    multiplyLeftTranspose(a, b, c);
    EXPECT_EQ(plain(c), (PlainMatrix{{401, 4010}, {502, 5020}, {603, 6030}}));
    EXPECT_EQ(c.size(), 6);
}

TEST(RightTransposeProduct, MultipliesTheTransposeOfTheRightOperand) {
    const Dense a(Vec{1, 2, 3, 4, 5, 6}, 3);
    const Dense b(Vec{1, 10, 100, 1, 0, 0}, 3);
    Dense c;
    multiplyRightTranspose(a, b, c);
    EXPECT_EQ(plain(c), (PlainMatrix{{321, 1}, {654, 4}}));
}

TEST(LeftTransposeProduct, HasTheBitsOfTheReferenceForEveryShape) {
    UniformNumbers random(61);
    for (int trial = 0; trial < scaled(300); ++trial) {
        const int inner = random.integer(0, 40);
        const Dense a = dense(random.matrix(inner, random.integer(0, 40)));
        const Dense b = dense(random.matrix(inner, random.integer(0, 40)));
        Dense c(1, 1, 3.0);
        multiplyLeftTranspose(a, b, c);
        ASSERT_TRUE(sameBits(plain(c), plainProduct(plainTranspose(plain(a)), plain(b))));
    }
}

TEST(RightTransposeProduct, HasTheBitsOfTheReferenceForEveryShape) {
    UniformNumbers random(62);
    for (int trial = 0; trial < scaled(300); ++trial) {
        const int inner = random.integer(0, 40);
        const Dense a = dense(random.matrix(random.integer(0, 40), inner));
        const Dense b = dense(random.matrix(random.integer(0, 40), inner));
        Dense c(1, 1, 3.0);
        multiplyRightTranspose(a, b, c);
        ASSERT_TRUE(sameBits(plain(c), plainProduct(plain(a), plainTranspose(plain(b)))));
    }
}

TEST(TransposeProducts, HaveTheBitsOfTheReferenceBeyondCacheBlocks) {
    UniformNumbers random(63);
    const int shapes[][3] = {{1, 700, 1}, {3, 1030, 5}, {130, 260, 270}, {65, 513, 129}, {257, 33, 515}};
    for (const auto& [rows, inner, cols] : shapes) {
        const PlainMatrix left = random.matrix(rows, inner);
        const PlainMatrix right = random.matrix(inner, cols);
        const PlainMatrix expected = plainProduct(left, right);
        Dense c;
        multiplyLeftTranspose(dense(plainTranspose(left)), dense(right), c);
        ASSERT_TRUE(sameBits(plain(c), expected)) << rows << ", " << inner << ", " << cols;
        multiplyRightTranspose(dense(left), dense(plainTranspose(right)), c);
        ASSERT_TRUE(sameBits(plain(c), expected)) << rows << ", " << inner << ", " << cols;
    }
}

TEST(TransposeProducts, DoNotSkipZeros) {
    const double infinity = std::numeric_limits<double>::infinity();
    for (const int order : {1, 3, 17}) {
        const Dense zeros(order, order, 0.0);
        const Dense infinities(order, order, infinity);
        Dense c;
        multiplyLeftTranspose(zeros, infinities, c);
        EXPECT_TRUE(std::isnan(c(0, order - 1)));
        multiplyLeftTranspose(infinities, zeros, c);
        EXPECT_TRUE(std::isnan(c(order - 1, 0)));
        multiplyRightTranspose(zeros, infinities, c);
        EXPECT_TRUE(std::isnan(c(0, order - 1)));
        multiplyRightTranspose(infinities, zeros, c);
        EXPECT_TRUE(std::isnan(c(order - 1, 0)));
    }
}

TEST(TransposeProducts, WithoutSharedDimensionAreZero) {
    Dense c(5, 5, 9.0);
    multiplyLeftTranspose(Dense(0, 2, 1.0), Dense(0, 3, 1.0), c);
    EXPECT_EQ(plain(c), PlainMatrix(2, 3));
    multiplyRightTranspose(Dense(2, 0, 1.0), Dense(3, 0, 1.0), c);
    EXPECT_EQ(plain(c), PlainMatrix(2, 3));
}

TEST(TransposeProducts, OfAMatrixWithItselfAreExactlySymmetric) {
    UniformNumbers random(64);
    const Dense a = dense(random.matrix(37, 23));
    Dense c;
    multiplyLeftTranspose(a, a, c);
    EXPECT_TRUE(sameBits(plain(c), plainTranspose(plain(c))));
    multiplyRightTranspose(a, a, c);
    EXPECT_TRUE(sameBits(plain(c), plainTranspose(plain(c))));
}

}  // namespace
}  // namespace reisti::test
