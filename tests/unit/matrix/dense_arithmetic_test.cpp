#include <limits>
#include <stdexcept>

#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
const double kNaN = std::numeric_limits<double>::quiet_NaN();

static_assert(std::is_same_v<decltype(std::declval<const Dense&>() + std::declval<const Dense&>()), Dense>);
static_assert(std::is_same_v<decltype(std::declval<const Dense&>() - std::declval<const Dense&>()), Dense>);
static_assert(std::is_same_v<decltype(-std::declval<const Dense&>()), Dense>);
static_assert(std::is_same_v<decltype(std::declval<const Dense&>() / 2.0), Dense>);
static_assert(std::is_same_v<decltype(std::declval<const Dense&>().transpose()), Dense>);

const char* const kSameShape = "m_ == other.m_ && n_ == other.n_";

TEST(DenseArithmetic, SumAndDifferenceAreElementWise) {
    const Dense a(Vec{1, 2, 3, 4}, 2);
    const Dense b(Vec{10, 20, 30, 40}, 2);
    EXPECT_EQ(plain(a + b), (PlainMatrix{{11, 22}, {33, 44}}));
    EXPECT_EQ(plain(a - b), (PlainMatrix{{-9, -18}, {-27, -36}}));
    EXPECT_EQ(plain(a), (PlainMatrix{{1, 2}, {3, 4}}));
}

TEST(DenseArithmetic, InPlaceSumAndDifferenceChangeTheLeftOperandOnly) {
    Dense a(Vec{1, 2, 3, 4}, 2);
    const Dense b(Vec{10, 20, 30, 40}, 2);
    a += b;
    EXPECT_EQ(plain(a), (PlainMatrix{{11, 22}, {33, 44}}));
    a -= b;
    a -= b;
    EXPECT_EQ(plain(a), (PlainMatrix{{-9, -18}, {-27, -36}}));
    EXPECT_EQ(plain(b), (PlainMatrix{{10, 20}, {30, 40}}));
}

TEST(DenseArithmetic, AnotherShapeIsAnAssertion) {
    Dense a(2, 3, 1.0);
    for (const Dense& b : {Dense(3, 2, 1.0), Dense(2, 2, 1.0), Dense(3, 3, 1.0), Dense()}) {
        EXPECT_THAT(messageOf<AllegeException>([&] { a += b; }), IsAssertion(kSameShape));
        EXPECT_THAT(messageOf<AllegeException>([&] { a -= b; }), IsAssertion(kSameShape));
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(a + b); }), IsAssertion(kSameShape));
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(a - b); }), IsAssertion(kSameShape));
        EXPECT_EQ(plain(a), plain(Dense(2, 3, 1.0)));
    }
}

TEST(DenseArithmetic, SameShapeWithAnotherStorageLengthIsAnAssertion) {
    Dense a(2, 2, 1.0);
    const Dense b(Vec{1, 2, 3, 4, 5}, 2);
    EXPECT_THAT(messageOf<AllegeException>([&] { a += b; }), IsAssertion("v_.size() == other.v_.size()"));
    EXPECT_THAT(messageOf<AllegeException>([&] { a -= b; }), IsAssertion("v_.size() == other.v_.size()"));
    EXPECT_EQ(plain(a), (PlainMatrix{{1, 1}, {1, 1}}));
}

TEST(DenseArithmetic, SumOfEmptyMatricesIsEmpty) {
    EXPECT_TRUE((Dense() + Dense()).empty());
    EXPECT_EQ((Dense(0, 4, 1.0) - Dense(0, 4, 1.0)).colCount(), 4);
}

TEST(DenseArithmetic, NegationFlipsEverySignIncludingThatOfZero) {
    const Dense m(Vec{1, -2, 0, 3}, 2);
    EXPECT_TRUE(sameBits(plain(-m), (PlainMatrix{{-1, 2}, {-0.0, -3}})));
}

TEST(DenseArithmetic, ScalarProductIsElementWise) {
    Dense m(Vec{1, 2, 3, 4}, 2);
    EXPECT_EQ(plain(m * 2.5), (PlainMatrix{{2.5, 5}, {7.5, 10}}));
    m *= -1.0;
    EXPECT_EQ(plain(m), (PlainMatrix{{-1, -2}, {-3, -4}}));
}

TEST(DenseArithmetic, ScalarProductWithInfinityTurnsZerosIntoNaN) {
    const Dense m = Dense(Vec{0, 1}, 2) * kInfinity;
    EXPECT_TRUE(std::isnan(m(0, 0)));
    EXPECT_EQ(m(0, 1), kInfinity);
}

TEST(DenseArithmetic, QuotientDividesAndDoesNotMultiplyByAReciprocal) {
    UniformNumbers random(11);
    const PlainMatrix source = random.matrix(20, 20);
    Dense m = dense(source);
    PlainMatrix expected = source;
    for (double& cell : expected.cells)
        cell = cell / 49.0;
    EXPECT_TRUE(sameBits(plain(m / 49.0), expected));
    m /= 49.0;
    EXPECT_TRUE(sameBits(plain(m), expected));
}

