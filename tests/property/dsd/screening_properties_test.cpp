// What has to hold for every design, whatever its construction.
#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <gtest/gtest.h>
#include <numeric>
#include <random>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "support/scale.h"
#include "support/screening_arrays.h"

namespace {

using reisti::test::scaled;
using reisti::test::ScreeningArrays;
using reisti::test::plain::baseOrder;
using reisti::test::plain::Request;
using List = std::vector<std::uint32_t>;

class ContinuousDesign : public testing::TestWithParam<std::uint32_t> {
  protected:
    void SetUp() override { ASSERT_EQ(arrays.create(), des_Success); }
    std::uint32_t n() const { return GetParam(); }
    std::int32_t x(std::size_t run, std::size_t factor) const { return arrays.level(run, factor); }

    ScreeningArrays arrays{Request{GetParam()}};
};

TEST_P(ContinuousDesign, ColumnsAreBalanced) {
    for (std::size_t j = 0; j < n(); ++j) {
        std::int32_t sum = 0;
        std::int32_t zeros = 0;
        for (std::size_t i = 0; i < arrays.numRuns(); ++i) {
            sum += x(i, j);
            zeros += x(i, j) == 0 ? 1 : 0;
        }
        EXPECT_EQ(sum, 0) << j;
        EXPECT_EQ(zeros, 3) << j;
    }
}

TEST_P(ContinuousDesign, MainEffectsAreOrthogonal) {
    for (std::size_t a = 0; a < n(); ++a) {
        for (std::size_t b = a; b < n(); ++b) {
            std::int32_t product = 0;
            for (std::size_t i = 0; i < arrays.numRuns(); ++i) {
                product += x(i, a) * x(i, b);
            }
            EXPECT_EQ(product, a == b ? 2 * static_cast<std::int32_t>(baseOrder(n())) - 2 : 0) << a << ' ' << b;
        }
    }
}

// A square is the product of a factor with itself.
TEST_P(ContinuousDesign, MainEffectsAreOrthogonalToSquaresAndTwoFactorProducts) {
    for (std::size_t a = 0; a < n(); ++a) {
        for (std::size_t b = 0; b < n(); ++b) {
            for (std::size_t c = b; c < n(); ++c) {
                std::int32_t product = 0;
                for (std::size_t i = 0; i < arrays.numRuns(); ++i) {
                    product += x(i, a) * x(i, b) * x(i, c);
                }
                ASSERT_EQ(product, 0) << a << ' ' << b << ' ' << c;
            }
        }
    }
}

TEST_P(ContinuousDesign, FoldOverPairsNegate) {
    for (std::size_t i = 0; i + 1 < arrays.numRuns(); i += 2) {
        for (std::size_t j = 0; j < n(); ++j) {
            EXPECT_EQ(x(i + 1, j), -x(i, j)) << i << ' ' << j;
        }
    }
}

TEST_P(ContinuousDesign, LevelsAreMinusOneZeroAndOne) {
    for (std::size_t i = 0; i < arrays.numRuns(); ++i) {
        for (std::size_t j = 0; j < n(); ++j) {
            EXPECT_LE(std::abs(x(i, j)), 1) << i << ' ' << j;
        }
    }
}

TEST_P(ContinuousDesign, PointTypesTellTheNumberOfZeros) {
    for (std::size_t i = 0; i < arrays.numRuns(); ++i) {
        const std::vector<std::int32_t> levels = arrays.run(i).levels;
        const auto zeros = std::count(levels.begin(), levels.end(), 0);
        const auto type = arrays.record(i).pointType;
        if (i == arrays.numRuns() - 1) {
            EXPECT_EQ(type, std::uint32_t{des_ScreeningPointCenter});
            EXPECT_EQ(zeros, static_cast<std::ptrdiff_t>(n()));
        } else {
            EXPECT_EQ(zeros, type == des_ScreeningPointOneZero ? 1 : 0) << i;
            EXPECT_NE(type, std::uint32_t{des_ScreeningPointCenter}) << i;
        }
    }
}

TEST_P(ContinuousDesign, RunsAreInStandardOrder) {
    for (std::size_t i = 0; i < arrays.numRuns(); ++i) {
        EXPECT_EQ(arrays.record(i).runOrder, i + 1);
        EXPECT_EQ(arrays.record(i).block, 1U);
    }
}

TEST_P(ContinuousDesign, RowCountIsTheNumberOfRunsWritten) {
    std::int32_t error = -1;
    EXPECT_EQ(des_FindDefinitiveScreeningDesignRowCount(static_cast<std::int32_t>(n()), &error, 0, 1),
              arrays.numRuns());
    for (std::size_t i = 0; i < arrays.numRuns(); ++i) {
        EXPECT_NE(arrays.level(i, n() - 1), reisti::test::kLevelPoison) << i;
    }
}

INSTANTIATE_TEST_SUITE_P(, ContinuousDesign, testing::Range(2U, 49U),
                         [](const testing::TestParamInfo<std::uint32_t>& param) {
                             return "Factors" + std::to_string(param.param);
                         });

class CategoricalDesign : public testing::TestWithParam<std::uint32_t> {
  protected:
    std::uint32_t n() const { return GetParam(); }

