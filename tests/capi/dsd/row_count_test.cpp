#include <cstdint>
#include <gtest/gtest.h>
#include <limits>
#include <ostream>
#include <string>

#include "reisti/reisti.h"
#include "support/plain_conference.h"

namespace {

using reisti::test::plain::baseRunCount;

constexpr std::int32_t kUnset = 123456;

struct Count {
    std::uint32_t runs;
    std::int32_t error;

    bool operator==(const Count&) const = default;
    friend std::ostream& operator<<(std::ostream& out, const Count& count) {
        return out << count.runs << " runs, error " << count.error;
    }
};

Count count(std::int32_t numFactors, std::uint8_t hasCategorical, std::uint32_t replicates) {
    std::int32_t error = kUnset;
    const std::uint32_t runs =
        des_FindDefinitiveScreeningDesignRowCount(numFactors, &error, hasCategorical, replicates);
    return {runs, error};
}

TEST(RowCount, FiveFactorsGiveThirteenRuns) {
    EXPECT_EQ(count(5, 0, 1), (Count{13, des_Success}));
}

TEST(RowCount, CategoricalFactorsAddOneRun) {
    EXPECT_EQ(count(5, 1, 1), (Count{14, des_Success}));
}

TEST(RowCount, NoReplicatesCountAsOne) {
    EXPECT_EQ(count(5, 0, 0), (Count{13, des_Success}));
}

TEST(RowCount, NoReplicatesCountAsOneWithCategoricalFactors) {
    EXPECT_EQ(count(5, 1, 0), (Count{14, des_Success}));
}

TEST(RowCount, EveryNumberOfFactorsHasItsBaseRuns) {
    for (std::uint32_t n = 2; n <= 48; ++n) {
        SCOPED_TRACE(n);
        EXPECT_EQ(count(static_cast<std::int32_t>(n), 0, 1), (Count{baseRunCount(n, false), des_Success}));
        EXPECT_EQ(count(static_cast<std::int32_t>(n), 1, 1), (Count{baseRunCount(n, true), des_Success}));
    }
}

TEST(RowCount, ReplicatesMultiplyTheBaseRuns) {
    for (const std::uint32_t replicates : {2U, 3U, 7U, 1000U}) {
        SCOPED_TRACE(replicates);
        EXPECT_EQ(count(21, 0, replicates), (Count{49 * replicates, des_Success}));
        EXPECT_EQ(count(21, 1, replicates), (Count{50 * replicates, des_Success}));
    }
}

TEST(RowCount, AnyNonzeroFlagMeansCategorical) {
    for (const std::uint8_t flag : {std::uint8_t{1}, std::uint8_t{2}, std::uint8_t{128}, std::uint8_t{255}}) {
        EXPECT_EQ(count(5, flag, 1), (Count{14, des_Success})) << int{flag};
    }
}

struct InvalidFactors {
    const char* name;
    std::int32_t numFactors;
};

class RowCountFactors : public testing::TestWithParam<InvalidFactors> {};

TEST_P(RowCountFactors, OutsideTheRangeReportErrorAndReturnZero) {
    EXPECT_EQ(count(GetParam().numFactors, 0, 1), (Count{0, des_ErrorNumFactors}));
}

TEST_P(RowCountFactors, AreTestedBeforeTheReplicates) {
    EXPECT_EQ(count(GetParam().numFactors, 1, std::numeric_limits<std::uint32_t>::max()),
              (Count{0, des_ErrorNumFactors}));
}

INSTANTIATE_TEST_SUITE_P(, RowCountFactors,
                         testing::Values(InvalidFactors{"None", 0}, InvalidFactors{"One", 1},
                                         InvalidFactors{"OneAboveTheMost", 49}, InvalidFactors{"Negative", -3},
                                         InvalidFactors{"MostNegative", INT32_MIN},
                                         InvalidFactors{"Largest", INT32_MAX}),
                         [](const testing::TestParamInfo<InvalidFactors>& param) {
                             return std::string(param.param.name);
                         });

struct LargestReplicates {
    const char* name;
    std::int32_t numFactors;
    std::uint8_t hasCategorical;
    std::uint32_t replicates;
    std::uint32_t runs;
};

class RowCountLimit : public testing::TestWithParam<LargestReplicates> {};

TEST_P(RowCountLimit, LastCountThatFitsIsAccepted) {
    const LargestReplicates& limit = GetParam();
    EXPECT_EQ(count(limit.numFactors, limit.hasCategorical, limit.replicates), (Count{limit.runs, des_Success}));
}

TEST_P(RowCountLimit, TooManyReplicatesReportOverflowAndReturnZero) {
    const LargestReplicates& limit = GetParam();
    EXPECT_EQ(count(limit.numFactors, limit.hasCategorical, limit.replicates + 1),
              (Count{0, des_ErrorTooManyReplicates}));
}

// 4294967295 is a multiple of 17 and 85: there the quotient is whole and the limit itself is accepted.
INSTANTIATE_TEST_SUITE_P(, RowCountLimit,
                         testing::Values(LargestReplicates{"FortyEightFactors", 48, 0, 44278013, 4294967261U},
                                         LargestReplicates{"FortyEightWithCategorical", 48, 1, 43826196, 4294967208U},
                                         LargestReplicates{"SixFactors", 6, 0, 330382099, 4294967287U},
                                         LargestReplicates{"EightFactorsExactly", 8, 0, 252645135, 4294967295U},
                                         LargestReplicates{"FortyTwoFactorsExactly", 42, 0, 50529027, 4294967295U}),
                         [](const testing::TestParamInfo<LargestReplicates>& param) {
                             return std::string(param.param.name);
                         });

TEST(RowCount, MostReplicatesOverflow) {
    EXPECT_EQ(count(2, 0, std::numeric_limits<std::uint32_t>::max()), (Count{0, des_ErrorTooManyReplicates}));
}

TEST(RowCount, NullErrorIsAcceptedOnSuccess) {
    EXPECT_EQ(des_FindDefinitiveScreeningDesignRowCount(5, nullptr, 0, 2), 26U);
}

TEST(RowCount, NullErrorIsAcceptedForInvalidFactors) {
    EXPECT_EQ(des_FindDefinitiveScreeningDesignRowCount(1, nullptr, 0, 1), 0U);
}

TEST(RowCount, NullErrorIsAcceptedForTooManyReplicates) {
    EXPECT_EQ(des_FindDefinitiveScreeningDesignRowCount(48, nullptr, 0, 44278014), 0U);
}

}  // namespace
