#include <limits>
#include <memory>
#include <sstream>
#include <type_traits>
#include <utility>

#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

namespace ex = qan::matrix_library::expressions;
using ex::ExpressionNode;
using ex::M_;
using Expression = std::shared_ptr<const ExpressionNode>;

static_assert(std::is_abstract_v<ExpressionNode>);
static_assert(std::has_virtual_destructor_v<ExpressionNode>);
static_assert(std::is_same_v<decltype(std::declval<const ExpressionNode&>().Evaluate()), Dense>);
static_assert(std::is_same_v<
              decltype(std::declval<const ExpressionNode&>().MultiplyOnRight(std::declval<const Dense&>())), Dense>);
static_assert(std::is_same_v<
              decltype(std::declval<const ExpressionNode&>().MultiplyOnLeft(std::declval<const Dense&>())), Dense>);
static_assert(std::is_convertible_v<decltype(M_(std::declval<const Dense&>())), Expression>);

std::string textOf(const Expression& e) {
    std::ostringstream os;
    os << e;
    return os.str();
}

PlainMatrix withRowCleared(PlainMatrix a, int row) {
    for (int j = 0; j < a.cols; ++j)
        a(row, j) = 0.0;
    return a;
}

PlainMatrix withColumnCleared(PlainMatrix a, int column) {
    for (int i = 0; i < a.rows; ++i)
        a(i, column) = 0.0;
    return a;
}

/// Checks an expression against its value in all the ways in which a value can be had. The values are whole numbers, so
/// that every way gives the same.
void expectValue(const Expression& e, const PlainMatrix& value, UniformNumbers& random) {
    EXPECT_EQ(ex::RowCount(e), value.rows);
    EXPECT_EQ(ex::ColumnCount(e), value.cols);
    EXPECT_EQ(plain(ex::Evaluate(e)), value);
    EXPECT_EQ(plain(e->Evaluate()), value);
    const PlainMatrix right = random.integerMatrix(value.cols, random.integer(1, 4));
    EXPECT_EQ(plain(ex::MultiplyOnRight(e, dense(right))), plainProduct(value, right));
    EXPECT_EQ(plain(e->MultiplyOnRight(dense(right))), plainProduct(value, right));
    const PlainMatrix left = random.integerMatrix(random.integer(1, 4), value.rows);
    EXPECT_EQ(plain(ex::MultiplyOnLeft(dense(left), e)), plainProduct(left, value));
    EXPECT_EQ(plain(e->MultiplyOnLeft(dense(left))), plainProduct(left, value));
    for (int i = 0; i < value.rows; ++i)
        EXPECT_EQ(plain(ex::GetRow(e, i)), plainRow(value, i));
    for (int j = 0; j < value.cols; ++j)
        EXPECT_EQ(plain(ex::GetColumn(e, j)), plainColumn(value, j));
}

template <class Kind>
class ValueExpression : public testing::Test {};
using Kinds = testing::Types<Dense, Symmetric, Diagonal, Upper>;
TYPED_TEST_SUITE(ValueExpression, Kinds);

TYPED_TEST(ValueExpression, StandsForTheValueOfItsKind) {
    UniformNumbers random(141);
    for (int order = 1; order <= 6; ++order) {
        const TypeParam m = make<TypeParam>(random.integerMatrix(order, order));
        expectValue(M_(m), plain(m), random);
    }
}

TYPED_TEST(ValueExpression, HoldsACopy) {
    TypeParam m = make<TypeParam>(PlainMatrix{{1, 2}, {2, 3}});
    const PlainMatrix before = plain(m);
    const Expression e = M_(m);
    m.set(99.0);
    EXPECT_EQ(plain(ex::Evaluate(e)), before);
}

TYPED_TEST(ValueExpression, PrintsItsDimensions) {
    EXPECT_EQ(textOf(M_(make<TypeParam>(PlainMatrix(3, 3)))), "< Matrix 3 by 3>");
}

TYPED_TEST(ValueExpression, OfOrderZeroEvaluatesToNothing) {
    const Expression e = M_(make<TypeParam>(PlainMatrix()));
    EXPECT_EQ(ex::RowCount(e), 0);
    EXPECT_TRUE(ex::Evaluate(e).empty());
}

TEST(ProductExpression, StandsForTheProduct) {
    UniformNumbers random(142);
    const PlainMatrix a = random.integerMatrix(3, 5);
    const PlainMatrix b = random.integerMatrix(5, 2);
    expectValue(ex::Mult(M_(dense(a)), M_(dense(b))), plainProduct(a, b), random);
    expectValue(M_(dense(a)) * M_(dense(b)), plainProduct(a, b), random);
}

