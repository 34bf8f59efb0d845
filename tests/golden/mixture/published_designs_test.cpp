// Designs as they are printed in the literature.
#include <algorithm>
#include <cmath>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <map>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "support/golden_lines.h"
#include "support/mixture_record.h"
#include "support/plain_process.h"

namespace reisti::test {
namespace {

constexpr double kExactMixture = 1e-12;

std::uint32_t countOf(const GoldenLines& golden, const std::string& keyword, std::uint32_t otherwise) {
    return golden.has(keyword) ? static_cast<std::uint32_t>(golden.integer(keyword)) : otherwise;
}

MixtureRequest requestOf(const GoldenLines& golden) {
    MixtureRequest request = centroidRequest(countOf(golden, "numComponents", 0));
    request.lattice = golden.has("design") && golden.only("design").at(0) == "lattice";
    request.degree = static_cast<std::int32_t>(countOf(golden, "degree", 1));
    request.centerPoint = static_cast<std::uint8_t>(countOf(golden, "centerPoint", 0));
    request.axialPoints = static_cast<std::uint8_t>(golden.has("axialPoints"));
    request.vertexReplicates = countOf(golden, "vertexReplicates", 1);
    if (golden.has("typeReplicates")) request.typeReplicates = {countOf(golden, "typeReplicates", 1)};
    if (golden.has("amounts")) request.amounts = golden.numbers("amounts");
    if (golden.has("lowerBounds")) request.lowerBounds = golden.numbers("lowerBounds");
    if (golden.has("upperBounds")) request.upperBounds = golden.numbers("upperBounds");
    request.outputUnits = countOf(golden, "outputUnits", 0);
    request.numProcessVariables = countOf(golden, "numProcessVariables", 0);
    request.processFraction = countOf(golden, "processFraction", 1);
    request.fractionIndex = countOf(golden, "fractionIndex", 1);
    return request;
}

/// The point type and the mixture of a line "type | x1 x2 ..".
struct Blend {
    std::int32_t pointType;
    std::vector<double> mixture;
};

std::vector<Blend> blendsOf(const GoldenLines& golden, const std::string& keyword) {
    std::vector<Blend> blends;
    for (const auto& words : golden.all(keyword)) {
        const auto groups = groupsOf(words);
        blends.push_back({std::stoi(groups.at(0).at(0)), numbersFrom(groups.at(1))});
    }
    return blends;
}

void expectNear(const std::vector<double>& actual, const std::vector<double>& expected, double tolerance) {
    ASSERT_EQ(actual.size(), expected.size());
    for (std::size_t i = 0; i < actual.size(); ++i)
        EXPECT_NEAR(actual[i], expected[i], tolerance);
}

std::vector<std::vector<std::int32_t>> settingsIn(const GoldenLines& golden) {
    std::vector<std::vector<std::int32_t>> settings;
    for (const auto& words : golden.all("setting")) {
        settings.emplace_back();
        for (const auto& word : words)
            settings.back().push_back(std::stoi(word));
    }
    return settings;
}

class SimplexDesign : public testing::TestWithParam<std::string> {
  protected:
    const GoldenLines golden_{"mixture/simplex_" + GetParam() + ".txt"};
    const MixtureRequest request_ = requestOf(golden_);
    const MixtureOutcome design_ = builtDesign(request_);
    const double total_ = request_.amounts.empty() ? 1.0 : request_.amounts[0];
};

TEST_P(SimplexDesign, HasTheStatedCounts) {
    ASSERT_EQ(design_.code, des_Success);
    EXPECT_EQ(design_.runs.size(), static_cast<std::size_t>(golden_.integer("numRuns")));
    EXPECT_EQ(design_.numAxialPoints, countOf(golden_, "numAxialPoints", 0));
    if (golden_.has("pointsPerType")) {
        const auto counts = golden_.numbers("pointsPerType");
        EXPECT_EQ(std::vector<double>(design_.pointsPerType.begin(), design_.pointsPerType.end()), counts);
        EXPECT_EQ(design_.numCenterPoints, countOf(golden_, "numCenterPoints", 0));
    }
}

TEST_P(SimplexDesign, HasTheExactMixturesInOrder) {
    const auto blends = blendsOf(golden_, "run");
    ASSERT_EQ(design_.runs.size(), blends.size());
    for (std::size_t i = 0; i < blends.size(); ++i) {
        SCOPED_TRACE(i);
        EXPECT_EQ(design_.runs[i].pointType, blends[i].pointType);
        expectNear(design_.runs[i].proportions, blends[i].mixture, kExactMixture * total_);
    }
}

TEST_P(SimplexDesign, HoldsThePrintedTable) {
    const double tolerance = golden_.numbers("printedTolerance").at(0);
    const bool axialOnly = golden_.only("printedPart").at(0) == "axial";
    std::vector<std::vector<double>> left;
    for (const auto& run : design_.runs)
        if (!axialOnly || run.pointType == des_MixturePointAxial) left.push_back(run.proportions);
    // Each printed row takes one run that it agrees with; no run may be left over.
    for (const auto& words : golden_.all("printed")) {
        const auto row = numbersFrom(words);
        const auto match = std::find_if(left.begin(), left.end(), [&](const auto& mixture) {
            return std::equal(mixture.begin(), mixture.end(), row.begin(), row.end(),
                              [&](double a, double b) { return std::fabs(a - b) <= tolerance; });
        });
        ASSERT_NE(match, left.end()) << testing::PrintToString(row);
        left.erase(match);
    }
    EXPECT_THAT(left, testing::IsEmpty());
}

TEST_P(SimplexDesign, HasTheStatedBoundsAfterwards) {
    EXPECT_EQ(design_.boundsAdjusted, golden_.has("boundsAdjusted"));
    const auto upper = golden_.has("upperBoundsAfter") ? golden_.numbers("upperBoundsAfter") : request_.upperBounds;
    expectNear(design_.upperBounds, upper, kExactMixture * total_);
}

INSTANTIATE_TEST_SUITE_P(Published, SimplexDesign,
                         testing::Values("centroid_3", "lattice_3_2", "lattice_3_3", "lattice_4_2", "lattice_5_2",
                                         "yarn", "axial_3", "fruit_punch"),
                         [](const auto& instance) { return instance.param; });

TEST(FruitPunch, InPseudoComponentsIsTheUnboundedDesign) {
    MixtureRequest request = requestOf(GoldenLines("mixture/simplex_fruit_punch.txt"));
    request.outputUnits = des_UnitsPseudo;
    const auto blends = blendsOf(GoldenLines("mixture/simplex_centroid_3.txt"), "run");
    const auto design = builtDesign(request);
    ASSERT_EQ(design.runs.size(), blends.size());
    for (std::size_t i = 0; i < blends.size(); ++i)
        expectNear(design.runs[i].proportions, blends[i].mixture, kExactMixture);
}

class CrossedDesign : public testing::TestWithParam<std::string> {};

TEST_P(CrossedDesign, RunsAllBlendsAtEachSettingInTurn) {
    const GoldenLines golden("mixture/process_" + GetParam() + ".txt");
    const auto blends = blendsOf(golden, "blend");
    const auto settings = settingsIn(golden);
    const auto design = builtDesign(requestOf(golden));
    ASSERT_EQ(design.code, des_Success);
    ASSERT_EQ(design.runs.size(), static_cast<std::size_t>(golden.integer("numRuns")));
    ASSERT_EQ(design.runs.size(), blends.size() * settings.size());
    for (std::size_t i = 0; i < design.runs.size(); ++i) {
        SCOPED_TRACE(i);
        EXPECT_EQ(design.runs[i].processLevels, settings[i / blends.size()]);
        EXPECT_EQ(design.runs[i].pointType, blends[i % blends.size()].pointType);
        expectNear(design.runs[i].proportions, blends[i % blends.size()].mixture, kExactMixture);
    }
}

INSTANTIATE_TEST_SUITE_P(Published, CrossedDesign,
                         testing::Values("fish_patties", "half_of_2_to_5", "eighth_of_2_to_7", "quarter_of_2_to_6"),
                         [](const auto& instance) { return instance.param; });

class TwoLevelFraction : public testing::TestWithParam<std::string> {
  protected:
    std::vector<std::vector<std::int32_t>> settingsWithIndex(std::uint32_t fractionIndex) const {
        MixtureRequest request = requestOf(golden_);
        request.lowerBounds = {0, 0};
        request.upperBounds = {1, 1};
        request.fractionIndex = fractionIndex;
        std::vector<std::vector<std::int32_t>> settings;
        const auto design = builtDesign(request);
        // Three blends of two components at each setting.
        for (std::size_t i = 0; i < design.runs.size(); i += 3)
            settings.push_back(design.runs[i].processLevels);
        return settings;
    }

