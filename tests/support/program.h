#ifndef REISTI_TESTS_SUPPORT_PROGRAM_H
#define REISTI_TESTS_SUPPORT_PROGRAM_H

#include <map>
#include <string>
#include <vector>

namespace reisti::test {

struct Outcome {
    int status = -1;
    std::string out;
    std::string err;
};

/// Runs a program to its end with these arguments, standard input empty.
Outcome runProgram(const std::string& program, const std::vector<std::string>& arguments);

/// An empty folder that goes away with its content.
class TemporaryFolder {
  public:
    TemporaryFolder();
    TemporaryFolder(const TemporaryFolder&) = delete;
    TemporaryFolder& operator=(const TemporaryFolder&) = delete;
    ~TemporaryFolder();

    std::string file(const std::string& name) const { return path_ + "/" + name; }
    const std::string& path() const { return path_; }

  private:
    std::string path_;
};

std::string readFile(const std::string& path);
void writeFile(const std::string& path, const std::string& content);

/// Records of CSV text by the rules of RFC 4180, the header line first. Throws std::runtime_error where the text breaks
/// them: a bare quote, a line end other than CRLF, a record of another length.
std::vector<std::vector<std::string>> parseCsv(const std::string& text);

}  // namespace reisti::test

#endif
