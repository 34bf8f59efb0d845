#include <limits>

#include "support/plain_factorizations.h"
#include "unit/matrix/matrix_kinds.h"
#include "unit/matrix/solver_samples.h"

namespace reisti::test {
namespace {

using qan::matrix_library::determinant;
using qan::matrix_library::determinantWithThrow;
using qan::matrix_library::inverse;
using qan::matrix_library::inverseWithThrow;
using qan::matrix_library::LUDecomposition;
using qan::matrix_library::LUDecompSafeIterator;

constexpr double kInfinity = std::numeric_limits<double>::infinity();
const double kNaN = std::numeric_limits<double>::quiet_NaN();

const Dense kSingular(Vec{1, 2, 2, 4}, 2);

TEST(LuFactors, OfATwoByTwoMatrix) {
    // Row 1 has the larger scaled head and comes first; the multiplier 1/4 is exact.
    std::vector<int> index;
    double parity = 0.0;
    const Dense factors = LUDecompSafeIterator(Dense(Vec{1, 8, 4, 4}, 2), index, parity);
    EXPECT_EQ(plain(factors), (PlainMatrix{{4, 4}, {0.25, 7}}));
    EXPECT_EQ(index, (std::vector<int>{1, 1}));
    EXPECT_EQ(parity, -1.0);
}

TEST(LuFactors, TiesGoToTheLaterRow) {
    std::vector<int> index;
    double parity = 0.0;
    const Dense factors = LUDecompSafeIterator(dense({{1, 0, 0}, {1, 1, 0}, {1, 0, 1}}), index, parity);
    EXPECT_EQ(index, (std::vector<int>{2, 1, 2}));
    EXPECT_EQ(plain(factors), (PlainMatrix{{1, 0, 1}, {1, 1, -1}, {1, 0, -1}}));
    EXPECT_EQ(parity, -1.0);
}

TEST(LuFactors, RowsAreScaledByTheirLargestElement) {
    // Unscaled, the row of the 1000 would be chosen; scaled, its head counts 1e-3.
    std::vector<int> index;
    double parity = 0.0;
    LUDecompSafeIterator(Dense(Vec{2, 2, 1000, 1000000}, 2), index, parity);
    EXPECT_EQ(index, (std::vector<int>{0, 1}));
    EXPECT_EQ(parity, 1.0);
}

TEST(LuFactors, OfASingularMatrixAreEmpty) {
    std::vector<int> index;
    double parity = 0.0;
    const Dense factors = LUDecompSafeIterator(kSingular, index, parity);
    EXPECT_EQ(factors.rowCount(), 0);
    EXPECT_EQ(factors.colCount(), 0);
}

TEST(LuFactors, OfOrderZeroAreEmptyWithEvenParity) {
    std::vector<int> index{5};
    double parity = 0.0;
    EXPECT_TRUE(LUDecompSafeIterator(Dense(), index, parity).empty());
    EXPECT_TRUE(index.empty());
    EXPECT_EQ(parity, 1.0);
}

/// Compares factors, permutation and parity with the plain loops, bit by bit.
void expectPlainBits(const PlainMatrix& a) {
    const PlainLu expected = plainLu(a);
    std::vector<int> index;
    double parity = 0.0;
    const Dense factors = LUDecompSafeIterator(dense(a), index, parity);
    ASSERT_TRUE(sameBits(plain(factors), expected.factors)) << "order " << a.rows;
    double det = -77.0;
    EXPECT_EQ(LUDecomposition(dense(a)).Determinant(&det), !expected.singular);
    if (!expected.singular) {
        EXPECT_EQ(index, expected.index);
        EXPECT_EQ(parity, expected.parity);
    }
}

TEST(LuFactors, HaveTheBitsOfThePlainLoops) {
    UniformNumbers random(101);
    for (const int order : {1, 2, 3, 5, 8, 13, 16, 31, 32, 33, 63, 64, 65, 96, 100, 130, 200})
        expectPlainBits(random.matrix(order, order));
}

TEST(LuFactors, HaveTheBitsOfThePlainLoopsWithManyTies) {
    UniformNumbers random(102);
    for (int trial = 0; trial < scaled(300); ++trial) {
        const int order = random.integer(1, 40);
        PlainMatrix a(order, order);
        for (double& cell : a.cells)
            cell = random.integer(-1, 1);
        expectPlainBits(a);
    }
}

TEST(LuFactors, HaveTheBitsOfThePlainLoopsOnIllConditionedMatrices) {
    for (int order = 1; order <= 16; ++order)
        expectPlainBits(hilbert(order));
    UniformNumbers random(103);
    for (int order = 1; order <= 50; ++order) {
        expectPlainBits(graded(order, random));
        PlainMatrix wild = random.matrix(order, order);
        for (int i = 0; i < order; ++i)
            for (int j = 0; j < order; ++j)
                wild(i, j) *= std::pow(10.0, random.integer(-8, 8));
        expectPlainBits(wild);
    }
}

TEST(LuFactors, HaveTheBitsOfThePlainLoopsOnStructuredMatrices) {
    UniformNumbers random(104);
    for (const int order : {1, 2, 7, 40, 70}) {
        const PlainMatrix source = random.matrix(order, order);
        expectPlainBits(plain(diagonal(source)));
        expectPlainBits(plain(upper(source)));
        expectPlainBits(plainTranspose(plain(upper(source))));
        expectPlainBits(plain(symmetric(source)));
    }
}

TEST(LuFactors, AgreeOnTheVerdictForNearlySingularMatrices) {
    UniformNumbers random(105);
    for (int trial = 0; trial < scaled(200); ++trial) {
        const int order = random.integer(2, 40);
        PlainMatrix a = random.matrix(order, order);
        // The last row is a combination of others up to a disturbance around the size of the zero test.
        const double disturbance = std::pow(10.0, random.integer(-14, -9));
        for (int j = 0; j < order; ++j)
            a(order - 1, j) = 0.5 * a(0, j) + (order > 2 ? 0.25 * a(1, j) : 0.0) + disturbance * random.between(-1, 1);
        expectPlainBits(a);
    }
}

struct NullRowCase {
    const char* name;
    double largest;
    bool singular;
};

class NullRow : public testing::TestWithParam<NullRowCase> {};

TEST_P(NullRow, IsJudgedWithTheFuzz) {
    const NullRowCase& row = GetParam();
    const Dense a(Vec{1e6, 0, 0, row.largest}, 2);
    double det = -77.0;
    EXPECT_EQ(determinant(a, &det), !row.singular);
    EXPECT_EQ(det, row.singular ? 0.0 : 1e6 * row.largest);
}

INSTANTIATE_TEST_SUITE_P(Cases, NullRow,
                         testing::Values(NullRowCase{"Zero", 0.0, true}, NullRowCase{"Tiny", 1e-300, true},
                                         NullRowCase{"JustBelow", 3.999e-12, true},
                                         NullRowCase{"AtTheFuzz", 4e-12, true},
                                         NullRowCase{"NegativeAtTheFuzz", -4e-12, true},
                                         NullRowCase{"JustAbove", 4.001e-12, false},
                                         NullRowCase{"NegativeJustAbove", -4.001e-12, false}),
                         [](const auto& caseInfo) { return std::string(caseInfo.param.name); });

TEST(LuDecomposition, OfANonSquareMatrixIsRefused) {
    const std::string text = "LU Decomp is defined for only square matrices";
    for (const Dense& a : {Dense(2, 3, 1.0), Dense(3, 2, 1.0), Dense(0, 1, 1.0)}) {
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(LUDecomposition(a)); }), text);
        double det = 0.0;
        Dense result;
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(determinant(a, &det)); }), text);
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(inverse(a, &result)); }), text);
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(determinantWithThrow(a)); }), text);
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(inverseWithThrow(a)); }), text);
    }
}

