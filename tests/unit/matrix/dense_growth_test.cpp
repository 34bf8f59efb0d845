#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

Dense sixElements() {
    return Dense(Vec{1, 2, 3, 4, 5, 6}, 3);
}
const PlainMatrix kSix{{1, 2, 3}, {4, 5, 6}};

TEST(DenseAddRow, VectorGivesADefaultMatrixItsWidth) {
    Dense m;
    m.addRow(Vec{1, 2, 3});
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2, 3}}));
    EXPECT_EQ(m.size(), 3);
}

TEST(DenseAddRow, VectorOfAnotherLengthIsRefused) {
    Dense m;
    m.addRow(Vec{1, 2, 3});
    EXPECT_EQ(messageOf<MatrixException>([&] { m.addRow(Vec{4, 5}); }), "addRow row std::vector must be of same order");
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2, 3}}));
    EXPECT_EQ(m.size(), 3);
}

TEST(DenseAddRow, VectorIsAppendedAtTheBottom) {
    Dense m = sixElements();
    m.addRow(Vec{7, 8, 9});
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2, 3}, {4, 5, 6}, {7, 8, 9}}));
    EXPECT_EQ(m.size(), 9);
}

TEST(DenseAddRow, VectorReplacesTheWidthOfAMatrixWithoutRows) {
    Dense m(0, 5, 0.0);
    m.addRow(Vec{1, 2});
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2}}));
}

TEST(DenseAddRow, EmptyVectorCountsAsARow) {
    Dense m;
    m.addRow(Vec{});
    EXPECT_EQ(m.rowCount(), 1);
    EXPECT_EQ(m.colCount(), 0);
    EXPECT_TRUE(m.empty());
}

TEST(DenseAddRow, ScalarFillsARow) {
    Dense m = sixElements();
    m.addRow(7.0);
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2, 3}, {4, 5, 6}, {7, 7, 7}}));
}

TEST(DenseAddRow, ScalarOnAnEmptyMatrixIsRefused) {
    for (Dense m : {Dense(), Dense(0, 3, 0.0), Dense(3, 0, 0.0)}) {
        const int rows = m.rowCount();
        EXPECT_EQ(messageOf<MatrixException>([&] { m.addRow(7.0); }), "addRow operating on a null matrix");
        EXPECT_EQ(m.rowCount(), rows);
    }
}

TEST(DenseAddRow, BrokenStorageIsReported) {
    Dense m(Vec{1, 2, 3, 4, 5}, 2);
    EXPECT_THAT(messageOf<AllegeException>([&] {
                    m.addRow(Vec{6, 7});
                }),
                IsAssertion("mn_ == static_cast<int>( v_.size() ) && \"vector not the right size\""));
}

TEST(DenseAddRow, ManyRowsKeepTheirOrder) {
    Dense m;
    for (int i = 0; i < 1000; ++i)
        m.addRow(Vec{1.0 * i, -1.0 * i});
    ASSERT_EQ(m.rowCount(), 1000);
    for (int i = 0; i < 1000; ++i) {
        ASSERT_EQ(m(i, 0), i);
        ASSERT_EQ(m(i, 1), -i);
    }
}

TEST(DenseAddCol, VectorMakesADefaultMatrixAColumn) {
    Dense m;
    m.addCol(Vec{1, 2});
    EXPECT_EQ(plain(m), (PlainMatrix{{1}, {2}}));
    EXPECT_EQ(m.size(), 2);
}

TEST(DenseAddCol, VectorReplacesTheShapeOfAnEmptyMatrix) {
    Dense m(0, 5, 0.0);
    m.addCol(Vec{1, 2});
    EXPECT_EQ(plain(m), (PlainMatrix{{1}, {2}}));
    Dense wide(7, 0, 0.0);
    wide.addCol(Vec{1, 2});
    EXPECT_EQ(plain(wide), (PlainMatrix{{1}, {2}}));
}

