#include <limits>
#include <type_traits>

#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
const double kNaN = std::numeric_limits<double>::quiet_NaN();
const char* const kIncompatible = "Matrix multiplication: incompatible orders";

/// One line of the table of products.
template <class LeftKind, class RightKind, class ResultKind>
struct Line {
    using Left = LeftKind;
    using Right = RightKind;
    using Result = ResultKind;
};

template <class... Case>
using LinesWithDense =
    testing::Types<Line<Dense, Dense, Dense>, Line<Dense, Symmetric, Dense>, Line<Dense, Upper, Dense>,
                   Line<Dense, Diagonal, Dense>, Line<Symmetric, Dense, Dense>, Line<Upper, Dense, Dense>,
                   Line<Diagonal, Dense, Dense>, Case...>;

using Lines =
    LinesWithDense<Line<Symmetric, Symmetric, Dense>, Line<Symmetric, Upper, Dense>, Line<Symmetric, Diagonal, Dense>,
                   Line<Upper, Symmetric, Dense>, Line<Upper, Upper, Upper>, Line<Upper, Diagonal, Upper>,
                   Line<Diagonal, Symmetric, Dense>, Line<Diagonal, Upper, Upper>, Line<Diagonal, Diagonal, Diagonal>>;

template <class Case>
class Multiplication : public testing::Test {};

TYPED_TEST_SUITE(Multiplication, Lines);

TYPED_TEST(Multiplication, HasTheResultKindOfTheTable) {
    using Left = typename TypeParam::Left;
    using Right = typename TypeParam::Right;
    static_assert(std::is_same_v<decltype(std::declval<const Left&>() * std::declval<const Right&>()),
                                 typename TypeParam::Result>);
}

TYPED_TEST(Multiplication, HasTheValuesOfThePlainLoopsAtEveryOrder) {
    UniformNumbers random(51);
    for (const int order : {0, 1, 2, 3, 4, 5, 7, 8, 9, 15, 16, 17, 31, 33, 64, 65, 100}) {
        const auto a = make<typename TypeParam::Left>(random.matrix(order, order));
        const auto b = make<typename TypeParam::Right>(random.matrix(order, order));
        const PlainMatrix left = plain(a);
        const PlainMatrix right = plain(b);
        ASSERT_EQ(plain(a * b), plainProduct(left, right)) << "order " << order;
        ASSERT_EQ(plain(a), left);
        ASSERT_EQ(plain(b), right);
    }
}

template <class Case>
class MultiplicationWithDense : public testing::Test {};
TYPED_TEST_SUITE(MultiplicationWithDense, LinesWithDense<>);

TYPED_TEST(MultiplicationWithDense, WorksForEveryOuterDimension) {
    constexpr bool leftIsDense = kIsDense<typename TypeParam::Left>;
    constexpr bool rightIsDense = kIsDense<typename TypeParam::Right>;
    UniformNumbers random(52);
    for (const int inner : {0, 1, 3, 8, 19}) {
        for (const int outer : {0, 1, 2, 5, 9, 40}) {
            const auto a = make<typename TypeParam::Left>(random.matrix(leftIsDense ? outer : inner, inner));
            const auto b = make<typename TypeParam::Right>(random.matrix(inner, rightIsDense ? outer : inner));
            ASSERT_EQ(plain(a * b), plainProduct(plain(a), plain(b))) << inner << ", " << outer;
        }
    }
}

TYPED_TEST(Multiplication, OfOtherOrdersIsRefused) {
    const auto a = make<typename TypeParam::Left>(PlainMatrix(3, 3));
    const auto b = make<typename TypeParam::Right>(PlainMatrix(2, 2));
    constexpr bool bothDiagonal =
        std::is_same_v<typename TypeParam::Left, Diagonal> && std::is_same_v<typename TypeParam::Right, Diagonal>;
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(a * b); }),
              bothDiagonal ? "diagonal matrix elementwise op : row counts are different" : kIncompatible);
}

TEST(DenseProduct, NeedsAnAgreeingInnerDimension) {
    EXPECT_EQ(messageOf<MatrixException>([] { static_cast<void>(Dense(2, 3, 1.0) * Dense(2, 3, 1.0)); }),
              kIncompatible);
    Dense m(2, 3, 1.0);
    EXPECT_EQ(messageOf<MatrixException>([&] { m *= Dense(2, 3, 1.0); }), kIncompatible);
    EXPECT_EQ(plain(m), plain(Dense(2, 3, 1.0)));
}

