// What a host gets from the create function, case by case.
#include <algorithm>
#include <cmath>
#include <cstdint>
#include <gtest/gtest.h>
#include <limits>
#include <numeric>
#include <vector>

#include "reisti/reisti.h"
#include "support/screening_arrays.h"

namespace {

using reisti::test::ScreeningArrays;
using reisti::test::plain::PlainRun;
using reisti::test::plain::Request;
using Levels = std::vector<std::int32_t>;

bool isPermutation(std::vector<std::uint32_t> orders) {
    std::sort(orders.begin(), orders.end());
    std::vector<std::uint32_t> all(orders.size());
    std::iota(all.begin(), all.end(), 1U);
    return orders == all;
}

TEST(SixFactors, FirstRunIsTheFirstRowOfTheMatrix) {
    ScreeningArrays arrays(Request{6});
    ASSERT_EQ(arrays.create(), des_Success);
    EXPECT_EQ(arrays.run(0), (PlainRun{1, 1, des_ScreeningPointOneZero, {0, 1, 1, 1, 1, 1}}));
}

TEST(SixFactors, SecondRunIsItsNegation) {
    ScreeningArrays arrays(Request{6});
    ASSERT_EQ(arrays.create(), des_Success);
    EXPECT_EQ(arrays.run(1), (PlainRun{2, 1, des_ScreeningPointOneZero, {0, -1, -1, -1, -1, -1}}));
}

TEST(SixFactors, LastRunIsTheCentre) {
    ScreeningArrays arrays(Request{6});
    ASSERT_EQ(arrays.create(), des_Success);
    EXPECT_EQ(arrays.run(12), (PlainRun{13, 1, des_ScreeningPointCenter, {0, 0, 0, 0, 0, 0}}));
}

TEST(FiveFactors, RowWhoseZeroLiesInADroppedColumnHasNoZero) {
    ScreeningArrays arrays(Request{5});
    ASSERT_EQ(arrays.create(), des_Success);
    EXPECT_EQ(arrays.run(10), (PlainRun{11, 1, des_ScreeningPointNoZero, {1, 1, -1, -1, 1}}));
}

TEST(FiveFactors, NothingBehindTheRunsAndLevelsIsWritten) {
    ScreeningArrays arrays(Request{5});
    ASSERT_EQ(arrays.create(), des_Success);
    EXPECT_EQ(arrays.differenceFrom(reisti::test::plain::create({5}).runs), "");
}

TEST(OneCategoricalFactor, TakesTheNegativeSignInItsRow) {
    for (const std::uint32_t column : {0U, 1U, 3U, 5U}) {
        ScreeningArrays arrays(Request{6, {column}});
        ASSERT_EQ(arrays.create(), des_Success);
        EXPECT_EQ(arrays.level(2 * column, column), -1) << column;
        EXPECT_EQ(arrays.run(2 * column).pointType, std::uint32_t{des_ScreeningPointNoZero}) << column;
        EXPECT_EQ(arrays.level(2 * column + 1, column), 1) << column;
    }
}

TEST(OneCategoricalFactor, IsNegativeInTheCentreRunAndPositiveInItsFoldOver) {
    ScreeningArrays arrays(Request{6, {3}});
    ASSERT_EQ(arrays.create(), des_Success);
    EXPECT_EQ(arrays.run(12), (PlainRun{13, 1, des_ScreeningPointCenter, {0, 0, 0, -1, 0, 0}}));
    EXPECT_EQ(arrays.run(13), (PlainRun{14, 1, des_ScreeningPointCenter, {0, 0, 0, 1, 0, 0}}));
}

TEST(AllFactorsCategorical, CentreRunsHoldNoZero) {
    for (std::uint32_t n = 2; n <= 48; ++n) {
        Request request{n};
        request.categorical.resize(n);
        std::iota(request.categorical.begin(), request.categorical.end(), 0U);
        ScreeningArrays arrays(request);
        ASSERT_EQ(arrays.create(), des_Success);
        for (const std::size_t i : {arrays.numRuns() - 2, arrays.numRuns() - 1}) {
            const PlainRun centre = arrays.run(i);
            EXPECT_EQ(centre.pointType, std::uint32_t{des_ScreeningPointNoZero}) << n;
            EXPECT_EQ(std::count(centre.levels.begin(), centre.levels.end(), 0), 0) << n;
        }
    }
}

TEST(OneContinuousFactor, ItsRowIsACentreRun) {
    ScreeningArrays arrays(Request{3, {0, 2}});
    ASSERT_EQ(arrays.create(), des_Success);
    EXPECT_EQ(arrays.run(2).pointType, std::uint32_t{des_ScreeningPointCenter});
    EXPECT_EQ(arrays.run(3).pointType, std::uint32_t{des_ScreeningPointCenter});
}

TEST(OneContinuousFactor, DescendingListLeavesItsRowAOneZeroRun) {
    // The walk stops at factor 0, whose row gets the type of a categorical factor afterwards.
    ScreeningArrays arrays(Request{3, {2, 0}});
    ASSERT_EQ(arrays.create(), des_Success);
    EXPECT_EQ(arrays.run(0).pointType, std::uint32_t{des_ScreeningPointNoZero});
    EXPECT_EQ(arrays.run(2).pointType, std::uint32_t{des_ScreeningPointOneZero});
}

TEST(OneContinuousFactor, BehindAllCategoricalOnesIsFoundToo) {
    ScreeningArrays arrays(Request{6, {0, 1, 2, 3, 4}});
    ASSERT_EQ(arrays.create(), des_Success);
    EXPECT_EQ(arrays.run(10).pointType, std::uint32_t{des_ScreeningPointCenter});
}

TEST(OneContinuousFactor, RepeatedEntriesCountAsTheyStand) {
    // By count one of three factors is left; the walk goes past both entries, to column 2.
    const Request request{3, {0, 0}};
    ScreeningArrays arrays(request);
    ASSERT_EQ(arrays.create(), des_Success);
    EXPECT_EQ(arrays.run(0).pointType, std::uint32_t{des_ScreeningPointNoZero});
    EXPECT_EQ(arrays.run(2).pointType, std::uint32_t{des_ScreeningPointOneZero});
    EXPECT_EQ(arrays.run(4).pointType, std::uint32_t{des_ScreeningPointCenter});
    EXPECT_EQ(arrays.differenceFrom(reisti::test::plain::create(request).runs), "");
}

std::vector<std::uint32_t> blockOfEachReplicate(std::uint32_t replicates, std::uint32_t numBlocks) {
    ScreeningArrays arrays(Request{6, {}, replicates, numBlocks});
    EXPECT_EQ(arrays.create(), des_Success);
    std::vector<std::uint32_t> blocks;
    for (std::size_t r = 0; r < replicates; ++r) {
        const std::vector<std::uint32_t> all = arrays.blocks();
        const auto first = all.begin() + static_cast<std::ptrdiff_t>(r * 13);
        EXPECT_EQ(std::count(first, first + 13, *first), 13) << "replicate " << r << " lies in several blocks";
        blocks.push_back(*first);
    }
    return blocks;
}

TEST(Blocks, HoldConsecutiveReplicates) {
    EXPECT_EQ(blockOfEachReplicate(4, 2), (std::vector<std::uint32_t>{1, 1, 2, 2}));
}

TEST(Blocks, AsManyAsReplicatesHoldOneEach) {
    EXPECT_EQ(blockOfEachReplicate(4, 4), (std::vector<std::uint32_t>{1, 2, 3, 4}));
}

TEST(Blocks, ZeroBlocksPutEveryRunIntoTheFirst) {
    EXPECT_EQ(blockOfEachReplicate(3, 0), (std::vector<std::uint32_t>{1, 1, 1}));
}

TEST(Blocks, OneBlockHoldsEveryRun) {
    EXPECT_EQ(blockOfEachReplicate(3, 1), (std::vector<std::uint32_t>{1, 1, 1}));
}

TEST(Blocks, AreNotLookedAtForOneReplicate) {
    for (const std::uint32_t replicates : {0U, 1U}) {
        for (const std::uint32_t numBlocks : {0U, 1U, 2U, 7U, std::numeric_limits<std::uint32_t>::max()}) {
            ScreeningArrays arrays(Request{6, {}, replicates, numBlocks});
            EXPECT_EQ(arrays.create(), des_Success);
            EXPECT_EQ(arrays.blocks(), std::vector<std::uint32_t>(13, 1)) << replicates << ' ' << numBlocks;
        }
    }
}

TEST(Replicates, NoneWriteOneCopy) {
    ScreeningArrays arrays(Request{6, {}, 0, 1});
    ASSERT_EQ(arrays.create(), des_Success);
    EXPECT_EQ(arrays.differenceFrom(reisti::test::plain::create({6}).runs), "");
}

TEST(Replicates, CopyLevelsIntoTheirOwnArrays) {
    ScreeningArrays arrays(Request{6, {1, 4}, 3, 3});
    ASSERT_EQ(arrays.create(), des_Success);
    for (std::size_t i = 14; i < 42; ++i) {
        EXPECT_EQ(arrays.run(i).levels, arrays.run(i % 14).levels) << i;
        EXPECT_NE(arrays.record(i).levels, arrays.record(i % 14).levels) << i;
    }
}

TEST(RandomizeFlag, ZeroKeepsTheStandardOrder) {
    ScreeningArrays arrays(Request{6, {}, 4, 2});
    arrays.randomized(1.0);
    arrays.design.randomize = 0;
    ASSERT_EQ(arrays.create(), des_Success);
    std::vector<std::uint32_t> standard(52);
    std::iota(standard.begin(), standard.end(), 1U);
    EXPECT_EQ(arrays.runOrders(), standard);
}

TEST(RandomizeFlag, AnyNonzeroByteRandomizes) {
    ScreeningArrays reference(Request{6, {}, 4, 2});
    ASSERT_EQ(reference.randomized(1.0).create(), des_Success);
    for (const std::uint8_t flag : {std::uint8_t{2}, std::uint8_t{128}, std::uint8_t{255}}) {
        ScreeningArrays arrays(Request{6, {}, 4, 2});
        arrays.randomized(1.0).design.randomize = flag;
        ASSERT_EQ(arrays.create(), des_Success);
        EXPECT_EQ(arrays.runOrders(), reference.runOrders()) << int{flag};
    }
}

TEST(RandomizedDesign, RunOrdersAreAPermutation) {
    ScreeningArrays arrays(Request{6});
    ASSERT_EQ(arrays.randomized(12345.0).create(), des_Success);
    EXPECT_TRUE(isPermutation(arrays.runOrders()));
}

TEST(RandomizedDesign, ChangesRunOrdersAlone) {
    const Request request{11, {0, 7, 3}, 4, 2};
    ScreeningArrays arrays(request);
    ASSERT_EQ(arrays.randomized(12345.0).create(), des_Success);
    auto expected = reisti::test::plain::create(request).runs;
    for (std::size_t i = 0; i < expected.size(); ++i) {
        expected[i]->runOrder = arrays.record(i).runOrder;
    }
    EXPECT_EQ(arrays.differenceFrom(expected), "");
}

TEST(RandomizedDesign, IsNotInStandardOrder) {
    ScreeningArrays arrays(Request{24});
    ASSERT_EQ(arrays.randomized(12345.0).create(), des_Success);
    const std::vector<std::uint32_t> orders = arrays.runOrders();
    EXPECT_FALSE(std::is_sorted(orders.begin(), orders.end()));
}

std::vector<std::uint32_t> randomizedOrders(double seed) {
    ScreeningArrays arrays(Request{24, {}, 2, 2});
    EXPECT_EQ(arrays.randomized(seed).create(), des_Success);
    return arrays.runOrders();
}

TEST(RandomizedDesign, SameSeedGivesTheSameOrder) {
    for (const double seed : {1.0, -1.0, 0.5, 1e300, 5e-324, std::numeric_limits<double>::infinity()}) {
        EXPECT_EQ(randomizedOrders(seed), randomizedOrders(seed)) << seed;
    }
}

TEST(RandomizedDesign, DifferentSeedsGiveDifferentOrders) {
    EXPECT_NE(randomizedOrders(1.0), randomizedOrders(2.0));
    EXPECT_NE(randomizedOrders(1.0), randomizedOrders(-1.0));
    EXPECT_NE(randomizedOrders(1.0), randomizedOrders(std::nextafter(1.0, 2.0)));
}

TEST(RandomizedDesign, NotANumberIsASeedLikeAnyOther) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    EXPECT_TRUE(isPermutation(randomizedOrders(nan)));
    EXPECT_EQ(randomizedOrders(nan), randomizedOrders(nan));
}

