#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <sstream>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "require.h"

namespace {

using fuzz::require;

/// Letters name the factors; I is left out, as in the literature.
constexpr const char* FACTOR_LETTERS = "ABCDEFGHJKLMNOP";

std::vector<std::string> wordsOf(const char* text) {
    std::istringstream stream(text);
    std::vector<std::string> words;
    for (std::string word; stream >> word;)
        words.push_back(word);
    return words;
}

void checkWords(const std::vector<std::string>& words, std::size_t numLetters) {
    for (const std::string& word : words) {
        for (const char letter : word) {
            const char* const place = std::strchr(FACTOR_LETTERS, letter);
            require(letter != '\0' && place != nullptr && static_cast<std::size_t>(place - FACTOR_LETTERS) < numLetters,
                    "words are products of the factors before them");
        }
    }
}

void checkEntry(const des_FractionalFactorial& entry) {
    require(entry.numFactors >= 1 && entry.numRuns >= 2, "a design has factors and runs");
    require(std::has_single_bit(static_cast<std::uint32_t>(entry.numRuns)), "the runs are a power of two");
    require(entry.generators != nullptr && entry.blockGenerators != nullptr, "words are never null");
    const auto base = static_cast<std::size_t>(std::countr_zero(static_cast<std::uint32_t>(entry.numRuns)));
    const auto factors = static_cast<std::size_t>(entry.numFactors);
    const std::vector<std::string> generators = wordsOf(entry.generators);
    require(base + generators.size() == factors, "each factor behind the base factors has a word");
    checkWords(generators, base);
    checkWords(wordsOf(entry.blockGenerators), factors);
    require((entry.resolution == 0) == generators.empty(), "a full factorial has resolution 0");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    std::uint32_t count = 0;
    const bool wantsCount = size != 0 && data[0] % 2 != 0;
    const des_FractionalFactorial* const catalog = des_FractionalFactorialCatalog(wantsCount ? &count : nullptr);
    require(catalog != nullptr, "the catalog is never null");
    std::uint32_t all = 0;
    require(des_FractionalFactorialCatalog(&all) == catalog, "the catalog is static");
    require(!wantsCount || count == all, "the catalog is constant");
    for (std::uint32_t i = 0; i < all; ++i) {
        checkEntry(catalog[i]);
        if (i == 0) continue;
        const des_FractionalFactorial& before = catalog[i - 1];
        require(before.numRuns < catalog[i].numRuns ||
                    (before.numRuns == catalog[i].numRuns && before.numFactors < catalog[i].numFactors),
                "entries are by number of runs, then of factors");
    }
    return 0;
}
