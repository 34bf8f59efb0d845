#include <climits>
#include <type_traits>

#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

static_assert(!std::is_polymorphic_v<Upper>);
static_assert(std::is_same_v<decltype(std::declval<Upper&>()(0, 0)), double&>);
static_assert(std::is_same_v<decltype(std::declval<const Upper&>().transpose()), Dense>);
static_assert(std::is_same_v<decltype(-std::declval<const Upper&>()), Upper>);

TEST(Upper, DefaultHasOrderZero) {
    const Upper u;
    EXPECT_EQ(u.rowCount(), 0);
    EXPECT_EQ(u.colCount(), 0);
    EXPECT_EQ(u.size(), 0);
}

TEST(Upper, PackedLengthIsHalfTheSquareWithTheDiagonal) {
    for (int order = 0; order <= 1000; ++order)
        ASSERT_EQ(Upper::calculate_size(order), order * (order + 1) / 2);
    EXPECT_EQ(Upper::calculate_size(46340), 1073720970);
}

TEST(Upper, FillReachesTheUpperTriangleOnly) {
    EXPECT_EQ(plain(Upper(3, 2.0)), (PlainMatrix{{2, 2, 2}, {0, 2, 2}, {0, 0, 2}}));
}

TEST(Upper, PackedVectorIsReadRowByRow) {
    EXPECT_EQ(plain(Upper(3, Vec{1, 2, 3, 4, 5, 6})), (PlainMatrix{{1, 2, 3}, {0, 4, 5}, {0, 0, 6}}));
    EXPECT_EQ(Upper(0, Vec{}).rowCount(), 0);
}

TEST(Upper, PackedVectorOfAnotherLengthIsAnAssertion) {
    for (const int length : {0, 5, 7, 9}) {
        EXPECT_THAT(messageOf<AllegeException>(
                        [&] { static_cast<void>(Upper(3, Vec(static_cast<std::size_t>(length), 1.0))); }),
                    IsAssertion("static_cast<int>( v.size() ) == calculate_size( m )", "src/matrix/matrix_upper_impl"))
            << length;
    }
}

TEST(Upper, SizeIsTheOrder) {
    EXPECT_EQ(Upper(3, 1.0).size(), 3);
}

TEST(Upper, ElementsAreStoredRowByRow) {
    Upper u(4, 0.0);
    int expectedOffset = 0;
    for (int i = 0; i < 4; ++i)
        for (int j = i; j < 4; ++j)
            EXPECT_EQ(&u(i, j) - &u(0, 0), expectedOffset++) << i << ", " << j;
}

TEST(Upper, WritesBelowTheDiagonalAreDiscarded) {
    Upper u(3, Vec{1, 2, 3, 4, 5, 6});
    u(2, 1) = 5.0;
    u.at(1, 0) = 6.0;
    EXPECT_EQ(plain(u), (PlainMatrix{{1, 2, 3}, {0, 4, 5}, {0, 0, 6}}));
    EXPECT_EQ(u(2, 1), 0.0);
}

TEST(Upper, EachAccessBelowTheDiagonalReadsZeroAgain) {
    Upper u(3, 1.0);
    double& discarded = u(1, 0);
    discarded = 5.0;
    EXPECT_EQ(u(2, 0), 0.0);
    EXPECT_EQ(discarded, 0.0) << "the scratch element is shared and cleared by the second access";
}

TEST(Upper, AtAssertsTheRowThenTheColumn) {
    Upper u(2, 1.0);
    const Upper& fixed = u;
    for (const int bad : {-1, 2, INT_MAX, INT_MIN}) {
        EXPECT_THAT(messageOf<AllegeException>([&] { u.at(bad, bad) = 1.0; }),
                    IsAssertion("row >= 0 && row < m_", "src/matrix/matrix_new"));
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(fixed.at(1, bad)); }),
                    IsAssertion("column >= 0 && column < m_", "src/matrix/matrix_new"));
    }
    EXPECT_EQ(fixed.at(0, 1), 1.0);
    EXPECT_EQ(fixed.at(1, 0), 0.0);
    EXPECT_NO_THROW(fixed.range_check(-5, 99));
}

TEST(Upper, ResizeDropsOldContent) {
    Upper u(3, Vec{1, 2, 3, 4, 5, 6});
    u.resize(2, 7.0);
    EXPECT_EQ(plain(u), (PlainMatrix{{7, 7}, {0, 7}}));
    u.resize(3, 8.0);
    EXPECT_EQ(plain(u), (PlainMatrix{{8, 8, 8}, {0, 8, 8}, {0, 0, 8}}));
}

TEST(Upper, SetFillsTheStoredElements) {
    Upper u(2, 1.0);
    u.set(4.0);
    EXPECT_EQ(plain(u), (PlainMatrix{{4, 4}, {0, 4}}));
}

TEST(Upper, NegationFlipsTheStoredElements) {
    EXPECT_EQ(plain(-Upper(2, Vec{1, -2, 3})), (PlainMatrix{{-1, 2}, {0, -3}}));
}

TEST(Upper, TransposeIsDenseAndLowerTriangular) {
    EXPECT_EQ(plain(Upper(3, Vec{1, 2, 3, 4, 5, 6}).transpose()), (PlainMatrix{{1, 0, 0}, {2, 4, 0}, {3, 5, 6}}));
    EXPECT_TRUE(Upper().transpose().empty());
}

TEST(Upper, SwapExchangesOrderAndElements) {
    Upper a(2, Vec{1, 2, 3});
    Upper b(1, 9.0);
    a.swap(b);
    EXPECT_EQ(plain(a), (PlainMatrix{{9}}));
    EXPECT_EQ(plain(b), (PlainMatrix{{1, 2}, {0, 3}}));
}

TEST(Upper, CopyIsIndependent) {
    const Upper original(2, Vec{1, 2, 3});
    Upper copy(original);
    copy(0, 1) = 9.0;
    EXPECT_EQ(original(0, 1), 2.0);
}

TEST(UpperConversion, ToSymmetricMirrorsTheUpperTriangle) {
    const Symmetric s = qan::matrix_library::mUTmatrixToSmatrix(Upper(3, Vec{1, 2, 3, 4, 5, 6}));
    EXPECT_EQ(plain(s), (PlainMatrix{{1, 2, 3}, {2, 4, 5}, {3, 5, 6}}));
}

TEST(UpperConversion, FromSymmetricTakesTheUpperTriangle) {
    const Upper u = qan::matrix_library::SmatrixToUTmatrix(symmetric({{1, 0, 0}, {2, 4, 0}, {3, 5, 6}}));
    EXPECT_EQ(plain(u), (PlainMatrix{{1, 2, 3}, {0, 4, 5}, {0, 0, 6}}));
}

TEST(UpperConversion, ThereAndBackIsTheSameForEveryOrder) {
    UniformNumbers random(21);
    for (int order = 0; order <= 12; ++order) {
        const Upper u = upper(random.matrix(order, order));
        EXPECT_EQ(plain(qan::matrix_library::SmatrixToUTmatrix(qan::matrix_library::mUTmatrixToSmatrix(u))), plain(u));
    }
}

}  // namespace
}  // namespace reisti::test
