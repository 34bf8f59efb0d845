#include "constraint.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "usage_error.h"

namespace {

using cli::Constraint;
using cli::parseConstraint;

const std::vector<std::string> kNames = {"A", "B", "C", "AB", "Solvent X"};

struct Reading {
    const char* name;
    const char* text;
    std::vector<double> coefficients;
    std::optional<double> lower;
    std::optional<double> upper;
};

class ParseConstraint : public testing::TestWithParam<Reading> {};

TEST_P(ParseConstraint, GivesTheLinearFormAndItsSides) {
    const Constraint constraint = parseConstraint(GetParam().text, kNames);
    EXPECT_EQ(constraint.coefficients, GetParam().coefficients);
    EXPECT_EQ(constraint.lower, GetParam().lower);
    EXPECT_EQ(constraint.upper, GetParam().upper);
    EXPECT_EQ(constraint.text, GetParam().text);
}

INSTANTIATE_TEST_SUITE_P(
    Texts, ParseConstraint,
    testing::Values(Reading{"TwoSided", "0.1 <= 2*A - B + 0.5*C <= 0.4", {2, -1, 0.5, 0, 0}, 0.1, 0.4},
                    Reading{"TwoSidedDescending", "0.4 >= A >= 0.1", {1, 0, 0, 0, 0}, 0.1, 0.4},
                    Reading{"UpperOnly", "A + B <= 0.5", {1, 1, 0, 0, 0}, {}, 0.5},
                    Reading{"LowerOnly", "A + B >= 0.5", {1, 1, 0, 0, 0}, 0.5, {}},
                    Reading{"ArrowWrittenTheOtherWay", "A => 0.5", {1, 0, 0, 0, 0}, 0.5, {}},
                    Reading{"NumberOnTheLeft", "0.5 <= A", {1, 0, 0, 0, 0}, 0.5, {}},
                    Reading{"NumberOnTheLeftAtLeast", "0.5 >= A", {1, 0, 0, 0, 0}, {}, 0.5},
                    Reading{"ZeroRightSide", "A >= 2*B", {1, -2, 0, 0, 0}, 0, {}},
                    Reading{"TermsOnBothSides", "A + 0.1 <= 2*B - C", {1, -2, 1, 0, 0}, {}, -0.1},
                    Reading{"NumberBehindName", "A*2*3 <= 1", {6, 0, 0, 0, 0}, {}, 1},
                    Reading{"LeadingMinus", "-A <= -0.5", {-1, 0, 0, 0, 0}, {}, -0.5},
                    Reading{"RepeatedName", "A + A - B <= 1", {2, -1, 0, 0, 0}, {}, 1},
                    Reading{"ConstantInTheMiddle", "0 <= A - 0.25 <= 0.5", {1, 0, 0, 0, 0}, 0.25, 0.75},
                    Reading{"LongestNameWins", "AB <= 1", {0, 0, 0, 1, 0}, {}, 1},
                    Reading{"NameWithBlank", "2*Solvent X - A <= 1", {-1, 0, 0, 0, 2}, {}, 1},
                    Reading{"NoBlanks", "2*A-B<=1e-1", {2, -1, 0, 0, 0}, {}, 0.1}),
    [](const auto& row) { return std::string(row.param.name); });

struct BadConstraint {
    const char* name;
    const char* text;
    const char* problem;
};

class ParseConstraintRefuses : public testing::TestWithParam<BadConstraint> {};

TEST_P(ParseConstraintRefuses, WithTheArgumentAndTheProblem) {
    try {
        parseConstraint(GetParam().text, kNames);
        FAIL() << "accepted " << GetParam().text;
    } catch (const cli::UsageError& error) {
        EXPECT_THAT(error.what(), testing::HasSubstr(std::string("--constraint \"") + GetParam().text + '"'));
        EXPECT_THAT(error.what(), testing::HasSubstr(GetParam().problem));
    }
}

INSTANTIATE_TEST_SUITE_P(
    Texts, ParseConstraintRefuses,
    testing::Values(BadConstraint{"Empty", "", "missing"}, BadConstraint{"NoRelation", "A + B", "no <= or >="},
                    BadConstraint{"Equation", "A = 0.5", "equation"},
                    BadConstraint{"DoubleEquals", "A == 0.5", "equation"}, BadConstraint{"Strict", "A < 0.5", "use <="},
                    BadConstraint{"StrictGreater", "A > 0.5", "use >="},
                    BadConstraint{"UnknownName", "D <= 1", "\"D\" is not a component"},
                    BadConstraint{"UnknownLongName", "ABC <= 1", "\"ABC\" is not a component"},
                    BadConstraint{"Product", "A*B <= 1", "linear"}, BadConstraint{"MissingStar", "2A <= 1", "*"},
                    BadConstraint{"Division", "A/2 <= 1", "unexpected"},
                    BadConstraint{"Parenthesis", "2*(A + B) <= 1", "expected a number"},
                    BadConstraint{"MissingSide", "A <=", "missing at the end"},
                    BadConstraint{"NamesOutside", "A <= B <= C", "outer sides"},
                    BadConstraint{"Opposite", "0.1 <= A >= 0.2", "different directions"},
                    BadConstraint{"ThreeRelations", "0 <= A <= 1 <= 2", "more than two"},
                    BadConstraint{"NothingLeft", "A - A <= 1", "no component"},
                    BadConstraint{"EmptyInterval", "0.5 <= A <= 0.1", "above"},
                    BadConstraint{"Overflow", "1e308*10*A <= 1", "too large"},
                    BadConstraint{"TwoNames", "A B <= 1", "unexpected"}),
    [](const auto& row) { return std::string(row.param.name); });

}  // namespace
