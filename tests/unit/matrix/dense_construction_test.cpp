#include <cstdint>
#include <type_traits>
#include <utility>

#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

using IntMatrix = qan::matrix_library::matrix<int>;

static_assert(!std::is_polymorphic_v<Dense> && !std::is_polymorphic_v<IntMatrix>);
static_assert(std::is_copy_constructible_v<Dense> && std::is_copy_assignable_v<Dense>);
static_assert(sizeof(Dense) == 4 * sizeof(std::int32_t) + sizeof(Vec), "signature, three counts, elements");

TEST(DenseConstruction, DefaultIsZeroByZero) {
    const Dense m;
    EXPECT_EQ(m.rowCount(), 0);
    EXPECT_EQ(m.colCount(), 0);
    EXPECT_EQ(m.size(), 0);
    EXPECT_TRUE(m.empty());
}

TEST(DenseConstruction, FillSetsEveryElement) {
    const Dense m(2, 3, 7.5);
    EXPECT_EQ(plain(m), (PlainMatrix{{7.5, 7.5, 7.5}, {7.5, 7.5, 7.5}}));
    EXPECT_EQ(m.size(), 6);
    EXPECT_FALSE(m.empty());
}

TEST(DenseConstruction, MatrixWithoutRowsOrWithoutColumnsIsEmptyButKeepsTheOtherCount) {
    const Dense noRows(0, 3, 1.0);
    EXPECT_TRUE(noRows.empty());
    EXPECT_EQ(noRows.rowCount(), 0);
    EXPECT_EQ(noRows.colCount(), 3);
    const Dense noCols(4, 0, 1.0);
    EXPECT_TRUE(noCols.empty());
    EXPECT_EQ(noCols.rowCount(), 4);
    EXPECT_EQ(noCols.colCount(), 0);
}

TEST(DenseConstruction, VectorIsReadRowByRow) {
    const Dense m(Vec{1, 2, 3, 4, 5, 6}, 3);
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2, 3}, {4, 5, 6}}));
}

TEST(DenseConstruction, VectorThatIsKeptIsCopied) {
    const Vec elements{1, 2, 3, 4, 5, 6};
    Dense m(elements, 3);
    m(0, 0) = 9.0;
    EXPECT_EQ(elements[0], 1.0);
    EXPECT_EQ(m(1, 2), 6.0);
    EXPECT_EQ(m.rowCount(), 2);
}

TEST(DenseConstruction, VectorThatIsGivenAwayKeepsItsStorage) {
    Vec elements{1, 2, 3, 4, 5, 6};
    const double* const storage = elements.data();
    Dense m(std::move(elements), 3);
    EXPECT_EQ(&m(0, 0), storage);
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2, 3}, {4, 5, 6}}));
}

TEST(DenseConstruction, VectorOfAnotherLengthIsNotRejectedAndItsRowCountIsRoundedDown) {
    const Dense m(Vec{1, 2, 3, 4, 5}, 2);
    EXPECT_EQ(m.rowCount(), 2);
    EXPECT_EQ(m.colCount(), 2);
    EXPECT_EQ(m.size(), 4);
    EXPECT_NO_THROW(m.CheckInvariant());
}

TEST(DenseConstruction, VectorOfAnotherLengthKeepsAllStoredValues) {
    const Vec five{1, 2, 3, 4, 5};
    Dense m(five, 2);
    // Assigning a vector that equals the storage changes nothing: the shape betrays that all five are there.
    m = five;
    EXPECT_EQ(m.rowCount(), 2);
    EXPECT_EQ(m.colCount(), 2);
    m = Vec{1, 2, 3, 4};
    EXPECT_EQ(m.rowCount(), 4);
    EXPECT_EQ(m.colCount(), 1);
}

TEST(DenseConstruction, VectorShorterThanOneRowGivesNoRows) {
    const Dense m(Vec{1, 2}, 3);
    EXPECT_EQ(m.rowCount(), 0);
    EXPECT_EQ(m.colCount(), 3);
    EXPECT_EQ(m.size(), 0);
}

TEST(DenseConstruction, RowVectorHasOneRow) {
    EXPECT_EQ(plain(Dense::CreateRowVector(Vec{1, 2, 3})), (PlainMatrix{{1, 2, 3}}));
}

// The row count is a quotient by the column count; a quotient by zero would end the host.
TEST(DenseConstruction, RowVectorOfNothingDoesNotDivideByZero) {
    try {
        EXPECT_TRUE(Dense::CreateRowVector(Vec{}).empty());
    } catch (const MatrixException&) {
        SUCCEED();
    }
}

TEST(DenseConstruction, VectorWithZeroColumnsDoesNotDivideByZero) {
    const Vec elements{1, 2};
    try {
        EXPECT_TRUE(Dense(elements, 0).empty());
        EXPECT_TRUE(Dense(Vec{1, 2}, 0).empty());
    } catch (const MatrixException&) {
        SUCCEED();
    }
}

