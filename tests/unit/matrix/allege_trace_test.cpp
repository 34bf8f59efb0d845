#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <stdexcept>
#include <string>
#include <sys/wait.h>
#include <type_traits>
#include <unistd.h>

#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

static_assert(std::is_base_of_v<std::runtime_error, AllegeException>);
static_assert(std::is_base_of_v<std::runtime_error, MatrixException>);
static_assert(std::is_base_of_v<std::runtime_error, MatrixSingular>);
static_assert(!std::is_base_of_v<MatrixException, MatrixSingular>);
static_assert(!std::is_base_of_v<MatrixException, AllegeException>);
static_assert(!std::is_base_of_v<AllegeException, MatrixException>);
static_assert(sizeof(AllegeException) == sizeof(std::runtime_error), "carries nothing but the message");
static_assert(sizeof(MatrixException) == sizeof(std::runtime_error), "carries nothing but the message");
static_assert(sizeof(MatrixSingular) == sizeof(std::runtime_error), "carries nothing but the message");

TEST(AllegeFailure, BuildsTheTextFromItsThreeParts) {
    EXPECT_EQ(messageOf<AllegeException>([] { qan::allege::AllegeFailure("a < b", "some/file.h", 123); }),
              "assertion failed: (a < b) some/file.h: 123");
}

TEST(AllegeFailure, TakesThePartsAsTheyAre) {
    EXPECT_EQ(messageOf<AllegeException>([] { qan::allege::AllegeFailure("", "", 0); }), "assertion failed: () : 0");
    EXPECT_EQ(messageOf<AllegeException>([] { qan::allege::AllegeFailure("x % 2 && \"%s\"", "f", -7); }),
              "assertion failed: (x % 2 && \"%s\") f: -7");
}

TEST(AssertionText, NamesTheSourceRelativeToTheProject) {
    const std::string text = messageOf<AllegeException>([] { Dense().removeRow(0); });
    EXPECT_THAT(text, testing::StartsWith("assertion failed: (0 <= i && i < m_) src/matrix/matrix_"));
    EXPECT_THAT(text, IsAssertion("0 <= i && i < m_"));
}

/// Runs `action` in a child process inside a fresh directory, since the trace file is opened once per process, and
/// returns what `action` returned. The directory is removed afterwards.
template <class Action>
bool holdsInFreshProcess(Action action) {
    std::string directory = (std::filesystem::temp_directory_path() / "reisti-trace-XXXXXX").string();
    if (mkdtemp(directory.data()) == nullptr) return false;
    const pid_t child = fork();
    if (child == 0) {
        const bool good = chdir(directory.c_str()) == 0 && action();
        _exit(good ? 0 : 1);
    }
    int status = 0;
    const bool ended = child > 0 && waitpid(child, &status, 0) == child;
    std::filesystem::remove_all(directory);
    return ended && WIFEXITED(status) && WEXITSTATUS(status) == 0;
}

std::string traceText() {
    std::ifstream file("trace.txt", std::ios::binary);
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
}

TEST(MatrixTrace, EachCallAppendsALineThatIsOnDiskAtOnce) {
    EXPECT_TRUE(holdsInFreshProcess([] {
        qan::matrix_trace("alpha", 1);
        const bool first = traceText() == "alpha : 1\n";
        qan::matrix_trace("beta", -2147483647 - 1);
        const bool second = traceText() == "alpha : 1\nbeta : -2147483648\n";
        qan::matrix_trace("", 0);
        return first && second && traceText() == "alpha : 1\nbeta : -2147483648\n : 0\n";
    }));
}

TEST(MatrixTrace, FirstCallDropsAnOlderFile) {
    EXPECT_TRUE(holdsInFreshProcess([] {
        std::ofstream("trace.txt") << "left from yesterday, longer than the new line\n";
        qan::matrix_trace("new", 7);
        return traceText() == "new : 7\n";
    }));
}

TEST(MatrixTrace, NoFileAppearsWithoutACall) {
    EXPECT_TRUE(holdsInFreshProcess([] {
        Dense m(2, 2, 1.0);
        m.addRow(1.0);
        return !std::filesystem::exists("trace.txt");
    }));
}

TEST(MatrixTrace, FileThatCannotBeOpenedLosesTheLinesSilently) {
    EXPECT_TRUE(holdsInFreshProcess([] {
        std::filesystem::create_directory("trace.txt");
        qan::matrix_trace("lost", 1);
        qan::matrix_trace("lost too", 2);
        return std::filesystem::is_directory("trace.txt");
    }));
}

TEST(MatrixTrace, StaysInTheDirectoryOfTheFirstCall) {
    EXPECT_TRUE(holdsInFreshProcess([] {
        qan::matrix_trace("first", 1);
        std::filesystem::create_directory("below");
        if (chdir("below") != 0) return false;
        qan::matrix_trace("second", 2);
        const bool nothingHere = !std::filesystem::exists("trace.txt");
        return chdir("..") == 0 && nothingHere && traceText() == "first : 1\nsecond : 2\n";
    }));
}

}  // namespace
}  // namespace reisti::test