TEST(DenseProduct, HasTheBitsOfTheReferenceForEveryShape) {
    UniformNumbers random(53);
    for (int trial = 0; trial < scaled(400); ++trial) {
        const Dense a = dense(random.matrix(random.integer(0, 40), random.integer(0, 40)));
        const Dense b = dense(random.matrix(a.colCount(), random.integer(0, 40)));
        const PlainMatrix expected = plainProduct(plain(a), plain(b));
        ASSERT_TRUE(sameBits(plain(a * b), expected)) << expected;
        ASSERT_TRUE(sameBits(plain(qan::matrix_library::SlowMatrixMultiply(a, b)), expected));
    }
}

TEST(DenseProduct, HasTheBitsOfTheReferenceBeyondCacheBlocks) {
    UniformNumbers random(54);
    const int shapes[][3] = {{1, 700, 1}, {3, 1030, 5}, {130, 260, 270}, {65, 513, 129}, {257, 33, 515}, {1, 1, 900}};
    for (const auto& [rows, inner, cols] : shapes) {
        const Dense a = dense(random.matrix(rows, inner));
        const Dense b = dense(random.matrix(inner, cols));
        ASSERT_TRUE(sameBits(plain(a * b), plainProduct(plain(a), plain(b)))) << rows << ", " << inner << ", " << cols;
    }
}

TEST(DenseProduct, KeepsTheOrderOfCancellingTerms) {
    // 1 + 1e300 - 1e300 is 0 in this order and 1 in any other.
    const Dense a(Vec{1, 1e300, -1e300}, 3);
    EXPECT_EQ((a * Dense(3, 1, 1.0))(0, 0), 0.0);
    EXPECT_EQ((a * Dense(3, 9, 1.0))(0, 8), 0.0);
}

TEST(DenseProduct, WithoutInnerDimensionIsZero) {
    EXPECT_EQ(plain(Dense(2, 0, 1.0) * Dense(0, 3, 1.0)), PlainMatrix(2, 3));
}

TEST(DenseProduct, DoesNotSkipZeros) {
    for (const int order : {1, 2, 8, 40}) {
        const Dense zeros(order, order, 0.0);
        const Dense infinities(order, order, kInfinity);
        for (const Dense& product : {zeros * infinities, infinities * zeros})
            for (int i = 0; i < order; ++i)
                for (int j = 0; j < order; ++j)
                    ASSERT_TRUE(std::isnan(product(i, j)));
    }
}

TEST(DenseProduct, SpreadsANaNOverItsRowOrColumn) {
    UniformNumbers random(55);
    PlainMatrix left = random.matrix(20, 20);
    left(7, 3) = kNaN;
    PlainMatrix right = random.matrix(20, 20);
    right(5, 11) = kInfinity;
    EXPECT_TRUE(sameBits(plain(dense(left) * dense(right)), plainProduct(left, right)));
}

TEST(DenseProduct, InPlaceReplacesTheLeftOperand) {
    Dense m(Vec{1, 2, 3, 4, 5, 6}, 3);
    m *= Dense(Vec{1, 10, 100}, 1);
    EXPECT_EQ(plain(m), (PlainMatrix{{321}, {654}}));
    EXPECT_EQ(m.size(), 2);
}

TEST(ReferenceProduct, ChecksTheInnerDimension) {
    EXPECT_EQ(messageOf<MatrixException>([] {
                  static_cast<void>(qan::matrix_library::SlowMatrixMultiply(Dense(2, 3, 1.0), Dense(2, 3, 1.0)));
              }),
              kIncompatible);
}

/// What a product with structural zeros is worth when the other operand holds infinities: only stored elements
/// multiply.
template <class Stored>
PlainMatrix structuralProduct(const PlainMatrix& a, const PlainMatrix& b, Stored stored) {
    PlainMatrix result(a.rows, b.cols);
    for (int i = 0; i < a.rows; ++i)
        for (int j = 0; j < b.cols; ++j)
            for (int k = 0; k < a.cols; ++k)
                if (stored(i, k, j)) result(i, j) += a(i, k) * b(k, j);
    return result;
}

