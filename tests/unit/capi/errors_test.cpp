#include <cstdint>
#include <fstream>
#include <gtest/gtest.h>
#include <map>
#include <set>
#include <sstream>
#include <string>

#include "capi/error_table.h"
#include "reisti/reisti.h"

namespace {

using reisti::ERROR_TABLE;
using reisti::ErrorEntry;

/// The constants of the enumeration, read from the public header, so that none can be added there alone. Each stands on
/// a line of its own, `des_Name = number`; the comments between them begin with other words.
std::map<std::int32_t, std::string> codesOfTheHeader() {
    std::ifstream header(REISTI_PUBLIC_HEADER);
    EXPECT_TRUE(header.is_open());
    std::map<std::int32_t, std::string> codes;
    bool inside = false;
    for (std::string line; std::getline(header, line) && line != "} des_ErrorCode;";) {
        std::istringstream words(line);
        std::string name;
        std::string equals;
        std::int32_t code = 0;
        if (inside && words >> name >> equals >> code && name.rfind("des_", 0) == 0) codes[code] = name;
        inside = inside || line == "typedef enum des_ErrorCode {";
    }
    return codes;
}

TEST(ErrorTable, HoldsEveryCodeOfTheHeaderUnderItsName) {
    std::map<std::int32_t, std::string> table;
    for (const ErrorEntry& entry : ERROR_TABLE) {
        table[entry.code] = entry.name;
    }
    EXPECT_EQ(table, codesOfTheHeader());
    EXPECT_GE(table.size(), 19U);
}

TEST(ErrorTable, AscendsWithoutRepetition) {
    for (std::size_t i = 1; i < ERROR_TABLE.size(); ++i) {
        EXPECT_LT(ERROR_TABLE[i - 1].code, ERROR_TABLE[i].code) << ERROR_TABLE[i].name;
    }
}

TEST(ErrorTable, TextsAreDifferentSentences) {
    std::set<std::string> texts;
    for (const ErrorEntry& entry : ERROR_TABLE) {
        const std::string text = entry.text;
        ASSERT_GT(text.size(), 5U) << entry.name;
        EXPECT_TRUE(text.front() >= 'A' && text.front() <= 'Z') << text;
        EXPECT_EQ(text.back(), '.') << text;
        EXPECT_TRUE(texts.insert(text).second) << "given twice: " << text;
    }
}

TEST(ErrorCodes, AreThePublishedNumbers) {
    EXPECT_EQ(des_Success, 0);
    EXPECT_EQ(des_ErrorNumFactors, 30001);
    EXPECT_EQ(des_ErrorTooManyReplicates, 30002);
    EXPECT_EQ(des_ErrorTooManyCategorical, 30003);
    EXPECT_EQ(des_ErrorCategoricalIndex, 30004);
    EXPECT_EQ(des_ErrorBlocks, 30005);
    EXPECT_EQ(des_ErrorNullRuns, 30006);
    EXPECT_EQ(des_ErrorNullLevels, 30007);
    EXPECT_EQ(des_ErrorLowerBoundSum, 30008);
    EXPECT_EQ(des_ErrorUpperBoundSum, 30009);
    EXPECT_EQ(des_ErrorUpperBound, 30010);
    EXPECT_EQ(des_ErrorEmptyRange, 30011);
    EXPECT_EQ(des_ErrorNotSimplex, 30012);
    EXPECT_EQ(des_ErrorProcessFraction, 30013);
    EXPECT_EQ(des_ErrorAmountsAndProcess, 30014);
    EXPECT_EQ(des_ErrorDegree, 30015);
    EXPECT_EQ(des_ErrorTooManyPoints, 30016);
    EXPECT_EQ(des_ErrorOutOfMemory, 30017);
    EXPECT_EQ(des_ErrorNullPointer, 30018);
}

TEST(ErrorMessage, IsTheTextOfTheTable) {
    for (const ErrorEntry& entry : ERROR_TABLE) {
        EXPECT_STREQ(des_ErrorMessage(entry.code), entry.text) << entry.name;
    }
}

TEST(ErrorMessage, UnknownCodesGiveASentenceOfTheirOwn) {
    const std::string unknown = des_ErrorMessage(1);
    EXPECT_FALSE(unknown.empty());
    for (const std::int32_t code : {-1, 2, 30000, 29999, 39999, INT32_MIN, INT32_MAX}) {
        ASSERT_NE(des_ErrorMessage(code), nullptr) << code;
        EXPECT_EQ(des_ErrorMessage(code), unknown) << code;
    }
    for (const ErrorEntry& entry : ERROR_TABLE) {
        EXPECT_NE(entry.text, unknown) << entry.name;
    }
}

TEST(ErrorMessage, IsNeverNullAroundTheTable) {
    for (std::int32_t code = 29990; code <= 30100; ++code) {
        ASSERT_NE(des_ErrorMessage(code), nullptr) << code;
    }
}

TEST(ErrorMessage, IsConstantStorage) {
    EXPECT_EQ(des_ErrorMessage(30001), des_ErrorMessage(30001));
}

}  // namespace