TEST(DenseArithmetic, DivisionByZeroOfEitherSignOverflows) {
    Dense m(Vec{1, 2, 3, 4}, 2);
    const std::string text = "op/ scalar division by zero";
    for (const double zero : {0.0, -0.0}) {
        EXPECT_EQ(messageOf<std::overflow_error>([&] { static_cast<void>(m / zero); }), text);
        EXPECT_EQ(messageOf<std::overflow_error>([&] { m /= zero; }), text);
    }
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2}, {3, 4}}));
}

TEST(DenseArithmetic, DivisionOfAnEmptyMatrixByZeroOverflowsToo) {
    EXPECT_EQ(messageOf<std::overflow_error>([] { static_cast<void>(Dense() / 0.0); }), "op/ scalar division by zero");
}

TEST(DenseArithmetic, DivisionByTinyOrNaNIsOrdinary) {
    EXPECT_EQ((Dense(1, 1, 1.0) / std::numeric_limits<double>::denorm_min())(0, 0), kInfinity);
    EXPECT_TRUE(std::isnan((Dense(1, 1, 1.0) / kNaN)(0, 0)));
}

TEST(DenseTranspose, ExchangesIndices) {
    EXPECT_EQ(plain(Dense(Vec{1, 2, 3, 4, 5, 6}, 3).transpose()), (PlainMatrix{{1, 4}, {2, 5}, {3, 6}}));
}

TEST(DenseTranspose, OfARowIsAColumnAndBack) {
    const Dense row(Vec{1, 2, 3}, 3);
    const Dense column = row.transpose();
    EXPECT_EQ(plain(column), (PlainMatrix{{1}, {2}, {3}}));
    EXPECT_EQ(plain(column.transpose()), plain(row));
}

TEST(DenseTranspose, OfAnEmptyMatrixExchangesItsCounts) {
    const Dense m = Dense(0, 3, 0.0).transpose();
    EXPECT_EQ(m.rowCount(), 3);
    EXPECT_EQ(m.colCount(), 0);
    EXPECT_TRUE(Dense().transpose().empty());
}

TEST(DenseTranspose, EveryShapeAgreesWithTheElementwiseDefinition) {
    UniformNumbers random(12);
    for (int rows = 1; rows <= 40; rows += 3) {
        for (int cols = 1; cols <= 70; cols += 7) {
            const PlainMatrix source = random.matrix(rows, cols);
            ASSERT_EQ(plain(dense(source).transpose()), plainTranspose(source)) << rows << " by " << cols;
        }
    }
}

TEST(DenseToVector, SingleColumnConverts) {
    const Dense column(Vec{1, 2, 3}, 1);
    EXPECT_EQ(column.ConvertToVector(), (Vec{1, 2, 3}));
    EXPECT_EQ(static_cast<Vec>(column), (Vec{1, 2, 3}));
    EXPECT_EQ(Dense(1, 1, 5.0).ConvertToVector(), (Vec{5}));
    EXPECT_EQ(Dense(0, 1, 5.0).ConvertToVector(), Vec());
}

TEST(DenseToVector, EverythingElseIsRefused) {
    const std::string text = "vector cast: result not a vector";
    for (const Dense& m : {Dense(1, 3, 0.0), Dense(2, 2, 0.0), Dense(), Dense(3, 0, 0.0)}) {
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(m.ConvertToVector()); }), text);
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(static_cast<Vec>(m)); }), text);
    }
}

TEST(DenseToSymmetric, TakesTheLowerTriangle) {
    const Dense m(Vec{1, 2 + 1e-12, 2, 3}, 2);
    const Symmetric s = m.ConvertToSmatrix();
    EXPECT_EQ(s.rowCount(), 2);
    EXPECT_EQ(s(0, 1), 2.0);
    EXPECT_EQ(s(1, 0), 2.0);
    EXPECT_EQ(s(1, 1), 3.0);
}

TEST(DenseToSymmetric, NonSquareSourceIsAnAssertion) {
    EXPECT_THAT(messageOf<AllegeException>([] { static_cast<void>(Dense(2, 3, 1.0).ConvertToSmatrix()); }),
                IsAssertion("rows == cols"));
}

TEST(DenseToSymmetric, OrderZeroAndOneConvert) {
    EXPECT_TRUE(Dense().ConvertToSmatrix().isEmpty());
    EXPECT_EQ(Dense(1, 1, kNaN).ConvertToSmatrix().size(), 1);
}

struct SymmetryCase {
    const char* name;
    double below;
    double above;
    bool accepted;
};

class SymmetryTolerance : public testing::TestWithParam<SymmetryCase> {};

