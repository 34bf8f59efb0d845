// The trace file is the one thing that all threads of a process share.
#include "matrix/trace.h"

#include <cstddef>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <set>
#include <string>

#include "threads/in_parallel.h"

namespace reisti::test {
namespace {

TEST(Trace, OfEightThreadsHoldsEveryLineWhole) {
    std::string directory = (std::filesystem::temp_directory_path() / "reisti-trace-XXXXXX").string();
    ASSERT_NE(mkdtemp(directory.data()), nullptr);
    const std::filesystem::path before = std::filesystem::current_path();
    std::filesystem::current_path(directory);

    const int count = 4000;
    inParallel(count, [](std::size_t i) { qan::matrix_trace("a line of some length", static_cast<int>(i)); });

    std::multiset<std::string> expected;
    for (int i = 0; i < count; ++i) {
        expected.insert("a line of some length : " + std::to_string(i));
    }
    std::multiset<std::string> lines;
    std::ifstream file("trace.txt");
    for (std::string line; std::getline(file, line);) {
        lines.insert(line);
    }
    EXPECT_EQ(lines, expected);

    std::filesystem::current_path(before);
    std::filesystem::remove_all(directory);
}

}  // namespace
}  // namespace reisti::test