// Two orders of 98 runs agree by chance with a probability of one in 49!.
TEST(RandomizedDesign, SeedZeroGivesAFreshOrderEachTime) {
    EXPECT_NE(randomizedOrders(0.0), randomizedOrders(0.0));
}

TEST(RandomizedDesign, SeedNegativeZeroGivesAFreshOrderEachTime) {
    EXPECT_NE(randomizedOrders(-0.0), randomizedOrders(-0.0));
}

TEST(RandomizedDesign, NoReplicatesKeepTheStandardOrder) {
    // The order of 0 replicates' runs is drawn: none of the one copy written.
    ScreeningArrays arrays(Request{6, {}, 0, 1});
    ASSERT_EQ(arrays.randomized(7.0).create(), des_Success);
    EXPECT_EQ(arrays.differenceFrom(reisti::test::plain::create({6}).runs), "");
}

TEST(RandomizedDesign, BlocksOccupyConsecutiveRanges) {
    for (const double seed : {1.0, 2.0, 3.0, 4.0, 5.0, 6.0, 7.0, 8.0}) {
        ScreeningArrays arrays(Request{6, {}, 2, 2});
        ASSERT_EQ(arrays.randomized(seed).create(), des_Success);
        const std::vector<std::uint32_t> orders = arrays.runOrders();
        const bool firstBlockFirst = *std::max_element(orders.begin(), orders.begin() + 13) == 13;
        const bool secondBlockFirst = *std::max_element(orders.begin() + 13, orders.end()) == 13;
        EXPECT_TRUE(isPermutation(orders));
        EXPECT_NE(firstBlockFirst, secondBlockFirst) << seed;
    }
}