TEST_P(SymmetryTolerance, DecidesThePair) {
    const SymmetryCase& pair = GetParam();
    const Dense m(Vec{1, pair.above, pair.below, 1}, 2);
    const Dense mirrored(Vec{1, pair.below, pair.above, 1}, 2);
    const std::string expected = pair.accepted ? "[nothing was thrown]" : "Smatrix cast: result not a symmetric matrix";
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(m.ConvertToSmatrix()); }), expected);
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(mirrored.ConvertToSmatrix()); }), expected);
}

INSTANTIATE_TEST_SUITE_P(Cases, SymmetryTolerance,
                         testing::Values(SymmetryCase{"Equal", 2.0, 2.0, true},
                                         SymmetryCase{"TinyDifference", 1.0, 1.0 + 1e-12, true},
                                         SymmetryCase{"AbsolutePartAlone", 0.0, 3.9e-12, true},
                                         SymmetryCase{"AtTheAbsolutePart", 0.0, 4e-12, true},
                                         SymmetryCase{"JustAboveTheAbsolutePart", 0.0, 4.001e-12, false},
                                         SymmetryCase{"AbsoluteAndRelativePartsAdd", 1.0, 1.0 + 7.9e-12, true},
                                         SymmetryCase{"AboveBothParts", 1.0, 1.0 + 8.1e-12, false},
                                         SymmetryCase{"RelativePartGrowsWithTheValues", 1e6, 1e6 + 3.9e-6, true},
                                         SymmetryCase{"RelativePartExceeded", 1e6, 1e6 + 4.1e-6, false},
                                         SymmetryCase{"OppositeSigns", 1e-3, -1e-3, false},
                                         SymmetryCase{"Different", 1.0, 1.001, false},
                                         SymmetryCase{"NaN", kNaN, kNaN, false},
                                         SymmetryCase{"EqualInfinities", kInfinity, kInfinity, false}),
                         [](const auto& caseInfo) { return std::string(caseInfo.param.name); });

TEST(DenseToSymmetric, OneBadPairAnywhereIsEnough) {
    UniformNumbers random(13);
    PlainMatrix source = random.matrix(6, 6);
    for (int i = 0; i < 6; ++i)
        for (int j = 0; j < i; ++j)
            source(j, i) = source(i, j);
    EXPECT_EQ(plain(dense(source).ConvertToSmatrix()), source);
    for (int i = 0; i < 6; ++i) {
        for (int j = 0; j < i; ++j) {
            PlainMatrix spoiled = source;
            spoiled(j, i) += 1e-6;
            EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(dense(spoiled).ConvertToSmatrix()); }),
                      "Smatrix cast: result not a symmetric matrix");
        }
    }
}

TEST(DenseFlatten, ByRowsStartsAtTheGivenRow) {
    const Dense m(Vec{1, 2, 3, 4, 5, 6}, 2);
    Vec out{99};
    m.mFlattenMatrix(out, 1, true);
    EXPECT_EQ(out, (Vec{3, 4, 5, 6}));
    m.mFlattenMatrix(out, 0, true);
    EXPECT_EQ(out, (Vec{1, 2, 3, 4, 5, 6}));
}

TEST(DenseFlatten, ByColumnsStartsAtTheGivenColumn) {
    const Dense m(Vec{1, 2, 3, 4, 5, 6}, 2);
    Vec out;
    m.mFlattenMatrix(out, 0, false);
    EXPECT_EQ(out, (Vec{1, 3, 5, 2, 4, 6}));
    m.mFlattenMatrix(out, 1, false);
    EXPECT_EQ(out, (Vec{2, 4, 6}));
}

TEST(DenseFlatten, StartAtOrPastTheEndGivesNothing) {
    const Dense m(Vec{1, 2, 3, 4, 5, 6}, 2);
    for (const bool byRows : {true, false}) {
        const int end = byRows ? 3 : 2;
        for (const int start : {end, end + 5}) {
            Vec out{99};
            m.mFlattenMatrix(out, start, byRows);
            EXPECT_TRUE(out.empty());
        }
    }
}

TEST(DenseFlatten, MatrixWithoutElementsClearsTheOutput) {
    for (const Dense& m : {Dense(), Dense(0, 3, 1.0), Dense(3, 0, 1.0)}) {
        for (const bool byRows : {true, false}) {
            Vec out{99};
            m.mFlattenMatrix(out, 0, byRows);
            EXPECT_TRUE(out.empty());
        }
    }
}

TEST(DenseFlatten, FreeFunctionAgreesWithTheMember) {
    const Dense m(Vec{1, 2, 3, 4, 5, 6}, 2);
    Vec out;
    qan::matrix_library::mFlattenmatrix(m, out, 1, true);
    EXPECT_EQ(out, (Vec{3, 4, 5, 6}));
}

}  // namespace
}  // namespace reisti::test
