#include <climits>
#include <stdexcept>
#include <type_traits>

#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

static_assert(!std::is_polymorphic_v<Symmetric>);
static_assert(sizeof(Symmetric) == sizeof(Vec) + sizeof(void*), "order (padded) and elements");
static_assert(std::is_same_v<decltype(std::declval<Symmetric&>()(0, 0)), double&>);
static_assert(std::is_same_v<decltype(std::declval<const Symmetric&>().transpose()), Symmetric>);
static_assert(std::is_same_v<decltype(-std::declval<const Symmetric&>()), Symmetric>);
static_assert(std::is_same_v<decltype(std::declval<const Symmetric&>().getSubmatrix(0, 0, 1, 1)), Dense>);
static_assert(std::is_same_v<decltype(std::declval<const Symmetric&>().mSmatrixToUTmatrix()), Upper>);

const PlainMatrix kThree{{1, 2, 4}, {2, 3, 5}, {4, 5, 6}};

TEST(Symmetric, FillReachesEveryElement) {
    EXPECT_EQ(plain(Symmetric(2, 3.0)), (PlainMatrix{{3, 3}, {3, 3}}));
}

TEST(Symmetric, OrderZeroIsEmpty) {
    const Symmetric s(0, 1.0);
    EXPECT_TRUE(s.isEmpty());
    EXPECT_EQ(s.rowCount(), 0);
    EXPECT_EQ(s.colCount(), 0);
    EXPECT_EQ(s.size(), 0);
    EXPECT_FALSE(Symmetric(1, 1.0).isEmpty());
}

TEST(Symmetric, SizeIsTheNumberOfStoredElements) {
    EXPECT_EQ(Symmetric(3, 1.0).size(), 6);
    EXPECT_EQ(Symmetric(10, 1.0).size(), 55);
}

TEST(Symmetric, PackedLengthIsHalfTheSquareWithTheDiagonal) {
    for (int order = 0; order <= 1000; ++order)
        ASSERT_EQ(Symmetric::calculate_size(order), order * (order + 1) / 2);
    EXPECT_EQ(Symmetric::calculate_size(46340), 1073720970);
}

TEST(Symmetric, MirroredPositionsAreOneElement) {
    Symmetric s(3, 0.0);
    s(0, 2) = 7.0;
    EXPECT_EQ(s(2, 0), 7.0);
    s.at(2, 1) = 8.0;
    EXPECT_EQ(s.at(1, 2), 8.0);
    EXPECT_EQ(std::as_const(s).at(1, 2), 8.0);
    EXPECT_EQ(&s(0, 1), &s(1, 0));
}

TEST(Symmetric, LowerTriangleIsStoredRowByRow) {
    Symmetric s(4, 0.0);
    int expectedOffset = 0;
    for (int i = 0; i < 4; ++i)
        for (int j = 0; j <= i; ++j)
            EXPECT_EQ(&s(i, j) - &s(0, 0), expectedOffset++) << i << ", " << j;
}

TEST(Symmetric, AtAssertsTheRowThenTheColumn) {
    Symmetric s(2, 1.0);
    const Symmetric& fixed = s;
    for (const int bad : {-1, 2, INT_MAX, INT_MIN}) {
        EXPECT_THAT(messageOf<AllegeException>([&] { s.at(bad, bad) = 1.0; }),
                    IsAssertion("i >= 0 && i < m_", "src/matrix/matrix_new"));
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(fixed.at(bad, 0)); }),
                    IsAssertion("i >= 0 && i < m_", "src/matrix/matrix_new"));
        EXPECT_THAT(messageOf<AllegeException>([&] { s.at(1, bad) = 1.0; }),
                    IsAssertion("j >= 0 && j < m_", "src/matrix/matrix_new"));
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(fixed.at(1, bad)); }),
                    IsAssertion("j >= 0 && j < m_", "src/matrix/matrix_new"));
    }
    EXPECT_NO_THROW(fixed.range_check(-5, 99));
}

TEST(SymmetricConversion, FromASymmetricDenseMatrix) {
    EXPECT_EQ(plain(Symmetric(dense(kThree))), kThree);
    Symmetric s(1, 0.0);
    s = dense(kThree);
    EXPECT_EQ(plain(s), kThree);
}