TEST(DenseConstruction, DenseCopyOfADiagonalHasZerosOffTheDiagonal) {
    EXPECT_EQ(plain(Dense(diagonal(Vec{2, 3}))), (PlainMatrix{{2, 0}, {0, 3}}));
}

TEST(DenseConstruction, DenseCopyOfAnUpperHasZerosBelowTheDiagonal) {
    EXPECT_EQ(plain(Dense(upper({{1, 2, 3}, {9, 4, 5}, {9, 9, 6}}))), (PlainMatrix{{1, 2, 3}, {0, 4, 5}, {0, 0, 6}}));
}

TEST(DenseConstruction, DenseCopyOfASymmetricHasBothTriangles) {
    EXPECT_EQ(plain(Dense(symmetric({{1, 9, 9}, {2, 3, 9}, {4, 5, 6}}))),
              (PlainMatrix{{1, 2, 4}, {2, 3, 5}, {4, 5, 6}}));
}

TEST(DenseConstruction, AssignmentFromEachStructuredKindReplacesShapeAndContent) {
    Dense m(1, 4, 8.0);
    m = diagonal(Vec{2, 3});
    EXPECT_EQ(plain(m), (PlainMatrix{{2, 0}, {0, 3}}));
    m = upper({{1, 2, 3}, {0, 4, 5}, {0, 0, 6}});
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2, 3}, {0, 4, 5}, {0, 0, 6}}));
    m = symmetric({{1, 0}, {2, 3}});
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2}, {2, 3}}));
    EXPECT_EQ(m.size(), 4);
}

TEST(DenseConstruction, AssignmentFromAStructuredMatrixOfOrderZeroEmpties) {
    Dense m(2, 2, 8.0);
    m = Diagonal();
    EXPECT_EQ(m.rowCount(), 0);
    EXPECT_EQ(m.colCount(), 0);
    EXPECT_EQ(m.size(), 0);
}

TEST(DenseConstruction, CopyIsIndependent) {
    Dense original(2, 2, 1.0);
    Dense copy(original);
    copy(0, 1) = 5.0;
    EXPECT_EQ(original(0, 1), 1.0);
    EXPECT_NO_THROW(copy.CheckInvariant());
}

TEST(DenseConstruction, CopyAssignmentTakesShapeAndElements) {
    const Dense original(Vec{1, 2, 3, 4, 5, 6}, 3);
    Dense target(5, 5, 0.0);
    target = original;
    EXPECT_EQ(plain(target), plain(original));
    EXPECT_EQ(target.size(), 6);
    target(1, 2) = -1.0;
    EXPECT_EQ(original(1, 2), 6.0);
}

struct Refill {
    const char* name;
    void (*fill)(Dense&, int, int, double);
};

class DenseRefill : public testing::TestWithParam<Refill> {};

TEST_P(DenseRefill, LeavesTheFillEverywhereEvenWhenTheShapeStays) {
    Dense m(Vec{1, 2, 3, 4, 5, 6}, 3);
    GetParam().fill(m, 2, 3, 7.0);
    EXPECT_EQ(plain(m), (PlainMatrix{{7, 7, 7}, {7, 7, 7}}));
}

TEST_P(DenseRefill, GrowsWithoutKeepingOldElements) {
    Dense m(Vec{1, 2, 3, 4}, 2);
    GetParam().fill(m, 3, 2, -1.0);
    EXPECT_EQ(plain(m), (PlainMatrix{{-1, -1}, {-1, -1}, {-1, -1}}));
    EXPECT_EQ(m.size(), 6);
}

TEST_P(DenseRefill, ShrinksWithoutKeepingOldElements) {
    Dense m(Vec{1, 2, 3, 4, 5, 6}, 3);
    GetParam().fill(m, 1, 2, 0.5);
    EXPECT_EQ(plain(m), (PlainMatrix{{0.5, 0.5}}));
    EXPECT_EQ(m.size(), 2);
}

TEST_P(DenseRefill, AcceptsZeroRows) {
    Dense m(2, 2, 1.0);
    GetParam().fill(m, 0, 3, 1.0);
    EXPECT_TRUE(m.empty());
    EXPECT_EQ(m.colCount(), 3);
}

TEST_P(DenseRefill, RepairsAStorageLongerThanTheShape) {
    Dense m(Vec{1, 2, 3, 4, 5}, 2);
    GetParam().fill(m, 2, 2, 3.0);
    m.addRow(Vec{1, 2});
    EXPECT_EQ(plain(m), (PlainMatrix{{3, 3}, {3, 3}, {1, 2}}));
}

INSTANTIATE_TEST_SUITE_P(
    AllNames, DenseRefill,
    testing::Values(Refill{"Initialize", [](Dense& m, int r, int c, double x) { m.Initialize(r, c, x); }},
                    Refill{"resize", [](Dense& m, int r, int c, double x) { m.resize(r, c, x); }},
                    Refill{"ResizeStorage", [](Dense& m, int r, int c, double x) { m.ResizeStorage(r, c, x); }}),
    [](const auto& caseInfo) { return std::string(caseInfo.param.name); });

