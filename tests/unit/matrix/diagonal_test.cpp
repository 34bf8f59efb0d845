#include <climits>
#include <type_traits>

#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

static_assert(!std::is_polymorphic_v<Diagonal>);
static_assert(std::is_same_v<decltype(std::declval<Diagonal&>()(0, 0)), double&>);
static_assert(std::is_same_v<decltype(std::declval<const Diagonal&>().getCol(0)), Dense>);
static_assert(std::is_same_v<decltype(std::declval<const Diagonal&>().transpose()), Diagonal>);
static_assert(std::is_same_v<decltype(-std::declval<const Diagonal&>()), Diagonal>);

TEST(Diagonal, SizeIsTheNumberOfStoredElements) {
    EXPECT_EQ(diagonal(Vec{1, 2, 3}).size(), 3);
}

TEST(Diagonal, DefaultHasOrderZero) {
    const Diagonal d;
    EXPECT_EQ(d.rowCount(), 0);
    EXPECT_EQ(d.colCount(), 0);
}

TEST(Diagonal, ResizeFillsTheDiagonalAndDropsOldContent) {
    Diagonal d;
    d.resize(2, 3.0);
    EXPECT_EQ(plain(d), (PlainMatrix{{3, 0}, {0, 3}}));
    d.resize(3, 5.0);
    EXPECT_EQ(plain(d), (PlainMatrix{{5, 0, 0}, {0, 5, 0}, {0, 0, 5}}));
    d.resize(1, 7.0);
    EXPECT_EQ(plain(d), (PlainMatrix{{7}}));
    EXPECT_EQ(d.colCount(), 1);
}

TEST(Diagonal, SetFillsTheDiagonalOnly) {
    Diagonal d = diagonal(Vec{1, 2});
    d.set(9.0);
    EXPECT_EQ(plain(d), (PlainMatrix{{9, 0}, {0, 9}}));
}

TEST(Diagonal, WritesOffTheDiagonalAreDiscarded) {
    Diagonal d = diagonal(Vec{1, 2, 3});
    d(0, 2) = 5.0;
    d(2, 0) = 6.0;
    d.at(1, 0) = 7.0;
    EXPECT_EQ(plain(d), (PlainMatrix{{1, 0, 0}, {0, 2, 0}, {0, 0, 3}}));
}

TEST(Diagonal, EachAccessOffTheDiagonalReadsZeroAgain) {
    Diagonal d = diagonal(Vec{1, 2});
    d(0, 1) = 5.0;
    EXPECT_EQ(d(0, 1), 0.0);
    double& discarded = d(0, 1);
    discarded = 5.0;
    EXPECT_EQ(d(1, 0), 0.0);
    EXPECT_EQ(discarded, 0.0) << "the scratch element is shared and cleared by the second access";
}

TEST(Diagonal, AtAssertsTheRowThenTheColumn) {
    Diagonal d = diagonal(Vec{1, 2});
    const Diagonal& fixed = d;
    for (const int bad : {-1, 2, INT_MAX, INT_MIN}) {
        EXPECT_THAT(messageOf<AllegeException>([&] { d.at(bad, bad) = 1.0; }),
                    IsAssertion("row >= 0 && row < m_", "src/matrix/matrix_new"));
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(fixed.at(1, bad)); }),
                    IsAssertion("column >= 0 && column < m_", "src/matrix/matrix_new"));
    }
    EXPECT_EQ(fixed.at(1, 1), 2.0);
    EXPECT_EQ(fixed.at(1, 0), 0.0);
    EXPECT_NO_THROW(fixed.range_check(-5, 99));
}

TEST(Diagonal, NegationFlipsTheStoredElements) {
    EXPECT_EQ(plain(-diagonal(Vec{1, -2})), (PlainMatrix{{-1, 0}, {0, 2}}));
}

TEST(Diagonal, TransposeIsACopy) {
    const Diagonal d = diagonal(Vec{1, 2});
    EXPECT_EQ(plain(d.transpose()), plain(d));
}

TEST(Diagonal, ColumnIsDense) {
    const Diagonal d = diagonal(Vec{1, 2, 3});
    EXPECT_EQ(plain(d.getCol(1)), (PlainMatrix{{0}, {2}, {0}}));
}

