#include "mixture/process_variables.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstddef>
#include <limits>
#include <string>
#include <vector>

#include "catalog/ff_design_catalog.h"
#include "mixture/run_array.h"
#include "mixture/run_counts.h"

namespace reisti {

namespace {

/// Largest denominator of the fraction for 1, 2, .. process variables; the smaller powers of two are allowed as well.
/// With more variables the catalog decides.
constexpr std::array<std::uint32_t, 7> MOST_FRACTIONS = {1, 1, 2, 2, 4, 8, 16};

/// Number of variables that take every combination of levels; the generators give the others.
std::uint32_t countBasicFactors(std::uint32_t numProcessVariables, std::uint32_t fraction) {
    switch (fraction) {
        case 2:
            return numProcessVariables - 1;
        case 4:
            return numProcessVariables - 2;
        case 8:
            return numProcessVariables - 3;
        case 16:
            return numProcessVariables - 4;
        default:
            return numProcessVariables;
    }
}

FF_CATALOG_DESIGN findFraction(std::uint32_t numProcessVariables, std::uint64_t numSettings) {
    constexpr std::uint64_t kMostInt = std::numeric_limits<int>::max();
    if (numProcessVariables > kMostInt || numSettings > kMostInt) return {};
    return ReadCatalogFile(static_cast<int>(numProcessVariables), static_cast<int>(numSettings));
}

/// The sign of generated factor j in the fraction asked for. The last fraction is the principal one, all signs
/// positive; the others are counted in binary, the first factor changing fastest and starting negative.
std::int32_t signOfGenerator(std::uint32_t j, std::uint32_t fraction, std::uint32_t fractionIndex) {
    if (fractionIndex == fraction) return 1;
    const std::uint32_t width = std::uint32_t{1} << j;
    const std::uint32_t turn = fractionIndex / width + (fractionIndex % width != 0 ? 1 : 0);
    return turn % 2 == 1 ? -1 : 1;
}

/// The levels of the process variables, setting after setting.
class ProcessSettings {
  public:
    /// The first setting. Words name the generated factors in order and are none in a full factorial.
    ProcessSettings(const des_MixtureDesign& design, const std::vector<std::string>& words)
        : basic_(countBasicFactors(design.numProcessVariables, design.processFraction)),
          levels_(design.numProcessVariables, -1) {
        for (std::uint32_t j = 0; basic_ + j < levels_.size(); ++j)
            generators_.push_back({signOfGenerator(j, design.processFraction, design.fractionIndex), words.at(j)});
        generate();
    }

    /// Goes on in standard order: the first basic factor changes fastest.
    void advance() {
        for (std::size_t i = 0; i < basic_; ++i) {
            levels_[i] = -levels_[i];
            if (levels_[i] == 1) break;
        }
        generate();
    }

    const std::vector<std::int32_t>& levels() const { return levels_; }

  private:
    struct Generator {
        std::int32_t sign;
        std::string word;
    };

    void generate() {
        for (std::size_t j = 0; j < generators_.size(); ++j) {
            std::int32_t level = generators_[j].sign;
            for (const char letter : generators_[j].word)
                level *= levels_[static_cast<std::size_t>(letter - 'A')];
            levels_[basic_ + j] = level;
        }
    }

    std::size_t basic_;
    std::vector<std::int32_t> levels_;
    std::vector<Generator> generators_;
};

}  // namespace

std::int32_t checkAmountsAgainstProcess(const des_MixtureDesign& design) {
    return design.numAmounts >= 2 && design.numProcessVariables >= 1 ? des_ErrorAmountsAndProcess : des_Success;
}

std::int32_t checkProcessFraction(const des_MixtureDesign& design) {
    const std::uint32_t p = design.numProcessVariables;
    const std::uint32_t fraction = design.processFraction;
    if (p == 0) return des_Success;
    bool allowed = true;
    if (p <= MOST_FRACTIONS.size()) {
        allowed = std::has_single_bit(fraction) && fraction <= MOST_FRACTIONS[p - 1];
    } else {
        // No setting would be left of 2^p, nor is there a division by 0.
        allowed = fraction != 0 && countProcessSettings(p, fraction) != 0;
    }
    return allowed ? des_Success : des_ErrorProcessFraction;
}

std::int32_t crossWithProcessVariables(des_MixtureDesign& design, std::uint32_t& written) {
    const std::uint32_t p = design.numProcessVariables;
    if (p == 0) return des_Success;
    const std::uint64_t numSettings = countProcessSettings(p, design.processFraction);
    std::vector<std::string> words;
    if (design.processFraction >= 2) {
        FF_CATALOG_DESIGN fraction = findFraction(p, numSettings);
        if (fraction.numRuns == 0) return des_ErrorProcessFraction;
        words = std::move(fraction.generators);
    }
    const std::uint32_t mixtures = written;
    // An empty design stays empty, however many settings there are.
    if (mixtures == 0) return des_Success;

    ProcessSettings settings(design, words);
    for (std::uint64_t k = 0; k < numSettings; ++k) {
        if (k > 0) settings.advance();
        for (std::uint32_t i = 0; i < mixtures; ++i) {
            const auto run = static_cast<std::uint32_t>(k * mixtures + i);
            if (k > 0) copyMixture(design, i, written++);
            std::ranges::copy(settings.levels(), design.runs[run].processLevels);
        }
    }
    return des_Success;
}

}  // namespace reisti
