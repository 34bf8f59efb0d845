#include <filesystem>
#include <gmock/gmock.h>
#include <sstream>
#include <sys/stat.h>

#include "cli/reisti_program.h"

namespace {

using namespace reisti::test;

std::vector<std::string> lines(const std::string& text) {
    std::istringstream stream(text);
    std::vector<std::string> result;
    for (std::string line; std::getline(stream, line);)
        result.push_back(line);
    return result;
}

TEST(TableOutput, NeverExceedsEightyColumns) {
    const Outcome outcome = runReisti({"dsd", "--factors", "48", "--seed", "1"});
    ASSERT_EQ(outcome.status, 0);
    for (const std::string& line : lines(outcome.out))
        EXPECT_LE(line.size(), 80U) << line;
}

TEST(TableOutput, RepeatsTheKeysInEveryPanel) {
    const Outcome outcome = runReisti({"dsd", "--factors", "20", "--seed", "1"});
    int headers = 0;
    for (const std::string& line : lines(outcome.out))
        headers += line.find("std_order  run_order") == 0 ? 1 : 0;
    EXPECT_EQ(headers, 2);
    EXPECT_THAT(outcome.out, testing::HasSubstr("X20"));
}

TEST(TableOutput, ShowsUnitsBelowTheNames) {
    const Outcome outcome = runReisti({"dsd", "--factor", "Temp=20:80:degC", "--factor", "pH=5:9", "--seed", "1"});
    const auto shown = lines(outcome.out);
    ASSERT_GE(shown.size(), 2U);
    EXPECT_EQ(shown[1].find("degC"), shown[0].find("Temp"));
}

TEST(TableOutput, CountsAccentedLettersAsOneColumn) {
    const Outcome outcome =
        runReisti({"dsd", "--factor", "Température=20:80", "--factor", "b=1000000:2000000", "--standard-order"});
    const auto shown = lines(outcome.out);
    // The accented e takes two bytes.
    EXPECT_EQ(shown[0].size(), shown[1].size() + 1);
}

TEST(CsvOutput, QuotesFieldsThatHoldCommasAndQuotes) {
    const Runs runs = csvRuns({"dsd", "--factor", "a \"x\", b=1:2", "--factor", "c=w,1|w\"2", "--standard-order"});
    EXPECT_EQ(runs[1].at("a \"x\", b"), "1.5");
    EXPECT_THAT(runs[0].at("c"), testing::AnyOf("w,1", "w\"2"));
}

TEST(CsvOutput, UsesTheDecimalMark) {
    const Runs runs =
        csvRuns({"dsd", "--factor", "a=1:2", "--factor", "b=0:1", "--standard-order", "--decimal-mark", ","});
    EXPECT_EQ(runs[0].at("a"), "1,5");
}

TEST(JsonOutput, HasAShortOption) {
    const std::vector<std::string> design = {"dsd", "--factors", "3", "--standard-order"};
    auto longForm = design;
    longForm.insert(longForm.end(), {"--format", "json"});
    auto shortForm = design;
    shortForm.emplace_back("--json");
    EXPECT_EQ(runReisti(shortForm).out, runReisti(longForm).out);
    EXPECT_EQ(runReisti(shortForm).out.front(), '{');
}

TEST(JsonOutput, IgnoresTheDecimalMark) {
    const auto design =
        jsonOf({"dsd", "--factor", "a=1:2", "--factor", "b=0:1", "--standard-order", "--decimal-mark", ","});
    EXPECT_EQ(design["runs"][0]["a"], 1.5);
}

TEST(JsonOutput, ReplacesBrokenUtf8) {
    const auto design = jsonOf({"dsd", "--factor", "a\xff=1:2", "--factor", "b=0:1", "--standard-order"});
    EXPECT_EQ(design["factors"][0]["name"], "a\xef\xbf\xbd");
}

TEST(OutputFile, HoldsWhatStandardOutputWould) {
    const TemporaryFolder folder;
    const std::string path = folder.file("design.csv");
    const std::vector<std::string> command = {"dsd", "--factors", "6", "--seed", "3", "--format", "csv"};
    auto toFile = command;
    toFile.insert(toFile.end(), {"--output", path});
    const Outcome outcome = runReisti(toFile);
    EXPECT_EQ(outcome.status, 0);
    EXPECT_EQ(outcome.out, "");
    EXPECT_EQ(readFile(path), runReisti(command).out);
}

TEST(OutputFile, IsNotReplacedWithoutForce) {
    const TemporaryFolder folder;
    const std::string path = folder.file("design.csv");
    writeFile(path, "precious");
    expectOneLineError({"dsd", "--factors", "6", "--output", path}, 2, path);
    EXPECT_EQ(readFile(path), "precious");
}

TEST(OutputFile, IsReplacedWithForce) {
    const TemporaryFolder folder;
    const std::string path = folder.file("design.csv");
    writeFile(path, "old");
    EXPECT_EQ(runReisti({"dsd", "--factors", "6", "--output", path, "--force"}).status, 0);
    EXPECT_THAT(readFile(path), testing::HasSubstr("std_order"));
}

TEST(OutputFile, LeavesNoTemporaryFileBehind) {
    const TemporaryFolder folder;
    EXPECT_EQ(runReisti({"dsd", "--factors", "6", "--output", folder.file("a")}).status, 0);
    EXPECT_EQ(runReisti({"dsd", "--factors", "49", "--output", folder.file("b")}).status, 1);
    std::size_t files = 0;
    for ([[maybe_unused]] const auto& entry : std::filesystem::directory_iterator(folder.path()))
        ++files;
    EXPECT_EQ(files, 1U);
}

TEST(OutputFile, HasThePermissionsOfAnyNewFile) {
    const TemporaryFolder folder;
    const mode_t before = umask(022);
    EXPECT_EQ(runReisti({"dsd", "--factors", "6", "--output", folder.file("a")}).status, 0);
    umask(before);
    struct stat status {};
    ASSERT_EQ(stat(folder.file("a").c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 0777U, 0644U);
}

TEST(OutputFile, ThatCannotBeMadeIsAFailedRun) {
    expectOneLineError({"dsd", "--factors", "6", "--standard-order", "--output", "/no/such/folder/design.csv"}, 1,
                       "/no/such/folder/design.csv");
}

}  // namespace
