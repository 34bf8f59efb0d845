#include <gtest/gtest.h>
#include <sstream>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "support/catalog_table.h"

namespace reisti::test {
namespace {

std::vector<std::string> wordsOf(const char* text) {
    std::istringstream in(text);
    std::vector<std::string> words;
    for (std::string word; in >> word;)
        words.push_back(word);
    return words;
}

TEST(FractionalFactorialCatalog, HasTheEntriesOfTheTableInItsOrder) {
    std::uint32_t count = 0;
    const des_FractionalFactorial* entries = des_FractionalFactorialCatalog(&count);
    ASSERT_EQ(count, catalogTable().size());
    for (std::size_t i = 0; i < count; ++i) {
        const CatalogRow& row = catalogTable()[i];
        SCOPED_TRACE(row.name());
        EXPECT_EQ(entries[i].numFactors, row.numFactors);
        EXPECT_EQ(entries[i].numRuns, row.numRuns);
        EXPECT_EQ(entries[i].resolution, row.resolution);
        EXPECT_EQ(entries[i].maxBlocks, row.maxBlocks);
        EXPECT_EQ(wordsOf(entries[i].generators), row.generators);
        EXPECT_EQ(wordsOf(entries[i].blockGenerators), row.blockGenerators);
    }
}

TEST(FractionalFactorialCatalog, IsTheSameStorageEachTime) {
    std::uint32_t count = 0;
    EXPECT_EQ(des_FractionalFactorialCatalog(&count), des_FractionalFactorialCatalog(nullptr));
}

}  // namespace
}  // namespace reisti::test
