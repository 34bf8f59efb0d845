#include "numbers.h"

#include <gtest/gtest.h>

namespace {

TEST(ParseNumber, ReadsDecimalNumbersWithPointSignAndExponent) {
    EXPECT_EQ(cli::parseNumber("1.5"), 1.5);
    EXPECT_EQ(cli::parseNumber("-2"), -2.0);
    EXPECT_EQ(cli::parseNumber("+3"), 3.0);
    EXPECT_EQ(cli::parseNumber("1e-3"), 0.001);
}

TEST(ParseNumber, RefusesEverythingThatIsNotOneFiniteNumber) {
    for (const char* text : {"", " 1", "1 ", "1,5", "x", "1x", "nan", "inf", "1e999", "+-1", "--1", "0x10"}) {
        EXPECT_EQ(cli::parseNumber(text), std::nullopt) << '"' << text << '"';
    }
}

TEST(FormatExact, GivesTheShortestTextThatReadsBackAsTheSameDouble) {
    EXPECT_EQ(cli::formatExact(0.1, '.'), "0.1");
    EXPECT_EQ(cli::formatExact(1.0 / 3, '.'), "0.3333333333333333");
    EXPECT_EQ(cli::formatExact(20, '.'), "20");
}

TEST(FormatExact, UsesTheDecimalMark) {
    EXPECT_EQ(cli::formatExact(0.25, ','), "0,25");
}

TEST(FormatExact, WritesNegativeZeroAsZero) {
    EXPECT_EQ(cli::formatExact(-0.0, '.'), "0");
}

TEST(FormatShort, KeepsSixSignificantDigits) {
    EXPECT_EQ(cli::formatShort(1.0 / 3, '.'), "0.333333");
    EXPECT_EQ(cli::formatShort(2.0 / 3, ','), "0,666667");
}

TEST(FormatShort, WritesWholeNumbersWhole) {
    EXPECT_EQ(cli::formatShort(1500000, '.'), "1500000");
    EXPECT_EQ(cli::formatShort(-12345678, '.'), "-12345678");
}

TEST(WithoutRoundingNoise, GivesTheTypedDecimalBack) {
    EXPECT_EQ(cli::withoutRoundingNoise(0.1 + 0.2), 0.3);
    EXPECT_EQ(cli::withoutRoundingNoise(123456.789), 123456.789);
}

TEST(Split, KeepsEmptyParts) {
    EXPECT_EQ(cli::split("a::b", ':'), (std::vector<std::string>{"a", "", "b"}));
    EXPECT_EQ(cli::split("", ':'), (std::vector<std::string>{""}));
    EXPECT_EQ(cli::split("a:", ':'), (std::vector<std::string>{"a", ""}));
}

TEST(Trimmed, TakesBlanksOffBothEnds) {
    EXPECT_EQ(cli::trimmed(" \ta b "), "a b");
    EXPECT_EQ(cli::trimmed("  "), "");
}

}  // namespace
