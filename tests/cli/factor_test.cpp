#include "factor.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "usage_error.h"

namespace {

using cli::Cell;
using cli::Factor;
using cli::parseFactor;

TEST(ParseFactor, ReadsARangeWithUnit) {
    const Factor factor = parseFactor("--factor", "Temp=20:80:degC");
    EXPECT_EQ(factor.name, "Temp");
    EXPECT_EQ(factor.low, 20);
    EXPECT_EQ(factor.high, 80);
    EXPECT_EQ(factor.unit, "degC");
    EXPECT_FALSE(factor.isCategorical);
}

TEST(ParseFactor, KeepsColonsOfTheUnit) {
    EXPECT_EQ(parseFactor("--factor", "Ratio=1:2:a:b").unit, "a:b");
}

TEST(ParseFactor, ReadsTwoWords) {
    const Factor factor = parseFactor("--factor", "Solvent = water | ethanol ");
    EXPECT_EQ(factor.name, "Solvent");
    EXPECT_TRUE(factor.isCategorical);
    EXPECT_EQ(factor.lowWord, "water");
    EXPECT_EQ(factor.highWord, "ethanol");
}

struct BadFactor {
    const char* text;
    const char* problem;
};

class ParseFactorRefuses : public testing::TestWithParam<BadFactor> {};

TEST_P(ParseFactorRefuses, WithTheArgumentAndTheProblem) {
    try {
        parseFactor("--factor", GetParam().text);
        FAIL() << "accepted " << GetParam().text;
    } catch (const cli::UsageError& error) {
        EXPECT_THAT(error.what(), testing::HasSubstr(std::string("--factor \"") + GetParam().text + '"'));
        EXPECT_THAT(error.what(), testing::HasSubstr(GetParam().problem));
    }
}

INSTANTIATE_TEST_SUITE_P(
    Texts, ParseFactorRefuses,
    testing::Values(BadFactor{"Temp", "expected NAME=LOW:HIGH"}, BadFactor{"=1:2", "name"},
                    BadFactor{"Temp=20", "expected LOW:HIGH"}, BadFactor{"Temp=a:80", "\"a\" is not a number"},
                    BadFactor{"Temp=20:", "\"\" is not a number"}, BadFactor{"Temp=20:nan", "\"nan\" is not a number"},
                    BadFactor{"Temp=80:20", "below"}, BadFactor{"Temp=20:20", "below"},
                    BadFactor{"S=a|b|c", "exactly two"}, BadFactor{"S=a|", "empty"}, BadFactor{"S=a|a", "the same"}),
    [](const auto& row) { return "Text" + std::to_string(row.index); });

TEST(FactorLevel, GivesRealLevelsAndTheirMiddle) {
    const Factor factor = parseFactor("--factor", "x=0.1:0.7");
    EXPECT_EQ(factor.level(-1, false), Cell(0.1));
    EXPECT_EQ(factor.level(0, false), Cell(0.4));
    EXPECT_EQ(factor.level(1, false), Cell(0.7));
}

TEST(FactorLevel, GivesWordsOfACategoricalFactor) {
    const Factor factor = parseFactor("--factor", "s=water|ethanol");
    EXPECT_EQ(factor.level(-1, false), Cell(std::string("water")));
    EXPECT_EQ(factor.level(1, false), Cell(std::string("ethanol")));
}

TEST(FactorLevel, GivesCodesOnRequest) {
    EXPECT_EQ(parseFactor("--factor", "s=water|ethanol").level(-1, true), Cell(std::int64_t{-1}));
    EXPECT_EQ(parseFactor("--factor", "x=20:80").level(0, true), Cell(std::int64_t{0}));
}

}  // namespace
