#include "random/random_numbers.h"

#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <limits>
#include <thread>
#include <vector>

#include "ruv/ruv.h"

namespace {

std::vector<double> generated(std::uint32_t count, double seed) {
    std::vector<double> out;
    reisti::generateRandomNumbers(count, seed, out);
    return out;
}

/// The numbers of a sampler of kind 10, without the adapter.
std::vector<double> sampled(std::uint32_t count, double seed) {
    std::vector<double> values(count);
    ruv_ISampler* sampler = ruv_MakeISampler(nullptr, 10, seed);
    ruv_GetUniformSample(sampler, values.data(), count, 0.0, 1.0);
    ruv_DeleteISampler(&sampler);
    return values;
}

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

TEST(GenerateRandomNumbers, GivesTheNumbersOfTheSampler) {
    for (const double seed : {1.0, -2.5, 1e-300, std::numeric_limits<double>::infinity(), kNaN}) {
        EXPECT_EQ(generated(100, seed), sampled(100, seed)) << seed;
    }
}

TEST(GenerateRandomNumbers, LiesInTheUnitInterval) {
    for (const double value : generated(10000, 5.0)) {
        ASSERT_GE(value, 0.0);
        ASSERT_LT(value, 1.0);
    }
}

TEST(GenerateRandomNumbers, GrowsTheVector) {
    std::vector<double> out = {9.0, 9.0};
    reisti::generateRandomNumbers(10, 1.0, out);
    EXPECT_EQ(out, sampled(10, 1.0));
}

TEST(GenerateRandomNumbers, DropsSurplusElements) {
    std::vector<double> out(50, 9.0);
    reisti::generateRandomNumbers(10, 1.0, out);
    EXPECT_EQ(out, sampled(10, 1.0));
}

TEST(GenerateRandomNumbers, CountZeroEmptiesTheVector) {
    std::vector<double> out(50, 9.0);
    reisti::generateRandomNumbers(0, 1.0, out);
    EXPECT_TRUE(out.empty());
}

TEST(GenerateRandomNumbers, KeepsNoStateBetweenCalls) {
    const std::vector<double> first = generated(20, 8.0);
    generated(7, 9.0);
    EXPECT_EQ(generated(20, 8.0), first);
}

TEST(GenerateRandomNumbers, DifferentSeedsDiffer) {
    EXPECT_NE(generated(20, 8.0), generated(20, 9.0));
}

TEST(GenerateRandomNumbers, NotANumberIsASeedLikeAnyOther) {
    EXPECT_EQ(generated(20, kNaN), generated(20, kNaN));
}

TEST(GenerateRandomNumbers, SmallestNumberIsNotZero) {
    EXPECT_EQ(generated(20, 5e-324), generated(20, 5e-324));
    EXPECT_EQ(generated(20, -5e-324), sampled(20, -5e-324));
}

TEST(GenerateRandomNumbers, SeedZeroIsFreshEachTime) {
    EXPECT_NE(generated(20, 0.0), generated(20, 0.0));
    EXPECT_NE(generated(20, 0.0), sampled(20, 0.0));
}

TEST(GenerateRandomNumbers, SeedNegativeZeroIsFreshEachTime) {
    EXPECT_NE(generated(20, -0.0), generated(20, -0.0));
    EXPECT_NE(generated(20, -0.0), sampled(20, -0.0));
}

TEST(GenerateRandomNumbers, RunsInSeveralThreads) {
    std::vector<std::vector<double>> results(4);
    std::vector<std::thread> threads;
    for (std::size_t t = 0; t < results.size(); ++t) {
        threads.emplace_back([&results, t] { results[t] = generated(5000, 1.0 + static_cast<double>(t)); });
    }
    for (std::thread& thread : threads) {
        thread.join();
    }
    for (std::size_t t = 0; t < results.size(); ++t) {
        EXPECT_EQ(results[t], sampled(5000, 1.0 + static_cast<double>(t))) << t;
    }
}

/// The first numbers of a sampler, which is freed.
std::vector<double> drawnFrom(ruv_ISampler* sampler) {
    std::vector<double> values(20, -1.0);
    ruv_GetUniformSample(sampler, values.data(), 20, 0.0, 1.0);
    ruv_DeleteISampler(&sampler);
    return values;
}

TEST(ConstructActualRandomNumberGenerator, HandsOutTheSamplerOfTheSeed) {
    EXPECT_EQ(drawnFrom(reisti::constructActualRandomNumberGenerator(6.0)), sampled(20, 6.0));
    EXPECT_EQ(drawnFrom(reisti::constructActualRandomNumberGenerator(kNaN)), sampled(20, kNaN));
}

TEST(ConstructActualRandomNumberGenerator, SeedZeroIsFreshEachTime) {
    EXPECT_NE(drawnFrom(reisti::constructActualRandomNumberGenerator(0.0)),
              drawnFrom(reisti::constructActualRandomNumberGenerator(0.0)));
    EXPECT_NE(drawnFrom(reisti::constructActualRandomNumberGenerator(-0.0)),
              drawnFrom(reisti::constructActualRandomNumberGenerator(-0.0)));
}

}  // namespace