TEST(SumExpression, StandsForTheSum) {
    UniformNumbers random(143);
    const PlainMatrix a = random.integerMatrix(3, 4);
    const PlainMatrix b = random.integerMatrix(3, 4);
    expectValue(ex::Add(M_(dense(a)), M_(dense(b))), plainSum(a, b), random);
    expectValue(M_(dense(a)) + M_(dense(b)), plainSum(a, b), random);
}

TEST(DifferenceExpression, StandsForTheDifference) {
    UniformNumbers random(144);
    const PlainMatrix a = random.integerMatrix(3, 4);
    const PlainMatrix b = random.integerMatrix(3, 4);
    expectValue(ex::Sub(M_(dense(a)), M_(dense(b))), plainDifference(a, b), random);
    expectValue(M_(dense(a)) - M_(dense(b)), plainDifference(a, b), random);
}

TEST(TransposeExpression, StandsForTheTranspose) {
    UniformNumbers random(145);
    const PlainMatrix a = random.integerMatrix(3, 4);
    expectValue(ex::Transpose(M_(dense(a))), plainTranspose(a), random);
    expectValue(ex::Transpose(ex::Transpose(M_(dense(a)))), a, random);
}

TEST(ZeroRowExpression, StandsForTheMatrixWithoutTheRow) {
    UniformNumbers random(146);
    const PlainMatrix a = random.integerMatrix(3, 4);
    for (int row = 0; row < 3; ++row)
        expectValue(ex::ZeroRow(M_(dense(a)), row), withRowCleared(a, row), random);
}

TEST(ZeroColumnExpression, StandsForTheMatrixWithoutTheColumn) {
    UniformNumbers random(147);
    const PlainMatrix a = random.integerMatrix(3, 4);
    for (int column = 0; column < 4; ++column)
        expectValue(ex::ZeroColumn(M_(dense(a)), column), withColumnCleared(a, column), random);
}

TEST(ZeroRowExpression, OverwritesWhateverWasThere) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    const Dense a(Vec{nan, 1, 2, 3}, 2);
    EXPECT_EQ(plain(ex::Evaluate(ex::ZeroRow(M_(a), 0))), (PlainMatrix{{0, 0}, {2, 3}}));
    EXPECT_EQ(plain(ex::MultiplyOnRight(ex::ZeroRow(M_(a), 0), Dense(2, 1, 1.0))), (PlainMatrix{{0}, {5}}));
    EXPECT_EQ(plain(ex::Evaluate(ex::ZeroColumn(M_(a), 0))), (PlainMatrix{{0, 1}, {0, 3}}));
    EXPECT_EQ(plain(ex::MultiplyOnLeft(Dense(1, 2, 1.0), ex::ZeroColumn(M_(a), 0))), (PlainMatrix{{0, 4}}));
}

TEST(ZeroExpression, ProductsLeaveTheOperandAsItWas) {
    const Dense m(2, 2, 5.0);
    const Dense a(2, 2, 1.0);
    static_cast<void>(ex::MultiplyOnLeft(m, ex::ZeroRow(M_(a), 0)));
    static_cast<void>(ex::MultiplyOnRight(ex::ZeroColumn(M_(a), 0), m));
    EXPECT_EQ(plain(m), plain(Dense(2, 2, 5.0)));
}

TEST(SubtreeSharing, OneSubtreeServesSeveralTrees) {
    UniformNumbers random(148);
    const PlainMatrix a = random.integerMatrix(3, 3);
    const Expression shared = ex::Mult(M_(dense(a)), ex::Transpose(M_(dense(a))));
    const PlainMatrix square = plainProduct(a, plainTranspose(a));
    expectValue(ex::Add(shared, shared), plainSum(square, square), random);
    expectValue(ex::Sub(shared, shared), PlainMatrix(3, 3), random);
    expectValue(shared, square, random);
}

TEST(SubtreeSharing, TreesHoldTheirChildrenAndReleaseThem) {
    const Expression child = M_(Dense(2, 2, 1.0));
    EXPECT_EQ(child.use_count(), 1);
    {
        const Expression sum = ex::Add(child, child);
        EXPECT_EQ(child.use_count(), 3);
        const Expression product = ex::Mult(sum, ex::ZeroRow(child, 0));
        EXPECT_EQ(child.use_count(), 4);
    }
    EXPECT_EQ(child.use_count(), 1);
}

