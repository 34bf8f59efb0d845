#include "component.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "usage_error.h"

namespace {

using cli::Component;
using cli::parseComponent;
using cli::parseReplicates;
using cli::Replicates;

TEST(ParseComponent, ReadsNameAndBounds) {
    const Component component = parseComponent("water=0.2:0.8", 1);
    EXPECT_EQ(component.name, "water");
    EXPECT_EQ(component.lower, 0.2);
    EXPECT_EQ(component.upper, 0.8);
}

TEST(ParseComponent, TakesZeroAndTheTotalForMissingBounds) {
    EXPECT_EQ(parseComponent("water", 100).upper, 100);
    EXPECT_EQ(parseComponent("water=:80", 100).lower, 0);
    EXPECT_EQ(parseComponent("water=20:", 100).upper, 100);
}

TEST(ParseComponent, RefusesWhatIsNoComponent) {
    for (const char* text :
         {"", "=0.1:0.2", "a=0.5", "a=x:1", "a=0:y", "a=0.5:0.2", "a=-0.1:1", "a=0:1.5", "a=0:1:2"}) {
        EXPECT_THROW(parseComponent(text, 1), cli::UsageError) << text;
    }
}

TEST(ParseReplicates, DefaultsToOneOfEach) {
    const Replicates replicates = parseReplicates("", 5);
    EXPECT_EQ(replicates.vertex, 1U);
    EXPECT_EQ(replicates.center, 1U);
    EXPECT_EQ(replicates.axial, 1U);
    EXPECT_EQ(replicates.types, (std::vector<std::uint32_t>{1, 1, 1}));
}

TEST(ParseReplicates, ReadsKindsAndPointTypes) {
    const Replicates replicates = parseReplicates("vertex=2,center=3,axial=0, 2=4,3=5", 4);
    EXPECT_EQ(replicates.vertex, 2U);
    EXPECT_EQ(replicates.center, 3U);
    EXPECT_EQ(replicates.axial, 0U);
    EXPECT_EQ(replicates.types, (std::vector<std::uint32_t>{4, 5}));
}

TEST(ParseReplicates, NamesTheKindsThatThereAre) {
    try {
        parseReplicates("4=2", 4);
        FAIL() << "accepted";
    } catch (const cli::UsageError& error) {
        EXPECT_THAT(error.what(), testing::HasSubstr("\"4\" is not vertex, center, axial or a point type from 2 to 3"));
    }
}

TEST(ParseReplicates, RefusesWhatIsNoCount) {
    for (const char* text :
         {"vertex", "vertex=", "vertex=-1", "vertex=x", "vertex=1.5", "vertex=4294967296", "1=2", ","}) {
        EXPECT_THROW(parseReplicates(text, 4), cli::UsageError) << text;
    }
}

}  // namespace