TEST(RandomizedDesign, EitherBlockComesFirstForSomeSeed) {
    bool firstBlockFirst = false;
    bool secondBlockFirst = false;
    for (int seed = 1; seed <= 60; ++seed) {
        ScreeningArrays arrays(Request{6, {}, 2, 2});
        ASSERT_EQ(arrays.randomized(seed).create(), des_Success);
        (arrays.record(0).runOrder <= 13 ? firstBlockFirst : secondBlockFirst) = true;
    }
    EXPECT_TRUE(firstBlockFirst);
    EXPECT_TRUE(secondBlockFirst);
}

TEST(RandomizedDesign, EveryRunComesFirstForSomeSeed) {
    // 600 seeds miss a given run with a probability of (12/13)^600 < 1e-20.
    std::vector<bool> cameFirst(13, false);
    for (int seed = 1; seed <= 600; ++seed) {
        ScreeningArrays arrays(Request{6});
        ASSERT_EQ(arrays.randomized(seed).create(), des_Success);
        const std::vector<std::uint32_t> orders = arrays.runOrders();
        cameFirst[static_cast<std::size_t>(std::find(orders.begin(), orders.end(), 1U) - orders.begin())] = true;
    }
    EXPECT_EQ(std::count(cameFirst.begin(), cameFirst.end(), true), 13);
}

}  // namespace
