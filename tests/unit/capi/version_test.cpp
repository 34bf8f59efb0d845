#include <fstream>
#include <gtest/gtest.h>
#include <regex>
#include <string>

#include "reisti/reisti.h"

namespace {

TEST(Version, IsTheFirstLineOfTheVersionFile) {
    std::ifstream file(REISTI_VERSION_FILE);
    std::string line;
    ASSERT_TRUE(std::getline(file, line));
    EXPECT_EQ(des_Version(), line);
}

TEST(Version, IsThreeNumbers) {
    EXPECT_TRUE(std::regex_match(des_Version(), std::regex(R"(\d+\.\d+\.\d+)"))) << des_Version();
}

}  // namespace
