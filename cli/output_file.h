#ifndef REISTI_CLI_OUTPUT_FILE_H
#define REISTI_CLI_OUTPUT_FILE_H

#include <functional>
#include <ostream>
#include <string>

namespace cli {

/// Throws UsageError when the file exists and may not be replaced: told before any work is done.
void checkOutputFile(const std::string& path, bool mayReplace);

/// Lets `write` fill a temporary file beside `path` and renames it, so that a reader never meets half a design and an
/// interrupted run leaves an old file as it was. Writes to standard output when `path` is empty. Throws RunError.
void writeOutput(const std::string& path, bool mayReplace, const std::function<void(std::ostream&)>& write);

}  // namespace cli

#endif
