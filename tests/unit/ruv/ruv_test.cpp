#include "ruv/ruv.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <limits>
#include <random>
#include <set>
#include <string>
#include <thread>
#include <vector>

#include "support/scale.h"

extern "C" double firstNumberInC(double seed);

namespace {

using reisti::test::scaled;
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInfinity = std::numeric_limits<double>::infinity();

/// A sampler that frees itself.
class Sampler {
  public:
    explicit Sampler(double seed) : sampler_(ruv_MakeISampler(&status_, ruv_KindMersenneTwister64, seed)) {}
    ~Sampler() { ruv_DeleteISampler(&sampler_); }
    Sampler(const Sampler&) = delete;
    Sampler& operator=(const Sampler&) = delete;

    std::int32_t status() const { return status_; }
    ruv_ISampler* get() const { return sampler_; }
    std::vector<double> draw(std::size_t count, double lower = 0.0, double upper = 1.0) {
        std::vector<double> values(count, -1.0);
        ruv_GetUniformSample(sampler_, values.data(), static_cast<std::uint32_t>(count), lower, upper);
        return values;
    }

  private:
    std::int32_t status_ = -1;
    ruv_ISampler* sampler_;
};

std::vector<double> draw(double seed, std::size_t count) {
    return Sampler(seed).draw(count);
}

double fromBits(std::uint64_t bits) {
    return std::bit_cast<double>(bits);
}

/// The documented sequence from the standard library alone: the two halves of the seed's bit pattern, the lower one
/// first, seed the 64-bit Mersenne Twister; its upper 53 bits make a number.
std::vector<double> knownSequence(double seed, std::size_t count) {
    const auto bits = std::bit_cast<std::uint64_t>(seed);
    std::seed_seq halves = {static_cast<std::uint32_t>(bits), static_cast<std::uint32_t>(bits >> 32)};
    std::mt19937_64 engine(halves);
    std::vector<double> values;
    for (std::size_t i = 0; i < count; ++i) {
        values.push_back(std::ldexp(static_cast<double>(engine() >> 11), -53));
    }
    return values;
}

class SamplerSeed : public testing::TestWithParam<double> {};

TEST_P(SamplerSeed, GivesTheSequenceOfTheStandardGenerator) {
    EXPECT_EQ(draw(GetParam(), 1000), knownSequence(GetParam(), 1000));
}

TEST_P(SamplerSeed, GivesTheSameSequenceEachTime) {
    EXPECT_EQ(draw(GetParam(), 100), draw(GetParam(), 100));
}

TEST_P(SamplerSeed, MakesAnUsableSampler) {
    const Sampler sampler(GetParam());
    EXPECT_EQ(sampler.status(), ruv_StatusOk);
    EXPECT_NE(sampler.get(), nullptr);
}

INSTANTIATE_TEST_SUITE_P(, SamplerSeed,
                         testing::Values(0.0, -0.0, 1.0, -1.0, 12345.678, 5e-324, 2.2250738585072014e-308, 1e308,
                                         kInfinity, -kInfinity, kNaN),
                         [](const testing::TestParamInfo<double>& param) {
                             return "Number" + std::to_string(param.index);
                         });

TEST(Sampler, NeighbouringSeedsGiveUnrelatedSequences) {
    for (const double seed : {1.0, 1234.5, -7.0, 1e100, 5e-324}) {
        const std::vector<double> here = draw(seed, 50);
        const std::vector<double> next = draw(std::nextafter(seed, kInfinity), 50);
        for (std::size_t i = 0; i < here.size(); ++i) {
            EXPECT_NE(here[i], next[i]) << seed << " number " << i;
        }
    }
}

TEST(Sampler, ManySeedsGiveAsManySequences) {
    std::set<std::vector<double>> sequences;
    for (int seed = 1; seed <= 1000; ++seed) {
        sequences.insert(draw(seed, 2));
        sequences.insert(draw(-seed, 2));
        sequences.insert(draw(1.0 / (seed + 1), 2));
    }
    EXPECT_EQ(sequences.size(), 3000U);
}

TEST(Sampler, ZeroAndNegativeZeroAreDifferentSeeds) {
    EXPECT_NE(draw(0.0, 10), draw(-0.0, 10));
}

TEST(Sampler, NaNsOfDifferentBitsAreDifferentSeeds) {
    EXPECT_NE(draw(fromBits(0x7ff8000000000001), 10), draw(fromBits(0x7ff8000000000002), 10));
    EXPECT_NE(draw(fromBits(0x7ff8000000000000), 10), draw(fromBits(0xfff8000000000000), 10));
}

TEST(Sampler, ContinuesItsSequenceFromCallToCall) {
    Sampler sampler(3.5);
    std::vector<double> pieces = sampler.draw(7);
    for (const std::size_t count : {0U, 1U, 92U}) {
        const std::vector<double> more = sampler.draw(count);
        pieces.insert(pieces.end(), more.begin(), more.end());
    }
    EXPECT_EQ(pieces, draw(3.5, 100));
}

TEST(Sampler, OtherSamplersDoNotDisturbIt) {
    Sampler first(3.5);
    std::vector<double> numbers = first.draw(5);
    Sampler second(4.5);
    second.draw(5);
    const std::vector<double> more = first.draw(5);
    numbers.insert(numbers.end(), more.begin(), more.end());
    EXPECT_EQ(numbers, draw(3.5, 10));
}

TEST(Sampler, GivesCTheSameNumbers) {
    EXPECT_EQ(firstNumberInC(3.5), draw(3.5, 1).front());
}

TEST(UniformSample, NumbersOfTheUnitIntervalCarry53Bits) {
    bool oddSeen = false;
    for (const double value : draw(77.0, 10000)) {
        ASSERT_GE(value, 0.0);
        ASSERT_LT(value, 1.0);
        const double bits = std::ldexp(value, 53);
        ASSERT_EQ(bits, std::floor(bits));
        oddSeen = oddSeen || std::fmod(bits, 2.0) == 1.0;
    }
    EXPECT_TRUE(oddSeen) << "the lowest bit is never set";
}

struct Bounds {
    const char* name;
    double lower;
    double upper;
};

class UniformSampleBounds : public testing::TestWithParam<Bounds> {};

TEST_P(UniformSampleBounds, IncludeTheLowerAndExcludeTheUpper) {
    Sampler sampler(11.0);
    for (const double value : sampler.draw(100000, GetParam().lower, GetParam().upper)) {
        ASSERT_GE(value, GetParam().lower);
        ASSERT_LT(value, GetParam().upper);
    }
}

TEST_P(UniformSampleBounds, ConsumeOneNumberForEachValue) {
    Sampler scaledFirst(11.0);
    scaledFirst.draw(10, GetParam().lower, GetParam().upper);
    Sampler plainFirst(11.0);
    plainFirst.draw(10);
    EXPECT_EQ(scaledFirst.draw(10), plainFirst.draw(10));
}

// In a range of few representable numbers the scaled value rounds to the upper bound unless that is prevented.
INSTANTIATE_TEST_SUITE_P(, UniformSampleBounds,
                         testing::Values(Bounds{"Unit", 0.0, 1.0}, Bounds{"Shifted", 2.0, 3.0},
                                         Bounds{"AroundZero", -5.0, 5.0}, Bounds{"Negative", -1.0, 0.0},
                                         Bounds{"OneUlpWide", 1.0, std::nextafter(1.0, 2.0)},
                                         Bounds{"FewUlpsWide", 1e16, 1e16 + 8}, Bounds{"OneDenormalWide", 0.0, 5e-324},
                                         Bounds{"LargeNarrow", 4503599627370496.0, 4503599627370497.0},
                                         Bounds{"Huge", -8e307, 8e307},
                                         Bounds{"WiderThanAnyNumber", -1.7e308, 1.7e308}),
                         [](const testing::TestParamInfo<Bounds>& param) { return std::string(param.param.name); });

TEST(UniformSample, FillsTheIntervalEvenly) {
    constexpr std::size_t kCells = 100;
    const std::size_t count = 1000 * kCells;
    std::array<double, kCells> hits{};
    for (const double value : draw(2.0, count)) {
        hits[static_cast<std::size_t>(value * kCells)] += 1.0;
    }
    double chiSquare = 0.0;
    for (const double observed : hits) {
        chiSquare += (observed - 1000.0) * (observed - 1000.0) / 1000.0;
    }
    // 99 degrees of freedom: beyond these bounds lie about one seed in 10,000 each.
    EXPECT_GT(chiSquare, 54.0);
    EXPECT_LT(chiSquare, 161.0);
}

TEST(UniformSample, CountZeroWritesNothing) {
    const Sampler sampler(1.0);
    double value = -7.0;
    ruv_GetUniformSample(sampler.get(), &value, 0, 0.0, 1.0);
    EXPECT_EQ(value, -7.0);
    ruv_GetUniformSample(sampler.get(), nullptr, 0, 0.0, 1.0);
}

TEST(UniformSample, WritesNothingBehindTheCount) {
    const Sampler sampler(1.0);
    std::vector<double> values(8, -7.0);
    ruv_GetUniformSample(sampler.get(), values.data(), 5, 0.0, 1.0);
    EXPECT_EQ(std::vector<double>(values.begin() + 5, values.end()), std::vector<double>(3, -7.0));
}

TEST(UniformSample, NullSamplerLeavesTheArrayAsItIs) {
    std::vector<double> values(4, -7.0);
    ruv_GetUniformSample(nullptr, values.data(), 4, 0.0, 1.0);
    EXPECT_EQ(values, std::vector<double>(4, -7.0));
}

TEST(MakeSampler, NullStatusIsAccepted) {
    ruv_ISampler* sampler = ruv_MakeISampler(nullptr, ruv_KindMersenneTwister64, 1.0);
    ASSERT_NE(sampler, nullptr);
    ruv_DeleteISampler(&sampler);
    EXPECT_EQ(ruv_MakeISampler(nullptr, 3, 1.0), nullptr);
}

TEST(MakeSampler, OtherKindsGiveAStatusAndNull) {
    for (const std::int32_t kind : {0, 1, 9, 11, -1, -10, 20, INT32_MAX, INT32_MIN}) {
        std::int32_t status = -1;
        EXPECT_EQ(ruv_MakeISampler(&status, kind, 1.0), nullptr) << kind;
        EXPECT_EQ(status, ruv_StatusUnknownKind) << kind;
    }
}

TEST(MakeSampler, KindTenIsTheMersenneTwister) {
    EXPECT_EQ(ruv_KindMersenneTwister64, 10);
}

TEST(DeleteSampler, SetsThePointerToNull) {
    ruv_ISampler* sampler = ruv_MakeISampler(nullptr, ruv_KindMersenneTwister64, 1.0);
    ruv_DeleteISampler(&sampler);
    EXPECT_EQ(sampler, nullptr);
}

TEST(DeleteSampler, AcceptsNullAndAPointerToNull) {
    ruv_DeleteISampler(nullptr);
    ruv_ISampler* none = nullptr;
    ruv_DeleteISampler(&none);
    EXPECT_EQ(none, nullptr);
}

TEST(Seeder, GivesNonzeroNumbers) {
    for (int i = 0; i < scaled(10000); ++i) {
        const double seed = ruv_Seeder();
        ASSERT_NE(seed, 0.0);
        ASSERT_FALSE(std::isnan(seed));
    }
}

TEST(Seeder, DiffersFromCallToCall) {
    const auto count = static_cast<std::size_t>(scaled(10000));
    std::set<double> seeds;
    for (std::size_t i = 0; i < count; ++i) {
        seeds.insert(ruv_Seeder());
    }
    EXPECT_EQ(seeds.size(), count);
}

TEST(Seeder, DiffersFromThreadToThread) {
    constexpr std::size_t kThreads = 4;
    const auto count = static_cast<std::size_t>(scaled(1000));
    std::array<std::vector<double>, kThreads> drawn;
    std::vector<std::thread> threads;
    for (std::vector<double>& seeds : drawn) {
        threads.emplace_back([&seeds] {
            for (std::size_t i = 0; i < count; ++i) {
                seeds.push_back(ruv_Seeder());
            }
        });
    }
    for (std::thread& thread : threads) {
        thread.join();
    }
    std::set<double> all;
    for (const std::vector<double>& seeds : drawn) {
        all.insert(seeds.begin(), seeds.end());
    }
    EXPECT_EQ(all.size(), kThreads * count);
}

TEST(Sampler, SeveralThreadsHaveOneEach) {
    constexpr std::size_t kThreads = 4;
    std::array<std::vector<double>, kThreads> drawn;
    std::vector<std::thread> threads;
    for (std::size_t t = 0; t < kThreads; ++t) {
        threads.emplace_back([&drawn, t] { drawn[t] = draw(1.0 + static_cast<double>(t), 2000); });
    }
    for (std::thread& thread : threads) {
        thread.join();
    }
    for (std::size_t t = 0; t < kThreads; ++t) {
        EXPECT_EQ(drawn[t], draw(1.0 + static_cast<double>(t), 2000)) << t;
    }
}

}  // namespace
