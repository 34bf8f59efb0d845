#ifndef REISTI_TESTS_CLI_REISTI_PROGRAM_H
#define REISTI_TESTS_CLI_REISTI_PROGRAM_H

#include <gtest/gtest.h>
#include <map>
#include <nlohmann/json.hpp>
#include <string>
#include <vector>

#include "support/program.h"

namespace reisti::test {

inline Outcome runReisti(const std::vector<std::string>& arguments) {
    return runProgram(REISTI_PROGRAM, arguments);
}

/// The design read back as a user's spreadsheet would read it: one map from column name to text for each run.
using Runs = std::vector<std::map<std::string, std::string>>;

inline Runs runsOf(const std::string& csv) {
    const auto records = parseCsv(csv);
    Runs runs;
    for (std::size_t i = 1; i < records.size(); ++i) {
        for (std::size_t j = 0; j < records[i].size(); ++j) {
            if (j == 0) runs.emplace_back();
            runs.back()[records[0][j]] = records[i][j];
        }
    }
    return runs;
}

/// The runs of a command that has to succeed, as CSV.
inline Runs csvRuns(std::vector<std::string> arguments) {
    arguments.insert(arguments.end(), {"--format", "csv"});
    const Outcome outcome = runReisti(arguments);
    EXPECT_EQ(outcome.status, 0) << outcome.err;
    return runsOf(outcome.out);
}

inline nlohmann::json jsonOf(std::vector<std::string> arguments) {
    arguments.insert(arguments.end(), {"--format", "json"});
    const Outcome outcome = runReisti(arguments);
    EXPECT_EQ(outcome.status, 0) << outcome.err;
    return nlohmann::json::parse(outcome.out);
}

/// Fails unless the command ends with this status and one line on standard error that holds `text`, and nothing else.
inline void expectOneLineError(const std::vector<std::string>& arguments, int status, const std::string& text) {
    const Outcome outcome = runReisti(arguments);
    EXPECT_EQ(outcome.status, status);
    EXPECT_EQ(outcome.out, "");
    EXPECT_NE(outcome.err.find(text), std::string::npos) << outcome.err;
    EXPECT_EQ(outcome.err.find('\n'), outcome.err.size() - 1) << outcome.err;
}

}  // namespace reisti::test

#endif
