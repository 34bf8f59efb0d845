#include "support/program.h"

#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <spawn.h>
#include <sstream>
#include <stdexcept>
#include <sys/wait.h>
#include <system_error>
#include <unistd.h>

namespace reisti::test {

Outcome runProgram(const std::string& program, const std::vector<std::string>& arguments) {
    const TemporaryFolder folder;
    std::vector<std::string> words{program};
    words.insert(words.end(), arguments.begin(), arguments.end());
    std::vector<char*> argv;
    for (std::string& word : words)
        argv.push_back(word.data());
    argv.push_back(nullptr);

    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    const std::string out = folder.file("out");
    const std::string err = folder.file("err");
    posix_spawn_file_actions_addopen(&actions, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
    posix_spawn_file_actions_addopen(&actions, STDOUT_FILENO, out.c_str(), O_WRONLY | O_CREAT, 0600);
    posix_spawn_file_actions_addopen(&actions, STDERR_FILENO, err.c_str(), O_WRONLY | O_CREAT, 0600);
    pid_t pid = 0;
    const int error = posix_spawn(&pid, program.c_str(), &actions, nullptr, argv.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    if (error != 0) throw std::system_error(error, std::generic_category(), program);
    int status = 0;
    waitpid(pid, &status, 0);
    return {WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status), readFile(out), readFile(err)};
}

TemporaryFolder::TemporaryFolder() {
    std::string pattern = (std::filesystem::temp_directory_path() / "reisti-test-XXXXXX").string();
    if (mkdtemp(pattern.data()) == nullptr) throw std::system_error(errno, std::generic_category(), pattern);
    path_ = pattern;
}

TemporaryFolder::~TemporaryFolder() {
    std::error_code ignored;
    std::filesystem::remove_all(path_, ignored);
}

std::string readFile(const std::string& path) {
    std::ifstream file(path, std::ios::binary);
    if (!file) throw std::runtime_error("cannot read " + path);
    std::ostringstream content;
    content << file.rdbuf();
    return content.str();
}

void writeFile(const std::string& path, const std::string& content) {
    std::ofstream(path, std::ios::binary) << content;
}

namespace {

/// Reads one field at `position` and leaves it behind the field.
std::string parseField(const std::string& text, std::size_t& position) {
    std::string field;
    if (position < text.size() && text[position] == '"') {
        for (++position; position < text.size(); ++position) {
            if (text[position] != '"') {
                field += text[position];
            } else if (position + 1 < text.size() && text[position + 1] == '"') {
                field += text[position++];
            } else {
                ++position;
                return field;
            }
        }
        throw std::runtime_error("a quoted field does not end");
    }
    while (position < text.size() && text[position] != ',' && text[position] != '\r') {
        if (text[position] == '"' || text[position] == '\n') throw std::runtime_error("bare quote or line feed");
        field += text[position++];
    }
    return field;
}

}  // namespace

std::vector<std::vector<std::string>> parseCsv(const std::string& text) {
    std::vector<std::vector<std::string>> records;
    std::vector<std::string> record;
    for (std::size_t position = 0; position < text.size();) {
        record.push_back(parseField(text, position));
        if (position < text.size() && text[position] == ',') {
            ++position;
            continue;
        }
        if (text.compare(position, 2, "\r\n") != 0) throw std::runtime_error("a record does not end in CRLF");
        position += 2;
        if (!records.empty() && records.front().size() != record.size()) {
            throw std::runtime_error("a record is not as long as the header");
        }
        records.push_back(std::move(record));
        record.clear();
    }
    if (!record.empty()) throw std::runtime_error("the last record does not end in CRLF");
    return records;
}

}  // namespace reisti::test