    /// Calls check(list, arrays) on designs with 1..n categorical factors, in shuffled order.
    template <typename Check>
    void forManyLists(Check check) {
        std::mt19937 engine(n());
        for (std::uint32_t k = 1; k <= n() && !HasFailure(); ++k) {
            for (int i = 0; i < scaled(10); ++i) {
                List list(n());
                std::iota(list.begin(), list.end(), 0U);
                std::shuffle(list.begin(), list.end(), engine);
                list.resize(k);
                ScreeningArrays arrays(Request{n(), list});
                ASSERT_EQ(arrays.create(), des_Success);
                check(list, arrays);
            }
        }
    }
};

TEST_P(CategoricalDesign, CategoricalColumnsHoldNoZero) {
    forManyLists([](const List& list, ScreeningArrays& arrays) {
        for (const std::uint32_t column : list) {
            for (std::size_t i = 0; i < arrays.numRuns(); ++i) {
                ASSERT_EQ(std::abs(arrays.level(i, column)), 1) << "column " << column << " run " << i;
            }
        }
    });
}

TEST_P(CategoricalDesign, ContinuousColumnsAreZeroInTheirPairAndTheCentreRuns) {
    forManyLists([this](const List& list, ScreeningArrays& arrays) {
        const std::size_t centre = 2 * std::size_t{baseOrder(n())};
        for (std::uint32_t column = 0; column < n(); ++column) {
            if (std::find(list.begin(), list.end(), column) != list.end()) continue;
            for (std::size_t i = 0; i < arrays.numRuns(); ++i) {
                ASSERT_EQ(arrays.level(i, column) == 0, i / 2 == column || i >= centre) << column << ' ' << i;
            }
        }
    });
}

TEST_P(CategoricalDesign, ColumnsAreBalancedAndPairsNegate) {
    forManyLists([this](const List&, ScreeningArrays& arrays) {
        for (std::size_t i = 0; i < arrays.numRuns(); i += 2) {
            for (std::size_t j = 0; j < n(); ++j) {
                ASSERT_EQ(arrays.level(i, j) + arrays.level(i + 1, j), 0) << i << ' ' << j;
            }
        }
    });
}

TEST_P(CategoricalDesign, SignsChangeNothingOffTheDiagonal) {
    ScreeningArrays continuous(Request{n()});
    ASSERT_EQ(continuous.create(), des_Success);
    forManyLists([&](const List&, ScreeningArrays& arrays) {
        for (std::size_t i = 0; i < 2 * std::size_t{baseOrder(n())}; ++i) {
            for (std::size_t j = 0; j < n(); ++j) {
                if (j == i / 2) continue;
                ASSERT_EQ(arrays.level(i, j), continuous.level(i, j)) << i << ' ' << j;
            }
        }
    });
}

INSTANTIATE_TEST_SUITE_P(, CategoricalDesign, testing::Range(2U, 49U),
                         [](const testing::TestParamInfo<std::uint32_t>& param) {
                             return "Factors" + std::to_string(param.param);
                         });

/// Replicated, blocked and randomized designs drawn at random.
struct RandomizedCase {
    Request request;
    double seed;
};

RandomizedCase drawCase(std::mt19937& engine) {
    RandomizedCase drawn{Request{2 + static_cast<std::uint32_t>(engine() % 47)},
                         static_cast<double>(1 + engine() % 100000) / 64.0};
    if (engine() % 2 == 0)
        drawn.request.categorical = {static_cast<std::uint32_t>(engine() % drawn.request.numFactors)};
    drawn.request.numBlocks = 1 + static_cast<std::uint32_t>(engine() % 5);
    drawn.request.replicates = drawn.request.numBlocks * (1 + static_cast<std::uint32_t>(engine() % 4));
    return drawn;
}

template <typename Check>
void forManyRandomizedDesigns(Check check) {
    std::mt19937 engine(99);
    for (int i = 0; i < scaled(1000) && !testing::Test::HasFailure(); ++i) {
        const RandomizedCase drawn = drawCase(engine);
        ScreeningArrays arrays(drawn.request);
        ASSERT_EQ(arrays.randomized(drawn.seed).create(), des_Success);
        check(drawn, arrays);
    }
}

TEST(RandomizedDesigns, RunOrdersAreAPermutation) {
    forManyRandomizedDesigns([](const RandomizedCase&, ScreeningArrays& arrays) {
        List orders = arrays.runOrders();
        std::sort(orders.begin(), orders.end());
        List all(arrays.numRuns());
        std::iota(all.begin(), all.end(), 1U);
        ASSERT_EQ(orders, all);
    });
}

TEST(RandomizedDesigns, BlocksOccupyConsecutiveRangesOfEqualLength) {
    forManyRandomizedDesigns([](const RandomizedCase& drawn, ScreeningArrays& arrays) {
        const std::uint32_t numBlocks = drawn.request.replicates > 1 ? drawn.request.numBlocks : 1;
        const std::uint32_t length = static_cast<std::uint32_t>(arrays.numRuns()) / numBlocks;
        for (std::uint32_t block = 1; block <= numBlocks; ++block) {
            List orders;
            for (std::size_t i = 0; i < arrays.numRuns(); ++i) {
                if (arrays.record(i).block == block) orders.push_back(arrays.record(i).runOrder);
            }
            const auto [first, last] = std::minmax_element(orders.begin(), orders.end());
            ASSERT_EQ(orders.size(), length);
            ASSERT_EQ(*last - *first, length - 1);
            ASSERT_EQ((*first - 1) % length, 0U);
        }
    });
}

TEST(RandomizedDesigns, SameSeedGivesTheSameDesign) {
    forManyRandomizedDesigns([](const RandomizedCase& drawn, ScreeningArrays& arrays) {
        ScreeningArrays again(drawn.request);
        ASSERT_EQ(again.randomized(drawn.seed).create(), des_Success);
        ASSERT_EQ(again.runOrders(), arrays.runOrders());
    });
}

TEST(RandomizedDesigns, BuildingAgainIntoUsedArraysGivesTheSameDesign) {
    forManyRandomizedDesigns([](const RandomizedCase&, ScreeningArrays& arrays) {
        const List first = arrays.runOrders();
        ASSERT_EQ(arrays.create(), des_Success);
        ASSERT_EQ(arrays.runOrders(), first);
    });
}

TEST(RandomizedDesigns, OtherSeedGivesAnotherOrder) {
    // At least 13 runs: a chance agreement is one in 6 billion.
    forManyRandomizedDesigns([](const RandomizedCase& drawn, ScreeningArrays& arrays) {
        ScreeningArrays other(drawn.request);
        ASSERT_EQ(other.randomized(drawn.seed + 0.5).create(), des_Success);
        ASSERT_NE(other.runOrders(), arrays.runOrders());
    });
}

}  // namespace
