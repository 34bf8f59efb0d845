#include <utility>

#include "support/failing_new.h"
#include "unit/matrix/matrix_kinds.h"

// What operations cost in memory, measured in bytes of operator new and never in time.

namespace reisti::test {
namespace {

namespace ex = qan::matrix_library::expressions;

template <class Action>
AllocationCounts countsOf(Action action) {
    AllocationWatch watch;
    action();
    watch.stop();
    return watch.counts();
}

constexpr std::ptrdiff_t kColumnBytes = 20000 * sizeof(double);

/// A handful of vectors of the outer dimension; the product itself would take 3.2 gigabytes.
constexpr std::ptrdiff_t kAFewColumns = 6 * kColumnBytes + 65536;

/// Products may pack tiles of their operands into buffers whose size does not depend on the order.
constexpr std::ptrdiff_t kPackingBuffers = std::ptrdiff_t{2} * 1024 * 1024;

class LargeProduct : public testing::Test {
  protected:
    LargeProduct() {
        Dense tall(20000, 1, 0.0);
        Dense wide(1, 20000, 0.0);
        for (int i = 0; i < 20000; ++i) {
            tall(i, 0) = i;
            wide(0, i) = 1 + i % 7;
        }
        product = ex::Mult(ex::M_(tall), ex::M_(wide));
    }
    std::shared_ptr<const ex::ExpressionNode> product;
};

TEST_F(LargeProduct, ColumnIsHadWithoutTheProduct) {
    Dense column;
    const AllocationCounts counts = countsOf([&] { column = ex::GetColumn(product, 12345); });
    EXPECT_LE(counts.peakBytes, kAFewColumns);
    ASSERT_EQ(column.rowCount(), 20000);
    EXPECT_EQ(column(777, 0), 777.0 * (1 + 12345 % 7));
}

TEST_F(LargeProduct, RowIsHadWithoutTheProduct) {
    Dense row;
    const AllocationCounts counts = countsOf([&] { row = ex::GetRow(product, 4321); });
    EXPECT_LE(counts.peakBytes, kAFewColumns);
    ASSERT_EQ(row.colCount(), 20000);
    EXPECT_EQ(row(0, 13), 4321.0 * (1 + 13 % 7));
}

TEST_F(LargeProduct, EveryNodeAboveItStaysLazy) {
    const auto tree = ex::Sub(ex::Add(ex::Transpose(ex::ZeroRow(product, 3)), ex::ZeroColumn(product, 5)),
                              ex::ZeroRow(ex::ZeroColumn(ex::Transpose(product), 1), 2));
    Dense column;
    Dense row;
    const AllocationCounts counts = countsOf([&] {
        column = ex::GetColumn(tree, 9);
        row = ex::GetRow(tree, 9);
    });
    EXPECT_LE(counts.peakBytes, 4 * kAFewColumns);
    const auto value = [](int i, int j) { return static_cast<double>(i) * (1 + j % 7); };
    for (const int k : {0, 1, 2, 3, 4, 5, 9, 100, 19999}) {
        // The transpose of the product is there twice and cancels, but for the row and column that were cleared.
        const double down = value(9, k) + value(k, 9) - (k == 2 ? 0.0 : value(9, k));
        EXPECT_EQ(column(k, 0), down) << k;
        const double across =
            (k == 3 ? 0.0 : value(k, 9)) + (k == 5 ? 0.0 : value(9, k)) - (k == 1 ? 0.0 : value(k, 9));
        EXPECT_EQ(row(0, k), across) << k;
    }
}

TEST_F(LargeProduct, BuildingATreeCopiesNoValue) {
    std::shared_ptr<const ex::ExpressionNode> tree;
    const AllocationCounts counts =
        countsOf([&] { tree = ex::ZeroRow(ex::Transpose(ex::Add(ex::Mult(product, product), product)), 1); });
    EXPECT_LE(counts.peakBytes, 4096);
}

TEST(StructuredValueExpression, ColumnOfADiagonalFormsNoDenseCopy) {
    Diagonal d;
    d.resize(20000, 3.0);
    const auto value = ex::M_(d);
    Dense column;
    Dense row;
    const AllocationCounts counts = countsOf([&] {
        column = ex::GetColumn(value, 7);
        row = ex::GetRow(value, 7);
    });
    EXPECT_LE(counts.peakBytes, kAFewColumns);
    EXPECT_EQ(column(7, 0), 3.0);
    EXPECT_EQ(row(0, 7), 3.0);
    EXPECT_EQ(column(8, 0), 0.0);
}

template <class Kind>
class PackedValueExpression : public testing::Test {};
using PackedKinds = testing::Types<Upper, Symmetric>;
TYPED_TEST_SUITE(PackedValueExpression, PackedKinds);

TYPED_TEST(PackedValueExpression, RowAndColumnFormNoDenseCopy) {
    const auto value = ex::M_(TypeParam(1500, 2.0));
    Dense column;
    Dense row;
    const AllocationCounts counts = countsOf([&] {
        column = ex::GetColumn(value, 1499);
        row = ex::GetRow(value, 0);
    });
    EXPECT_LE(counts.peakBytes, kPackingBuffers) << "a dense copy takes 18 megabytes";
    EXPECT_EQ(column(3, 0), 2.0);
    EXPECT_EQ(row(0, 3), 2.0);
}

template <class Kind>
class StructuredOperand : public testing::Test {};
using StructuredKinds = testing::Types<Diagonal, Upper, Symmetric>;
TYPED_TEST_SUITE(StructuredOperand, StructuredKinds);

TYPED_TEST(StructuredOperand, IsNeverCopiedIntoADenseMatrixForAProduct) {
    const int order = 1500;
    const TypeParam structured = make<TypeParam>(plainIdentity(order));
    const Dense column(order, 2, 1.0);
    const Dense row(2, order, 1.0);
    Dense right;
    Dense left;
    const AllocationCounts counts = countsOf([&] {
        right = structured * column;
        left = row * structured;
    });
    EXPECT_LE(counts.peakBytes, kPackingBuffers) << "a dense copy takes 18 megabytes";
    EXPECT_EQ(plain(right), plain(column));
    EXPECT_EQ(plain(left), plain(row));
}

TYPED_TEST(StructuredOperand, IsNeverCopiedIntoADenseMatrixForASum) {
    const int order = 400;
    const TypeParam structured = make<TypeParam>(plainIdentity(order));
    const Dense ones(order, order, 1.0);
    Dense sum;
    const AllocationCounts counts = countsOf([&] { sum = ones + structured; });
    EXPECT_LE(counts.peakBytes, order * order * std::ptrdiff_t{sizeof(double)} + 65536) << "the result alone";
    EXPECT_EQ(sum(3, 3), 2.0);
}

template <class Kind>
class MoveCost : public testing::Test {};
using Kinds = testing::Types<Dense, Diagonal, Upper, Symmetric>;
TYPED_TEST_SUITE(MoveCost, Kinds);

TYPED_TEST(MoveCost, IsNoAllocation) {
    TypeParam a = make<TypeParam>(PlainMatrix(100, 100));
    TypeParam b = make<TypeParam>(PlainMatrix(50, 50));
    const AllocationCounts counts = countsOf([&] {
        TypeParam c(std::move(a));
        a = std::move(b);
        b = std::move(c);
        a.swap(b);
    });
    EXPECT_EQ(counts.attempts, 0U);
}

TEST(DenseGrowth, AppendingRowsAllocatesRarely) {
    Dense m;
    const Vec row(10, 1.0);
    const AllocationCounts counts = countsOf([&] {
        for (int i = 0; i < 100000; ++i)
            m.addRow(row);
    });
    // Growth by a factor of 1.5 takes 28 steps from one row to a hundred thousand.
    EXPECT_LE(counts.attempts, 40U);
    EXPECT_EQ(m.rowCount(), 100000);
}

TEST(DenseGrowth, AppendingScalarRowsAllocatesRarely) {
    Dense m(1, 10, 0.0);
    const AllocationCounts counts = countsOf([&] {
        for (int i = 0; i < 100000; ++i)
            m.addRow(1.0);
    });
    EXPECT_LE(counts.attempts, 40U);
    EXPECT_EQ(m(100000, 9), 1.0);
}

TEST(DenseGrowth, InsertionsAllocateOnce) {
    Dense m(300, 300, 1.0);
    EXPECT_LE(countsOf([&] { m.insertRow(5, 2.0); }).attempts, 1U);
    Dense n(300, 300, 1.0);
    EXPECT_LE(countsOf([&] { n.insertCol(5, 2.0); }).attempts, 1U);
    EXPECT_EQ(n(299, 5), 2.0);
}

TEST(DenseGrowth, AppendingAColumnAllocatesOnceAndRemovingNever) {
    Dense m(300, 300, 1.0);
    EXPECT_LE(countsOf([&] { m.addCol(2.0); }).attempts, 1U);
    EXPECT_EQ(countsOf([&] { m.removeCol(7); }).attempts, 0U);
    EXPECT_EQ(countsOf([&] { m.removeRow(7); }).attempts, 0U);
    EXPECT_EQ(countsOf([&] { m.addCol(2.0); }).attempts, 0U) << "the removed column left room";
}

TEST(StructuredShrinking, AllocatesNothing) {
    Symmetric s(100, 1.0);
    Diagonal d;
    d.resize(100, 1.0);
    EXPECT_EQ(countsOf([&] { s.removeColRow(50); }).attempts, 0U);
    EXPECT_EQ(countsOf([&] { d.removeColRow(50); }).attempts, 0U);
}

/// Fails every allocation of `action` in turn; `check` looks at what each failure leaves behind.
template <class Action, class Check>
void failEachAllocation(Action action, Check check) {
    for (std::size_t n = 1;; ++n) {
        bool threw = false;
        AllocationWatch watch(n);
        try {
            action();
        } catch (const std::bad_alloc&) {
            threw = true;
        }
        watch.stop();
        if (!watch.counts().failed) break;
        EXPECT_TRUE(threw) << "allocation " << n << " failed unnoticed";
        check();
        ASSERT_LT(n, 1000U);
    }
}

TEST(AllocationFailure, OfAGrowingMatrixPropagatesAndKeepsItsRows) {
    Dense m(Vec{1, 2, 3, 4}, 2);
    const PlainMatrix before = plain(m);
    const auto unchanged = [&] {
        EXPECT_EQ(plain(m), before);
        EXPECT_EQ(m.size(), 4);
    };
    const Vec row{5, 6};
    failEachAllocation(
        [&] {
            Dense copy(m);
            copy.addRow(row);
        },
        unchanged);
    const auto growing = [&](auto grow) {
        Dense target(Vec{1, 2, 3, 4}, 2);
        AllocationWatch watch(1);
        try {
            grow(target);
        } catch (const std::bad_alloc&) {
            watch.stop();
            EXPECT_EQ(plain(target), before);
            EXPECT_EQ(target.size(), 4);
        }
    };
    growing([&](Dense& target) { target.addRow(row); });
    growing([&](Dense& target) { target.insertRow(0, row); });
    growing([&](Dense& target) { target.insertCol(0, row); });
    growing([&](Dense& target) { target.insertRow(0, 1.0); });
    growing([&](Dense& target) { target.insertCol(0, 1.0); });
}

TEST(AllocationFailure, OfProductsAndSolversPropagates) {
    const Dense a(Vec{2, 1, 1, 3}, 2);
    const Symmetric s = symmetric({{2, 1}, {1, 3}});
    const auto untouched = [&] {
        EXPECT_EQ(plain(a), (PlainMatrix{{2, 1}, {1, 3}}));
        EXPECT_EQ(plain(s), plain(a));
    };
    failEachAllocation([&] { static_cast<void>(a * a); }, untouched);
    failEachAllocation([&] { static_cast<void>(s * a); }, untouched);
    failEachAllocation([&] { static_cast<void>(s + a); }, untouched);
    failEachAllocation([&] { static_cast<void>(qan::matrix_library::inverseWithThrow(a)); }, untouched);
    failEachAllocation([&] { static_cast<void>(qan::matrix_library::inverseWithThrow(s)); }, untouched);
    failEachAllocation([&] { static_cast<void>(qan::matrix_library::determinantWithThrow(s)); }, untouched);
    failEachAllocation(
        [&] {
            Vec values;
            Dense vectors;
            static_cast<void>(qan::matrix_library::EigenSystems(a, values, vectors));
        },
        untouched);
    failEachAllocation(
        [&] {
            const auto tree = ex::Mult(ex::M_(a), ex::Transpose(ex::M_(s)));
            static_cast<void>(ex::GetColumn(tree, 0));
        },
        untouched);
}

}  // namespace
}  // namespace reisti::test
