// Random numbers and run orders that hosts may have recorded: a change of them is an incompatible change.
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <gtest/gtest.h>
#include <sstream>
#include <string>
#include <vector>

#include "golden_text.h"
#include "reisti/reisti.h"
#include "ruv/ruv.h"
#include "support/screening_arrays.h"

namespace {

using reisti::test::goldenLines;
using reisti::test::ScreeningArrays;
using reisti::test::plain::PlainRun;
using reisti::test::plain::Request;

constexpr std::size_t kNumbers = 6;

/// "seed" and the first numbers, in hexadecimal so that no digit is lost.
std::string sequenceText(const std::string& seedText) {
    std::vector<double> values(kNumbers);
    ruv_ISampler* sampler = ruv_MakeISampler(nullptr, 10, std::strtod(seedText.c_str(), nullptr));
    ruv_GetUniformSample(sampler, values.data(), kNumbers, 0.0, 1.0);
    ruv_DeleteISampler(&sampler);
    std::ostringstream text;
    text << seedText << std::hexfloat;
    for (const double value : values) {
        text << ' ' << value;
    }
    return text.str();
}

std::string joined(const std::vector<std::string>& words) {
    std::string line;
    for (const std::string& word : words) {
        if (!line.empty()) line += ' ';
        line += word;
    }
    return line;
}

TEST(RecordedSequences, FirstNumbersOfEachSeedAreUnchanged) {
    const auto lines = goldenLines("sampler_sequences.txt");
    ASSERT_GE(lines.size(), 3U);
    for (const auto& words : lines) {
        EXPECT_EQ(joined(words), sequenceText(words[0]));
    }
}

/// One line a run: standard order, run order, block, point type, levels.
std::string designText(const Request& request, double seed) {
    ScreeningArrays arrays(request);
    EXPECT_EQ(arrays.randomized(seed).create(), des_Success);
    std::ostringstream text;
    for (std::size_t i = 0; i < arrays.numRuns(); ++i) {
        const PlainRun run = arrays.run(i);
        text << i + 1 << ' ' << run.runOrder << ' ' << run.block << ' ' << run.pointType;
        for (const std::int32_t level : run.levels) {
            text << ' ' << level;
        }
        text << '\n';
    }
    return text.str();
}

TEST(RecordedDesign, RandomizedDesignIsUnchanged) {
    std::string recorded;
    for (const auto& words : goldenLines("randomized_design.txt")) {
        recorded += joined(words);
        recorded += '\n';
    }
    const std::string now = designText(Request{6, {1, 3}, 4, 2}, 2024.5);
    EXPECT_TRUE(recorded == now) << "the design is now\n" << now;
}

}  // namespace