TEST(SymmetricConversion, FromAnAsymmetricDenseMatrixIsRefused) {
    const Dense skewed(Vec{1, 1, 1.001, 1}, 2);
    const std::string text = "Smatrix cast: result not a symmetric matrix";
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(Symmetric(skewed)); }), text);
    Symmetric s = symmetric(kThree);
    EXPECT_EQ(messageOf<MatrixException>([&] { s = skewed; }), text);
    EXPECT_EQ(plain(s), kThree);
}

TEST(SymmetricConversion, FromANonSquareDenseMatrixIsAnAssertion) {
    EXPECT_THAT(messageOf<AllegeException>([] { static_cast<void>(Symmetric(Dense(2, 3, 1.0))); }),
                IsAssertion("rows == cols"));
    Symmetric s = symmetric(kThree);
    EXPECT_THAT(messageOf<AllegeException>([&] { s = Dense(1, 2, 1.0); }), IsAssertion("rows == cols"));
    EXPECT_EQ(plain(s), kThree);
}

TEST(SymmetricConversion, OfEitherTriangleLooksAtNoSymmetry) {
    const Dense skewed(Vec{1, 2, 3, 4, 5, 6, 7, 8, 9}, 3);
    EXPECT_EQ(plain(Symmetric(skewed, true)), (PlainMatrix{{1, 4, 7}, {4, 5, 8}, {7, 8, 9}}));
    EXPECT_EQ(plain(Symmetric(skewed, false)), (PlainMatrix{{1, 2, 3}, {2, 5, 6}, {3, 6, 9}}));
}

TEST(SymmetricConversion, OfATriangleOfANonSquareMatrixIsADomainError) {
    for (const bool lower : {true, false}) {
        EXPECT_EQ(messageOf<std::domain_error>([&] { static_cast<void>(Symmetric(Dense(2, 3, 1.0), lower)); }),
                  "Originating matrix must be a square matrix");
    }
}

TEST(Symmetric, ResizeDropsOldContent) {
    Symmetric s = symmetric(kThree);
    s.resize(2, 7.0);
    EXPECT_EQ(plain(s), (PlainMatrix{{7, 7}, {7, 7}}));
    EXPECT_EQ(s.size(), 3);
    s.resize(3, 8.0);
    EXPECT_EQ(plain(s), plain(Symmetric(3, 8.0)));
    s.resize(0, 8.0);
    EXPECT_TRUE(s.isEmpty());
}

TEST(Symmetric, SetFillsEveryElement) {
    Symmetric s = symmetric(kThree);
    s.set(4.0);
    EXPECT_EQ(plain(s), plain(Symmetric(3, 4.0)));
}

TEST(Symmetric, NegationFlipsEveryElement) {
    EXPECT_EQ(plain(-symmetric(kThree)), plainScaled(kThree, -1.0));
}

TEST(Symmetric, TransposeIsACopy) {
    EXPECT_EQ(plain(symmetric(kThree).transpose()), kThree);
}

TEST(Symmetric, RowAndColumnVectorsAreComplete) {
    const Symmetric s = symmetric(kThree);
    EXPECT_EQ(s.getRowVector(1), (Vec{2, 3, 5}));
    EXPECT_EQ(s.getColVector(0), (Vec{1, 2, 4}));
}

TEST(Symmetric, RowAndColumnVectorsAssertTheIndex) {
    const Symmetric s = symmetric(kThree);
    for (const int bad : {-1, 3, INT_MAX}) {
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(s.getRowVector(bad)); }),
                    IsAssertion("i >= 0 && i < m_", "src/matrix/matrix_symmetric_impl"));
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(s.getColVector(bad)); }),
                    IsAssertion("j >= 0 && j < m_"));
    }
}

TEST(Symmetric, SubmatrixIsDenseAndMayCrossTheDiagonal) {
    const Symmetric s = symmetric(kThree);
    EXPECT_EQ(plain(s.getSubmatrix(0, 1, 3, 2)), (PlainMatrix{{2, 4}, {3, 5}, {5, 6}}));
    EXPECT_EQ(plain(s.getSubmatrix(2, 0, 1, 3)), (PlainMatrix{{4, 5, 6}}));
    EXPECT_TRUE(s.getSubmatrix(0, 0, 0, 0).empty());
}

PlainMatrix withInserted(const PlainMatrix& source, int target, const Vec& line) {
    PlainMatrix result(source.rows + 1, source.cols + 1);
    for (int i = 0; i < result.rows; ++i)
        for (int j = 0; j < result.cols; ++j) {
            if (i == target)
                result(i, j) = line[static_cast<std::size_t>(j)];
            else if (j == target)
                result(i, j) = line[static_cast<std::size_t>(i)];
            else
                result(i, j) = source(i - (i > target ? 1 : 0), j - (j > target ? 1 : 0));
        }
    return result;
}

