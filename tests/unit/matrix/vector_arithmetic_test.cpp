#include <limits>
#include <type_traits>

#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();

static_assert(std::is_same_v<decltype(std::declval<const Dense&>() + std::declval<const Vec&>()), Dense>);
static_assert(std::is_same_v<decltype(std::declval<const Vec&>() + std::declval<const Dense&>()), Dense>);
static_assert(std::is_same_v<decltype(std::declval<const Dense&>() - std::declval<const Vec&>()), Dense>);
static_assert(std::is_same_v<decltype(std::declval<const Dense&>() * std::declval<const Vec&>()), Dense>);
static_assert(std::is_same_v<decltype(std::declval<const Symmetric&>() * std::declval<const Vec&>()), Dense>);

TEST(MatrixWithVector, SumAndDifferenceTakeTheVectorAsAColumn) {
    const Dense column(Vec{1, 2, 3}, 1);
    const Vec v{10, 20, 30};
    EXPECT_EQ(plain(column + v), (PlainMatrix{{11}, {22}, {33}}));
    EXPECT_EQ(plain(v + column), (PlainMatrix{{11}, {22}, {33}}));
    EXPECT_EQ(plain(column - v), (PlainMatrix{{-9}, {-18}, {-27}}));
}

TEST(MatrixWithVector, InPlaceFormsChangeTheMatrix) {
    Dense column(Vec{1, 2, 3}, 1);
    column += Vec{10, 20, 30};
    EXPECT_EQ(plain(column), (PlainMatrix{{11}, {22}, {33}}));
    column -= Vec{1, 2, 3};
    EXPECT_EQ(plain(column), (PlainMatrix{{10}, {20}, {30}}));
}

TEST(MatrixWithVector, SumNeedsASingleColumnOfTheVectorsLength) {
    const Vec v{1, 2, 3};
    const std::string text = "op+= matrix and vector must be of same order";
    for (const Dense& original :
         {Dense(2, 1, 5.0), Dense(4, 1, 5.0), Dense(3, 2, 5.0), Dense(1, 3, 5.0), Dense(), Dense(3, 0, 5.0)}) {
        Dense m = original;
        EXPECT_EQ(messageOf<MatrixException>([&] { m += v; }), text);
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(m + v); }), text);
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(v + m); }), text);
        EXPECT_EQ(plain(m), plain(original));
    }
}

TEST(MatrixWithVector, DifferenceNeedsASingleColumnOfTheVectorsLength) {
    const Vec v{1, 2, 3};
    const std::string text = "op-= matrix and vector must be of same order";
    for (const Dense& original :
         {Dense(2, 1, 5.0), Dense(4, 1, 5.0), Dense(3, 2, 5.0), Dense(1, 3, 5.0), Dense(), Dense(3, 0, 5.0)}) {
        Dense m = original;
        EXPECT_EQ(messageOf<MatrixException>([&] { m -= v; }), text);
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(m - v); }), text);
        EXPECT_EQ(plain(m), plain(original));
    }
}

TEST(MatrixTimesVector, IsAColumn) {
    const Dense m(Vec{1, 2, 3, 4, 5, 6}, 3);
    EXPECT_EQ(plain(m * Vec{1, 10, 100}), (PlainMatrix{{321}, {654}}));
    EXPECT_EQ(plain(symmetric({{1, 2}, {2, 3}}) * Vec{1, 10}), (PlainMatrix{{21}, {32}}));
}

TEST(MatrixTimesVector, InPlaceReplacesTheMatrixByTheColumn) {
    Dense m(Vec{1, 2, 3, 4, 5, 6}, 3);
    m *= Vec{1, 10, 100};
    EXPECT_EQ(plain(m), (PlainMatrix{{321}, {654}}));
    EXPECT_EQ(m.size(), 2);
}

TEST(MatrixTimesVector, AgreesWithThePlainProduct) {
    UniformNumbers random(41);
    for (int rows = 0; rows <= 9; ++rows) {
        for (int cols = 1; cols <= 9; ++cols) {
            const Dense m = dense(random.matrix(rows, cols));
            const Vec v = random.vector(cols);
            EXPECT_EQ(plain(m * v), plainProduct(plain(m), plainVector(v)));
        }
        const Symmetric s = symmetric(random.matrix(rows, rows));
        const Vec v = random.vector(rows);
        EXPECT_EQ(plain(s * v), plainProduct(plain(s), plainVector(v)));
    }
}

TEST(MatrixTimesVector, DoesNotSkipZeros) {
    EXPECT_TRUE(std::isnan((Dense(1, 1, kInfinity) * Vec{0})(0, 0)));
    EXPECT_TRUE(std::isnan((Dense(1, 1, 0.0) * Vec{kInfinity})(0, 0)));
    EXPECT_TRUE(std::isnan((Symmetric(1, 0.0) * Vec{kInfinity})(0, 0)));
}

TEST(MatrixTimesVector, AnotherLengthIsRefused) {
    Dense m(2, 3, 1.0);
    const std::string text = "matrix and vector must be of same order";
    for (const Vec& v : {Vec{}, Vec{1, 2}, Vec{1, 2, 3, 4}}) {
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(m * v); }), text);
        EXPECT_EQ(messageOf<MatrixException>([&] { m *= v; }), text);
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(Symmetric(3, 1.0) * v); }), text);
        EXPECT_EQ(plain(m), plain(Dense(2, 3, 1.0)));
    }
}

}  // namespace
}  // namespace reisti::test
