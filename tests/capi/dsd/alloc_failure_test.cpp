// Exhausted memory at every allocation of a call, one after the other.
#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <new>
#include <numeric>
#include <optional>
#include <string>
#include <vector>

#include "random/random_numbers.h"
#include "reisti/reisti.h"
#include "support/failing_new.h"
#include "support/screening_arrays.h"

namespace {

using reisti::test::AllocationCounts;
using reisti::test::AllocationWatch;
using reisti::test::completeBaseRuns;
using reisti::test::evenBaseRuns;
using reisti::test::ScreeningArrays;
using reisti::test::plain::Request;

/// Far more than any of the calls makes; reaching it means that a call never succeeds.
constexpr std::size_t kMostAllocations = 100000;

using Runs = std::vector<std::optional<reisti::test::plain::PlainRun>>;
using Change = std::function<void(ScreeningArrays&)>;

struct Outcome {
    std::int32_t code;
    AllocationCounts counts;
};

Outcome createFailing(ScreeningArrays& arrays, std::size_t failNth) {
    AllocationWatch watch(failNth);
    const std::int32_t code = des_CreateDefinitiveScreeningDesign(&arrays.design);
    watch.stop();
    return {code, watch.counts()};
}

std::vector<std::uint32_t> firstFactors(std::uint32_t count) {
    std::vector<std::uint32_t> list(count);
    std::iota(list.begin(), list.end(), 0U);
    return list;
}

Runs written(const ScreeningArrays& arrays) {
    Runs runs;
    for (std::size_t i = 0; i < arrays.numRuns(); ++i) {
        runs.emplace_back(arrays.run(i));
    }
    return runs;
}

TEST(ScreeningMemory, PlainDesignAllocatesNothing) {
    ScreeningArrays arrays(Request{48, {}, 10, 5});
    const Outcome outcome = createFailing(arrays, AllocationWatch::kNeverFail);
    EXPECT_EQ(outcome.code, des_Success);
    EXPECT_EQ(outcome.counts.attempts, 0U);
}

/// Fails each allocation of the create function in turn. Every failure has to leave the runs of `afterFailure`.
/// Returns how many allocations there were to fail.
std::size_t failEachAllocation(const Request& request, const Change& change, const Runs& afterFailure,
                               const Runs& afterSuccess) {
    for (std::size_t n = 1; n < kMostAllocations; ++n) {
        ScreeningArrays arrays(request);
        change(arrays);
        const Outcome outcome = createFailing(arrays, n);
        EXPECT_EQ(outcome.counts.liveBlocks, 0) << "allocation " << n;
        if (!outcome.counts.failed) {
            EXPECT_EQ(outcome.code, des_Success);
            EXPECT_EQ(arrays.differenceFrom(afterSuccess), "");
            return n - 1;
        }
        EXPECT_EQ(outcome.code, des_ErrorOutOfMemory) << "allocation " << n;
        EXPECT_EQ(arrays.differenceFrom(afterFailure), "") << "allocation " << n;
    }
    ADD_FAILURE() << "the call never succeeds";
    return kMostAllocations;
}

class SignChoiceMemory : public testing::TestWithParam<Request> {};

TEST_P(SignChoiceMemory, FailureLeavesTheEvenBaseRuns) {
    const Request& request = GetParam();
    failEachAllocation(
        request, [](ScreeningArrays&) {}, evenBaseRuns(request), reisti::test::plain::create(request).runs);
}

// The signs of the first factors of order 42 are found by the fallback search, those of order 48 by propagation.
INSTANTIATE_TEST_SUITE_P(, SignChoiceMemory,
                         testing::Values(Request{42, firstFactors(1)}, Request{42, firstFactors(24)},
                                         Request{42, firstFactors(41)}, Request{42, firstFactors(42)},
                                         Request{48, firstFactors(1)}, Request{48, firstFactors(24)},
                                         Request{48, firstFactors(47)}, Request{48, firstFactors(48)}),
                         [](const testing::TestParamInfo<Request>& param) {
                             return std::to_string(param.param.categorical.size()) + "Of" +
                                    std::to_string(param.param.numFactors);
                         });

TEST(ScreeningMemory, FailedRandomizationLeavesTheWholeDesignInStandardOrder) {
    const Request request{21, {}, 6, 3};
    ScreeningArrays reference(request);
    ASSERT_EQ(reference.randomized(3.0).create(), des_Success);
    const std::size_t failures = failEachAllocation(
        request, [](ScreeningArrays& arrays) { arrays.randomized(3.0); }, reisti::test::plain::create(request).runs,
        written(reference));
    EXPECT_GT(failures, 0U) << "randomization is expected to draw its numbers into memory of its own";
}

TEST(ScreeningMemory, FailedRandomizedCategoricalDesignIsLeftAtOneOfItsTwoStages) {
    const Request request{16, {15, 3, 4, 0, 9, 12}, 4, 2};
    ScreeningArrays reference(request);
    ASSERT_EQ(reference.randomized(3.0).create(), des_Success);
    bool succeeded = false;
    bool signsChosen = false;
    for (std::size_t n = 1; n < kMostAllocations && !succeeded; ++n) {
        ScreeningArrays arrays(request);
        const Outcome outcome = createFailing(arrays.randomized(3.0), n);
        ASSERT_EQ(outcome.counts.liveBlocks, 0) << "allocation " << n;
        if (!outcome.counts.failed) {
            EXPECT_EQ(outcome.code, des_Success);
            EXPECT_EQ(arrays.differenceFrom(written(reference)), "");
            succeeded = true;
            continue;
        }
        ASSERT_EQ(outcome.code, des_ErrorOutOfMemory) << "allocation " << n;
        const bool evenRunsOnly = arrays.differenceFrom(evenBaseRuns(request)).empty();
        const bool standardOrder = arrays.differenceFrom(reisti::test::plain::create(request).runs).empty();
        EXPECT_TRUE(evenRunsOnly || standardOrder) << "allocation " << n;
        EXPECT_FALSE(signsChosen && evenRunsOnly) << "allocation " << n << " fails earlier than one before it";
        signsChosen = signsChosen || standardOrder;
    }
    EXPECT_TRUE(succeeded);
}

TEST(ScreeningMemory, FailureWithAFreshSeedLeavesTheStandardOrderOrARandomOne) {
    // The source of fresh seeds may do without memory, so that a failure of its own need not fail the call.
    const Request request{6};
    for (std::size_t n = 1; n < kMostAllocations; ++n) {
        ScreeningArrays arrays(request);
        const Outcome outcome = createFailing(arrays.randomized(0.0), n);
        ASSERT_EQ(outcome.counts.liveBlocks, 0) << "allocation " << n;
        if (!outcome.counts.failed) {
            EXPECT_EQ(outcome.code, des_Success);
            break;
        }
        if (outcome.code == des_Success) continue;
        ASSERT_EQ(outcome.code, des_ErrorOutOfMemory) << "allocation " << n;
        EXPECT_EQ(arrays.differenceFrom(completeBaseRuns(request)), "") << "allocation " << n;
    }
}

TEST(ScreeningMemory, RandomizationNeedsAtMostTwentyFourBytesARun) {
    // The sampler and the lists by block do not grow with the runs of a block.
    constexpr std::ptrdiff_t kFixedBytes = 16384;
    for (const std::uint32_t numBlocks : {1U, 2U, 10U}) {
        ScreeningArrays arrays(Request{48, {}, 200, numBlocks});
        const Outcome outcome = createFailing(arrays.randomized(1.0), AllocationWatch::kNeverFail);
        ASSERT_EQ(outcome.code, des_Success);
        EXPECT_LE(outcome.counts.peakBytes, static_cast<std::ptrdiff_t>(24 * arrays.numRuns()) + kFixedBytes)
            << numBlocks;
        EXPECT_EQ(outcome.counts.liveBlocks, 0);
    }
}

TEST(RandomNumbersMemory, FailureIsBadAllocAndLeaksNothing) {
    std::vector<double> reference;
    reisti::generateRandomNumbers(50, 9.0, reference);
    for (std::size_t n = 1; n < kMostAllocations; ++n) {
        bool threw = false;
        AllocationWatch watch(n);
        {
            std::vector<double> numbers;
            try {
                reisti::generateRandomNumbers(50, 9.0, numbers);
            } catch (const std::bad_alloc&) {
                threw = true;
            }
            if (!watch.counts().failed) {
                watch.stop();
                EXPECT_EQ(numbers, reference);
            }
        }
        watch.stop();
        EXPECT_EQ(threw, watch.counts().failed) << "allocation " << n;
        if (!watch.counts().failed) break;
        EXPECT_EQ(watch.counts().liveBlocks, 0) << "allocation " << n;
    }
}

}  // namespace
