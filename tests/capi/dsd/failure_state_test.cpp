// Every failure of the create function with the exact state it leaves behind, and the order in which the tests are
// made.
#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <limits>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "support/screening_arrays.h"

namespace {

using reisti::test::completeBaseRuns;
using reisti::test::evenBaseRuns;
using reisti::test::ScreeningArrays;
using reisti::test::plain::baseRunCount;
using reisti::test::plain::Request;

constexpr std::uint32_t kMost = std::numeric_limits<std::uint32_t>::max();

TEST(CreateFailure, NullRecordIsReported) {
    EXPECT_EQ(des_CreateDefinitiveScreeningDesign(nullptr), des_ErrorNullPointer);
}

TEST(CreateFailure, NullRunsAreReportedBeforeInvalidFactors) {
    for (const std::uint32_t numFactors : {0U, 1U, 6U, 49U}) {
        ScreeningArrays arrays(6, 13);
        arrays.design.numFactors = numFactors;
        arrays.design.runs = nullptr;
        EXPECT_EQ(arrays.create(), des_ErrorNullRuns) << numFactors;
    }
}

TEST(CreateFailure, NullRunsLeaveLevelsUntouched) {
    ScreeningArrays arrays(6, 13);
    arrays.design.runs = nullptr;
    arrays.create();
    EXPECT_EQ(arrays.differenceFromUntouched(), "");
}

class CreateWithInvalidFactors : public testing::TestWithParam<std::uint32_t> {};

TEST_P(CreateWithInvalidFactors, WritesNothing) {
    ScreeningArrays arrays(6, 14, {0});
    arrays.design.numFactors = GetParam();
    EXPECT_EQ(arrays.create(), des_ErrorNumFactors);
    EXPECT_EQ(arrays.differenceFromUntouched(), "");
}

TEST_P(CreateWithInvalidFactors, IsReportedBeforeNullLevels) {
    ScreeningArrays arrays(6, 14, {0});
    arrays.design.numFactors = GetParam();
    arrays.record(0).levels = nullptr;
    EXPECT_EQ(arrays.create(), des_ErrorNumFactors);
}

TEST_P(CreateWithInvalidFactors, IsReportedBeforeEveryLaterError) {
    ScreeningArrays arrays(6, 14);
    arrays.design.numFactors = GetParam();
    arrays.design.numCategorical = kMost;
    arrays.design.replicates = kMost;
    arrays.design.numBlocks = 2;
    EXPECT_EQ(arrays.create(), des_ErrorNumFactors);
}

INSTANTIATE_TEST_SUITE_P(, CreateWithInvalidFactors, testing::Values(0U, 1U, 49U, 0x80000006U, kMost),
                         testing::PrintToStringParamName());

// One continuous factor left makes the library look into the list before it tests the levels.
TEST(CreateFailure, NullFirstLevelsWriteNothing) {
    for (const std::size_t k : {0U, 1U, 5U, 6U}) {
        std::vector<std::uint32_t> list;
        for (std::uint32_t c = 0; c < k; ++c) {
            list.push_back(c);
        }
        ScreeningArrays arrays(6, 14, list);
        arrays.record(0).levels = nullptr;
        EXPECT_EQ(arrays.create(), des_ErrorNullLevels) << k;
        EXPECT_EQ(arrays.differenceFromUntouched(), "") << k;
    }
}

TEST(CreateFailure, NullFirstLevelsAreReportedBeforeTooManyCategorical) {
    ScreeningArrays arrays(6, 14);
    arrays.record(0).levels = nullptr;
    arrays.design.numCategorical = 7;
    EXPECT_EQ(arrays.create(), des_ErrorNullLevels);
}

TEST(CreateFailure, NullFirstLevelsAreReportedBeforeNullList) {
    for (const std::uint32_t k : {1U, 5U, 6U}) {
        ScreeningArrays arrays(6, 14);
        arrays.record(0).levels = nullptr;
        arrays.design.numCategorical = k;
        EXPECT_EQ(arrays.create(), des_ErrorNullLevels) << k;
    }
}

TEST(CreateFailure, NullFirstLevelsAreReportedBeforeBadReplicates) {
    ScreeningArrays arrays(6, 13);
    arrays.record(0).levels = nullptr;
    arrays.design.replicates = kMost;
    EXPECT_EQ(arrays.create(), des_ErrorNullLevels);
}

TEST(CreateFailure, TooManyCategoricalLeavesTheEvenBaseRuns) {
    ScreeningArrays arrays(6, 14, {0, 1, 2, 3, 4, 5, 0});
    EXPECT_EQ(arrays.create(), des_ErrorTooManyCategorical);
    EXPECT_EQ(arrays.differenceFrom(evenBaseRuns({6, {0, 1, 2, 3, 4, 5, 0}})), "");
}

TEST(CreateFailure, TooManyCategoricalLeavesTheEvenBaseRunsForEveryNumberOfFactors) {
    for (std::uint32_t n = 2; n <= 48; ++n) {
        ScreeningArrays arrays(n, baseRunCount(n, true), std::vector<std::uint32_t>(n + 1, 0));
        EXPECT_EQ(arrays.create(), des_ErrorTooManyCategorical) << n;
        EXPECT_EQ(arrays.differenceFrom(evenBaseRuns({n, std::vector<std::uint32_t>(n + 1, 0)})), "") << n;
    }
}

TEST(CreateFailure, NothingIsReadByTheNumberOfCategoricalFactorsBeforeItIsTested) {
    // A list of one entry and a count of billions: a sanitizer or a crash tells when it is followed.
    for (const std::uint32_t count : {7U, 1000000U, kMost - 1, kMost}) {
        ScreeningArrays arrays(6, 14, {0});
        arrays.design.numCategorical = count;
        EXPECT_EQ(arrays.create(), des_ErrorTooManyCategorical) << count;
        EXPECT_EQ(arrays.differenceFrom(evenBaseRuns({6, {}})), "") << count;
    }
}

TEST(CreateFailure, TooManyCategoricalIsReportedBeforeNullList) {
    ScreeningArrays arrays(6, 14);
    arrays.design.numCategorical = 7;
    EXPECT_EQ(arrays.create(), des_ErrorTooManyCategorical);
}

TEST(CreateFailure, TooManyCategoricalIsReportedBeforeBadIndexAndReplicates) {
    ScreeningArrays arrays(6, 14, std::vector<std::uint32_t>(7, kMost));
    arrays.design.replicates = kMost;
    EXPECT_EQ(arrays.create(), des_ErrorTooManyCategorical);
}

TEST(CreateFailure, NullListLeavesTheEvenBaseRuns) {
    for (const std::uint32_t k : {1U, 3U, 4U, 6U}) {
        ScreeningArrays arrays(6, 14);
        arrays.design.numCategorical = k;
        EXPECT_EQ(arrays.create(), des_ErrorNullPointer) << k;
        EXPECT_EQ(arrays.differenceFrom(evenBaseRuns({6, {}})), "") << k;
    }
}

TEST(CreateFailure, NullListWithOneContinuousFactorWritesLevelsOfTheEvenBaseRuns) {
    // Which of the runs would be the centre of the one continuous factor cannot be told without a list.
    ScreeningArrays arrays(6, 14);
    arrays.design.numCategorical = 5;
    EXPECT_EQ(arrays.create(), des_ErrorNullPointer);
    for (const std::size_t i : {0U, 2U, 4U, 6U, 8U, 10U}) {
        EXPECT_EQ(arrays.run(i).levels, evenBaseRuns({6, {}})[i]->levels) << i;
    }
    for (const std::size_t i : {1U, 3U, 5U, 7U, 9U, 11U, 12U, 13U}) {
        EXPECT_EQ(arrays.record(i).runOrder, reisti::test::kPoison) << i;
        EXPECT_EQ(arrays.level(i, 0), reisti::test::kLevelPoison) << i;
    }
}

TEST(CreateFailure, NullListIsReportedBeforeBadReplicates) {
    ScreeningArrays arrays(6, 14);
    arrays.design.numCategorical = 2;
    arrays.design.replicates = kMost;
    arrays.design.numBlocks = 2;
    EXPECT_EQ(arrays.create(), des_ErrorNullPointer);
}

struct BadList {
    const char* name;
    std::uint32_t numFactors;
    std::vector<std::uint32_t> list;
};

class CreateWithBadIndex : public testing::TestWithParam<BadList> {};

TEST_P(CreateWithBadIndex, LeavesTheEvenBaseRuns) {
    const BadList& bad = GetParam();
    ScreeningArrays arrays(bad.numFactors, baseRunCount(bad.numFactors, true), bad.list);
    EXPECT_EQ(arrays.create(), des_ErrorCategoricalIndex);
    EXPECT_EQ(arrays.differenceFrom(evenBaseRuns({bad.numFactors, bad.list})), "");
}

TEST_P(CreateWithBadIndex, IsReportedBeforeTooManyReplicates) {
    const BadList& bad = GetParam();
    ScreeningArrays arrays(bad.numFactors, baseRunCount(bad.numFactors, true), bad.list);
    arrays.design.replicates = kMost;
    EXPECT_EQ(arrays.create(), des_ErrorCategoricalIndex);
}

TEST_P(CreateWithBadIndex, IsReportedBeforeBadBlocks) {
    const BadList& bad = GetParam();
    ScreeningArrays arrays(bad.numFactors, baseRunCount(bad.numFactors, true), bad.list);
    arrays.design.replicates = 3;
    arrays.design.numBlocks = 2;
    EXPECT_EQ(arrays.create(), des_ErrorCategoricalIndex);
}

// Indices between the number of factors and the order of the matrix name a column that exists but is dropped.
INSTANTIATE_TEST_SUITE_P(, CreateWithBadIndex,
                         testing::Values(BadList{"EqualToTheNumberOfFactors", 6, {6}},
                                         BadList{"InADroppedColumn", 4, {0, 5}}, BadList{"LastOfMany", 6, {0, 2, 6}},
                                         BadList{"FirstOfMany", 6, {6, 0, 2}}, BadList{"Largest", 6, {0, kMost}},
                                         BadList{"OneContinuousFactorLeft", 3, {0, 3}},
                                         BadList{"OneContinuousFactorLeftLargestFirst", 3, {kMost, 1}},
                                         BadList{"AllCategorical", 3, {0, 1, 3}},
                                         BadList{"MostFactors", 48, {0, 47, 48}}, BadList{"TwoFactors", 2, {2}}),
                         [](const testing::TestParamInfo<BadList>& param) { return std::string(param.param.name); });

// The runs between the even ones are not looked at before the list is examined.
TEST(CreateFailure, BadIndexIsFoundBeforeOddRunsAreTouched) {
    ScreeningArrays arrays(6, 14, {6});
    for (const std::size_t i : {1U, 3U, 5U, 7U, 9U, 11U, 12U, 13U}) {
        arrays.record(i).levels = nullptr;
    }
    EXPECT_EQ(arrays.create(), des_ErrorCategoricalIndex);
    EXPECT_EQ(arrays.differenceFrom(evenBaseRuns({6, {6}})), "");
}

class CreateWithTooManyReplicates : public testing::TestWithParam<Request> {};

TEST_P(CreateWithTooManyReplicates, LeavesTheBaseRunsComplete) {
    Request request = GetParam();
    ScreeningArrays arrays(request.numFactors, baseRunCount(request.numFactors, !request.categorical.empty()),
                           request.categorical);
    arrays.design.replicates = request.replicates;
    arrays.design.numBlocks = request.numBlocks;
    EXPECT_EQ(arrays.create(), des_ErrorTooManyReplicates);
    EXPECT_EQ(arrays.differenceFrom(completeBaseRuns(request)), "");
}

TEST_P(CreateWithTooManyReplicates, DoesNotRandomize) {
    Request request = GetParam();
    ScreeningArrays arrays(request.numFactors, baseRunCount(request.numFactors, !request.categorical.empty()),
                           request.categorical);
    arrays.design.replicates = request.replicates;
    arrays.design.numBlocks = request.numBlocks;
    arrays.randomized(1.5);
    EXPECT_EQ(arrays.create(), des_ErrorTooManyReplicates);
    EXPECT_EQ(arrays.differenceFrom(completeBaseRuns(request)), "");
}

// The last ones also have blocks that do not divide the replicates: that is tested later.
INSTANTIATE_TEST_SUITE_P(, CreateWithTooManyReplicates,
                         testing::Values(Request{48, {}, 44278014, 1}, Request{48, {3, 4}, 43826197, 1},
                                         Request{8, {}, 252645136, 1}, Request{2, {}, kMost, 1},
                                         Request{2, {1}, kMost, 2}, Request{48, {}, 44278015, 2}),
                         [](const testing::TestParamInfo<Request>& param) {
                             return "Factors" + std::to_string(param.param.numFactors) + "Categorical" +
                                    std::to_string(param.param.categorical.size()) + "Replicates" +
                                    std::to_string(param.param.replicates);
                         });

class CreateWithBadBlocks : public testing::TestWithParam<Request> {};

TEST_P(CreateWithBadBlocks, LeavesTheBaseRunsComplete) {
    Request request = GetParam();
    ScreeningArrays arrays(request.numFactors, baseRunCount(request.numFactors, !request.categorical.empty()),
                           request.categorical);
    arrays.design.replicates = request.replicates;
    arrays.design.numBlocks = request.numBlocks;
    arrays.randomized(1.5);
    EXPECT_EQ(arrays.create(), des_ErrorBlocks);
    EXPECT_EQ(arrays.differenceFrom(completeBaseRuns(request)), "");
}

// 44278013 is the last count of replicates for 48 factors: it passes the test of the count.
INSTANTIATE_TEST_SUITE_P(, CreateWithBadBlocks,
                         testing::Values(Request{6, {}, 3, 2}, Request{6, {0, 2}, 3, 2}, Request{6, {}, 2, 4},
                                         Request{6, {}, 2, kMost}, Request{5, {1, 2, 3, 4}, 10, 4},
                                         Request{48, {}, 44278013, 2}),
                         [](const testing::TestParamInfo<Request>& param) {
                             return "Factors" + std::to_string(param.param.numFactors) + "Categorical" +
                                    std::to_string(param.param.categorical.size()) + "Replicates" +
                                    std::to_string(param.param.replicates) + "Blocks" +
                                    std::to_string(param.param.numBlocks);
                         });

}  // namespace
