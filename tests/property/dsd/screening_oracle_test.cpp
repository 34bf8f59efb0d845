// Whole designs, cell by cell, against the plain formulation: every number of factors, lists of categorical factors in
// every kind of order, replicates, blocks and randomization.
#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <limits>
#include <numeric>
#include <optional>
#include <random>
#include <sstream>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "ruv/ruv.h"
#include "support/plain_run_order.h"
#include "support/scale.h"
#include "support/screening_arrays.h"

namespace {

using reisti::test::scaled;
using reisti::test::ScreeningArrays;
using reisti::test::plain::Design;
using reisti::test::plain::PlainRun;
using reisti::test::plain::Request;
using List = std::vector<std::uint32_t>;

// The plain formulation is slow under a sanitizer: there only every seventh size of a long series is tried.
constexpr std::uint32_t kStep = scaled(7) == 7 ? 1 : 7;

std::string describe(const Request& request) {
    std::ostringstream text;
    text << request.numFactors << " factors, " << request.replicates << " replicates, " << request.numBlocks
         << " blocks, categorical:";
    for (const std::uint32_t column : request.categorical) {
        text << ' ' << column;
    }
    return text.str();
}

/// The numbers that the library has to draw, straight from the sampler.
std::vector<double> keys(std::size_t count, double seed) {
    std::vector<double> values(count);
    ruv_ISampler* sampler = ruv_MakeISampler(nullptr, ruv_KindMersenneTwister64, seed);
    ruv_GetUniformSample(sampler, values.data(), static_cast<std::uint32_t>(count), 0.0, 1.0);
    ruv_DeleteISampler(&sampler);
    return values;
}

/// Gives the runs of a complete design their randomized order. Without replicates none are randomized.
void randomize(Design& design, const Request& request, double seed) {
    if (request.replicates == 0) return;
    List blocks;
    for (const std::optional<PlainRun>& run : design.runs) {
        blocks.push_back(run->block);
    }
    const List runsPerBlock = reisti::test::plain::countRunsPerBlock(blocks);
    const List orders =
        reisti::test::plain::randomizedRunOrders(blocks, runsPerBlock, keys(runsPerBlock.size() + blocks.size(), seed));
    for (std::size_t i = 0; i < orders.size(); ++i) {
        design.runs[i]->runOrder = orders[i];
    }
}

void expectPlainDesign(const Request& request, std::optional<double> seed = std::nullopt) {
    SCOPED_TRACE(describe(request));
    Design expected = reisti::test::plain::create(request);
    ScreeningArrays arrays(request);
    if (seed) {
        arrays.randomized(*seed);
        if (expected.code == des_Success) randomize(expected, request, *seed);
    }
    ASSERT_EQ(arrays.create(), expected.code);
    ASSERT_EQ(arrays.differenceFrom(expected.runs), "");
}

class EveryNumberOfFactors : public testing::TestWithParam<std::uint32_t> {
  protected:
    std::uint32_t n() const { return GetParam(); }
    List firstFactors(std::uint32_t count) const {
        List list(count);
        std::iota(list.begin(), list.end(), 0U);
        return list;
    }
    List randomSubset(std::uint32_t count, std::mt19937& engine) const {
        List list = firstFactors(n());
        std::shuffle(list.begin(), list.end(), engine);
        list.resize(count);
        return list;
    }
};

TEST_P(EveryNumberOfFactors, ContinuousDesign) {
    expectPlainDesign({n()});
}

TEST_P(EveryNumberOfFactors, EachSingleCategoricalFactor) {
    for (std::uint32_t column = 0; column < n(); ++column) {
        expectPlainDesign({n(), {column}});
    }
}

TEST_P(EveryNumberOfFactors, EachSingleContinuousFactor) {
    for (std::uint32_t column = 0; column < n(); column += kStep) {
        List list = firstFactors(n());
        list.erase(list.begin() + column);
        expectPlainDesign({n(), list});
        std::reverse(list.begin(), list.end());
        expectPlainDesign({n(), list});
    }
}

TEST_P(EveryNumberOfFactors, FirstFactorsCategoricalAscendingAndDescending) {
    for (std::uint32_t k = 1; k <= n(); k += kStep) {
        List list = firstFactors(k);
        expectPlainDesign({n(), list});
        std::reverse(list.begin(), list.end());
        expectPlainDesign({n(), list});
    }
}

TEST_P(EveryNumberOfFactors, CategoricalSubsetsAscendingAndShuffled) {
    std::mt19937 engine(n());
    for (std::uint32_t k = 1; k <= n(); k += kStep) {
        for (int i = 0; i < scaled(6); ++i) {
            List list = randomSubset(k, engine);
            expectPlainDesign({n(), list});
            std::sort(list.begin(), list.end());
            expectPlainDesign({n(), list});
        }
    }
}

TEST_P(EveryNumberOfFactors, RepeatedCategoricalFactors) {
    std::mt19937 engine(1000 + n());
    for (std::uint32_t k = 2; k <= n(); k += kStep) {
        for (int i = 0; i < scaled(6); ++i) {
            List list = randomSubset(k, engine);
            for (std::uint32_t& column : list) {
                if (engine() % 3 == 0) column = list[engine() % k];
            }
            expectPlainDesign({n(), list});
        }
    }
}

TEST_P(EveryNumberOfFactors, ReplicatesAndBlocks) {
    std::mt19937 engine(2000 + n());
    for (const std::uint32_t replicates : {0U, 1U, 2U, 3U, 4U, 6U, 12U}) {
        for (const std::uint32_t numBlocks : {0U, 1U, 2U, 3U, 4U, 6U, 12U, 4294967295U}) {
            expectPlainDesign({n(), {}, replicates, numBlocks});
            expectPlainDesign(
                {n(), randomSubset(1 + static_cast<std::uint32_t>(engine() % n()), engine), replicates, numBlocks});
        }
    }
}

TEST_P(EveryNumberOfFactors, RandomizedWithFixedSeeds) {
    std::mt19937 engine(3000 + n());
    for (const double seed : {1.0, -1.0, 0.1, 987654321.0, 1e-310, std::numeric_limits<double>::quiet_NaN()}) {
        expectPlainDesign({n()}, seed);
        expectPlainDesign({n(), {}, 0, 1}, seed);
        expectPlainDesign({n(), {}, 6, 3}, seed);
        expectPlainDesign({n(), {}, 6, 6}, seed);
        expectPlainDesign({n(), {}, 5, 2}, seed);
        expectPlainDesign({n(), randomSubset(1 + static_cast<std::uint32_t>(engine() % n()), engine), 4, 2}, seed);
        expectPlainDesign({n(), randomSubset(n(), engine), 3, 0}, seed);
    }
}

INSTANTIATE_TEST_SUITE_P(, EveryNumberOfFactors, testing::Range(2U, 49U),
                         [](const testing::TestParamInfo<std::uint32_t>& param) {
                             return "Factors" + std::to_string(param.param);
                         });

/// Calls visit(list) for every list of different factors, in every order.
template <typename Visit>
void forEveryOrderedList(std::uint32_t numFactors, const List& list, const Visit& visit) {
    if (!list.empty()) visit(list);
    for (std::uint32_t column = 0; column < numFactors; ++column) {
        if (std::find(list.begin(), list.end(), column) != list.end()) continue;
        List longer = list;
        longer.push_back(column);
        forEveryOrderedList(numFactors, longer, visit);
    }
}

TEST(FewFactors, EveryOrderedListOfCategoricalFactors) {
    for (std::uint32_t n = 2; n <= 6; ++n) {
        forEveryOrderedList(n, {}, [n](const List& list) {
            if (!testing::Test::HasFailure()) expectPlainDesign({n, list});
        });
    }
}

TEST(FewFactors, EveryListOfThreeEntriesRepeatedOrNot) {
    for (std::uint32_t n = 3; n <= 6; ++n) {
        for (std::uint32_t code = 0; code < n * n * n; ++code) {
            expectPlainDesign({n, {code % n, code / n % n, code / n / n}});
        }
    }
}

TEST(FewFactors, EverySubsetOfTheOrdersUpToTen) {
    for (const std::uint32_t n : {7U, 8U, 9U, 10U}) {
        for (std::uint32_t mask = 1; mask < 1U << n; ++mask) {
            List list;
            for (std::uint32_t column = 0; column < n; ++column) {
                if ((mask >> column & 1U) != 0) list.push_back(column);
            }
            expectPlainDesign({n, list});
        }
    }
}

TEST(ManyReplicates, HaveThePlainLayout) {
    expectPlainDesign({48, {}, 1000, 1000}, 5.0);
    expectPlainDesign({48, {}, 1000, 8}, 5.0);
    expectPlainDesign({2, {1}, 5040, 504}, 6.0);
    expectPlainDesign({20, {19, 0}, 997, 997});
}

TEST(RandomRequests, HaveThePlainDesign) {
    std::mt19937 engine(4711);
    for (int i = 0; i < scaled(3000) && !testing::Test::HasFailure(); ++i) {
        Request request{2 + static_cast<std::uint32_t>(engine() % 47)};
        const std::size_t k = engine() % 2 == 0 ? 0 : engine() % (request.numFactors + 1);
        for (std::size_t a = 0; a < k; ++a) {
            // Now and then an index behind the last factor.
            request.categorical.push_back(
                static_cast<std::uint32_t>(engine() % (request.numFactors + (engine() % 50 == 0 ? 1 : 0))));
        }
        request.replicates = static_cast<std::uint32_t>(engine() % 8);
        request.numBlocks = static_cast<std::uint32_t>(engine() % 5);
        if (engine() % 2 == 0) {
            expectPlainDesign(request, static_cast<double>(1 + engine() % 1000) / 7.0);
        } else {
            expectPlainDesign(request);
        }
    }
}

}  // namespace
