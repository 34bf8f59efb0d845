#include "support/plain_process.h"

#include <cmath>
#include <stdexcept>

#include "support/catalog_table.h"

namespace reisti::test {

std::size_t factorOfLetter(char letter) {
    const auto factor = std::string("ABCDEFGHJKLMNOP").find(letter);
    if (factor == std::string::npos) throw std::runtime_error("no factor has this letter");
    return factor;
}

std::vector<std::vector<std::int32_t>> plainTwoLevelRuns(std::uint32_t numBaseFactors,
                                                         const std::vector<std::string>& generators,
                                                         const std::vector<std::int32_t>& signs) {
    std::vector<std::vector<std::int32_t>> runs;
    for (std::uint64_t run = 0; run < std::uint64_t{1} << numBaseFactors; ++run) {
        std::vector<std::int32_t> levels;
        for (std::uint32_t factor = 0; factor < numBaseFactors; ++factor)
            levels.push_back((run >> factor & 1U) != 0 ? 1 : -1);
        for (std::size_t j = 0; j < generators.size(); ++j) {
            std::int32_t product = signs.at(j);
            for (const char letter : generators[j])
                product *= levels.at(factorOfLetter(letter));
            levels.push_back(product);
        }
        runs.push_back(levels);
    }
    return runs;
}

bool plainFractionAllowed(std::uint32_t p, std::uint32_t f) {
    switch (p) {
        case 1:
        case 2:
            return f == 1;
        case 3:
        case 4:
            return f <= 2;
        case 5:
            return f == 1 || f == 2 || f == 4;
        case 6:
            return f == 1 || f == 2 || f == 4 || f == 8;
        case 7:
            return f == 1 || f == 2 || f == 4 || f == 8 || f == 16;
        default:
            return true;
    }
}

std::int32_t plainColumnSign(std::uint32_t j, std::uint32_t fraction, std::uint32_t fractionIndex) {
    if (fractionIndex == fraction) return 1;
    const double quotient = std::ceil(static_cast<double>(fractionIndex) / std::ldexp(1.0, static_cast<int>(j)));
    return std::fmod(quotient, 2.0) != 0.0 ? -1 : 1;
}

std::optional<std::vector<std::vector<std::int32_t>>> plainProcessSettings(std::uint32_t p, std::uint32_t f,
                                                                           std::uint32_t fractionIndex) {
    const double numSettings = std::floor(std::ldexp(1.0, static_cast<int>(p)) / f);
    if (f < 2) return plainTwoLevelRuns(p, {}, {});
    const CatalogRow* row = catalogRow(p, static_cast<long long>(numSettings));
    if (row == nullptr) return std::nullopt;
    if (f != 2 && f != 4 && f != 8 && f != 16) {
        // Of a fraction without a rule only the number of settings is kept: they are the first of the full factorial.
        auto settings = plainTwoLevelRuns(p, {}, {});
        settings.resize(static_cast<std::size_t>(numSettings));
        return settings;
    }
    std::vector<std::int32_t> signs;
    for (std::uint32_t j = 0; j < row->generators.size(); ++j)
        signs.push_back(plainColumnSign(j, f, fractionIndex));
    return plainTwoLevelRuns(static_cast<std::uint32_t>(row->numBaseFactors()), row->generators, signs);
}

}  // namespace reisti::test
