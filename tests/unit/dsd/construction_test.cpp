// The steps of the construction, each on its own.
#include "dsd/construction.h"

#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <limits>
#include <optional>
#include <vector>

#include "dsd/conference_matrices.h"
#include "support/screening_arrays.h"

namespace {

using reisti::test::evenBaseRuns;
using reisti::test::ScreeningArrays;
using reisti::test::plain::PlainRun;
using reisti::test::plain::Request;
using Runs = std::vector<std::optional<PlainRun>>;

TEST(FillInitialDesign, WritesTheEvenBaseRunsForEveryNumberOfFactors) {
    for (std::uint32_t n = 2; n <= 48; ++n) {
        ScreeningArrays arrays(Request{n});
        EXPECT_EQ(reisti::fillInitialDesign(arrays.design), des_Success) << n;
        EXPECT_EQ(arrays.differenceFrom(evenBaseRuns({n})), "") << n;
    }
}

TEST(FillInitialDesign, RefusesTooFewAndTooManyFactors) {
    for (const std::uint32_t n : {0U, 1U, 49U, 4294967295U}) {
        ScreeningArrays arrays(Request{6});
        arrays.design.numFactors = n;
        EXPECT_EQ(reisti::fillInitialDesign(arrays.design), des_ErrorNumFactors) << n;
        EXPECT_EQ(arrays.differenceFromUntouched(), "") << n;
    }
}

TEST(FillInitialDesign, UsesAllColumnsForFortyEightFactorsAndDropsTheLastForFortySeven) {
    ScreeningArrays all(Request{48});
    ScreeningArrays fewer(Request{47});
    ASSERT_EQ(reisti::fillInitialDesign(all.design), des_Success);
    ASSERT_EQ(reisti::fillInitialDesign(fewer.design), des_Success);
    for (std::size_t i = 0; i < 48; ++i) {
        std::vector<std::int32_t> row = all.run(2 * i).levels;
        EXPECT_EQ(row[47], reisti::DSD_48[i * 48 + 47]) << i;
        row.pop_back();
        EXPECT_EQ(fewer.run(2 * i).levels, row) << i;
    }
}

// A table of its own tells the copy of rows from the choice of a matrix.
constexpr std::int32_t kNumbers[] = {11, 12, 13, 14, 21, 22, 23, 24, 31, 32, 33, 34, 41, 42, 43, 44};

TEST(CopyFromArrayToDesign, CopiesTheFirstColumnsOfEachRow) {
    ScreeningArrays arrays(3, 9);
    EXPECT_EQ(reisti::copyFromArrayToDesign(kNumbers, 4, arrays.design), des_Success);
    const Runs expected = {PlainRun{1, 1, 2, {11, 12, 13}}, std::nullopt, PlainRun{3, 1, 2, {21, 22, 23}}, std::nullopt,
                           PlainRun{5, 1, 2, {31, 32, 33}}, std::nullopt, PlainRun{7, 1, 1, {41, 42, 43}}};
    EXPECT_EQ(arrays.differenceFrom(expected), "");
}

TEST(CopyFromArrayToDesign, RefusesNullLevelsOfTheFirstRunBeforeItWrites) {
    ScreeningArrays arrays(3, 9);
    arrays.record(0).levels = nullptr;
    EXPECT_EQ(reisti::copyFromArrayToDesign(kNumbers, 4, arrays.design), des_ErrorNullLevels);
    EXPECT_EQ(arrays.differenceFromUntouched(), "");
}

struct Walk {
    const char* name;
    std::uint32_t numFactors;
    std::vector<std::uint32_t> list;
    std::optional<std::uint32_t> centreRow;
};

class SingleContinuousFactor : public testing::TestWithParam<Walk> {};

TEST_P(SingleContinuousFactor, WalkInListOrderMarksItsRowAsCentre) {
    const Walk& walk = GetParam();
    ScreeningArrays arrays(Request{walk.numFactors, walk.list});
    ASSERT_EQ(reisti::fillInitialDesign(arrays.design), des_Success);
    std::optional<std::uint32_t> marked;
    for (std::uint32_t i = 0; i < reisti::baseOrder(walk.numFactors); ++i) {
        if (arrays.run(2 * i).pointType != des_ScreeningPointCenter) continue;
        EXPECT_FALSE(marked.has_value()) << "two rows are marked";
        marked = i;
    }
    EXPECT_EQ(marked, walk.centreRow);
}

INSTANTIATE_TEST_SUITE_P(
    , SingleContinuousFactor,
    testing::Values(Walk{"Between", 3, {0, 2}, 1}, Walk{"BeforeAll", 3, {1, 2}, 0}, Walk{"BehindAll", 3, {0, 1}, 2},
                    Walk{"DescendingList", 3, {2, 0}, 0}, Walk{"ListOfOneFirst", 2, {0}, 1},
                    Walk{"ListOfOneSecond", 2, {1}, 0}, Walk{"SwappedPairStopsAtOnce", 4, {1, 0, 2}, 0},
                    Walk{"SwappedLaterPairStopsThere", 5, {0, 1, 4, 2}, 2}, Walk{"RepeatedFirst", 3, {0, 0}, 2},
                    Walk{"RepeatedLast", 3, {2, 2}, 0}, Walk{"IndexBehindTheFactors", 3, {0, 9}, 1},
                    Walk{"LargestIndexFirst", 3, {4294967295U, 0}, 0}, Walk{"TwoContinuousHaveNone", 4, {0, 2}, {}},
                    Walk{"AllCategoricalHaveNone", 3, {0, 1, 2}, {}}, Walk{"NoneCategoricalHasNone", 3, {}, {}}),
    [](const testing::TestParamInfo<Walk>& param) { return std::string(param.param.name); });

TEST(AddTrueCenterpoint, WritesOneRunOfZeros) {
    ScreeningArrays arrays(Request{5});
    reisti::addTrueCenterpoint(arrays.design);
    Runs expected(13);
    expected[12] = PlainRun{13, 1, 0, {0, 0, 0, 0, 0}};
    EXPECT_EQ(arrays.differenceFrom(expected), "");
}

/// Even runs that no design has: the fold-over copies whatever it finds.
void writeArbitraryEvenRuns(ScreeningArrays& arrays, std::size_t count) {
    for (std::size_t i = 0; i < count; ++i) {
        des_DefinitiveScreeningRun& run = arrays.record(2 * i);
        const auto number = static_cast<std::uint32_t>(i);
        run.runOrder = 100 + 7 * number;
        run.block = 3 + number;
        run.pointType = 5 + number;
        run.levels[0] = static_cast<std::int32_t>(number) - 2;
        run.levels[1] = 0;
    }
}

Runs arbitraryPairs(std::size_t even, std::size_t pairs) {
    Runs expected(2 * even);
    for (std::size_t i = 0; i < even; ++i) {
        const auto number = static_cast<std::uint32_t>(i);
        const std::int32_t level = static_cast<std::int32_t>(number) - 2;
        expected[2 * i] = PlainRun{100 + 7 * number, 3 + number, 5 + number, {level, 0}};
        if (i < pairs) expected[2 * i + 1] = PlainRun{101 + 7 * number, 3 + number, 5 + number, {-level, 0}};
    }
    return expected;
}

TEST(AddFlippedRows, NegatesEveryEvenRunAndTheCentre) {
    ScreeningArrays arrays(Request{2, {0}});
    writeArbitraryEvenRuns(arrays, 7);
    reisti::addFlippedRows(arrays.design, false);
    EXPECT_EQ(arrays.differenceFrom(arbitraryPairs(7, 7)), "");
}

TEST(AddFlippedRows, WithoutCentreLeavesTheRunBehindTheCentreAlone) {
    ScreeningArrays arrays(Request{2, {0}});
    writeArbitraryEvenRuns(arrays, 7);
    reisti::addFlippedRows(arrays.design, true);
    EXPECT_EQ(arrays.differenceFrom(arbitraryPairs(7, 6)), "");
}

/// The base runs of 6 factors, written by hand, and room for the replicates.
void writeBaseRuns(ScreeningArrays& arrays) {
    const Runs base = reisti::test::plain::create({6}).runs;
    for (std::size_t i = 0; i < base.size(); ++i) {
        des_DefinitiveScreeningRun& run = arrays.record(i);
        run.runOrder = base[i]->runOrder;
        run.block = base[i]->block;
        run.pointType = base[i]->pointType;
        std::copy(base[i]->levels.begin(), base[i]->levels.end(), run.levels);
    }
}

TEST(AddReplicates, CopiesTheBaseRunsBlockByBlock) {
    for (const std::uint32_t numBlocks : {0U, 1U, 2U, 3U, 4U, 6U, 12U}) {
        const Request request{6, {}, 12, numBlocks};
        ScreeningArrays arrays(request);
        writeBaseRuns(arrays);
        EXPECT_EQ(reisti::addReplicates(arrays.design), des_Success) << numBlocks;
        EXPECT_EQ(arrays.differenceFrom(reisti::test::plain::create(request).runs), "") << numBlocks;
    }
}

TEST(AddReplicates, RefusesBlocksThatDoNotDivide) {
    for (const std::uint32_t numBlocks : {5U, 7U, 8U, 9U, 10U, 11U, 13U, 24U, 4294967295U}) {
        ScreeningArrays arrays(Request{6, {}, 12, numBlocks});
        EXPECT_EQ(reisti::addReplicates(arrays.design), des_ErrorBlocks) << numBlocks;
        EXPECT_EQ(arrays.differenceFromUntouched(), "") << numBlocks;
    }
}

TEST(AddReplicates, OneCopyNeedsNothing) {
    for (const std::uint32_t replicates : {0U, 1U}) {
        ScreeningArrays arrays(Request{6, {}, replicates, 5});
        EXPECT_EQ(reisti::addReplicates(arrays.design), des_Success);
        EXPECT_EQ(arrays.differenceFromUntouched(), "");
    }
}

TEST(AddReplicates, RefusesMoreRunsThanThirtyTwoBitsCount) {
    ScreeningArrays arrays(Request{48});
    arrays.design.replicates = 44278014;
    EXPECT_EQ(reisti::addReplicates(arrays.design), des_ErrorTooManyReplicates);
    EXPECT_EQ(arrays.differenceFromUntouched(), "");
}

TEST(AddReplicates, CountsTheSecondCentreRunOfCategoricalDesigns) {
    ScreeningArrays arrays(Request{48, {0}});
    arrays.design.replicates = 43826197;
    EXPECT_EQ(reisti::addReplicates(arrays.design), des_ErrorTooManyReplicates);
}

TEST(AddReplicates, TestsTheCountBeforeTheBlocks) {
    ScreeningArrays arrays(Request{48});
    arrays.design.replicates = std::numeric_limits<std::uint32_t>::max();
    arrays.design.numBlocks = 2;
    EXPECT_EQ(reisti::addReplicates(arrays.design), des_ErrorTooManyReplicates);
}

TEST(CreateDesign, IsTheWholeConstruction) {
    const Request request{10, {9, 1, 4, 6, 2, 0, 8}, 6, 3};
    ScreeningArrays arrays(request);
    EXPECT_EQ(reisti::createDesign(arrays.design), des_Success);
    EXPECT_EQ(arrays.differenceFrom(reisti::test::plain::create(request).runs), "");
}

}  // namespace