TEST(LuDecomposition, OfOrderZeroIsNotSingular) {
    const LUDecomposition lu{Dense()};
    double det = 0.0;
    EXPECT_TRUE(lu.Determinant(&det));
    EXPECT_EQ(det, 1.0);
    Vec x{7};
    EXPECT_TRUE(lu.Solve(Vec{}, &x));
    EXPECT_TRUE(x.empty());
    Dense result(2, 2, 1.0);
    EXPECT_TRUE(lu.Inverse(&result));
    EXPECT_EQ(result.rowCount(), 0);
    EXPECT_EQ(result.colCount(), 0);
}

TEST(LuDecomposition, KeepsItsOwnCopy) {
    Dense a(Vec{2, 0, 0, 4}, 2);
    const LUDecomposition lu(a);
    a.set(0.0);
    double det = 0.0;
    EXPECT_TRUE(lu.Determinant(&det));
    EXPECT_EQ(det, 8.0);
}

TEST(NonFiniteLu, NaNAnywhereStaysInBounds) {
    UniformNumbers random(111);
    for (const int order : {1, 2, 3, 10, 40}) {
        for (int trial = 0; trial < 5; ++trial) {
            PlainMatrix a = random.matrix(order, order);
            a(random.integer(0, order - 1), random.integer(0, order - 1)) = kNaN;
            if (trial == 4)
                for (double& cell : a.cells)
                    cell = kNaN;
            std::vector<int> index;
            double parity = 0.0;
            LUDecompSafeIterator(dense(a), index, parity);
            for (const int row : index) {
                EXPECT_GE(row, 0);
                EXPECT_LT(row, order);
            }
        }
    }
}

TEST(NonFiniteLu, ColumnOfNaNChoosesItsOwnRow) {
    std::vector<int> index;
    double parity = 0.0;
    const Dense factors = LUDecompSafeIterator(dense({{kNaN, 1, 2}, {kNaN, 3, 4}, {kNaN, 5, 7}}), index, parity);
    if (!factors.empty()) {
        EXPECT_EQ(index[0], 0);
    }
    double det = 0.0;
    static_cast<void>(determinant(dense({{kNaN, 1}, {kNaN, 3}}), &det));
    EXPECT_TRUE(det == 0.0 || std::isnan(det));
}

TEST(NonFiniteLu, InfinityAnywhereEnds) {
    UniformNumbers random(112);
    for (const int order : {1, 2, 3, 10, 40}) {
        for (const double extreme : {kInfinity, -kInfinity}) {
            PlainMatrix a = random.matrix(order, order);
            a(random.integer(0, order - 1), random.integer(0, order - 1)) = extreme;
            double det = 0.0;
            static_cast<void>(determinant(dense(a), &det));
            // A zero on the diagonal can be met behind infinities only; it is reported, never divided by.
            try {
                Dense result;
                static_cast<void>(inverse(dense(a), &result));
            } catch (const AllegeException& failure) {
                EXPECT_THAT(std::string(failure.what()), IsAssertion("lhs( i, i )"));
            }
        }
    }
}

}  // namespace
}  // namespace reisti::test