TEST(SubtreeSharing, EveryCallMakesANodeOfItsOwn) {
    const Expression a = M_(Dense(2, 2, 1.0));
    EXPECT_NE(M_(Dense(2, 2, 1.0)), a);
    EXPECT_NE(ex::Mult(a, a), ex::Mult(a, a));
    EXPECT_NE(ex::Transpose(a), a);
    EXPECT_NE(ex::ZeroRow(a, 0), a);
}

/// A random tree over whole numbers together with its value.
std::pair<Expression, PlainMatrix> randomTree(int rows, int cols, int depth, UniformNumbers& random) {
    if (depth == 0) {
        const PlainMatrix source = random.integerMatrix(rows, cols);
        const int kind = rows == cols ? random.integer(0, 3) : 0;
        if (kind == 1) return {M_(symmetric(source)), plain(symmetric(source))};
        if (kind == 2) return {M_(upper(source)), plain(upper(source))};
        if (kind == 3) return {M_(diagonal(source)), plain(diagonal(source))};
        return {M_(dense(source)), source};
    }
    const int operation = random.integer(0, 5);
    if (operation == 0) {
        const int inner = random.integer(1, 4);
        const auto [left, leftValue] = randomTree(rows, inner, depth - 1, random);
        const auto [right, rightValue] = randomTree(inner, cols, depth - 1, random);
        return {ex::Mult(left, right), plainProduct(leftValue, rightValue)};
    }
    if (operation == 3) {
        const auto [child, value] = randomTree(cols, rows, depth - 1, random);
        return {ex::Transpose(child), plainTranspose(value)};
    }
    const auto [child, value] = randomTree(rows, cols, depth - 1, random);
    if (operation == 4) {
        const int row = random.integer(0, rows - 1);
        return {ex::ZeroRow(child, row), withRowCleared(value, row)};
    }
    if (operation == 5) {
        const int column = random.integer(0, cols - 1);
        return {ex::ZeroColumn(child, column), withColumnCleared(value, column)};
    }
    const auto [other, otherValue] = randomTree(rows, cols, depth - 1, random);
    if (operation == 1) return {ex::Add(child, other), plainSum(value, otherValue)};
    return {ex::Sub(child, other), plainDifference(value, otherValue)};
}

TEST(RandomTrees, GiveTheSameValueByEveryRoute) {
    UniformNumbers random(149);
    for (int trial = 0; trial < scaled(300); ++trial) {
        const auto [tree, value] = randomTree(random.integer(1, 4), random.integer(1, 4), random.integer(0, 4), random);
        expectValue(tree, value, random);
        ASSERT_FALSE(HasFailure()) << textOf(tree);
    }
}

TEST(GetRow, OutsideIsAnAssertion) {
    const Expression e = M_(Dense(2, 3, 1.0));
    for (const int row : {-1, 2, 1000}) {
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(ex::GetRow(e, row)); }),
                    IsAssertion("row >= 0 && row < M", "src/matrix/matrix_expression"));
    }
}

TEST(GetColumn, OutsideIsAnAssertion) {
    const Expression e = M_(Dense(2, 3, 1.0));
    for (const int column : {-1, 3, 1000}) {
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(ex::GetColumn(e, column)); }),
                    IsAssertion("column >= 0 && column < N", "src/matrix/matrix_expression"));
    }
}

TEST(DeferredChecks, ProductOfOtherOrdersIsBuiltAndFailsWhenEvaluated) {
    const Expression e = ex::Mult(M_(Dense(2, 3, 1.0)), M_(Dense(2, 5, 1.0)));
    EXPECT_EQ(ex::RowCount(e), 2);
    EXPECT_EQ(ex::ColumnCount(e), 5);
    EXPECT_EQ(textOf(e), "( < Matrix 2 by 3> * < Matrix 2 by 5>)");
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(ex::Evaluate(e)); }),
              "Matrix multiplication: incompatible orders");
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(ex::GetColumn(e, 0)); }),
              "Matrix multiplication: incompatible orders");
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(ex::GetRow(e, 0)); }),
              "Matrix multiplication: incompatible orders");
}

TEST(DeferredChecks, SumOfOtherShapesTakesRowsFromTheLeftAndColumnsFromTheRight) {
    for (const Expression& e :
         {ex::Add(M_(Dense(2, 3, 1.0)), M_(Dense(4, 5, 1.0))), ex::Sub(M_(Dense(2, 3, 1.0)), M_(Dense(4, 5, 1.0)))}) {
        EXPECT_EQ(ex::RowCount(e), 2);
        EXPECT_EQ(ex::ColumnCount(e), 5);
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(ex::Evaluate(e)); }),
                    IsAssertion("m_ == other.m_ && n_ == other.n_"));
    }
}

