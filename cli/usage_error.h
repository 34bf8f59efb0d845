#ifndef REISTI_CLI_USAGE_ERROR_H
#define REISTI_CLI_USAGE_ERROR_H

#include <fmt/format.h>
#include <stdexcept>
#include <string>

namespace cli {

constexpr int kExitSuccess = 0;
constexpr int kExitFailedRun = 1;
constexpr int kExitBadUsage = 2;

/// The command line asks for something that cannot be meant. The message is one line that names the argument.
class UsageError : public std::runtime_error {
  public:
    UsageError(const std::string& argument, const std::string& problem)
        : std::runtime_error(fmt::format("{}: {}", argument, problem)) {}
};

/// The request was understood but could not be carried out. The message is one line.
class RunError : public std::runtime_error {
  public:
    using std::runtime_error::runtime_error;
};

}  // namespace cli

#endif