bool inPattern(const Dense&, int, int) {
    return true;
}
bool inPattern(const Symmetric&, int, int) {
    return true;
}
bool inPattern(const Upper&, int i, int j) {
    return i <= j;
}
bool inPattern(const Diagonal&, int i, int j) {
    return i == j;
}

TYPED_TEST(Multiplication, PositionsOutsideAPatternContributeNothing) {
    UniformNumbers random(56);
    for (const int order : {1, 2, 5, 12}) {
        for (const double extreme : {kInfinity, -kInfinity, kNaN}) {
            for (int trial = 0; trial < 6; ++trial) {
                PlainMatrix left = random.matrix(order, order);
                PlainMatrix right = random.matrix(order, order);
                left(random.integer(0, order - 1), random.integer(0, order - 1)) = extreme;
                right(random.integer(0, order - 1), random.integer(0, order - 1)) = extreme;
                const auto a = make<typename TypeParam::Left>(left);
                const auto b = make<typename TypeParam::Right>(right);
                const auto stored = [&](int i, int k, int j) { return inPattern(a, i, k) && inPattern(b, k, j); };
                const auto product = a * b;
                PlainMatrix expected = structuralProduct(plain(a), plain(b), stored);
                ASSERT_TRUE(sameBits(plainSum(plain(product), PlainMatrix(order, order)),
                                     plainSum(expected, PlainMatrix(order, order))))
                    << plain(a) << '\n'
                    << plain(b) << '\n'
                    << plain(product);
            }
        }
    }
}

TEST(StructuredProduct, StoredZerosMultiplyLikeAnyOtherElement) {
    const Dense infinities(2, 2, kInfinity);
    EXPECT_TRUE(std::isnan((diagonal(Vec{0, 1}) * infinities)(0, 0)));
    EXPECT_EQ((diagonal(Vec{0, 1}) * infinities)(1, 0), kInfinity);
    EXPECT_TRUE(std::isnan((infinities * diagonal(Vec{0, 1}))(1, 0)));
    EXPECT_TRUE(std::isnan((Upper(2, 0.0) * infinities)(1, 1)));
    EXPECT_TRUE(std::isnan((Symmetric(2, 0.0) * infinities)(1, 1)));
}

TEST(DiagonalProduct, InPlaceMultipliesTheDiagonals) {
    Diagonal d = diagonal(Vec{2, 3});
    d *= diagonal(Vec{10, 100});
    EXPECT_EQ(plain(d), (PlainMatrix{{20, 0}, {0, 300}}));
}

TEST(DiagonalProduct, InPlaceOfDifferentOrdersIsRefusedAndChangesNothing) {
    Diagonal d = diagonal(Vec{2, 3});
    EXPECT_THROW(d *= diagonal(Vec{1}), MatrixException);
    EXPECT_THROW(d *= diagonal(Vec{1, 2, 3}), MatrixException);
    EXPECT_EQ(plain(d), (PlainMatrix{{2, 0}, {0, 3}}));
}

template <class Kind>
class ScalarProduct : public testing::Test {};
using Kinds = testing::Types<Dense, Diagonal, Upper, Symmetric>;
TYPED_TEST_SUITE(ScalarProduct, Kinds);

TYPED_TEST(ScalarProduct, KeepsTheKindOnBothSides) {
    static_assert(std::is_same_v<decltype(2.0 * std::declval<const TypeParam&>()), TypeParam>);
    static_assert(std::is_same_v<decltype(std::declval<const TypeParam&>() * 2.0), TypeParam>);
}

TYPED_TEST(ScalarProduct, MultipliesEveryStoredElement) {
    UniformNumbers random(57);
    for (int order = 0; order <= 8; ++order) {
        const TypeParam m = make<TypeParam>(random.matrix(order, order));
        const PlainMatrix expected = plainScaled(plain(m), -2.7);
        EXPECT_EQ(plain(-2.7 * m), expected);
        EXPECT_EQ(plain(m * -2.7), expected);
    }
}

TYPED_TEST(ScalarProduct, LeavesPositionsOutsideThePatternZero) {
    const TypeParam product = kInfinity * make<TypeParam>(PlainMatrix{{1, 1}, {1, 1}});
    for (int i = 0; i < 2; ++i)
        for (int j = 0; j < 2; ++j)
            EXPECT_EQ(product(i, j), inPattern(product, i, j) ? kInfinity : 0.0);
}

}  // namespace
}  // namespace reisti::test