TEST(DenseAssignment, ScalarFillsAndKeepsTheShape) {
    Dense m(Vec{1, 2, 3, 4, 5, 6}, 3);
    m = 4.0;
    EXPECT_EQ(plain(m), (PlainMatrix{{4, 4, 4}, {4, 4, 4}}));
    m.set(-2.0);
    EXPECT_EQ(plain(m), (PlainMatrix{{-2, -2, -2}, {-2, -2, -2}}));
}

TEST(DenseAssignment, ScalarOnAnEmptyMatrixChangesNothing) {
    Dense m(0, 3, 1.0);
    m = 4.0;
    EXPECT_TRUE(m.empty());
    EXPECT_EQ(m.colCount(), 3);
}

TEST(DenseAssignment, VectorMakesAColumn) {
    Dense m(2, 3, 1.0);
    m = Vec{1, 2, 3, 4};
    EXPECT_EQ(plain(m), (PlainMatrix{{1}, {2}, {3}, {4}}));
    EXPECT_EQ(m.size(), 4);
}

TEST(DenseAssignment, VectorEqualToTheStorageKeepsTheShape) {
    Dense m(Vec{1, 2, 3, 4}, 2);
    m = Vec{1, 2, 3, 4};
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2}, {3, 4}}));
}

TEST(DenseAssignment, VectorOfTheSameLengthWithOneOtherValueMakesAColumn) {
    Dense m(Vec{1, 2, 3, 4}, 2);
    m = Vec{1, 2, 3, 5};
    EXPECT_EQ(plain(m), (PlainMatrix{{1}, {2}, {3}, {5}}));
}

TEST(DenseAssignment, NegativeZeroEqualsZeroInTheStorage) {
    Dense m(2, 2, 0.0);
    m = Vec{-0.0, -0.0, -0.0, -0.0};
    EXPECT_EQ(m.colCount(), 2);
}

TEST(DenseAssignment, NaNInTheStorageEqualsNothing) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    Dense m(1, 2, nan);
    m = Vec{nan, nan};
    EXPECT_EQ(m.rowCount(), 2);
    EXPECT_EQ(m.colCount(), 1);
}

TEST(DenseAssignment, EmptyVectorKeepsTheShapeOfAnEmptyMatrix) {
    Dense m(0, 3, 1.0);
    m = Vec{};
    EXPECT_EQ(m.rowCount(), 0);
    EXPECT_EQ(m.colCount(), 3);
}

TEST(DenseAssignment, EmptyVectorMakesAFilledMatrixAColumnWithoutRows) {
    Dense m(2, 2, 1.0);
    m = Vec{};
    EXPECT_EQ(m.rowCount(), 0);
    EXPECT_EQ(m.colCount(), 1);
    EXPECT_EQ(m.size(), 0);
}

TEST(DenseSwap, ExchangesShapeAndElements) {
    Dense a(Vec{1, 2, 3, 4, 5, 6}, 3);
    Dense b(Vec{7, 8}, 1);
    a.swap(b);
    EXPECT_EQ(plain(a), (PlainMatrix{{7}, {8}}));
    EXPECT_EQ(plain(b), (PlainMatrix{{1, 2, 3}, {4, 5, 6}}));
    EXPECT_EQ(a.size(), 2);
    EXPECT_EQ(b.size(), 6);
    EXPECT_NO_THROW(a.CheckInvariant());
}

TEST(IntMatrix, IsConstructedFilledAndResized) {
    IntMatrix m(2, 3, 4);
    EXPECT_EQ(m.rowCount(), 2);
    EXPECT_EQ(m.colCount(), 3);
    EXPECT_EQ(m.size(), 6);
    EXPECT_EQ(m(1, 2), 4);
    m.resize(1, 2, -7);
    EXPECT_EQ(m(0, 1), -7);
    m.ResizeStorage(3, 1, 9);
    EXPECT_EQ(m.rowCount(), 3);
    EXPECT_EQ(m(2, 0), 9);
    EXPECT_TRUE(IntMatrix().empty());
}

TEST(IntMatrix, KeepsWrittenElements) {
    IntMatrix m(2, 2, 0);
    m(0, 1) = 5;
    m.at(1, 0) = 2147483647;
    const IntMatrix copy(m);
    EXPECT_EQ(copy(0, 1), 5);
    EXPECT_EQ(copy.at(1, 0), 2147483647);
}

TEST(IntMatrix, HasTheGenericMembersToo) {
    IntMatrix m(std::vector<int>{1, 2, 3, 4}, 2);
    m.addRow(std::vector<int>{5, 6});
    m.removeCol(0);
    m += m;
    EXPECT_EQ(m.getColVector(0), (std::vector<int>{4, 8, 12}));
}

}  // namespace
}  // namespace reisti::test
