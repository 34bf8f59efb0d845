#include <algorithm>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <set>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "support/plain_process.h"
#include "unit/mixture/expect_plain.h"

namespace reisti::test {
namespace {

using testing::Each;
using testing::ElementsAre;
using testing::ElementsAreArray;

using Settings = std::vector<std::vector<std::int32_t>>;

MixtureRequest crossed(std::uint32_t numComponents, std::uint32_t p, std::uint32_t f, std::uint32_t index = 1) {
    MixtureRequest request = centroidRequest(numComponents);
    request.numProcessVariables = p;
    request.processFraction = f;
    request.fractionIndex = index;
    return request;
}

/// The levels of every first run of a block of `blockSize` runs.
Settings settingsOf(const MixtureOutcome& design, std::size_t blockSize) {
    Settings settings;
    for (std::size_t i = 0; i < design.runs.size(); i += blockSize)
        settings.push_back(design.runs[i].processLevels);
    return settings;
}

Settings settingsOfFraction(std::uint32_t p, std::uint32_t f, std::uint32_t index) {
    return settingsOf(builtDesign(crossed(2, p, f, index)), 3);
}

TEST(ProcessVariables, FullFactorialCrossesAllSettingsFirstVariableFastest) {
    const auto design = builtDesign(crossed(3, 2, 1));
    ASSERT_EQ(design.runs.size(), 28U);
    EXPECT_THAT(settingsOf(design, 7),
                ElementsAre(ElementsAre(-1, -1), ElementsAre(1, -1), ElementsAre(-1, 1), ElementsAre(1, 1)));
}

TEST(ProcessVariables, EveryRunOfABlockHasTheSameSetting) {
    const auto design = builtDesign(crossed(3, 2, 1));
    for (std::size_t i = 0; i < 28; ++i)
        EXPECT_EQ(design.runs[i].processLevels, design.runs[i / 7 * 7].processLevels);
}

TEST(ProcessVariables, EveryBlockRepeatsTheMixtures) {
    const auto design = builtDesign(crossed(3, 2, 1));
    EXPECT_THAT(ordersOf(design), ElementsAreArray(standardOrder(28)));
    for (std::size_t i = 7; i < 28; ++i) {
        EXPECT_EQ(design.runs[i].proportions, design.runs[i - 7].proportions);
        EXPECT_EQ(design.runs[i].pointType, design.runs[i - 7].pointType);
    }
}

TEST(ProcessVariables, OneVariableHasTwoSettings) {
    EXPECT_THAT(settingsOfFraction(1, 1, 1), ElementsAre(ElementsAre(-1), ElementsAre(1)));
}

TEST(ProcessVariables, HalfOfThreeHasTheNegativeGeneratorByDefault) {
    EXPECT_THAT(settingsOfFraction(3, 2, 1), ElementsAre(ElementsAre(-1, -1, -1), ElementsAre(1, -1, 1),
                                                         ElementsAre(-1, 1, 1), ElementsAre(1, 1, -1)));
}

TEST(ProcessVariables, SecondHalfOfThreeIsThePrincipalFraction) {
    EXPECT_THAT(settingsOfFraction(3, 2, 2), ElementsAre(ElementsAre(-1, -1, 1), ElementsAre(1, -1, -1),
                                                         ElementsAre(-1, 1, -1), ElementsAre(1, 1, 1)));
}

TEST(ProcessVariables, QuartersOfFiveHaveTheFourCombinationsOfSigns) {
    // At the first setting both generators AB and AC are products of two negative levels.
    const auto added = [](std::uint32_t index) {
        const auto levels = settingsOfFraction(5, 4, index)[0];
        return std::vector<std::int32_t>{levels[3], levels[4]};
    };
    EXPECT_THAT(added(1), ElementsAre(-1, -1));
    EXPECT_THAT(added(2), ElementsAre(1, -1));
    EXPECT_THAT(added(3), ElementsAre(-1, 1));
    EXPECT_THAT(added(4), ElementsAre(1, 1));
}

TEST(ProcessVariables, EighthsOfSixHaveTheEightCombinationsOfSigns) {
    // Generators AB, AC and BC: all products are positive at the first setting, so the levels are the signs.
    std::set<std::vector<std::int32_t>> signs;
    for (std::uint32_t index = 1; index <= 8; ++index) {
        const auto levels = settingsOfFraction(6, 8, index)[0];
        signs.insert({levels.begin() + 3, levels.end()});
    }
    EXPECT_EQ(signs.size(), 8U);
}

struct Fraction {
    std::uint32_t p;
    std::uint32_t f;
    std::string name() const { return "OneIn" + std::to_string(f) + "Of" + std::to_string(p); }
};

class OfferedFraction : public testing::TestWithParam<Fraction> {};

TEST_P(OfferedFraction, GivesThePlainSettingsForEveryIndex) {
    const auto [p, f] = GetParam();
    // Index 0 and those above the number of fractions have no fraction of their own, but the rule for signs covers
    // them.
    for (std::uint32_t index = 0; index <= f + 2; ++index) {
        SCOPED_TRACE(index);
        EXPECT_EQ(settingsOfFraction(p, f, index), plainProcessSettings(p, f, index));
    }
    EXPECT_EQ(settingsOfFraction(p, f, 0xFFFFFFFF), plainProcessSettings(p, f, 0xFFFFFFFF));
}

TEST_P(OfferedFraction, LastIndexIsThePrincipalFraction) {
    const auto [p, f] = GetParam();
    // The last setting has all base levels at +1, and so all products.
    EXPECT_THAT(settingsOfFraction(p, f, f).back(), Each(1));
}

TEST_P(OfferedFraction, AllTogetherAreTheFullFactorial) {
    const auto [p, f] = GetParam();
    std::set<std::vector<std::int32_t>> all;
    std::size_t count = 0;
    for (std::uint32_t index = 1; index <= f; ++index) {
        const auto settings = settingsOfFraction(p, f, index);
        count += settings.size();
        all.insert(settings.begin(), settings.end());
    }
    EXPECT_EQ(count, std::size_t{1} << p);
    EXPECT_EQ(all.size(), std::size_t{1} << p);
}

TEST_P(OfferedFraction, ColumnsAreOrthogonal) {
    const auto [p, f] = GetParam();
    const auto settings = settingsOfFraction(p, f, 1);
    for (std::size_t a = 0; a < p; ++a) {
        for (std::size_t b = 0; b < a; ++b) {
            std::int32_t product = 0;
            for (const auto& levels : settings)
                product += levels[a] * levels[b];
            EXPECT_EQ(product, 0) << a << ", " << b;
        }
    }
}

TEST_P(OfferedFraction, OfAThreeComponentDesignIsThePlainDesign) {
    const auto [p, f] = GetParam();
    MixtureRequest request = crossed(3, p, f, f);
    request.axialPoints = 1;
    request.vertexReplicates = 2;
    request.designReplicates = 2;
    expectPlain(request);
}

INSTANTIATE_TEST_SUITE_P(All, OfferedFraction,
                         testing::Values(Fraction{1, 1}, Fraction{2, 1}, Fraction{3, 1}, Fraction{3, 2}, Fraction{4, 1},
                                         Fraction{4, 2}, Fraction{5, 1}, Fraction{5, 2}, Fraction{5, 4}, Fraction{6, 1},
                                         Fraction{6, 2}, Fraction{6, 4}, Fraction{6, 8}, Fraction{7, 1}, Fraction{7, 2},
                                         Fraction{7, 4}, Fraction{7, 8}, Fraction{7, 16}, Fraction{8, 1},
                                         Fraction{8, 2}, Fraction{8, 4}, Fraction{8, 8}, Fraction{8, 16},
                                         Fraction{9, 4}, Fraction{9, 8}, Fraction{9, 16}, Fraction{10, 8},
                                         Fraction{10, 16}, Fraction{11, 16}),
                         [](const auto& instance) { return instance.param.name(); });

TEST(ProcessFraction, UpToSevenVariablesIsAcceptedAsListed) {
    for (std::uint32_t p = 1; p <= 7; ++p) {
        for (std::uint32_t f = 1; f <= 33; ++f) {
            const std::int32_t expected = plainFractionAllowed(p, f) ? des_Success : des_ErrorProcessFraction;
            EXPECT_EQ(builtDesign(crossed(2, p, f)).code, expected) << "p " << p << ", f " << f;
        }
    }
}

TEST(ProcessFraction, IsNotReadWithoutProcessVariables) {
    for (const std::uint32_t f : {0U, 3U, 0xFFFFFFFFU})
        EXPECT_EQ(builtDesign(crossed(3, 0, f)).code, des_Success);
}

TEST(ProcessFraction, NotOfferedChangesNothing) {
    MixtureRequest request = crossed(3, 3, 4);
    request.amounts = {50};
    request.upperBounds = {50, 50, 50};
    MixtureRecord record(request);
    record->boundsAdjusted = 1;
    const auto before = record.bytes();
    EXPECT_EQ(record.run(), des_ErrorProcessFraction);
    EXPECT_EQ(record.bytes(), before);
}

TEST(ProcessFraction, IsRefusedBeforeTheBoundsAreLookedAt) {
    MixtureRequest request = crossed(3, 5, 8);
    request.lowerBounds = {1, 1, 1};
    EXPECT_EQ(builtDesign(request).code, des_ErrorProcessFraction);
}

class ImpossibleFraction : public testing::TestWithParam<Fraction> {};

TEST_P(ImpossibleFraction, IsRefusedAndLeavesRunsUntouched) {
    const auto [p, f] = GetParam();
    MixtureRecord record(crossed(3, p, f));
    des_MixtureRun theirs{};
    record->runs = &theirs;
    record->numRuns = 77;
    EXPECT_EQ(record.run(), des_ErrorProcessFraction);
    EXPECT_EQ(record->runs, &theirs);
    EXPECT_EQ(record->numRuns, 77U);
    EXPECT_THAT(record.scaledLowerBounds, Each(POISON_NUMBER));
    EXPECT_THAT(record.pointsPerType, Each(POISON_COUNT));
    record->runs = nullptr;
    record->numRuns = 0;
}

// A fraction of 0 divides by nothing, one above 2^p leaves no settings.
INSTANTIATE_TEST_SUITE_P(All, ImpossibleFraction,
                         testing::Values(Fraction{1, 0}, Fraction{2, 0}, Fraction{3, 0}, Fraction{4, 0}, Fraction{5, 0},
                                         Fraction{7, 0}, Fraction{8, 0}, Fraction{15, 0}, Fraction{40, 0},
                                         Fraction{8, 257}, Fraction{9, 513}, Fraction{8, 0xFFFFFFFF},
                                         Fraction{31, 0x80000001}),
                         [](const auto& instance) { return instance.param.name(); });

class UncataloguedFraction : public testing::TestWithParam<Fraction> {
  protected:
    MixtureRequest request() const {
        MixtureRequest request = crossed(3, GetParam().p, GetParam().f);
        request.amounts = {10};
        request.lowerBounds = {1, 2, 3};
        request.upperBounds = {10, 10, 10};
        return request;
    }
    std::size_t numSettings() const { return (std::uint64_t{1} << GetParam().p) / GetParam().f; }
};

TEST_P(UncataloguedFraction, IsRefused) {
    EXPECT_EQ(builtDesign(request()).code, des_ErrorProcessFraction);
}

TEST_P(UncataloguedFraction, KeepsTheMixtureRunsOfTheFirstBlock) {
    const auto refused = builtDesign(request());
    const auto uncrossed = builtDesign(centroidRequest(3));
    ASSERT_EQ(refused.runs.size(), 7 * numSettings());
    for (std::size_t i = 0; i < 7; ++i) {
        EXPECT_EQ(refused.runs[i].proportions, uncrossed.runs[i].proportions);
        EXPECT_EQ(refused.runs[i].pointType, uncrossed.runs[i].pointType);
        EXPECT_EQ(refused.runs[i].runOrder, i + 1);
    }
}

TEST_P(UncataloguedFraction, LeavesAllProcessLevelsZero) {
    const auto refused = builtDesign(request());
    for (const auto& run : refused.runs) {
        EXPECT_EQ(run.processLevels.size(), GetParam().p);
        EXPECT_THAT(run.processLevels, Each(0));
    }
}

TEST_P(UncataloguedFraction, LeavesTheBoundsDividedAndTightened) {
    const auto refused = builtDesign(request());
    EXPECT_THAT(refused.lowerBounds, ElementsAre(0.1, 0.2, 0.3));
    EXPECT_THAT(refused.upperBounds, Each(testing::Lt(0.8)));
    EXPECT_TRUE(refused.boundsAdjusted);
}

TEST_P(UncataloguedFraction, LeavesTheOutputArraysUntouched) {
    MixtureRecord record(request());
    record.run();
    for (const auto* numbers :
         {&record.scaledLowerBounds, &record.scaledUpperBounds, &record.pseudoLowerBounds, &record.pseudoUpperBounds})
        EXPECT_THAT(*numbers, Each(POISON_NUMBER));
    EXPECT_THAT(record.pointsPerType, Each(POISON_COUNT));
    EXPECT_THAT(record.boundaryCounts, Each(POISON_COUNT));
}

TEST_P(UncataloguedFraction, LeavesWhatThePlainDesignLeaves) {
    EXPECT_TRUE(sameOutcome(builtDesign(request()), plainDesign(request())));
}

INSTANTIATE_TEST_SUITE_P(All, UncataloguedFraction,
                         testing::Values(Fraction{9, 2}, Fraction{10, 2}, Fraction{10, 4}, Fraction{12, 16},
                                         Fraction{8, 3}, Fraction{8, 256}, Fraction{8, 128}, Fraction{16, 16},
                                         Fraction{16, 16384}, Fraction{33, 0x80000000}),
                         [](const auto& instance) { return instance.param.name(); });

TEST(ProcessFraction, OfAnotherSizeTakesTheFirstSettingsOfTheFullFactorial) {
    // 512 / 31 and 512 / 32 both leave 16 settings, for which nine factors have an entry.
    for (const std::uint32_t f : {31U, 32U}) {
        const auto settings = settingsOfFraction(9, f, 1);
        ASSERT_EQ(settings.size(), 16U);
        EXPECT_THAT(settings.front(), Each(-1));
        EXPECT_THAT(settings[1], ElementsAre(1, -1, -1, -1, -1, -1, -1, -1, -1));
        EXPECT_THAT(settings.back(), ElementsAre(1, 1, 1, 1, -1, -1, -1, -1, -1));
        EXPECT_EQ(settings, plainProcessSettings(9, f, 1));
    }
}

TEST(ProcessVariables, AboveThirtyWithFewSettingsAreCountedWithoutOverflow) {
    // 2^64 / 2^31 settings would fit no count; 2^33 / 2^31 are four, for which the catalog has no entry.
    EXPECT_EQ(builtDesign(crossed(2, 64, 0x80000000)).code, des_ErrorOutOfMemory);
    EXPECT_EQ(builtDesign(crossed(2, 33, 0x80000000)).code, des_ErrorProcessFraction);
}

TEST(ProcessVariables, TooManyForThirtyTwoBitsAreOutOfMemory) {
    for (const std::uint32_t p : {31U, 32U, 63U, 64U, 65U, 1023U, 1024U, 1025U, 0x7FFFFFFFU, 0xFFFFFFFFU})
        EXPECT_EQ(builtDesign(crossed(3, p, 1)).code, des_ErrorOutOfMemory) << p;
}

TEST(ProcessVariables, OfALatticeWithCentreAndAxialPointsAreThePlainDesign) {
    MixtureRequest request = latticeRequest(4, 3, 1);
    request.axialPoints = 1;
    request.numProcessVariables = 4;
    request.processFraction = 2;
    request.randomize = 1;
    request.seed = 8.5;
    expectPlain(request);
}

}  // namespace
}  // namespace reisti::test