TEST(DenseAddCol, VectorIsAppendedAtTheRight) {
    Dense m = sixElements();
    m.addCol(Vec{7, 8});
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2, 3, 7}, {4, 5, 6, 8}}));
    EXPECT_EQ(m.size(), 8);
}

TEST(DenseAddCol, VectorOfAnotherLengthIsRefused) {
    Dense m = sixElements();
    for (const Vec& column : {Vec{7}, Vec{7, 8, 9}, Vec{}}) {
        EXPECT_EQ(messageOf<MatrixException>([&] { m.addCol(column); }),
                  "addCol column std::vector must be of same order");
        EXPECT_EQ(plain(m), kSix);
    }
}

TEST(DenseAddCol, ScalarFillsAColumn) {
    Dense m = sixElements();
    m.addCol(7.0);
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2, 3, 7}, {4, 5, 6, 7}}));
    EXPECT_EQ(m.size(), 8);
}

TEST(DenseAddCol, ScalarOnAnEmptyMatrixIsRefused) {
    for (Dense m : {Dense(), Dense(0, 3, 0.0), Dense(3, 0, 0.0)}) {
        const int cols = m.colCount();
        EXPECT_EQ(messageOf<MatrixException>([&] { m.addCol(5.0); }), "addCol operating on a null matrix");
        EXPECT_EQ(m.colCount(), cols);
    }
}

TEST(DenseAddCol, BrokenStorageIsReported) {
    Dense m(Vec{1, 2, 3, 4, 5}, 2);
    EXPECT_THAT(messageOf<AllegeException>([&] { m.addCol(6.0); }),
                IsAssertion("mn_ == static_cast<int>( v_.size() )"));
    Dense other(Vec{1, 2, 3, 4, 5}, 2);
    EXPECT_THAT(messageOf<AllegeException>([&] {
                    other.addCol(Vec{6, 7});
                }),
                IsAssertion("mn_ == static_cast<int>( v_.size() )"));
}

TEST(DenseInsertRow, GoesBeforeTheGivenRow) {
    Dense m = sixElements();
    m.insertRow(1, 7.0);
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2, 3}, {7, 7, 7}, {4, 5, 6}}));
    m.insertRow(0, Vec{8, 9, 10});
    EXPECT_EQ(plain(m), (PlainMatrix{{8, 9, 10}, {1, 2, 3}, {7, 7, 7}, {4, 5, 6}}));
    EXPECT_EQ(m.size(), 12);
}

TEST(DenseInsertRow, AtTheRowCountAppends) {
    Dense m = sixElements();
    m.insertRow(2, 7.0);
    m.insertRow(3, Vec{8, 9, 10});
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2, 3}, {4, 5, 6}, {7, 7, 7}, {8, 9, 10}}));
}

TEST(DenseInsertRow, GivesAMatrixWithoutRowsItsFirst) {
    Dense m(0, 3, 0.0);
    m.insertRow(0, 7.0);
    EXPECT_EQ(plain(m), (PlainMatrix{{7, 7, 7}}));
}

TEST(DenseInsertRow, VectorOfAnotherLengthIsRefusedWithTheTextOfAddRow) {
    Dense m = sixElements();
    for (const Vec& row : {Vec{7, 8}, Vec{7, 8, 9, 10}, Vec{}}) {
        EXPECT_EQ(messageOf<MatrixException>([&] { m.insertRow(0, row); }),
                  "addRow row std::vector must be of same order");
        EXPECT_EQ(plain(m), kSix);
    }
}

TEST(DenseInsertCol, GoesBeforeTheGivenColumn) {
    Dense m = sixElements();
    m.insertCol(0, 7.0);
    EXPECT_EQ(plain(m), (PlainMatrix{{7, 1, 2, 3}, {7, 4, 5, 6}}));
    m.insertCol(2, Vec{8, 9});
    EXPECT_EQ(plain(m), (PlainMatrix{{7, 1, 8, 2, 3}, {7, 4, 9, 5, 6}}));
    EXPECT_EQ(m.size(), 10);
}

