#include <gmock/gmock.h>

#include "cli/reisti_program.h"
#include "reisti/reisti.h"

namespace {

using namespace reisti::test;

class EveryCommand : public testing::TestWithParam<const char*> {};

TEST_P(EveryCommand, HasAHelpTextWithAWorkedExample) {
    const Outcome outcome = runReisti({GetParam(), "--help"});
    EXPECT_EQ(outcome.status, 0);
    EXPECT_EQ(outcome.err, "");
    EXPECT_THAT(outcome.out, testing::HasSubstr(std::string("  reisti ") + GetParam()));
}

/// The words of the example in a help text, as a shell would split them.
std::vector<std::string> exampleOf(const std::string& help) {
    std::vector<std::string> words(1);
    bool isQuoted = false;
    const std::size_t start = help.find("  reisti ") + 9;
    for (std::size_t i = start; i < help.size(); ++i) {
        if (help[i] == '"') {
            isQuoted = !isQuoted;
        } else if (help[i] == '\\' || (help[i] == '\n' && help[i - 1] == '\\')) {
            continue;
        } else if (help[i] == '\n') {
            break;
        } else if (help[i] == ' ' && !isQuoted) {
            if (!words.back().empty()) words.emplace_back();
        } else {
            words.back() += help[i];
        }
    }
    if (words.back().empty()) words.pop_back();
    return words;
}

TEST_P(EveryCommand, RunsTheExampleOfItsHelpText) {
    const TemporaryFolder folder;
    std::vector<std::string> words = exampleOf(runReisti({GetParam(), "--help"}).out);
    for (std::size_t i = 1; i < words.size(); ++i) {
        if (words[i - 1] == "--output") words[i] = folder.file(words[i]);
    }
    const Outcome outcome = runReisti(words);
    EXPECT_EQ(outcome.status, 0) << outcome.err;
}

INSTANTIATE_TEST_SUITE_P(Commands, EveryCommand, testing::Values("dsd", "centroid", "lattice", "vertices", "catalog"),
                         [](const auto& row) { return std::string(row.param); });

TEST(Program, TellsItsVersion) {
    const Outcome outcome = runReisti({"--version"});
    EXPECT_EQ(outcome.status, 0);
    EXPECT_EQ(outcome.out, std::string("reisti ") + des_Version() + "\n");
}

TEST(Program, ListsItsCommands) {
    const Outcome outcome = runReisti({"--help"});
    EXPECT_EQ(outcome.status, 0);
    for (const char* command : {"dsd", "centroid", "lattice", "vertices", "catalog"}) {
        EXPECT_THAT(outcome.out, testing::HasSubstr(command));
    }
}

TEST(Program, NeedsACommandThatItKnows) {
    expectOneLineError({}, 2, "A subcommand is required");
    expectOneLineError({"nonsense"}, 2, "nonsense");
}

}  // namespace