    const GoldenLines golden_{"mixture/fraction_" + GetParam() + ".txt"};
};

TEST_P(TwoLevelFraction, HasThePrintedSettingsInOrder) {
    EXPECT_EQ(settingsWithIndex(static_cast<std::uint32_t>(golden_.integer("fractionIndex"))), settingsIn(golden_));
}

TEST_P(TwoLevelFraction, HasTheNamedProductsAsAddedColumns) {
    const auto words = golden_.only("addedColumns");
    for (const auto& levels : settingsWithIndex(static_cast<std::uint32_t>(golden_.integer("fractionIndex")))) {
        const std::size_t base = levels.size() - words.size();
        for (std::size_t j = 0; j < words.size(); ++j) {
            std::int32_t product = 1;
            for (const char letter : words[j])
                product *= levels[factorOfLetter(letter)];
            EXPECT_EQ(levels[base + j], product);
        }
    }
}

TEST_P(TwoLevelFraction, TogetherWithTheOthersIsTheFullFactorial) {
    std::map<std::vector<std::int32_t>, int> times;
    const auto fractions = static_cast<std::uint32_t>(golden_.integer("processFraction"));
    for (std::uint32_t index = 1; index <= fractions; ++index) {
        for (const auto& levels : settingsWithIndex(index))
            ++times[levels];
    }
    EXPECT_EQ(times.size(), std::size_t{1} << golden_.integer("numProcessVariables"));
    for (const auto& [levels, count] : times)
        EXPECT_EQ(count, 1) << testing::PrintToString(levels);
}

INSTANTIATE_TEST_SUITE_P(Published, TwoLevelFraction, testing::Values("2to3m1", "2to5m2", "2to6m2", "2to7m4", "2to9m4"),
                         [](const auto& instance) { return instance.param; });

}  // namespace
}  // namespace reisti::test
