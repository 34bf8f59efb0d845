#include <limits>
#include <type_traits>

#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();

enum class What { kMatrixAddition, kUpper, kDiagonal };

std::string textOf(What what) {
    switch (what) {
        case What::kMatrixAddition:
            return "matrix addition";
        case What::kUpper:
            return "upper matrix element wise op";
        default:
            return "diagonal matrix elementwise op";
    }
}

/// One line of the table of sums: both operand kinds, the kind of the result and the wording of the check.
template <class LeftKind, class RightKind, class ResultKind, What kWhat>
struct Line {
    using Left = LeftKind;
    using Right = RightKind;
    using Result = ResultKind;
    static std::string text() { return textOf(kWhat); }
};

template <class... Case>
using LinesWithDense = testing::Types<
    Line<Dense, Diagonal, Dense, What::kMatrixAddition>, Line<Dense, Symmetric, Dense, What::kMatrixAddition>,
    Line<Dense, Upper, Dense, What::kMatrixAddition>, Line<Diagonal, Dense, Dense, What::kMatrixAddition>,
    Line<Symmetric, Dense, Dense, What::kMatrixAddition>, Line<Upper, Dense, Dense, What::kMatrixAddition>, Case...>;

using Lines =
    LinesWithDense<Line<Symmetric, Upper, Dense, What::kMatrixAddition>,
                   Line<Upper, Symmetric, Dense, What::kMatrixAddition>,
                   Line<Diagonal, Symmetric, Symmetric, What::kMatrixAddition>,
                   Line<Symmetric, Diagonal, Symmetric, What::kMatrixAddition>,
                   Line<Symmetric, Symmetric, Symmetric, What::kMatrixAddition>,
                   Line<Diagonal, Upper, Upper, What::kUpper>, Line<Upper, Diagonal, Upper, What::kUpper>,
                   Line<Upper, Upper, Upper, What::kUpper>, Line<Diagonal, Diagonal, Diagonal, What::kDiagonal>>;

template <class Case>
class Addition : public testing::Test {};
TYPED_TEST_SUITE(Addition, Lines);

TYPED_TEST(Addition, HasTheResultKindOfTheTable) {
    using Left = typename TypeParam::Left;
    using Right = typename TypeParam::Right;
    using Result = typename TypeParam::Result;
    static_assert(std::is_same_v<decltype(std::declval<const Left&>() + std::declval<const Right&>()), Result>);
    static_assert(std::is_same_v<decltype(std::declval<const Left&>() - std::declval<const Right&>()), Result>);
}

TYPED_TEST(Addition, AgreesWithDenseCopiesAtEveryOrder) {
    UniformNumbers random(31);
    for (int order = 0; order <= 9; ++order) {
        const auto a = make<typename TypeParam::Left>(random.matrix(order, order));
        const auto b = make<typename TypeParam::Right>(random.matrix(order, order));
        const PlainMatrix left = plain(a);
        const PlainMatrix right = plain(b);
        EXPECT_EQ(plain(a + b), plainSum(left, right));
        EXPECT_EQ(plain(a - b), plainDifference(left, right));
        EXPECT_EQ(plain(a), left);
        EXPECT_EQ(plain(b), right);
    }
}

TYPED_TEST(Addition, CarriesInfinitiesOnlyWhereAnOperandStoresThem) {
    const PlainMatrix ones{{1, 1, 1}, {1, 1, 1}, {1, 1, 1}};
    const auto a = make<typename TypeParam::Left>(plainScaled(ones, kInfinity));
    const auto b = make<typename TypeParam::Right>(ones);
    EXPECT_EQ(plain(a + b), plainSum(plain(a), plain(b)));
    EXPECT_EQ(plain(a - b), plainDifference(plain(a), plain(b)));
}

TYPED_TEST(Addition, OfDifferentOrdersNamesTheRowCounts) {
    const auto a = make<typename TypeParam::Left>(PlainMatrix(3, 3));
    const auto b = make<typename TypeParam::Right>(PlainMatrix(2, 2));
    const std::string text = TypeParam::text() + " : row counts are different";
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(a + b); }), text);
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(a - b); }), text);
}

template <class Case>
class AdditionWithDense : public testing::Test {};
TYPED_TEST_SUITE(AdditionWithDense, LinesWithDense<>);

TYPED_TEST(AdditionWithDense, OfAnotherWidthNamesTheColumnCounts) {
    const std::string text = TypeParam::text() + " : col counts are different";
    for (const int cols : {1, 3}) {
        const auto a = make<typename TypeParam::Left>(PlainMatrix(2, kIsDense<typename TypeParam::Left> ? cols : 2));
        const auto b = make<typename TypeParam::Right>(PlainMatrix(2, kIsDense<typename TypeParam::Right> ? cols : 2));
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(a + b); }), text);
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(a - b); }), text);
    }
}

TYPED_TEST(AdditionWithDense, OfAnotherHeightAndWidthNamesTheRowCountsFirst) {
    const PlainMatrix other(4, 5);
    const PlainMatrix square(2, 2);
    const auto a = make<typename TypeParam::Left>(kIsDense<typename TypeParam::Left> ? other : square);
    const auto b = make<typename TypeParam::Right>(kIsDense<typename TypeParam::Right> ? other : square);
    const std::string text = TypeParam::text() + " : row counts are different";
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(a + b); }), text);
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(a - b); }), text);
}

TEST(AdditionMessages, AreThoseOfTheTypicalMistakes) {
    EXPECT_EQ(messageOf<MatrixException>([] {
                  static_cast<void>(Dense(2, 3, 1.0) + diagonal(Vec{1, 1}));
              }),
              "matrix addition : col counts are different");
    EXPECT_EQ(messageOf<MatrixException>([] { static_cast<void>(Dense(3, 3, 1.0) - Symmetric(2, 1.0)); }),
              "matrix addition : row counts are different");
    EXPECT_EQ(messageOf<MatrixException>([] {
                  static_cast<void>(Upper(3, 1.0) + diagonal(Vec{1, 1}));
              }),
              "upper matrix element wise op : row counts are different");
    EXPECT_EQ(messageOf<MatrixException>([] {
                  static_cast<void>(diagonal(Vec{1}) - diagonal(Vec{1, 1}));
              }),
              "diagonal matrix elementwise op : row counts are different");
}

TEST(DensePlusDiagonalInPlace, AddsToTheDiagonal) {
    Dense m(Vec{1, 2, 3, 4}, 2);
    Dense& result = (m += diagonal(Vec{10, 20}));
    EXPECT_EQ(plain(m), (PlainMatrix{{11, 2}, {3, 24}}));
    EXPECT_EQ(&result, &m);
}

TEST(DensePlusDiagonalInPlace, OtherDimensionsAreRefused) {
    Dense m(2, 3, 1.0);
    EXPECT_EQ(messageOf<MatrixException>([&] {
                  m += diagonal(Vec{1, 1});
              }),
              "matrix += diagonal : col counts are different");
    EXPECT_EQ(messageOf<MatrixException>([&] {
                  m += diagonal(Vec{1, 1, 1});
              }),
              "matrix += diagonal : row counts are different");
    EXPECT_EQ(plain(m), plain(Dense(2, 3, 1.0)));
}

}  // namespace
}  // namespace reisti::test
