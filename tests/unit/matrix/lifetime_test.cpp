#include <type_traits>
#include <utility>

#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

template <class Kind>
class Lifetime : public testing::Test {
  protected:
    const PlainMatrix source{{1, 2, 3}, {2, 4, 5}, {3, 5, 6}};
    Kind sample() const { return make<Kind>(source); }
    PlainMatrix sampleValue() const { return plain(sample()); }
};
using Kinds = testing::Types<Dense, Diagonal, Upper, Symmetric>;
TYPED_TEST_SUITE(Lifetime, Kinds);

TYPED_TEST(Lifetime, MovesDoNotThrow) {
    static_assert(std::is_nothrow_move_constructible_v<TypeParam>);
    static_assert(std::is_nothrow_move_assignable_v<TypeParam>);
}

TYPED_TEST(Lifetime, MoveConstructionTakesTheStorageAndLeavesAnEmptyMatrix) {
    TypeParam from = this->sample();
    const double* const storage = &from(0, 0);
    TypeParam to(std::move(from));
    EXPECT_EQ(plain(to), this->sampleValue());
    EXPECT_EQ(&to(0, 0), storage);
    // NOLINTNEXTLINE(bugprone-use-after-move): the state left behind is promised.
    EXPECT_EQ(from.rowCount(), 0);
    EXPECT_EQ(from.colCount(), 0);
}

TYPED_TEST(Lifetime, MoveAssignmentTakesTheStorageAndLeavesAnEmptyMatrix) {
    TypeParam from = this->sample();
    const double* const storage = &from(0, 0);
    TypeParam to = make<TypeParam>(PlainMatrix(7, 7));
    to = std::move(from);
    EXPECT_EQ(plain(to), this->sampleValue());
    EXPECT_EQ(&to(0, 0), storage);
    // NOLINTNEXTLINE(bugprone-use-after-move): the state left behind is promised.
    EXPECT_EQ(from.rowCount(), 0);
    EXPECT_EQ(from.colCount(), 0);
}

TYPED_TEST(Lifetime, MovedFromMatrixCanBeUsedAgain) {
    TypeParam from = this->sample();
    const TypeParam to(std::move(from));
    // NOLINTNEXTLINE(bugprone-use-after-move): the state left behind is promised.
    EXPECT_EQ(plain(from), PlainMatrix());
    from = this->sample();
    EXPECT_EQ(plain(from), this->sampleValue());
    TypeParam again(std::move(from));
    from.swap(again);
    EXPECT_EQ(plain(from), this->sampleValue());
    EXPECT_EQ(again.rowCount(), 0);
}

TYPED_TEST(Lifetime, MovedFromMatrixHasNoElementsLeft) {
    TypeParam from = this->sample();
    const TypeParam to(std::move(from));
    // NOLINTNEXTLINE(bugprone-use-after-move): the state left behind is promised.
    EXPECT_EQ(plain(-from), PlainMatrix());
    EXPECT_EQ(plain(from.transpose()), PlainMatrix());
}

TYPED_TEST(Lifetime, SelfAssignmentKeepsTheValue) {
    TypeParam m = this->sample();
    TypeParam& same = m;
    m = same;
    EXPECT_EQ(plain(m), this->sampleValue());
}

TYPED_TEST(Lifetime, SelfMoveLeavesAValidMatrix) {
    TypeParam m = this->sample();
    TypeParam& same = m;
    m = std::move(same);
    EXPECT_EQ(m.rowCount(), m.colCount());
    m = this->sample();
    EXPECT_EQ(plain(m), this->sampleValue());
}

TYPED_TEST(Lifetime, SelfSwapKeepsTheValue) {
    TypeParam m = this->sample();
    m.swap(m);
    EXPECT_EQ(plain(m), this->sampleValue());
}

TYPED_TEST(Lifetime, CopyOfAnEmptyMatrixIsEmpty) {
    const TypeParam empty = make<TypeParam>(PlainMatrix());
    const TypeParam copy(empty);
    EXPECT_EQ(plain(copy), PlainMatrix());
    TypeParam target = this->sample();
    target = empty;
    EXPECT_EQ(plain(target), PlainMatrix());
}

TEST(DenseLifetime, MovedFromMatrixIsWhole) {
    Dense from(2, 3, 1.0);
    const Dense to(std::move(from));
    // NOLINTNEXTLINE(bugprone-use-after-move): the state left behind is promised.
    EXPECT_EQ(from.size(), 0);
    EXPECT_TRUE(from.empty());
    EXPECT_NO_THROW(from.CheckInvariant());
    EXPECT_EQ(messageOf<MatrixException>([&] { from.addRow(1.0); }), "addRow operating on a null matrix");
    from.addRow(Vec{1, 2});
    EXPECT_EQ(plain(from), (PlainMatrix{{1, 2}}));
}

TEST(SymmetricLifetime, MovedFromMatrixIsWhole) {
    Symmetric from(3, 1.0);
    const Symmetric to(std::move(from));
    // NOLINTNEXTLINE(bugprone-use-after-move): the state left behind is promised.
    EXPECT_TRUE(from.isEmpty());
    EXPECT_EQ(from.size(), 0);
    from.insertColRow(0, 5.0);
    EXPECT_EQ(plain(from), (PlainMatrix{{5}}));
}

TEST(DiagonalLifetime, MoveKeepsPositionsOffTheDiagonalZero) {
    Diagonal from = diagonal(Vec{1, 2});
    from(0, 1) = 99.0;
    const Diagonal to(std::move(from));
    EXPECT_EQ(to(0, 1), 0.0);
    EXPECT_EQ(to(1, 0), 0.0);
}

}  // namespace
}  // namespace reisti::test
