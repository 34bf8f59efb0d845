#ifndef REISTI_TESTS_SUPPORT_GOLDEN_LINES_H
#define REISTI_TESTS_SUPPORT_GOLDEN_LINES_H

#include <cstdint>
#include <string>
#include <vector>

namespace reisti::test {

/// A golden text file: comment lines (#) dropped, every other line split at blanks into a keyword and its words. A bar
/// separates groups of words on one line and is itself a word.
class GoldenLines {
  public:
    /// @param file path below tests/golden; a missing file throws, so that no test passes on nothing
    explicit GoldenLines(const std::string& file);

    /// The words of every line with this keyword, in file order.
    std::vector<std::vector<std::string>> all(const std::string& keyword) const;
    bool has(const std::string& keyword) const;
    /// The words of the only line with this keyword; throws when there is none or more than one.
    std::vector<std::string> only(const std::string& keyword) const;
    std::int64_t integer(const std::string& keyword) const;
    std::vector<double> numbers(const std::string& keyword) const;

  private:
    std::string file_;
    std::vector<std::vector<std::string>> lines_;
};

/// "0.25", "-1" or "1/4".
double numberFrom(const std::string& word);
std::vector<double> numbersFrom(const std::vector<std::string>& words);
/// The groups between the bars of one line.
std::vector<std::vector<std::string>> groupsOf(const std::vector<std::string>& words);

}  // namespace reisti::test

#endif
