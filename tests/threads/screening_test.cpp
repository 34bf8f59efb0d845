// Screening designs, whose random orders draw on shared sources of seeds.
#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <memory>
#include <numeric>
#include <vector>

#include "reisti/reisti.h"
#include "support/scale.h"
#include "support/screening_arrays.h"
#include "threads/in_parallel.h"

namespace {

using reisti::test::inParallel;
using reisti::test::scaled;
using reisti::test::ScreeningArrays;
using reisti::test::plain::PlainRun;
using reisti::test::plain::Request;

Request requestNumber(std::uint32_t number) {
    Request request{2 + number % 47};
    const std::uint32_t k = number % 5 * request.numFactors / 4;
    for (std::uint32_t c = 0; c < k; ++c) {
        request.categorical.push_back(k - 1 - c);
    }
    request.replicates = 1 + number % 4;
    request.numBlocks = number % 3 == 0 ? request.replicates : 1;
    return request;
}

std::unique_ptr<ScreeningArrays> arraysNumber(std::uint32_t number) {
    auto arrays = std::make_unique<ScreeningArrays>(requestNumber(number));
    arrays->randomized(1.0 + number).design.randomize = number % 2 == 0;
    return arrays;
}

TEST(ManyThreads, BuildTheDesignsThatOneThreadBuilds) {
    const auto count = static_cast<std::uint32_t>(scaled(2000));
    std::vector<std::unique_ptr<ScreeningArrays>> parallel;
    for (std::uint32_t i = 0; i < count; ++i) {
        parallel.push_back(arraysNumber(i));
    }
    std::vector<std::int32_t> codes(count, -1);
    inParallel(count, [&](std::size_t i) { codes[i] = des_CreateDefinitiveScreeningDesign(&parallel[i]->design); });

    for (std::uint32_t i = 0; i < count; ++i) {
        const auto serial = arraysNumber(i);
        ASSERT_EQ(serial->create(), codes[i]) << i;
        std::vector<std::optional<PlainRun>> expected;
        for (std::size_t run = 0; run < serial->numRuns(); ++run) {
            expected.emplace_back(serial->run(run));
        }
        ASSERT_EQ(parallel[i]->differenceFrom(expected), "") << i;
    }
}

TEST(ManyThreads, DrawFreshSeedsAtTheSameTime) {
    const auto count = static_cast<std::size_t>(scaled(400));
    std::vector<std::unique_ptr<ScreeningArrays>> arrays;
    for (std::size_t i = 0; i < count; ++i) {
        arrays.push_back(std::make_unique<ScreeningArrays>(Request{24}));
        arrays.back()->randomized(0.0);
    }
    inParallel(count, [&](std::size_t i) { des_CreateDefinitiveScreeningDesign(&arrays[i]->design); });

    std::vector<std::vector<std::uint32_t>> orders;
    orders.reserve(count);
    for (const auto& design : arrays) {
        orders.push_back(design->runOrders());
    }
    std::sort(orders.begin(), orders.end());
    EXPECT_EQ(std::adjacent_find(orders.begin(), orders.end()), orders.end()) << "two designs share their order";
}

TEST(ManyThreads, ReadConstantTexts) {
    std::vector<const char*> texts(400);
    inParallel(texts.size(), [&](std::size_t i) { texts[i] = i % 2 == 0 ? des_Version() : des_ErrorMessage(30001); });
    for (std::size_t i = 2; i < texts.size(); ++i) {
        EXPECT_EQ(texts[i], texts[i % 2]);
    }
}

}  // namespace
