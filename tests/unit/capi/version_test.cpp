#include <fstream>
#include <gtest/gtest.h>
#include <sstream>
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
    std::istringstream text(des_Version());
    unsigned major = 0;
    unsigned minor = 0;
    unsigned patch = 0;
    char firstDot = 0;
    char secondDot = 0;
    ASSERT_TRUE(text >> major >> firstDot >> minor >> secondDot >> patch) << des_Version();
    EXPECT_EQ(firstDot, '.');
    EXPECT_EQ(secondDot, '.');
    EXPECT_TRUE(text.eof()) << "something follows the number of the patch";
}

}  // namespace
