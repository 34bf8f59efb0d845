#include <cmath>
#include <cstdlib>
#include <gmock/gmock.h>

#include "cli/reisti_program.h"

namespace {

using namespace reisti::test;

double number(const std::string& text) {
    return std::strtod(text.c_str(), nullptr);
}

TEST(CentroidCommand, ShowsTheSevenBlendsOfThreeComponents) {
    const Runs runs =
        csvRuns({"centroid", "--component", "water", "--component", "oil", "--component", "egg", "--standard-order"});
    ASSERT_EQ(runs.size(), 7U);
    const std::vector<std::vector<double>> expected = {
        {1, 0, 0}, {0, 1, 0}, {0, 0, 1}, {0.5, 0.5, 0}, {0.5, 0, 0.5}, {0, 0.5, 0.5}, {1.0 / 3, 1.0 / 3, 1.0 / 3}};
    const char* const types[] = {"1", "1", "1", "2", "2", "2", "0"};
    for (std::size_t i = 0; i < 7; ++i) {
        EXPECT_EQ(number(runs[i].at("water")), expected[i][0]);
        EXPECT_EQ(number(runs[i].at("oil")), expected[i][1]);
        EXPECT_EQ(number(runs[i].at("egg")), expected[i][2]);
        EXPECT_EQ(runs[i].at("point_type"), types[i]);
        EXPECT_EQ(runs[i].count("amount"), 0U);
    }
}

TEST(CentroidCommand, HoldsTheCentroidWithOrWithoutAskingForIt) {
    const std::vector<std::string> plain = {"centroid", "--component", "a", "--component",
                                            "b",        "--component", "c", "--standard-order"};
    std::vector<std::string> asked = plain;
    asked.emplace_back("--center");
    EXPECT_EQ(csvRuns(asked), csvRuns(plain));
    EXPECT_EQ(csvRuns(asked).back().at("point_type"), "0");
}

TEST(CentroidCommand, ShowsAmountsOfATotalWithinTheBoundsAndTellsWhatItTightened) {
    const std::vector<std::string> command = {"centroid",      "--component",   "watermelon=20:100",
                                              "--component",   "pineapple=10:", "--component",
                                              "orange=10:100", "--total",       "100",
                                              "--format",      "csv",           "--standard-order"};
    const Outcome outcome = runReisti(command);
    EXPECT_EQ(outcome.err,
              "upper bound of watermelon tightened from 100 to 80\n"
              "upper bound of pineapple tightened from 100 to 70\n"
              "upper bound of orange tightened from 100 to 70\n");
    for (const auto& run : runsOf(outcome.out)) {
        EXPECT_EQ(run.at("amount"), "100");
        EXPECT_NEAR(number(run.at("watermelon")) + number(run.at("pineapple")) + number(run.at("orange")), 100, 1e-9);
        EXPECT_GE(number(run.at("watermelon")), 20 - 1e-9);
    }
}

TEST(CentroidCommand, ShowsTheUnitsAskedFor) {
    const std::vector<std::string> base = {"centroid",    "--component", "a=20:100", "--component", "b",
                                           "--component", "c",           "--total",  "100",         "--standard-order"};
    auto units = [&](const std::string& name) {
        auto arguments = base;
        arguments.insert(arguments.end(), {"--units", name});
        return number(csvRuns(arguments)[0].at("a"));
    };
    EXPECT_EQ(units("amount"), 100);
    EXPECT_EQ(units("proportion"), 1);
    EXPECT_EQ(units("pseudo"), 1);
    EXPECT_EQ(number(csvRuns(base)[1].at("a")), 20);
}

TEST(CentroidCommand, RunsEveryAmount) {
    const Runs runs = csvRuns(
        {"centroid", "--component", "a", "--component", "b", "--amount", "2", "--amount", "3", "--standard-order"});
    ASSERT_EQ(runs.size(), 6U);
    for (std::size_t i = 0; i < 6; ++i) {
        EXPECT_EQ(runs[i].at("amount"), i < 3 ? "2" : "3");
        EXPECT_NEAR(number(runs[i].at("a")) + number(runs[i].at("b")), i < 3 ? 2 : 3, 1e-12);
    }
}

TEST(CentroidCommand, CrossesProcessVariablesInRealUnits) {
    const Runs runs = csvRuns({"centroid", "--component", "a", "--component", "b", "--process", "Temp=150:200:degC",
                               "--process", "Pan=iron|steel", "--standard-order"});
    ASSERT_EQ(runs.size(), 12U);
    EXPECT_EQ(runs[0].at("Temp"), "150");
    EXPECT_EQ(runs[0].at("Pan"), "iron");
    EXPECT_EQ(runs[3].at("Temp"), "200");
    EXPECT_EQ(runs[11].at("Pan"), "steel");
}

TEST(CentroidCommand, RunsTheFractionAskedFor) {
    const std::vector<std::string> base = {"centroid",  "--component", "a",         "--component", "b",
                                           "--process", "x=0:1",       "--process", "y=0:1",       "--process",
                                           "z=0:1",     "--fraction",  "2",         "--coded",     "--standard-order"};
    auto principal = base;
    principal.insert(principal.end(), {"--fraction-index", "2"});
    const Runs other = csvRuns(base);
    ASSERT_EQ(other.size(), 12U);
    for (const auto& run : other)
        EXPECT_EQ(number(run.at("x")) * number(run.at("y")) * number(run.at("z")), -1);
    for (const auto& run : csvRuns(principal))
        EXPECT_EQ(number(run.at("x")) * number(run.at("y")) * number(run.at("z")), 1);
}

TEST(CentroidCommand, ReplicatesEachKindOfPoint) {
    const Runs runs =
        csvRuns({"centroid", "--component", "a", "--component", "b", "--component", "c", "--axial", "--replicates",
                 "vertex=2,2=3,center=4,axial=5", "--design-replicates", "2", "--standard-order"});
    std::map<std::string, int> counts;
    for (const auto& run : runs)
        ++counts[run.at("point_type")];
    EXPECT_EQ(counts, (std::map<std::string, int>{{"1", 12}, {"2", 18}, {"0", 8}, {"-1", 30}}));
}

TEST(CentroidCommand, TellsEverythingInJson) {
    const auto design =
        jsonOf({"centroid", "--component", "a=0.2:1", "--component", "b", "--component", "c", "--seed", "3"});
    EXPECT_EQ(design["design"], "simplex centroid");
    EXPECT_EQ(design["components"][0]["name"], "a");
    EXPECT_NEAR(design["components"][1]["implied_upper"].get<double>(), 0.8, 1e-12);
    EXPECT_EQ(design["points_per_type"], nlohmann::json({3, 3, 0}));
    EXPECT_EQ(design["center_points"], 1);
    EXPECT_EQ(design["boundary_counts"], nlohmann::json({3, 3, 1}));
    EXPECT_EQ(design["runs"].size(), 7U);
}

TEST(CentroidCommand, RefusesBadArgumentsInOneLine) {
    expectOneLineError({"centroid"}, 2, "--component");
    expectOneLineError({"centroid", "--component", "a"}, 2, "two components");
    expectOneLineError({"centroid", "--component", "a", "--component", "b", "--total", "0"}, 2, "--total");
    expectOneLineError({"centroid", "--component", "a", "--component", "b", "--fraction", "3"}, 2, "--fraction");
    expectOneLineError({"centroid", "--component", "a", "--component", "b", "--total", "2", "--amount", "3"}, 2,
                       "--amount");
    expectOneLineError(
        {"centroid", "--component", "a", "--component", "b", "--amount", "2", "--amount", "3", "--process", "x=0:1"}, 2,
        "--amount");
    expectOneLineError({"centroid", "--component", "a", "--component", "b", "--replicates", "2=1"}, 2, "--replicates");
    expectOneLineError({"centroid", "--component", "a", "--component", "a", "--standard-order"}, 2, "\"a\"");
    expectOneLineError({"centroid", "--component", "a", "--component", "b", "--fraction-index", "2"}, 2,
                       "--fraction-index");
}

TEST(CentroidCommand, FailsWithTheOptionWhenTheLibraryRefuses) {
    expectOneLineError({"centroid", "--component", "a=0.6:1", "--component", "b=0.5:1"}, 1, "--component");
    expectOneLineError({"centroid", "--component", "a=0:0.3", "--component", "b=0:0.5", "--component", "c"}, 1,
                       "--component");
    expectOneLineError({"centroid", "--component", "a", "--component", "b", "--process", "x=0:1", "--fraction", "2"}, 1,
                       "--fraction");
}

TEST(CentroidCommand, AsksForALimitBeforeItBuildsABillionRuns) {
    std::vector<std::string> command = {"centroid"};
    for (int i = 0; i < 30; ++i)
        command.insert(command.end(), {"--component", std::string("c").append(std::to_string(i))});
    expectOneLineError(command, 2, "1073741823 runs");
}

TEST(LatticeCommand, ShowsTheLatticeOfHalves) {
    const Runs runs = csvRuns({"lattice", "--degree", "2", "--component", "a", "--component", "b", "--component", "c",
                               "--center", "--standard-order"});
    ASSERT_EQ(runs.size(), 7U);
    EXPECT_EQ(runs[1].at("a"), "0.5");
    EXPECT_EQ(runs[6].at("point_type"), "0");
}

TEST(LatticeCommand, CountsItsRunsForTheLimit) {
    const std::vector<std::string> base = {"lattice",
                                           "--degree",
                                           "3",
                                           "--component",
                                           "a",
                                           "--component",
                                           "b",
                                           "--component",
                                           "c",
                                           "--center",
                                           "--replicates",
                                           "vertex=2,2=3,center=5",
                                           "--standard-order"};
    auto limited = base;
    limited.insert(limited.end(), {"--max-runs", "28"});
    expectOneLineError(limited, 2, "29 runs");
    EXPECT_EQ(csvRuns(base).size(), 29U);
}

TEST(LatticeCommand, NeedsADegreeThatFits) {
    expectOneLineError({"lattice", "--component", "a", "--component", "b"}, 2, "--degree");
    expectOneLineError({"lattice", "--degree", "0", "--component", "a", "--component", "b"}, 2, "--degree");
    expectOneLineError({"lattice", "--degree", "11", "--component", "a", "--component", "b"}, 1, "--degree");
}

TEST(CatalogCommand, ListsEveryDesign) {
    const Runs runs = csvRuns({"catalog"});
    ASSERT_EQ(runs.size(), 49U);
    EXPECT_EQ(runs[1].at("factors"), "3");
    EXPECT_EQ(runs[1].at("runs"), "4");
    EXPECT_EQ(runs[1].at("resolution"), "3");
    EXPECT_EQ(runs[1].at("generators"), "AB");
    EXPECT_EQ(runs[48].at("factors"), "15");
    EXPECT_EQ(runs[48].at("runs"), "128");
}

}  // namespace
