#include "dsd/run_order.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <numeric>
#include <random>
#include <vector>

#include "ruv/ruv.h"
#include "support/plain_run_order.h"
#include "support/scale.h"
#include "support/screening_arrays.h"

namespace {

using reisti::test::scaled;
using reisti::test::ScreeningArrays;
using reisti::test::plain::countRunsPerBlock;
using reisti::test::plain::randomizedRunOrders;
using reisti::test::plain::Request;
using Numbers = std::vector<std::uint32_t>;

Numbers assign(const Numbers& blocks, const Numbers& runsPerBlock, const std::vector<double>& keys) {
    std::vector<des_DefinitiveScreeningRun> runs;
    for (const std::uint32_t block : blocks) {
        runs.push_back({4711, block, 2, nullptr});
    }
    reisti::assignRunOrders(runs.data(), static_cast<std::uint32_t>(runs.size()), runsPerBlock, keys);
    Numbers orders;
    for (std::size_t i = 0; i < runs.size(); ++i) {
        EXPECT_EQ(runs[i].block, blocks[i]) << "the block of run " << i << " was changed";
        EXPECT_EQ(runs[i].pointType, 2U) << "the type of run " << i << " was changed";
        orders.push_back(runs[i].runOrder);
    }
    return orders;
}

bool isPermutation(Numbers orders) {
    std::sort(orders.begin(), orders.end());
    Numbers all(orders.size());
    std::iota(all.begin(), all.end(), 1U);
    return orders == all;
}

TEST(AssignRunOrders, RunGetsTheIndexOfTheSmallestKeyLeft) {
    // Keys of ranks 1..4 ascend as rank 3, 1, 4, 2.
    EXPECT_EQ(assign({1, 1, 1, 1}, {4}, {0.5, 0.2, 0.9, 0.1, 0.4}), (Numbers{3, 1, 4, 2}));
}

TEST(AssignRunOrders, BlockWithTheSmallerKeyComesFirst) {
    EXPECT_EQ(assign({1, 1, 2, 2}, {2, 2}, {0.9, 0.1, 0.2, 0.3, 0.1, 0.2}), (Numbers{3, 4, 1, 2}));
    EXPECT_EQ(assign({1, 1, 2, 2}, {2, 2}, {0.1, 0.1, 0.2, 0.3, 0.1, 0.2}), (Numbers{1, 2, 3, 4}));
}

TEST(AssignRunOrders, KeysAreTakenBlockByBlockEvenWhenRunsAlternate) {
    EXPECT_EQ(assign({2, 1, 2, 1, 1}, {3, 2}, {0.8, 0.3, 0.2, 0.1, 0.4, 0.6, 0.5}), (Numbers{2, 5, 1, 4, 3}));
}

TEST(AssignRunOrders, BlockThatNoRunCarriesTakesAKeyOfItsOwn) {
    EXPECT_EQ(assign({1, 3, 3, 1}, {2, 0, 2}, {0.7, 0.1, 0.2, 0.05, 0.5, 0.9, 0.8}), (Numbers{3, 2, 1, 4}));
}

TEST(AssignRunOrders, RepeatedKeyInABlockLeavesTheFirstAndFillsTheSmallestRankLeft) {
    // Rank 2 repeats the key of rank 1 and is lost; the run that finds no key left takes it.
    EXPECT_EQ(assign({1, 1, 1, 1}, {4}, {0.5, 0.3, 0.3, 0.1, 0.2}), (Numbers{3, 4, 1, 2}));
}

TEST(AssignRunOrders, AllKeysEqualInABlockGiveRanksInSequence) {
    EXPECT_EQ(assign({1, 1, 1, 1}, {4}, {0.5, 0.3, 0.3, 0.3, 0.3}), (Numbers{1, 2, 3, 4}));
}

TEST(AssignRunOrders, SeveralLostRanksAreHandedOutAscending) {
    // Ranks 2 and 5 are lost; the ranks in key order are 4, 3, 1, then 2, 5.
    EXPECT_EQ(assign({1, 1, 1, 1, 1}, {5}, {0.5, 0.9, 0.9, 0.4, 0.2, 0.2}), (Numbers{4, 3, 1, 2, 5}));
}

TEST(AssignRunOrders, BlockWhoseKeyIsRepeatedComesLast) {
    // Block 2 repeats the key of block 1 and goes behind block 3, although its key is smaller.
    EXPECT_EQ(assign({1, 2, 3}, {1, 1, 1}, {0.2, 0.5, 0.2, 0.5, 0.9, 0.5}), (Numbers{1, 3, 2}));
}

TEST(AssignRunOrders, SeveralLostBlocksComeByAscendingNumber) {
    EXPECT_EQ(assign({1, 2, 3, 4, 5}, {1, 1, 1, 1, 1}, {0.7, 0.5, 0.7, 0.5, 0.1, 0.5, 0.1, 0.5, 0.7, 0.5}),
              (Numbers{2, 3, 1, 4, 5}));
}

TEST(AssignRunOrders, AllBlockKeysEqualKeepTheBlocksInSequence) {
    EXPECT_EQ(assign({1, 1, 2, 3, 3}, {2, 1, 2}, {0.5, 0.2, 0.1, 0.5, 0.3, 0.5, 0.6, 0.4}), (Numbers{2, 1, 3, 5, 4}));
}

TEST(AssignRunOrders, NoRunsNeedNoKeys) {
    EXPECT_EQ(assign({}, {}, {}), Numbers{});
}

std::uint32_t below(std::mt19937& engine, std::uint32_t limit) {
    return static_cast<std::uint32_t>(engine() % limit);
}

/// Runs in random blocks, where some numbers may be left out, and keys drawn from `distinctKeys` values.
void compareWithPlain(std::mt19937& engine, std::uint32_t mostRuns, std::uint32_t mostBlocks,
                      std::uint32_t distinctKeys) {
    Numbers blocks;
    const std::uint32_t total = below(engine, mostRuns + 1);
    const std::uint32_t numBlocks = 1 + below(engine, mostBlocks);
    for (std::uint32_t i = 0; i < total; ++i) {
        blocks.push_back(1 + below(engine, numBlocks));
    }
    const Numbers runsPerBlock = countRunsPerBlock(blocks);
    std::vector<double> keys;
    for (std::size_t i = 0; i < runsPerBlock.size() + blocks.size(); ++i) {
        keys.push_back(static_cast<double>(below(engine, distinctKeys)) / distinctKeys);
    }
    const Numbers orders = assign(blocks, runsPerBlock, keys);
    ASSERT_EQ(orders, randomizedRunOrders(blocks, runsPerBlock, keys));
    ASSERT_TRUE(isPermutation(orders));
}

TEST(AssignRunOrders, EqualsTheMapsForKeysThatHardlyRepeat) {
    std::mt19937 engine(7);
    for (int i = 0; i < scaled(2000) && !testing::Test::HasFailure(); ++i) {
        compareWithPlain(engine, 200, 8, 1U << 30);
    }
}

TEST(AssignRunOrders, EqualsTheMapsForKeysThatRepeatOften) {
    std::mt19937 engine(8);
    for (int i = 0; i < scaled(6000) && !testing::Test::HasFailure(); ++i) {
        compareWithPlain(engine, 40, 12, 1 + below(engine, 30));
    }
}

TEST(AssignRunOrders, EqualsTheMapsForManyBlocks) {
    std::mt19937 engine(9);
    for (int i = 0; i < scaled(400) && !testing::Test::HasFailure(); ++i) {
        compareWithPlain(engine, 300, 300, 1U << 30);
    }
}

TEST(AssignRunOrders, EqualsTheMapsForManyRuns) {
    std::mt19937 engine(10);
    for (int i = 0; i < scaled(20) && !testing::Test::HasFailure(); ++i) {
        compareWithPlain(engine, 30000, 3, i % 2 == 0 ? 1U << 30 : 20000);
    }
}

/// Lets the runs carry other blocks than a construction gives them.
void setBlocks(ScreeningArrays& arrays, const Numbers& blocks) {
    for (std::size_t i = 0; i < arrays.numRuns(); ++i) {
        arrays.record(i).block = blocks[i];
        arrays.record(i).runOrder = static_cast<std::uint32_t>(i + 1);
    }
}

std::vector<double> samplerNumbers(std::size_t count, double seed) {
    std::vector<double> numbers(count);
    std::int32_t status = -1;
    ruv_ISampler* sampler = ruv_MakeISampler(&status, ruv_KindMersenneTwister64, seed);
    ruv_GetUniformSample(sampler, numbers.data(), static_cast<std::uint32_t>(count), 0.0, 1.0);
    ruv_DeleteISampler(&sampler);
    return numbers;
}

TEST(RandomizeDesign, DrawsOneKeyForEachBlockAndRun) {
    Numbers blocks(26, 1);
    std::fill(blocks.begin() + 13, blocks.end(), 2);
    ScreeningArrays arrays(Request{6, {}, 2, 2});
    setBlocks(arrays, blocks);
    arrays.randomized(99.25);
    reisti::randomizeDesign(arrays.design);
    EXPECT_EQ(arrays.runOrders(), randomizedRunOrders(blocks, {13, 13}, samplerNumbers(28, 99.25)));
}

TEST(RandomizeDesign, CountsABlockThatNoRunCarries) {
    Numbers blocks(26, 1);
    std::fill(blocks.begin() + 13, blocks.end(), 3);
    ScreeningArrays arrays(Request{6, {}, 2, 2});
    setBlocks(arrays, blocks);
    arrays.randomized(-4.0);
    reisti::randomizeDesign(arrays.design);
    EXPECT_EQ(arrays.runOrders(), randomizedRunOrders(blocks, {13, 0, 13}, samplerNumbers(29, -4.0)));
}

TEST(RandomizeDesign, BlocksMayLieInAnyOrder) {
    Numbers blocks;
    for (std::uint32_t i = 0; i < 28; ++i) {
        blocks.push_back(1 + (i * 5 + 2) % 4);
    }
    ScreeningArrays arrays(Request{6, {0}, 2, 2});
    setBlocks(arrays, blocks);
    arrays.randomized(0.125);
    reisti::randomizeDesign(arrays.design);
    EXPECT_EQ(arrays.runOrders(), randomizedRunOrders(blocks, countRunsPerBlock(blocks), samplerNumbers(32, 0.125)));
}

TEST(RandomizeDesign, WithoutTheFlagChangesNothing) {
    ScreeningArrays arrays(Request{6});
    arrays.randomized(1.0).design.randomize = 0;
    reisti::randomizeDesign(arrays.design);
    EXPECT_EQ(arrays.differenceFromUntouched(), "");
}

TEST(RandomizeDesign, NoReplicatesChangeNothing) {
    ScreeningArrays arrays(Request{6, {}, 0, 1});
    arrays.randomized(1.0);
    reisti::randomizeDesign(arrays.design);
    EXPECT_EQ(arrays.differenceFromUntouched(), "");
}

}  // namespace
