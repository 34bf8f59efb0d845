// Designs of all kinds, built at once on different records, are those that one thread builds.
#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <vector>

#include "digest/design_digest.h"
#include "support/scale.h"
#include "threads/in_parallel.h"

namespace reisti::test {
namespace {

TEST(EightThreads, BuildDesignsOfAllKindsAsOneThreadDoes) {
    const auto count = static_cast<std::size_t>(scaled(2 * static_cast<int>(DIGEST_DESIGNS)));
    std::vector<DesignDigest> together(count);
    inParallel(count, [&](std::size_t i) { together[i] = digestOfDesign(static_cast<std::uint32_t>(i)); });
    for (std::size_t i = 0; i < count; ++i) {
        const auto number = static_cast<std::uint32_t>(i);
        ASSERT_EQ(together[i], digestOfDesign(number)) << familyOfDesign(number) << " design " << number;
    }
}

/// Every thread works on the same request, so that they go through the same code at the same time.
TEST(EightThreads, BuildTheSameDesignAtTheSameTime) {
    for (std::uint32_t number = 0; number < static_cast<std::uint32_t>(scaled(400)); ++number) {
        std::vector<DesignDigest> together(THREADS);
        inParallel(THREADS, [&](std::size_t i) { together[i] = digestOfDesign(number); });
        ASSERT_EQ(together, std::vector<DesignDigest>(THREADS, digestOfDesign(number))) << familyOfDesign(number);
    }
}

}  // namespace
}  // namespace reisti::test
