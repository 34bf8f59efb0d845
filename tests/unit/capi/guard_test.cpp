#include "capi/guard.h"

#include <cstdint>
#include <gtest/gtest.h>
#include <new>
#include <stdexcept>

namespace {

TEST(Guard, PassesTheCodeOfTheBody) {
    EXPECT_EQ(reisti::guard([]() -> std::int32_t { return 30004; }), 30004);
    EXPECT_EQ(reisti::guard([]() -> std::int32_t { return 0; }), 0);
}

TEST(Guard, FailedAllocationIsOutOfMemory) {
    EXPECT_EQ(reisti::guard([]() -> std::int32_t { throw std::bad_alloc(); }), des_ErrorOutOfMemory);
}

TEST(Guard, VectorThatCouldNeverBeAllocatedIsOutOfMemory) {
    EXPECT_EQ(reisti::guard([]() -> std::int32_t { throw std::length_error("vector"); }), des_ErrorOutOfMemory);
}

TEST(Guard, LetsNothingElseOutEither) {
    EXPECT_NE(reisti::guard([]() -> std::int32_t { throw std::runtime_error("any"); }), des_Success);
    EXPECT_NE(reisti::guard([]() -> std::int32_t { throw 42; }), des_Success);
}

}  // namespace
