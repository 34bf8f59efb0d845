#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

Dense sixElements() {
    return Dense(Vec{1, 2, 3, 4, 5, 6}, 3);
}
const PlainMatrix kSix{{1, 2, 3}, {4, 5, 6}};

TEST(DenseRows, RowIsAMatrixOfOneRowOrAVector) {
    const Dense m = sixElements();
    EXPECT_EQ(plain(m.getRow(1)), (PlainMatrix{{4, 5, 6}}));
    EXPECT_EQ(m.getRowVector(0), (Vec{1, 2, 3}));
}

TEST(DenseColumns, ColumnIsAMatrixOfOneColumnOrAVector) {
    const Dense m = sixElements();
    EXPECT_EQ(plain(m.getCol(2)), (PlainMatrix{{3}, {6}}));
    EXPECT_EQ(m.getColVector(0), (Vec{1, 4}));
}

TEST(DenseRows, SetRowFromAMatrixCopiesItsFirstRow) {
    Dense m = sixElements();
    m.setRow(1, Dense(Vec{7, 8, 9}, 3));
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2, 3}, {7, 8, 9}}));
    m.setRow(0, Dense(Vec{10, 11, 12, 13, 14, 15}, 3));
    EXPECT_EQ(plain(m), (PlainMatrix{{10, 11, 12}, {7, 8, 9}}));
}

TEST(DenseRows, SetRowFromAMatrixOfAnotherWidthIsRefused) {
    Dense m = sixElements();
    EXPECT_EQ(messageOf<MatrixException>([&] { m.setRow(0, Dense(1, 2, 0.0)); }),
              "matrix::setRow incompatible matrices");
    EXPECT_EQ(messageOf<MatrixException>([&] { m.setRow(0, Dense(3, 1, 0.0)); }),
              "matrix::setRow incompatible matrices");
    EXPECT_EQ(plain(m), kSix);
}

// There is no first row to copy: whatever the answer, memory behind the source is none of it.
TEST(DenseRows, SetRowFromAMatrixWithoutRowsLeavesTheTarget) {
    Dense m = sixElements();
    try {
        m.setRow(0, Dense(0, 3, 0.0));
    } catch (const MatrixException&) {
        SUCCEED();
    }
    EXPECT_EQ(plain(m), kSix);
}

TEST(DenseColumns, SetColFromAMatrixWithoutColumnsLeavesTheTarget) {
    Dense m = sixElements();
    try {
        m.setCol(0, Dense(2, 0, 0.0));
    } catch (const MatrixException&) {
        SUCCEED();
    }
    EXPECT_EQ(plain(m), kSix);
}

TEST(DenseRows, SetRowFromAVectorOverwritesTheRow) {
    Dense m = sixElements();
    m.setRow(0, Vec{7, 8, 9});
    EXPECT_EQ(plain(m), (PlainMatrix{{7, 8, 9}, {4, 5, 6}}));
}

TEST(DenseRows, SetRowFromAVectorOfAnotherLengthWritesConsecutiveElements) {
    if (uncheckedArgumentsMayBeAsserted()) GTEST_SKIP() << "this build may look at the length";
    Dense m = sixElements();
    m.setRow(1, Vec{7});
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2, 3}, {7, 5, 6}}));
    m.setRow(0, Vec{10, 11, 12, 13});
    EXPECT_EQ(plain(m), (PlainMatrix{{10, 11, 12}, {13, 5, 6}}));
}

TEST(DenseColumns, SetColFromAMatrixCopiesItsFirstStoredElements) {
    Dense m = sixElements();
    m.setCol(1, Dense(Vec{7, 8}, 1));
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 7, 3}, {4, 8, 6}}));
    // A source of several columns gives its first stored elements, which lie along its first row.
    m.setCol(0, Dense(Vec{10, 11, 12, 13}, 2));
    EXPECT_EQ(plain(m), (PlainMatrix{{10, 7, 3}, {11, 8, 6}}));
}

TEST(DenseColumns, SetColFromAMatrixOfAnotherHeightIsRefused) {
    Dense m = sixElements();
    EXPECT_EQ(messageOf<MatrixException>([&] { m.setCol(0, Dense(3, 1, 0.0)); }),
              "matrix::setCol incompatible matrices");
    EXPECT_EQ(messageOf<MatrixException>([&] { m.setCol(0, Dense(1, 2, 0.0)); }),
              "matrix::setCol incompatible matrices");
    EXPECT_EQ(plain(m), kSix);
}

TEST(DenseColumns, SetColFromAVectorOverwritesTheColumn) {
    Dense m = sixElements();
    m.setCol(2, Vec{7, 8});
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2, 7}, {4, 5, 8}}));
}

TEST(DenseColumns, SetColFromAShorterVectorWritesTheFirstRows) {
    if (uncheckedArgumentsMayBeAsserted()) GTEST_SKIP() << "this build may look at the length";
    Dense m = sixElements();
    m.setCol(2, Vec{7});
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2, 7}, {4, 5, 6}}));
}

using DenseAction = void (*)(Dense&, int);
struct CheckedIndex {
    const char* name;
    const char* expression;
    int limit;
    DenseAction action;
};

class DenseIndexAssertion : public testing::TestWithParam<CheckedIndex> {};

TEST_P(DenseIndexAssertion, RejectsBothSidesAndLeavesTheMatrix) {
    const CheckedIndex& checked = GetParam();
    Dense m = sixElements();
    for (const int index : {-1, checked.limit, checked.limit + 1000, -2147483647 - 1}) {
        EXPECT_THAT(messageOf<AllegeException>([&] { checked.action(m, index); }), IsAssertion(checked.expression))
            << index;
        EXPECT_EQ(plain(m), kSix) << index;
    }
}