TEST(Diagonal, RemoveColRowErasesOneElement) {
    Diagonal d = diagonal(Vec{1, 2, 3});
    d.removeColRow(1);
    EXPECT_EQ(plain(d), (PlainMatrix{{1, 0}, {0, 3}}));
    d.removeColRow(1);
    d.removeColRow(0);
    EXPECT_EQ(d.rowCount(), 0);
}

TEST(DiagonalSubmatrix, BlockOnTheDiagonalIsCopiedIn) {
    Diagonal d = diagonal(Vec{1, 2, 3, 4});
    d.setSubmatrix(1, 1, diagonal(Vec{20, 30}));
    EXPECT_EQ(plain(d), plain(diagonal(Vec{1, 20, 30, 4})));
    d.setSubmatrix(2, 2, diagonal(Vec{7, 8}));
    EXPECT_EQ(plain(d), plain(diagonal(Vec{1, 20, 7, 8})));
}

TEST(DiagonalSubmatrix, BlockOffTheDiagonalIsIgnored) {
    Diagonal d = diagonal(Vec{1, 2, 3, 4});
    d.setSubmatrix(1, 2, diagonal(Vec{20, 30}));
    d.setSubmatrix(2, 0, diagonal(Vec{20, 30}));
    EXPECT_EQ(plain(d), plain(diagonal(Vec{1, 2, 3, 4})));
}

TEST(DiagonalSubmatrix, BlockThatDoesNotFitIsRefusedOffTheDiagonalToo) {
    Diagonal d = diagonal(Vec{1, 2, 3});
    const std::string text = "Dmatrixmatrix::setSubmatrix incompatible matrices";
    const Diagonal block = diagonal(Vec{8, 9});
    EXPECT_EQ(messageOf<MatrixException>([&] { d.setSubmatrix(2, 2, block); }), text);
    EXPECT_EQ(messageOf<MatrixException>([&] { d.setSubmatrix(1, 2, block); }), text);
    EXPECT_EQ(messageOf<MatrixException>([&] { d.setSubmatrix(2, 1, block); }), text);
    EXPECT_EQ(messageOf<MatrixException>([&] { d.setSubmatrix(INT_MAX, INT_MAX, block); }), text);
    EXPECT_EQ(plain(d), plain(diagonal(Vec{1, 2, 3})));
}

TEST(DiagonalSubmatrix, EmptyBlockChangesNothing) {
    Diagonal d = diagonal(Vec{1, 2});
    d.setSubmatrix(2, 2, Diagonal());
    EXPECT_EQ(plain(d), plain(diagonal(Vec{1, 2})));
}

TEST(DiagonalInverseMember, WritesTheResultAndReturnsTheFlagAsAnOrder) {
    const Diagonal d = diagonal(Vec{2, 4});
    Diagonal result;
    const Diagonal flag = d.inverse(&result);
    EXPECT_EQ(plain(result), (PlainMatrix{{0.5, 0}, {0, 0.25}}));
    EXPECT_EQ(plain(flag), (PlainMatrix{{0}}));
}

TEST(DiagonalInverseMember, FailureReturnsOrderZero) {
    const Diagonal d = diagonal(Vec{2, 0});
    Diagonal result = diagonal(Vec{1, 1, 1});
    EXPECT_EQ(d.inverse(&result).rowCount(), 0);
    EXPECT_EQ(result.rowCount(), 0);
}

TEST(Diagonal, SwapExchangesOrderAndElements) {
    Diagonal a = diagonal(Vec{1, 2});
    Diagonal b = diagonal(Vec{3});
    a.swap(b);
    EXPECT_EQ(plain(a), (PlainMatrix{{3}}));
    EXPECT_EQ(plain(b), (PlainMatrix{{1, 0}, {0, 2}}));
}

TEST(Diagonal, CopyIsIndependent) {
    const Diagonal original = diagonal(Vec{1, 2});
    Diagonal copy(original);
    copy(0, 0) = 9.0;
    EXPECT_EQ(original(0, 0), 1.0);
    copy = original;
    EXPECT_EQ(copy(0, 0), 1.0);
}

}  // namespace
}  // namespace reisti::test
