#include <cstdlib>
#include <gmock/gmock.h>

#include "cli/reisti_program.h"

namespace {

using namespace reisti::test;

double number(const std::string& text) {
    return std::strtod(text.c_str(), nullptr);
}

const std::vector<std::string> kFlare = {"vertices",     "--component",     "x1=0.4:0.6", "--component",
                                         "x2=0.1:0.5",   "--component",     "x3=0.1:0.5", "--component",
                                         "x4=0.03:0.08", "--standard-order"};
const std::vector<std::string> kTriangle = {"vertices", "--component", "A", "--component",
                                            "B",        "--component", "C", "--standard-order"};

std::vector<std::string> with(std::vector<std::string> arguments, const std::vector<std::string>& more) {
    arguments.insert(arguments.end(), more.begin(), more.end());
    return arguments;
}

TEST(VerticesCommand, FindsTheEightVerticesOfTheFlareRegion) {
    const Runs runs = csvRuns(kFlare);
    ASSERT_EQ(runs.size(), 8U);
    for (const auto& run : runs) {
        EXPECT_EQ(run.at("point_type"), "1");
        EXPECT_NEAR(number(run.at("x1")) + number(run.at("x2")) + number(run.at("x3")) + number(run.at("x4")), 1,
                    1e-12);
    }
}

TEST(VerticesCommand, TakesTheDegreeAsAWord) {
    std::map<std::string, std::size_t> sizes;
    for (const char* degree : {"vertices", "edges", "faces", "all", "1", "2", "3", "4"})
        sizes[degree] = csvRuns(with(kFlare, {"--degree", degree})).size();
    EXPECT_EQ(sizes["vertices"], sizes["1"]);
    EXPECT_EQ(sizes["edges"], sizes["2"]);
    EXPECT_EQ(sizes["faces"], sizes["3"]);
    EXPECT_EQ(sizes["all"], sizes["4"]);
    EXPECT_EQ(sizes["4"], sizes["3"] + 1);
    EXPECT_LT(sizes["1"], sizes["2"]);
    EXPECT_LT(sizes["2"], sizes["3"]);
}

TEST(VerticesCommand, AddsCentreAndAxialPoints) {
    const Runs runs = csvRuns(with(kFlare, {"--center", "--axial"}));
    ASSERT_EQ(runs.size(), 17U);
    EXPECT_EQ(runs[8].at("point_type"), "0");
    EXPECT_EQ(runs[9].at("point_type"), "-1");
}

TEST(VerticesCommand, CutsTheRegionWithAConstraint) {
    const Outcome outcome = runReisti(with(kTriangle, {"--constraint", "A >= 2*B", "--format", "csv"}));
    ASSERT_EQ(outcome.status, 0) << outcome.err;
    const Runs runs = runsOf(outcome.out);
    ASSERT_EQ(runs.size(), 3U);
    for (const auto& run : runs)
        EXPECT_GE(number(run.at("A")), 2 * number(run.at("B")) - 1e-9);
    EXPECT_THAT(outcome.err, testing::HasSubstr("upper bound of B tightened from 1 to 0.333333"));
}

TEST(VerticesCommand, ReadsConstraintsInUnitsOfTheTotal) {
    const std::vector<std::string> command = {"vertices", "--component",  "A",          "--component",
                                              "B",        "--component",  "C",          "--total",
                                              "10",       "--constraint", "A - B <= 4", "--standard-order"};
    for (const auto& run : csvRuns(command))
        EXPECT_LE(number(run.at("A")) - number(run.at("B")), 4 + 1e-9);
}

TEST(VerticesCommand, TellsOfARedundantConstraint) {
    const Outcome outcome = runReisti(with(kTriangle, {"--constraint", "A + B <= 2"}));
    EXPECT_EQ(outcome.status, 0);
    EXPECT_THAT(outcome.err, testing::HasSubstr("--constraint \"A + B <= 2\" is redundant"));
}

TEST(VerticesCommand, TellsWhichSideIsRedundant) {
    const Outcome outcome = runReisti(with(kTriangle, {"--constraint", "-1 <= A - B <= 0.5"}));
    EXPECT_EQ(outcome.status, 0);
    EXPECT_THAT(outcome.err, testing::HasSubstr("\"-1 <= A - B <= 0.5\" (lower side) is redundant"));
    EXPECT_THAT(outcome.err, testing::Not(testing::HasSubstr("upper side")));
}

TEST(VerticesCommand, RefusesConstraintsThatExcludeTheWholeRegion) {
    expectOneLineError(with(kTriangle, {"--constraint", "A + B >= 2"}), 1, "excludes the whole region");
    const Outcome outcome = runReisti(with(kTriangle, {"--constraint", "A <= 0.3", "--constraint", "A >= 0.5"}));
    EXPECT_EQ(outcome.status, 1);
    EXPECT_THAT(outcome.err, testing::HasSubstr("--constraint \"A >= 0.5\": excludes the whole region"));
}

TEST(VerticesCommand, TellsOfAConstraintThatLeavesOnlyAFace) {
    const Outcome outcome = runReisti(with(kTriangle, {"--constraint", "A >= 1"}));
    EXPECT_EQ(outcome.status, 0);
    EXPECT_THAT(outcome.err, testing::HasSubstr("leaves only a face"));
}

TEST(VerticesCommand, RefusesPseudoComponentsOfASingleMixture) {
    const std::vector<std::string> corner = with(kTriangle, {"--constraint", "A >= 0.999995"});
    EXPECT_EQ(csvRuns(corner).size(), 1U);
    expectOneLineError(with(corner, {"--units", "pseudo"}), 1, "--units pseudo");
}

TEST(VerticesCommand, TellsStatusesBoundsAndCountsInJson) {
    const auto design =
        jsonOf(with(kTriangle, {"--constraint", "A <= 0.5", "--constraint", "A + B <= 2", "--degree", "edges"}));
    EXPECT_EQ(design["design"], "extreme vertices");
    EXPECT_EQ(design["degree"], 2);
    EXPECT_EQ(design["constraints"][0]["status"], 0);
    EXPECT_EQ(design["constraints"][1]["status"], 2);
    EXPECT_EQ(design["constraints"][1]["coefficients"], nlohmann::json({1, 1, 0}));
    EXPECT_EQ(design["components"][0]["implied_upper"], 0.5);
    EXPECT_EQ(design["boundary_counts"].size(), 3U);
    EXPECT_EQ(design["points_per_type"], nlohmann::json({4, 4, 0}));
}

TEST(VerticesCommand, SaysWhatToDoAtTheLimitOnPoints) {
    expectOneLineError(with(kFlare, {"--max-points", "8", "--degree", "edges"}), 1, "--max-points");
    expectOneLineError(with(kFlare, {"--max-points", "7"}), 1, "--max-points");
    EXPECT_EQ(runReisti(with(kFlare, {"--max-points", "8"})).status, 0);
}

TEST(VerticesCommand, AsksForALimitOnRuns) {
    expectOneLineError(with(kFlare, {"--replicates", "vertex=3", "--max-runs", "23"}), 2, "24 runs");
    EXPECT_EQ(csvRuns(with(kFlare, {"--replicates", "vertex=3", "--max-runs", "24"})).size(), 24U);
}

TEST(VerticesCommand, RefusesBadArgumentsInOneLine) {
    expectOneLineError(with(kTriangle, {"--constraint", "A = 0.5"}), 2, "equation");
    expectOneLineError(with(kTriangle, {"--constraint", "D <= 0.5"}), 2, "\"D\" is not a component");
    expectOneLineError(with(kTriangle, {"--degree", "5"}), 2, "--degree");
    expectOneLineError(with(kTriangle, {"--degree", "corners"}), 2, "--degree");
    expectOneLineError(with(kTriangle, {"--max-points", "0"}), 2, "--max-points");
}

}  // namespace