const char* const kRowTest = "0 <= i && i < m_";
const char* const kColumnTest = "0 <= j && j < n_";

INSTANTIATE_TEST_SUITE_P(
    Operations, DenseIndexAssertion,
    testing::Values(
        CheckedIndex{"getCol", kColumnTest, 3, [](Dense& m, int j) { static_cast<void>(m.getCol(j)); }},
        CheckedIndex{"getColVector", kColumnTest, 3, [](Dense& m, int j) { static_cast<void>(m.getColVector(j)); }},
        CheckedIndex{"setRowMatrix", kRowTest, 2, [](Dense& m, int i) { m.setRow(i, Dense(1, 3, 0.0)); }},
        CheckedIndex{"setRowMatrixIndexBeforeWidth", kRowTest, 2,
                     [](Dense& m, int i) { m.setRow(i, Dense(1, 1, 0.0)); }},
        CheckedIndex{"setRowVector", kRowTest, 2,
                     [](Dense& m, int i) {
                         m.setRow(i, Vec{0, 0, 0});
                     }},
        CheckedIndex{"setColMatrix", kColumnTest, 3, [](Dense& m, int j) { m.setCol(j, Dense(2, 1, 0.0)); }},
        CheckedIndex{"setColMatrixIndexBeforeHeight", kColumnTest, 3,
                     [](Dense& m, int j) { m.setCol(j, Dense(1, 1, 0.0)); }},
        CheckedIndex{"setColVector", kColumnTest, 3,
                     [](Dense& m, int j) {
                         m.setCol(j, Vec{0, 0});
                     }},
        CheckedIndex{"removeRow", kRowTest, 2, [](Dense& m, int i) { m.removeRow(i); }},
        CheckedIndex{"removeCol", kColumnTest, 3, [](Dense& m, int j) { m.removeCol(j); }},
        CheckedIndex{"delRow", kRowTest, 2, [](Dense& m, int i) { static_cast<void>(m.delRow(i)); }},
        CheckedIndex{"delCol", kColumnTest, 3, [](Dense& m, int j) { static_cast<void>(m.delCol(j)); }}),
    [](const auto& caseInfo) { return std::string(caseInfo.param.name); });

TEST(DenseSubmatrix, BlockIsCopiedOut) {
    const Dense m(Vec{1, 2, 3, 4, 5, 6, 7, 8, 9}, 3);
    EXPECT_EQ(plain(m.getSubmatrix(1, 1, 2, 2)), (PlainMatrix{{5, 6}, {8, 9}}));
    EXPECT_EQ(plain(m.getSubmatrix(0, 2, 3, 1)), (PlainMatrix{{3}, {6}, {9}}));
    EXPECT_EQ(plain(m.getSubmatrix(0, 0, 3, 3)), plain(m));
}

TEST(DenseSubmatrix, BlockWithoutElementsIsAllowedUpToTheEdge) {
    const Dense m(3, 3, 1.0);
    EXPECT_TRUE(m.getSubmatrix(3, 3, 0, 0).empty());
    EXPECT_EQ(m.getSubmatrix(0, 0, 0, 2).colCount(), 2);
}

TEST(DenseSubmatrix, BlockThatDoesNotFitIsRefused) {
    const Dense m(3, 3, 1.0);
    const auto attempt = [&](int r, int c, int rows, int cols) {
        return messageOf<MatrixException>([&] { static_cast<void>(m.getSubmatrix(r, c, rows, cols)); });
    };
    const std::string refusal = "matrix::getSubmatrix incompatible matrices";
    EXPECT_EQ(attempt(2, 0, 2, 1), refusal);
    EXPECT_EQ(attempt(0, 2, 1, 2), refusal);
    EXPECT_EQ(attempt(4, 0, 0, 1), refusal);
}

TEST(DenseSubmatrix, SumOfStartAndLengthIsNotFooledByItsOwnOverflow) {
    const Dense m(3, 3, 1.0);
    const std::string refusal = "matrix::getSubmatrix incompatible matrices";
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(m.getSubmatrix(1, 0, 2147483647, 1)); }), refusal);
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(m.getSubmatrix(0, 1, 1, 2147483647)); }), refusal);
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(m.getSubmatrix(2147483647, 0, 1, 1)); }), refusal);
}

TEST(DenseSubmatrix, BlockIsCopiedIn) {
    Dense m(3, 3, 0.0);
    m.setSubmatrix(1, 0, Dense(Vec{1, 2, 3, 4}, 2));
    EXPECT_EQ(plain(m), (PlainMatrix{{0, 0, 0}, {1, 2, 0}, {3, 4, 0}}));
}

TEST(DenseSubmatrix, BlockThatDoesNotFitIsNotCopiedIn) {
    Dense m = sixElements();
    const std::string refusal = "matrix::setSubmatrix incompatible matrices";
    EXPECT_EQ(messageOf<MatrixException>([&] { m.setSubmatrix(1, 0, Dense(2, 1, 9.0)); }), refusal);
    EXPECT_EQ(messageOf<MatrixException>([&] { m.setSubmatrix(0, 2, Dense(1, 2, 9.0)); }), refusal);
    EXPECT_EQ(messageOf<MatrixException>([&] { m.setSubmatrix(2147483647, 0, Dense(1, 1, 9.0)); }), refusal);
    EXPECT_EQ(plain(m), kSix);
}

}  // namespace
}  // namespace reisti::test
