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
    EXPECT_FALSE(table.empty());
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

// Hosts have the numbers compiled in. They stand here once more so that none changes unseen.
TEST(ErrorCodes, AreThePublishedNumbers) {
    const std::map<std::int32_t, std::string> published = {
        {0, "des_Success"},
        {30001, "des_ErrorNumFactors"},
        {30002, "des_ErrorTooManyReplicates"},
        {30003, "des_ErrorTooManyCategorical"},
        {30004, "des_ErrorCategoricalIndex"},
        {30005, "des_ErrorBlocks"},
        {30006, "des_ErrorNullRuns"},
        {30007, "des_ErrorNullLevels"},
        {30008, "des_ErrorLowerBoundSum"},
        {30009, "des_ErrorUpperBoundSum"},
        {30010, "des_ErrorUpperBound"},
        {30011, "des_ErrorEmptyRange"},
        {30012, "des_ErrorNotSimplex"},
        {30013, "des_ErrorProcessFraction"},
        {30014, "des_ErrorAmountsAndProcess"},
        {30015, "des_ErrorDegree"},
        {30016, "des_ErrorTooManyPoints"},
        {30017, "des_ErrorOutOfMemory"},
        {30018, "des_ErrorNullPointer"},
        {30019, "des_ErrorNotANumber"},
    };
    EXPECT_EQ(codesOfTheHeader(), published);
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