PlainMatrix withRemoved(const PlainMatrix& source, int target) {
    PlainMatrix result(source.rows - 1, source.cols - 1);
    for (int i = 0; i < result.rows; ++i)
        for (int j = 0; j < result.cols; ++j)
            result(i, j) = source(i + (i >= target ? 1 : 0), j + (j >= target ? 1 : 0));
    return result;
}

PlainMatrix numberedSymmetric(int order) {
    PlainMatrix result(order, order);
    for (int i = 0; i < order; ++i)
        for (int j = 0; j <= i; ++j)
            result(i, j) = result(j, i) = 10.0 * i + j + 1.0;
    return result;
}

TEST(SymmetricInsert, ScalarFillsTheNewRowAndColumnAtEveryPosition) {
    for (int order = 0; order <= 6; ++order) {
        for (int target = 0; target <= order; ++target) {
            Symmetric s = symmetric(numberedSymmetric(order));
            s.insertColRow(target, -5.0);
            EXPECT_EQ(plain(s),
                      withInserted(numberedSymmetric(order), target, Vec(static_cast<std::size_t>(order) + 1, -5.0)))
                << "order " << order << ", target " << target;
            EXPECT_EQ(s.size(), Symmetric::calculate_size(order + 1));
        }
    }
}

TEST(SymmetricInsert, VectorBecomesTheNewRowAndColumnAtEveryPosition) {
    for (int order = 0; order <= 6; ++order) {
        for (int target = 0; target <= order; ++target) {
            Vec line;
            for (int k = 0; k <= order; ++k)
                line.push_back(-1.0 - k);
            Symmetric s = symmetric(numberedSymmetric(order));
            s.insertColRow(target, line);
            EXPECT_EQ(plain(s), withInserted(numberedSymmetric(order), target, line))
                << "order " << order << ", target " << target;
        }
    }
}

TEST(SymmetricInsert, VectorAtTheTopIsTheNewFirstRow) {
    Symmetric s = symmetric({{1, 2}, {2, 3}});
    s.insertColRow(0, Vec{7, 8, 9});
    EXPECT_EQ(s.rowCount(), 3);
    EXPECT_EQ(s.getRowVector(0), (Vec{7, 8, 9}));
}

TEST(SymmetricInsert, VectorOfAnotherLengthIsRefused) {
    Symmetric s = symmetric(kThree);
    for (const int length : {0, 3, 5}) {
        EXPECT_EQ(messageOf<MatrixException>([&] { s.insertColRow(0, Vec(static_cast<std::size_t>(length), 1.0)); }),
                  "insertColRow: vector length must be 1 more than the number of rows in the matrix");
        EXPECT_EQ(plain(s), kThree);
    }
}

TEST(SymmetricInsert, LengthIsTestedBeforeTheTarget) {
    Symmetric s = symmetric(kThree);
    EXPECT_EQ(messageOf<MatrixException>([&] { s.insertColRow(99, Vec{1}); }),
              "insertColRow: vector length must be 1 more than the number of rows in the matrix");
}

TEST(SymmetricInsert, TargetOutsideIsAnAssertion) {
    Symmetric s = symmetric(kThree);
    for (const int target : {-1, 4, INT_MAX, INT_MIN}) {
        EXPECT_THAT(messageOf<AllegeException>([&] { s.insertColRow(target, 1.0); }),
                    IsAssertion("target_row >= 0 && target_row < m_ + 1"));
        EXPECT_THAT(messageOf<AllegeException>([&] {
                        s.insertColRow(target, Vec{1, 2, 3, 4});
                    }),
                    IsAssertion("target_row >= 0 && target_row < m_ + 1"));
        EXPECT_EQ(plain(s), kThree);
    }
}

TEST(SymmetricRemove, ClosesTheGapAtEveryPosition) {
    for (int order = 1; order <= 6; ++order) {
        for (int target = 0; target < order; ++target) {
            Symmetric s = symmetric(numberedSymmetric(order));
            const Symmetric copy = s.delColRow(target);
            EXPECT_EQ(plain(s), numberedSymmetric(order));
            s.removeColRow(target);
            EXPECT_EQ(plain(s), withRemoved(numberedSymmetric(order), target))
                << "order " << order << ", target " << target;
            EXPECT_EQ(plain(copy), plain(s));
            EXPECT_EQ(s.size(), Symmetric::calculate_size(order - 1));
        }
    }
}

