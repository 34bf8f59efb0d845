#include <cstdint>
#include <gtest/gtest.h>

#include "catalog/ff_design_catalog.h"
#include "reisti/reisti.h"

namespace {

TEST(CatalogOfTheInterface, IsTheOneThatEnginesLookFractionsUpIn) {
    std::uint32_t count = 0;
    const des_FractionalFactorial* entries = des_FractionalFactorialCatalog(&count);
    ASSERT_EQ(count, reisti::catalogRows().size());
    EXPECT_EQ(entries, reisti::catalogRows().data());
}

TEST(CatalogOfTheInterface, IsGivenWithoutACountToo) {
    EXPECT_EQ(des_FractionalFactorialCatalog(nullptr), reisti::catalogRows().data());
}

}  // namespace
