#ifndef REISTI_TESTS_GOLDEN_DSD_GOLDEN_TEXT_H
#define REISTI_TESTS_GOLDEN_DSD_GOLDEN_TEXT_H

#include <filesystem>
#include <fstream>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

namespace reisti::test {

/// The words of each line of a golden file; comments (#) and empty lines are left out.
inline std::vector<std::vector<std::string>> goldenLines(const std::string& name) {
    std::ifstream file(std::filesystem::path(REISTI_GOLDEN_DIR) / "dsd" / name);
    if (!file) throw std::runtime_error("a golden file is missing: " + name);
    std::vector<std::vector<std::string>> lines;
    for (std::string line; std::getline(file, line);) {
        if (line.empty() || line.front() == '#') continue;
        std::istringstream text(line);
        std::vector<std::string> words;
        for (std::string word; text >> word;) {
            words.push_back(word);
        }
        lines.push_back(words);
    }
    return lines;
}

}  // namespace reisti::test

#endif