TEST(SymmetricRemove, IndexOutsideIsAnAssertion) {
    Symmetric s = symmetric({{1, 2}, {2, 3}});
    for (const int bad : {-1, 2, INT_MAX}) {
        EXPECT_THAT(messageOf<AllegeException>([&] { s.removeColRow(bad); }),
                    IsAssertion("j >= 0 && j < m_", "src/matrix/matrix_symmetric_impl"));
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(s.delColRow(bad)); }),
                    IsAssertion("j >= 0 && j < m_", "src/matrix/matrix_symmetric_impl"));
        EXPECT_EQ(plain(s), (PlainMatrix{{1, 2}, {2, 3}}));
    }
}

TEST(SymmetricFisherUpdate, AddsTheScaledProductToTheLowerTriangle) {
    const Vec a{1, 2, 3};
    const Vec b{10, 20, 30};
    const Vec c{100, 200, 300};
    Symmetric s = symmetric(kThree);
    s.UpdateForFisher(a, b, c, 3);
    PlainMatrix expected = kThree;
    for (std::size_t i = 0; i < 3; ++i)
        for (std::size_t k = 0; k <= i; ++k) {
            const int row = static_cast<int>(i);
            const int col = static_cast<int>(k);
            expected(row, col) += a[k] * c[i] + b[k];
            expected(col, row) = expected(row, col);
        }
    EXPECT_EQ(plain(s), expected);
}

TEST(SymmetricFisherUpdate, TouchesOnlyTheFirstRows) {
    Symmetric s = symmetric(kThree);
    s.UpdateForFisher(Vec{1, 1}, Vec{0, 0}, Vec{1, 1}, 2);
    EXPECT_EQ(plain(s), (PlainMatrix{{2, 3, 4}, {3, 4, 5}, {4, 5, 6}}));
}

TEST(SymmetricFisherUpdate, FewerThanOneRowDoesNothing) {
    Symmetric s = symmetric(kThree);
    for (const int n : {0, -1, INT_MIN}) {
        s.UpdateForFisher(Vec{}, Vec{}, Vec{}, n);
        EXPECT_EQ(plain(s), kThree);
    }
}

TEST(SymmetricFisherUpdate, RoundsTheIncrementBeforeAddingIt) {
    Symmetric s(1, 1.0);
    s.UpdateForFisher(Vec{0x1p-27 + 1.0}, Vec{-1.0}, Vec{0x1p-27 + 1.0}, 1);
    const double product = (0x1p-27 + 1.0) * (0x1p-27 + 1.0);
    EXPECT_EQ(s(0, 0), 1.0 + (product + -1.0));
}

TEST(SymmetricConversion, ToUpperTakesTheUpperTriangle) {
    EXPECT_EQ(plain(symmetric(kThree).mSmatrixToUTmatrix()), (PlainMatrix{{1, 2, 4}, {0, 3, 5}, {0, 0, 6}}));
}

TEST(SymmetricFlatten, CoversTheFullMatrix) {
    const Symmetric s = symmetric(kThree);
    Vec out{99};
    s.mFlattenMatrix(out, 0, true);
    EXPECT_EQ(out, (Vec{1, 2, 4, 2, 3, 5, 4, 5, 6}));
    s.mFlattenMatrix(out, 2, false);
    EXPECT_EQ(out, (Vec{4, 5, 6}));
    qan::matrix_library::mFlattenmatrix(s, out, 1, true);
    EXPECT_EQ(out, (Vec{2, 3, 5, 4, 5, 6}));
    s.mFlattenMatrix(out, 3, true);
    EXPECT_TRUE(out.empty());
    Symmetric(0, 0.0).mFlattenMatrix(out = Vec{99}, 0, true);
    EXPECT_TRUE(out.empty());
}

TEST(Symmetric, SwapExchangesOrderAndElements) {
    Symmetric a = symmetric(kThree);
    Symmetric b(1, 9.0);
    a.swap(b);
    EXPECT_EQ(plain(a), (PlainMatrix{{9}}));
    EXPECT_EQ(plain(b), kThree);
    EXPECT_EQ(b.size(), 6);
}

}  // namespace
}  // namespace reisti::test
