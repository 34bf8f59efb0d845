#include <climits>
#include <type_traits>

#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

static_assert(std::is_same_v<decltype(std::declval<Dense&>()(0, 0)), double&>);
static_assert(std::is_same_v<decltype(std::declval<Dense&>().at(0, 0)), double&>);
static_assert(std::is_same_v<decltype(std::declval<const Dense&>().rowCount()), int>);
static_assert(std::is_same_v<decltype(std::declval<const Dense&>().size()), int>);

TEST(DenseAccess, ElementsAreRowMajor) {
    const Dense m(Vec{1, 2, 3, 4, 5, 6}, 3);
    EXPECT_EQ(m(0, 2), 3.0);
    EXPECT_EQ(m(1, 0), 4.0);
    EXPECT_EQ(m.at(1, 2), 6.0);
}

TEST(DenseAccess, RowsLieBehindOneAnotherInStorage) {
    Dense m(2, 3, 0.0);
    EXPECT_EQ(&m(1, 2) - &m(0, 0), 5);
}

TEST(DenseAccess, WritesGoToTheElement) {
    Dense m(2, 2, 0.0);
    m(0, 1) = 3.0;
    m.at(1, 0) = 4.0;
    EXPECT_EQ(plain(m), (PlainMatrix{{0, 3}, {4, 0}}));
}

struct BadIndex {
    const char* name;
    int row;
    int column;
    const char* expression;
};

class DenseAtAssertion : public testing::TestWithParam<BadIndex> {};

TEST_P(DenseAtAssertion, QuotesTheFailedTest) {
    const BadIndex& bad = GetParam();
    Dense m(2, 3, 1.0);
    EXPECT_THAT(messageOf<AllegeException>([&] { m.at(bad.row, bad.column) = 5.0; }),
                IsAssertion(bad.expression, "src/matrix/matrix_new"));
    const Dense& fixed = m;
    EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(fixed.at(bad.row, bad.column)); }),
                IsAssertion(bad.expression, "src/matrix/matrix_new"));
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 1, 1}, {1, 1, 1}}));
}

INSTANTIATE_TEST_SUITE_P(Cases, DenseAtAssertion,
                         testing::Values(BadIndex{"RowBelow", -1, 0, "row >= 0 && row < m_"},
                                         BadIndex{"RowAbove", 2, 0, "row >= 0 && row < m_"},
                                         BadIndex{"RowLargest", INT_MAX, 0, "row >= 0 && row < m_"},
                                         BadIndex{"RowIsTestedFirst", 2, 3, "row >= 0 && row < m_"},
                                         BadIndex{"ColumnBelow", 0, -1, "column >= 0 && column < n_"},
                                         BadIndex{"ColumnAbove", 1, 3, "column >= 0 && column < n_"},
                                         BadIndex{"ColumnSmallest", 1, INT_MIN, "column >= 0 && column < n_"}),
                         [](const auto& caseInfo) { return std::string(caseInfo.param.name); });

TEST(DenseAccess, AtOfAnEmptyMatrixIsOutOfRange) {
    const Dense m;
    EXPECT_THAT(messageOf<AllegeException>([&] { static_cast<void>(m.at(0, 0)); }),
                IsAssertion("row >= 0 && row < m_", "src/matrix/matrix_new"));
}

TEST(DenseAccess, RangeCheckAcceptsAnything) {
    const Dense m(2, 2, 1.0);
    EXPECT_NO_THROW(m.range_check(-1, 99));
    EXPECT_NO_THROW(m.range_check(INT_MAX, INT_MIN));
}

TEST(DenseInvariant, HoldsForEveryConstructor) {
    EXPECT_NO_THROW(Dense().CheckInvariant());
    EXPECT_NO_THROW(Dense(2, 2, 1.0).CheckInvariant());
    EXPECT_NO_THROW(Dense(Vec{1, 2}, 1).CheckInvariant());
    EXPECT_NO_THROW(Dense::CreateRowVector(Vec{1, 2}).CheckInvariant());
    EXPECT_NO_THROW(Dense(diagonal(Vec{1})).CheckInvariant());
    EXPECT_NO_THROW(Dense(upper({{1}})).CheckInvariant());
    EXPECT_NO_THROW(Dense(symmetric({{1}})).CheckInvariant());
}

TEST(DenseInvariant, OverwrittenSignatureIsReported) {
    static_assert(std::is_standard_layout_v<Dense>, "the signature is the first thing in memory");
    Dense m(1, 1, 1.0);
    auto* const signature = reinterpret_cast<std::uint32_t*>(&m);
    EXPECT_EQ(*signature, 0xFEEDBAAAU);
    *signature = 0;
    EXPECT_THAT(messageOf<AllegeException>([&] { m.CheckInvariant(); }), IsAssertion("signature_ == matrixsignature_"));
    *signature = 0xFEEDBAAAU;
    EXPECT_NO_THROW(m.CheckInvariant());
}

}  // namespace
}  // namespace reisti::test
