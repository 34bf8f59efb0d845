#include "support/golden_lines.h"

#include <algorithm>
#include <fstream>
#include <sstream>
#include <stdexcept>

namespace reisti::test {

GoldenLines::GoldenLines(const std::string& file) : file_(file) {
    std::ifstream in(std::string(REISTI_GOLDEN_DIR) + "/" + file);
    if (!in) throw std::runtime_error("cannot read golden file " + file);
    for (std::string line; std::getline(in, line);) {
        if (line.empty() || line[0] == '#') continue;
        std::istringstream words(line);
        lines_.emplace_back();
        for (std::string word; words >> word;)
            lines_.back().push_back(word);
    }
}

std::vector<std::vector<std::string>> GoldenLines::all(const std::string& keyword) const {
    std::vector<std::vector<std::string>> found;
    for (const auto& line : lines_)
        if (!line.empty() && line[0] == keyword) found.emplace_back(line.begin() + 1, line.end());
    return found;
}

bool GoldenLines::has(const std::string& keyword) const {
    return !all(keyword).empty();
}

std::vector<std::string> GoldenLines::only(const std::string& keyword) const {
    auto found = all(keyword);
    if (found.size() != 1) throw std::runtime_error(file_ + " needs exactly one line " + keyword);
    return found[0];
}

std::int64_t GoldenLines::integer(const std::string& keyword) const {
    return std::stoll(only(keyword).at(0));
}

std::vector<double> GoldenLines::numbers(const std::string& keyword) const {
    return numbersFrom(only(keyword));
}

double numberFrom(const std::string& word) {
    const auto slash = word.find('/');
    if (slash == std::string::npos) return std::stod(word);
    return std::stod(word.substr(0, slash)) / std::stod(word.substr(slash + 1));
}

std::vector<double> numbersFrom(const std::vector<std::string>& words) {
    std::vector<double> numbers(words.size());
    std::transform(words.begin(), words.end(), numbers.begin(), numberFrom);
    return numbers;
}

std::vector<std::vector<std::string>> groupsOf(const std::vector<std::string>& words) {
    std::vector<std::vector<std::string>> groups(1);
    for (const auto& word : words) {
        if (word == "|") {
            groups.emplace_back();
        } else {
            groups.back().push_back(word);
        }
    }
    return groups;
}

}  // namespace reisti::test
