#include "output_file.h"

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fmt/format.h>
#include <fstream>
#include <iostream>
#include <sys/stat.h>
#include <system_error>
#include <unistd.h>
#include <vector>

#include "usage_error.h"

namespace cli {

namespace {

std::string existsMessage(const std::string& path) {
    return fmt::format("{} exists; give --force to replace it", path);
}

RunError systemError(const std::string& path, int error) {
    return RunError(fmt::format("--output: cannot write {}: {}", path, std::generic_category().message(error)));
}

/// A new empty file beside the path, with the permissions that a plain new file would have.
std::string makeTemporary(const std::string& path) {
    const std::string pattern = path + ".XXXXXX";
    std::vector<char> name(pattern.begin(), pattern.end());
    name.push_back('\0');
    const int descriptor = ::mkstemp(name.data());
    if (descriptor < 0) throw systemError(path, errno);
    ::close(descriptor);
    return name.data();
}

class TemporaryFile {
  public:
    explicit TemporaryFile(const std::string& path) : name_(makeTemporary(path)) {}
    TemporaryFile(const TemporaryFile&) = delete;
    TemporaryFile& operator=(const TemporaryFile&) = delete;
    ~TemporaryFile() {
        std::error_code ignored;
        std::filesystem::remove(name_, ignored);
    }

    const std::string& name() const { return name_; }

  private:
    std::string name_;
};

void publish(const std::string& temporary, const std::string& path, bool mayReplace) {
    // mkstemp makes files that only their owner may read; the umask can only be read by setting it.
    const mode_t mask = ::umask(0);
    ::umask(mask);
    if (::chmod(temporary.c_str(), 0666 & ~mask) != 0) throw systemError(path, errno);
    if (mayReplace) {
        if (std::rename(temporary.c_str(), path.c_str()) != 0) throw systemError(path, errno);
        return;
    }
    // Unlike a rename, a link never replaces a file that appeared meanwhile.
    if (::link(temporary.c_str(), path.c_str()) != 0) {
        if (errno == EEXIST) throw UsageError("--output", existsMessage(path));
        throw systemError(path, errno);
    }
}

}  // namespace

void checkOutputFile(const std::string& path, bool mayReplace) {
    if (!path.empty() && !mayReplace && std::filesystem::exists(std::filesystem::symlink_status(path))) {
        throw UsageError("--output", existsMessage(path));
    }
}

void writeOutput(const std::string& path, bool mayReplace, const std::function<void(std::ostream&)>& write) {
    if (path.empty()) {
        write(std::cout);
        std::cout.flush();
        if (!std::cout) throw RunError("cannot write to standard output");
        return;
    }
    const TemporaryFile temporary(path);
    std::ofstream file(temporary.name(), std::ios::binary);
    write(file);
    file.close();
    if (!file) throw systemError(path, errno);
    publish(temporary.name(), path, mayReplace);
}

}  // namespace cli
