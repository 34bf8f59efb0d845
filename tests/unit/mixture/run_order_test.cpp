#include <algorithm>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <limits>
#include <vector>

#include "random/random_numbers.h"
#include "reisti/reisti.h"
#include "unit/mixture/expect_plain.h"

namespace reisti::test {
namespace {

MixtureRequest randomized(MixtureRequest request, double seed) {
    request.randomize = 1;
    request.seed = seed;
    return request;
}

std::vector<std::uint32_t> sorted(std::vector<std::uint32_t> orders) {
    std::sort(orders.begin(), orders.end());
    return orders;
}

TEST(RunOrder, WithoutRandomizationIsTheStandardOrderWhateverTheSeed) {
    MixtureRequest request = centroidRequest(5);
    request.seed = 123.0;
    EXPECT_EQ(ordersOf(builtDesign(request)), standardOrder(31));
}

TEST(RunOrder, RandomizedIsAPermutation) {
    EXPECT_EQ(sorted(ordersOf(builtDesign(randomized(centroidRequest(7), 3.25)))), standardOrder(127));
}

TEST(RunOrder, OfOneSeedIsTheSameEachTime) {
    const MixtureRequest request = randomized(centroidRequest(7), 3.25);
    EXPECT_EQ(ordersOf(builtDesign(request)), ordersOf(builtDesign(request)));
}

TEST(RunOrder, OfANotANumberSeedIsTheSameEachTime) {
    const MixtureRequest request = randomized(centroidRequest(7), std::numeric_limits<double>::quiet_NaN());
    EXPECT_EQ(ordersOf(builtDesign(request)), ordersOf(builtDesign(request)));
}

TEST(RunOrder, OfOtherSeedsDiffers) {
    EXPECT_NE(ordersOf(builtDesign(randomized(centroidRequest(7), 3.25))),
              ordersOf(builtDesign(randomized(centroidRequest(7), 3.5))));
}

// 1023 runs: that two fresh orders agree by chance is out of the question.
TEST(RunOrder, OfSeedZeroIsFreshEachTime) {
    for (const double zero : {0.0, -0.0}) {
        const MixtureRequest request = randomized(centroidRequest(10), zero);
        const auto first = ordersOf(builtDesign(request));
        EXPECT_EQ(sorted(first), standardOrder(1023));
        EXPECT_NE(first, ordersOf(builtDesign(request)));
    }
}

TEST(RunOrder, RandomizingMovesNoRecord) {
    MixtureOutcome design = builtDesign(randomized(centroidRequest(6), 77.0));
    const MixtureOutcome standard = builtDesign(centroidRequest(6));
    for (std::size_t i = 0; i < design.runs.size(); ++i)
        design.runs[i].runOrder = standard.runs[i].runOrder;
    EXPECT_TRUE(sameOutcome(design, standard));
}

TEST(RunOrder, FollowsTheRandomNumbersFromSmallestToLargest) {
    const auto orders = ordersOf(builtDesign(randomized(centroidRequest(6), 77.0)));
    std::vector<double> keys;
    generateRandomNumbers(63, 77.0, keys);
    for (std::size_t i = 0; i < keys.size(); ++i) {
        const auto smaller = std::count_if(keys.begin(), keys.end(), [&](double key) { return key < keys[i]; });
        EXPECT_EQ(orders[i], smaller + 1);
    }
}

TEST(RunOrder, RandomizedLeavesTheSeedInTheRecord) {
    MixtureRecord record(randomized(centroidRequest(3), 0.0));
    ASSERT_EQ(record.run(), des_Success);
    EXPECT_EQ(record->seed, 0.0);
}

TEST(RunOrder, CoversReplicatesAmountsAndAxialPoints) {
    MixtureRequest request = randomized(centroidRequest(3), 5.0);
    request.axialPoints = 1;
    request.designReplicates = 3;
    request.amounts = {1, 2};
    const auto design = builtDesign(request);
    EXPECT_EQ(sorted(ordersOf(design)), standardOrder(60));
    EXPECT_TRUE(sameOutcome(design, plainDesign(request)));
}

TEST(RunOrder, RunsOverAllProcessSettings) {
    MixtureRequest request = randomized(latticeRequest(3, 2), 5.0);
    request.numProcessVariables = 3;
    const auto design = builtDesign(request);
    EXPECT_EQ(sorted(ordersOf(design)), standardOrder(48));
    EXPECT_TRUE(sameOutcome(design, plainDesign(request)));
}

}  // namespace
}  // namespace reisti::test
