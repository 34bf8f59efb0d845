// usage: print_digests [GOLDEN_FILE]
//
// Prints one line for each fifty designs of a family: family, block number, designs that succeeded, their runs, and a
// digest of all that the host got back. With a file the lines are compared with it, and the exit status is 1 when they
// differ.
#include <cinttypes>
#include <cstdint>
#include <cstdio>
#include <fstream>
#include <iostream>
#include <sstream>
#include <string>

#include "digest/design_digest.h"

namespace {

using namespace reisti::test;

constexpr std::uint32_t DESIGNS_PER_LINE = 50;

std::string line(std::uint32_t family, std::uint32_t block) {
    std::uint32_t succeeded = 0;
    std::uint64_t runs = 0;
    std::uint64_t digest = 0;
    for (std::uint32_t i = 0; i < DESIGNS_PER_LINE; ++i) {
        const DesignDigest design = digestOfDesign((block * DESIGNS_PER_LINE + i) * DIGEST_FAMILIES + family);
        succeeded += design.code == 0 ? 1U : 0U;
        runs += design.numRuns;
        // The order counts: two designs that change places change the sum.
        digest = digest * 0x100000001B3U + design.digest;
    }
    char text[120];
    std::snprintf(text, sizeof text, "%-9s %u  %2u of %u  %6" PRIu64 " runs  %016" PRIx64 "\n", familyOfDesign(family),
                  block, succeeded, DESIGNS_PER_LINE, runs, digest);
    return text;
}

std::string allLines() {
    std::string lines;
    for (std::uint32_t family = 0; family < DIGEST_FAMILIES; ++family) {
        for (std::uint32_t block = 0; block < DIGEST_DESIGNS / DIGEST_FAMILIES / DESIGNS_PER_LINE; ++block) {
            lines += line(family, block);
        }
    }
    return lines;
}

}  // namespace

int main(int argc, char** argv) {
    const std::string lines = allLines();
    std::cout << lines;
    if (argc < 2) {
        return 0;
    }
    std::ifstream file(argv[1]);
    std::ostringstream golden;
    golden << file.rdbuf();
    if (golden.str() != lines) {
        std::cerr << "differs from " << argv[1] << '\n';
        return 1;
    }
    return 0;
}