TEST(DenseInsertCol, AtTheColumnCountAppends) {
    Dense m = sixElements();
    m.insertCol(3, 7.0);
    m.insertCol(4, Vec{8, 9});
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2, 3, 7, 8}, {4, 5, 6, 7, 9}}));
}

TEST(DenseInsertCol, GivesAMatrixWithoutColumnsItsFirst) {
    Dense m(2, 0, 0.0);
    m.insertCol(0, 7.0);
    EXPECT_EQ(plain(m), (PlainMatrix{{7}, {7}}));
}

TEST(DenseInsertCol, VectorOfAnotherLengthIsRefusedWithTheTextOfAddCol) {
    Dense m = sixElements();
    for (const Vec& column : {Vec{7}, Vec{7, 8, 9}, Vec{}}) {
        EXPECT_EQ(messageOf<MatrixException>([&] { m.insertCol(0, column); }),
                  "addCol column std::vector must be of same order");
        EXPECT_EQ(plain(m), kSix);
    }
}

TEST(DenseRemove, RowClosesTheGap) {
    const PlainMatrix source{{1, 2}, {3, 4}, {5, 6}};
    for (int i = 0; i < 3; ++i) {
        Dense m = dense(source);
        m.removeRow(i);
        PlainMatrix expected(2, 2);
        for (int r = 0, from = 0; r < 2; ++r, ++from) {
            if (from == i) ++from;
            expected(r, 0) = source(from, 0);
            expected(r, 1) = source(from, 1);
        }
        EXPECT_EQ(plain(m), expected) << "row " << i;
        EXPECT_EQ(m.size(), 4);
        EXPECT_EQ(plain(dense(source).delRow(i)), expected);
    }
}

TEST(DenseRemove, ColumnClosesTheGapInEveryRow) {
    const PlainMatrix source{{1, 2, 3}, {4, 5, 6}, {7, 8, 9}, {10, 11, 12}};
    for (int j = 0; j < 3; ++j) {
        Dense m = dense(source);
        m.removeCol(j);
        PlainMatrix expected(4, 2);
        for (int r = 0; r < 4; ++r)
            for (int c = 0, from = 0; c < 2; ++c, ++from) {
                if (from == j) ++from;
                expected(r, c) = source(r, from);
            }
        EXPECT_EQ(plain(m), expected) << "column " << j;
        EXPECT_EQ(m.size(), 8);
        EXPECT_EQ(plain(dense(source).delCol(j)), expected);
    }
}

TEST(DenseRemove, CopyingFormLeavesTheSource) {
    const Dense m = sixElements();
    EXPECT_EQ(plain(m.delRow(0)), (PlainMatrix{{4, 5, 6}}));
    EXPECT_EQ(plain(m.delCol(1)), (PlainMatrix{{1, 3}, {4, 6}}));
    EXPECT_EQ(plain(m), kSix);
}

TEST(DenseRemove, LastRowLeavesTheColumnCountAndLastColumnTheRowCount) {
    Dense row(1, 3, 1.0);
    row.removeRow(0);
    EXPECT_EQ(row.rowCount(), 0);
    EXPECT_EQ(row.colCount(), 3);
    EXPECT_EQ(row.size(), 0);
    Dense column(3, 1, 1.0);
    column.removeCol(0);
    EXPECT_EQ(column.rowCount(), 3);
    EXPECT_EQ(column.colCount(), 0);
    EXPECT_EQ(column.size(), 0);
}

TEST(DenseRemove, NegativeRowTextBeginsAsCallersExpect) {
    Dense m = sixElements();
    EXPECT_THAT(messageOf<AllegeException>([&] { m.removeRow(-1); }),
                testing::StartsWith("assertion failed: (0 <= i && i < m_) "));
}

}  // namespace
}  // namespace reisti::test