TEST(DeferredChecks, OperandOfAnotherSizeFailsInTheProduct) {
    const Expression e = M_(Dense(2, 3, 1.0));
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(ex::MultiplyOnRight(e, Dense(2, 1, 1.0))); }),
              "Matrix multiplication: incompatible orders");
    EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(ex::MultiplyOnLeft(Dense(1, 3, 1.0), e)); }),
              "Matrix multiplication: incompatible orders");
}

TEST(DeferredChecks, IndexOfAZeroNodeIsCheckedWhenItClears) {
    for (const int bad : {-1, 2, 50}) {
        const Expression row = ex::ZeroRow(M_(Dense(2, 2, 1.0)), bad);
        const Expression column = ex::ZeroColumn(M_(Dense(2, 2, 1.0)), bad);
        EXPECT_EQ(ex::RowCount(row), 2);
        const auto rowTest = IsAssertion("row >= 0 && row < m.rowCount()", "src/matrix/matrix_expression");
        const auto columnTest = IsAssertion("column >= 0 && column < m.colCount()", "src/matrix/matrix_expression");
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(ex::Evaluate(row)); }), rowTest);
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(ex::MultiplyOnRight(row, Dense(2, 1, 1.0))); }),
                    rowTest);
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(ex::MultiplyOnLeft(Dense(1, 2, 1.0), row)); }),
                    columnTest);
        EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(ex::Evaluate(column)); }), columnTest);
        EXPECT_THAT(
            messageOf<AllegeException>([&] { static_cast<void>(ex::MultiplyOnRight(column, Dense(2, 1, 1.0))); }),
            rowTest);
        EXPECT_THAT(
            messageOf<AllegeException>([&] { static_cast<void>(ex::MultiplyOnLeft(Dense(1, 2, 1.0), column)); }),
            columnTest);
    }
}

TEST(ExpressionText, OfEachNode) {
    const Expression a = M_(Dense(2, 3, 1.0));
    const Expression b = M_(Dense(3, 2, 1.0));
    EXPECT_EQ(textOf(a), "< Matrix 2 by 3>");
    EXPECT_EQ(textOf(ex::Mult(a, b)), "( < Matrix 2 by 3> * < Matrix 3 by 2>)");
    EXPECT_EQ(textOf(ex::Add(a, a)), "( < Matrix 2 by 3> + < Matrix 2 by 3>)");
    EXPECT_EQ(textOf(ex::Sub(a, a)), "( < Matrix 2 by 3> - < Matrix 2 by 3>)");
    EXPECT_EQ(textOf(ex::Transpose(a)), "( < Matrix 2 by 3> transpose ) ");
    EXPECT_EQ(textOf(ex::ZeroRow(a, 1)), "(zero row : 1 < Matrix 2 by 3>)");
    EXPECT_EQ(textOf(ex::ZeroColumn(a, -4)), "(zero column : -4 < Matrix 2 by 3>)");
}

TEST(ExpressionText, OfNestedNodes) {
    const Expression a = M_(Dense(2, 3, 1.0));
    const Expression b = M_(Dense(3, 2, 1.0));
    EXPECT_EQ(textOf(ex::Add(a, ex::Transpose(b))), "( < Matrix 2 by 3> + ( < Matrix 3 by 2> transpose ) )");
    EXPECT_EQ(textOf(ex::ZeroRow(ex::Transpose(ex::ZeroColumn(a, 0)), 2)),
              "(zero row : 2 ( (zero column : 0 < Matrix 2 by 3>) transpose ) )");
}

TEST(ExpressionText, DoesNotDependOnTheDepth) {
    const Expression e = ex::ZeroRow(ex::Transpose(M_(Dense(2, 3, 1.0))), 0);
    std::ostringstream os;
    std::ostream& returned = e->ToString(os, 17);
    EXPECT_EQ(&returned, &os);
    EXPECT_EQ(os.str(), textOf(e));
}

TEST(ExpressionText, StreamingReturnsTheStream) {
    std::ostringstream os;
    EXPECT_EQ(&(os << M_(Dense(1, 1, 1.0))), &os);
}

TEST(ShowMatrix, WritesAScalar) {
    std::ostringstream os;
    ex::showMatrix(os, 2.5);
    ex::showMatrix(os, -1e300);
    EXPECT_EQ(os.str(), "<Value: 2.5><Value: -1e+300>");
}

}  // namespace
}  // namespace reisti::test
