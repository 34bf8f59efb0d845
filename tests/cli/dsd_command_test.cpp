#include <gmock/gmock.h>
#include <set>

#include "cli/reisti_program.h"
#include "reisti/reisti.h"

namespace {

using namespace reisti::test;

const std::vector<std::string> kFourFactors = {"dsd",      "--factor",       "Temp=20:80:degC",
                                               "--factor", "Time=10:30:min", "--factor",
                                               "pH=5:9",   "--factor",       "Solvent=water|ethanol"};

std::vector<std::string> with(std::vector<std::string> arguments, const std::vector<std::string>& more) {
    arguments.insert(arguments.end(), more.begin(), more.end());
    return arguments;
}

TEST(DsdCommand, ShowsTheColumnsInOrder) {
    const Outcome outcome =
        runReisti(with(kFourFactors, {"--format", "csv", "--response", "Yield", "--response", "Purity"}));
    EXPECT_EQ(parseCsv(outcome.out)[0], (std::vector<std::string>{"std_order", "run_order", "block", "point_type",
                                                                  "Temp", "Time", "pH", "Solvent", "Yield", "Purity"}));
}

TEST(DsdCommand, ShowsEveryRunOfTheDesignInRealLevels) {
    const Runs runs = csvRuns(with(kFourFactors, {"--standard-order"}));
    std::vector<std::int32_t> levels(14 * 4);
    std::vector<des_DefinitiveScreeningRun> expected(14);
    for (std::size_t i = 0; i < 14; ++i)
        expected[i].levels = &levels[i * 4];
    const std::uint32_t categorical = 3;
    des_DefinitiveScreeningDesign design{};
    design.numFactors = 4;
    design.numCategorical = 1;
    design.categoricalFactors = &categorical;
    design.runs = expected.data();
    ASSERT_EQ(des_CreateDefinitiveScreeningDesign(&design), des_Success);

    const char* const temperatures[] = {"20", "50", "80"};
    const char* const acidities[] = {"5", "7", "9"};
    ASSERT_EQ(runs.size(), 14U);
    for (std::size_t i = 0; i < 14; ++i) {
        const std::int32_t* row = expected[i].levels;
        EXPECT_EQ(runs[i].at("std_order"), std::to_string(i + 1));
        EXPECT_EQ(runs[i].at("run_order"), std::to_string(i + 1));
        EXPECT_EQ(runs[i].at("point_type"), std::to_string(expected[i].pointType));
        EXPECT_EQ(runs[i].at("Temp"), temperatures[row[0] + 1]);
        EXPECT_EQ(runs[i].at("pH"), acidities[row[2] + 1]);
        EXPECT_EQ(runs[i].at("Solvent"), row[3] < 0 ? "water" : "ethanol");
    }
}

TEST(DsdCommand, ShowsRunsInRunOrderByDefault) {
    const Runs runs = csvRuns(with(kFourFactors, {"--seed", "5"}));
    for (std::size_t i = 0; i < runs.size(); ++i)
        EXPECT_EQ(runs[i].at("run_order"), std::to_string(i + 1));
}

TEST(DsdCommand, ShowsRunsInStandardOrderOnRequest) {
    const Runs runs = csvRuns(with(kFourFactors, {"--seed", "5", "--order", "standard"}));
    std::set<std::string> runOrders;
    for (std::size_t i = 0; i < runs.size(); ++i) {
        EXPECT_EQ(runs[i].at("std_order"), std::to_string(i + 1));
        runOrders.insert(runs[i].at("run_order"));
    }
    EXPECT_EQ(runOrders.size(), runs.size());
    EXPECT_NE(runs[0].at("run_order") + runs[1].at("run_order") + runs[2].at("run_order"), "123");
}

TEST(DsdCommand, MakesTheSameDesignAgainFromTheSeedThatItReports) {
    const Outcome drawn = runReisti({"dsd", "--factors", "6", "--format", "csv"});
    ASSERT_THAT(drawn.err, testing::MatchesRegex("seed [0-9]+\n"));
    const std::string seed = drawn.err.substr(5, drawn.err.size() - 6);
    EXPECT_EQ(runReisti({"dsd", "--factors", "6", "--format", "csv", "--seed", seed}).out, drawn.out);
}

TEST(DsdCommand, DrawsAnotherSeedEachTime) {
    EXPECT_NE(runReisti({"dsd", "--factors", "6"}).err, runReisti({"dsd", "--factors", "6"}).err);
}

TEST(DsdCommand, TakesZeroForADrawnSeedAndReportsIt) {
    EXPECT_THAT(runReisti({"dsd", "--factors", "6", "--seed", "0"}).err, testing::MatchesRegex("seed [1-9][0-9]*\n"));
}

TEST(DsdCommand, ReportsNoSeedWithoutRandomization) {
    EXPECT_EQ(runReisti({"dsd", "--factors", "6", "--standard-order"}).err, "");
}

TEST(DsdCommand, NamesAnonymousFactorsAndShowsThemCoded) {
    const Runs runs = csvRuns({"dsd", "--factors", "3", "--standard-order"});
    ASSERT_EQ(runs.size(), 13U);
    EXPECT_EQ(runs[1].at("X1"), "0");
    EXPECT_EQ(runs[1].at("X2"), "-1");
    EXPECT_EQ(runs[0].at("X3"), "1");
}

TEST(DsdCommand, ShowsCodedLevelsOnRequest) {
    const Runs runs = csvRuns(with(kFourFactors, {"--coded", "--standard-order"}));
    EXPECT_EQ(runs[0].at("Temp"), "0");
    EXPECT_EQ(runs[0].at("Time"), "1");
    EXPECT_EQ(runs[1].at("Time"), "-1");
    EXPECT_THAT(runs[0].at("Solvent"), testing::AnyOf("1", "-1"));
}

TEST(DsdCommand, PutsReplicatesIntoBlocks) {
    const Runs runs = csvRuns({"dsd", "--factors", "4", "--replicates", "4", "--blocks", "2", "--standard-order"});
    ASSERT_EQ(runs.size(), 52U);
    for (std::size_t i = 0; i < 52; ++i)
        EXPECT_EQ(runs[i].at("block"), i < 26 ? "1" : "2");
}

TEST(DsdCommand, TellsEverythingInJson) {
    const auto design = jsonOf(with(kFourFactors, {"--seed", "7", "--response", "Yield"}));
    EXPECT_EQ(design["design"], "definitive screening");
    EXPECT_EQ(design["seed"], 7);
    EXPECT_EQ(design["factors"][0]["unit"], "degC");
    EXPECT_EQ(design["factors"][3]["levels"][1], "ethanol");
    ASSERT_EQ(design["runs"].size(), 14U);
    EXPECT_TRUE(design["runs"][0]["Yield"].is_null());
    EXPECT_TRUE(design["runs"][0]["Temp"].is_number());
    EXPECT_EQ(design["runs"][2]["run_order"], 3);
}

TEST(DsdCommand, FailsWithTheOptionWhenTheLibraryRefuses) {
    expectOneLineError({"dsd", "--factors", "49", "--standard-order"}, 1, "--factor");
    expectOneLineError({"dsd", "--factors", "1", "--standard-order"}, 1, "--factor");
    expectOneLineError({"dsd", "--factors", "4", "--replicates", "3", "--blocks", "2", "--standard-order"}, 1,
                       "--blocks");
    expectOneLineError({"dsd", "--factors", "48", "--replicates", "4294967295", "--standard-order"}, 1, "--replicates");
}

TEST(DsdCommand, AsksForALimitAboveAMillionRuns) {
    expectOneLineError({"dsd", "--factors", "6", "--replicates", "76924", "--standard-order"}, 2, "--max-runs");
    EXPECT_EQ(runReisti({"dsd", "--factors", "6", "--replicates", "2", "--max-runs", "26"}).status, 0);
    expectOneLineError({"dsd", "--factors", "6", "--replicates", "2", "--max-runs", "25", "--standard-order"}, 2,
                       "26 runs");
}

TEST(DsdCommand, RefusesBadArgumentsInOneLine) {
    expectOneLineError({"dsd"}, 2, "--factor");
    expectOneLineError({"dsd", "--factors", "x"}, 2, "--factors");
    expectOneLineError({"dsd", "--factor", "Temp=80:20"}, 2, "Temp=80:20");
    expectOneLineError({"dsd", "--factors", "3", "--factor", "a=1:2"}, 2, "--factor");
    expectOneLineError({"dsd", "--factors", "3", "--seed", "abc"}, 2, "--seed \"abc\"");
    expectOneLineError({"dsd", "--factors", "3", "--seed", "nan"}, 2, "--seed");
    expectOneLineError({"dsd", "--factors", "3", "--blocks", "0"}, 2, "--blocks");
    expectOneLineError({"dsd", "--factors", "3", "--replicates", "0"}, 2, "--replicates");
    expectOneLineError({"dsd", "--factors", "3", "--format", "xml"}, 2, "--format");
    expectOneLineError({"dsd", "--factors", "3", "--order", "random"}, 2, "--order");
    expectOneLineError({"dsd", "--factors", "3", "--decimal-mark", ";"}, 2, "--decimal-mark");
    expectOneLineError({"dsd", "--factors", "3", "--bogus"}, 2, "--bogus");
}

TEST(DsdCommand, RefusesTwoColumnsOfOneName) {
    expectOneLineError({"dsd", "--factor", "a=1:2", "--factor", "a=3:4", "--standard-order"}, 2, "\"a\"");
    expectOneLineError({"dsd", "--factor", "block=1:2", "--factor", "a=3:4", "--standard-order"}, 2, "\"block\"");
    expectOneLineError({"dsd", "--factors", "3", "--response", "X1", "--standard-order"}, 2, "\"X1\"");
}

}  // namespace
