#include "dsd/conference_matrices.h"

#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <string>
#include <vector>

#include "support/plain_conference.h"

namespace {

using reisti::test::plain::SignMatrix;

struct Table {
    std::uint32_t order;
    const std::int32_t* values;
    std::size_t size;
};

template <std::size_t size>
constexpr Table tableOf(std::uint32_t order, const std::array<std::int32_t, size>& values) {
    return {order, values.data(), size};
}

const std::vector<Table>& tables() {
    static const std::vector<Table> all = {
        tableOf(4, reisti::DSD_4),   tableOf(6, reisti::DSD_6),   tableOf(8, reisti::DSD_8),
        tableOf(10, reisti::DSD_10), tableOf(12, reisti::DSD_12), tableOf(14, reisti::DSD_14),
        tableOf(16, reisti::DSD_16), tableOf(18, reisti::DSD_18), tableOf(20, reisti::DSD_20),
        tableOf(24, reisti::DSD_24), tableOf(26, reisti::DSD_26), tableOf(30, reisti::DSD_30),
        tableOf(32, reisti::DSD_32), tableOf(38, reisti::DSD_38), tableOf(42, reisti::DSD_42),
        tableOf(44, reisti::DSD_44), tableOf(48, reisti::DSD_48),
    };
    return all;
}

SignMatrix rowsOf(const std::int32_t* values, std::uint32_t order) {
    SignMatrix rows;
    for (std::size_t i = 0; i < order; ++i) {
        rows.emplace_back(values + i * order, values + (i + 1) * order);
    }
    return rows;
}

class ConferenceTable : public testing::TestWithParam<Table> {
  protected:
    std::uint32_t order() const { return GetParam().order; }
    std::int32_t at(std::size_t i, std::size_t j) const { return GetParam().values[i * GetParam().order + j]; }
};

TEST_P(ConferenceTable, HoldsOrderSquaredValues) {
    EXPECT_EQ(GetParam().size, std::size_t{order()} * order());
}

TEST_P(ConferenceTable, IsTheMatrixOfThePlainRule) {
    EXPECT_EQ(rowsOf(GetParam().values, order()), reisti::test::plain::conferenceMatrix(order()));
}

TEST_P(ConferenceTable, IsZeroOnTheDiagonalAndNowhereElse) {
    for (std::size_t i = 0; i < order(); ++i) {
        for (std::size_t j = 0; j < order(); ++j) {
            EXPECT_EQ(at(i, j) * at(i, j), i == j ? 0 : 1) << i << ' ' << j;
        }
    }
}

TEST_P(ConferenceTable, HasPositiveBorder) {
    for (std::size_t i = 1; i < order(); ++i) {
        EXPECT_EQ(at(0, i), 1) << i;
        EXPECT_EQ(at(i, 0), 1) << i;
    }
}

TEST_P(ConferenceTable, HasOrthogonalColumnsOfEqualLength) {
    for (std::size_t a = 0; a < order(); ++a) {
        for (std::size_t b = 0; b < order(); ++b) {
            std::int32_t product = 0;
            for (std::size_t i = 0; i < order(); ++i) {
                product += at(i, a) * at(i, b);
            }
            EXPECT_EQ(product, a == b ? static_cast<std::int32_t>(order()) - 1 : 0) << a << ' ' << b;
        }
    }
}

TEST_P(ConferenceTable, CoreIsSymmetricForOrdersTwoModuloFourElseAntisymmetric) {
    const std::int32_t sign = order() % 4 == 2 ? 1 : -1;
    for (std::size_t i = 1; i < order(); ++i) {
        for (std::size_t j = 1; j < order(); ++j) {
            EXPECT_EQ(at(i, j), sign * at(j, i)) << i << ' ' << j;
        }
    }
}

INSTANTIATE_TEST_SUITE_P(, ConferenceTable, testing::ValuesIn(tables()),
                         [](const testing::TestParamInfo<Table>& param) {
                             return "Order" + std::to_string(param.param.order);
                         });

TEST(ConferenceTables, OrderFourIsThePublishedMatrix) {
    EXPECT_EQ(rowsOf(reisti::DSD_4.data(), 4), (SignMatrix{{0, 1, 1, 1}, {1, 0, 1, -1}, {1, -1, 0, 1}, {1, 1, -1, 0}}));
}

TEST(ConferenceTables, OrderSixIsThePublishedMatrix) {
    EXPECT_EQ(rowsOf(reisti::DSD_6.data(), 6), (SignMatrix{{0, 1, 1, 1, 1, 1},
                                                           {1, 0, 1, -1, -1, 1},
                                                           {1, 1, 0, 1, -1, -1},
                                                           {1, -1, 1, 0, 1, -1},
                                                           {1, -1, -1, 1, 0, 1},
                                                           {1, 1, -1, -1, 1, 0}}));
}

TEST(ConferenceTables, SizesAreTheSixteenBaseOrders) {
    EXPECT_EQ(std::vector<std::uint32_t>(reisti::DSD_SIZES.begin(), reisti::DSD_SIZES.end()),
              reisti::test::plain::baseOrders());
}

TEST(ConferenceTables, LookupGivesTheTableOfEverySize) {
    for (const Table& table : tables()) {
        if (table.order == 4) continue;
        const std::int32_t* found = reisti::conferenceMatrix(table.order);
        ASSERT_NE(found, nullptr) << table.order;
        EXPECT_EQ(rowsOf(found, table.order), rowsOf(table.values, table.order)) << table.order;
    }
}

TEST(ConferenceTables, LookupGivesNullForAnOrderWithoutTable) {
    for (const std::uint32_t order : {0U, 1U, 2U, 5U, 7U, 22U, 28U, 34U, 36U, 40U, 46U, 47U, 49U, 50U, 4294967295U}) {
        EXPECT_EQ(reisti::conferenceMatrix(order), nullptr) << order;
    }
}

TEST(BaseOrder, IsTheSmallestSizeWithEnoughColumns) {
    for (std::uint32_t n = 2; n <= 48; ++n) {
        EXPECT_EQ(reisti::baseOrder(n), reisti::test::plain::baseOrder(n)) << n;
    }
}

TEST(BaseOrder, NeverSelectsFour) {
    for (const std::uint32_t n : {2U, 3U, 4U}) {
        EXPECT_EQ(reisti::baseOrder(n), 6U) << n;
    }
}

TEST(BaseRunCount, IsTwiceTheOrderPlusTheCentreRuns) {
    for (std::uint32_t n = 2; n <= 48; ++n) {
        EXPECT_EQ(reisti::baseRunCount(n, false), 2 * reisti::test::plain::baseOrder(n) + 1) << n;
        EXPECT_EQ(reisti::baseRunCount(n, true), 2 * reisti::test::plain::baseOrder(n) + 2) << n;
    }
}

}  // namespace
