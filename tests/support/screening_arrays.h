#ifndef REISTI_TESTS_SUPPORT_SCREENING_ARRAYS_H
#define REISTI_TESTS_SUPPORT_SCREENING_ARRAYS_H

// The arrays of one request as a host owns them, poisoned and with guard cells, so that a test sees exactly what a call
// wrote.

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <gtest/gtest.h>
#include <optional>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

#include "reisti/reisti.h"
#include "support/plain_screening.h"

namespace reisti::test {

constexpr std::uint32_t kPoison = 0xDEADBEEFU;
constexpr std::int32_t kLevelPoison = -77777777;

inline std::string describe(const plain::PlainRun& run) {
    std::ostringstream text;
    text << "{order " << run.runOrder << ", block " << run.block << ", type " << run.pointType << ", levels";
    for (const std::int32_t level : run.levels) {
        text << ' ' << level;
    }
    text << '}';
    return text.str();
}

class ScreeningArrays {
  public:
    /// Level cells behind each run and records behind the last run, which no call may touch.
    static constexpr std::size_t kGuard = 2;

    des_DefinitiveScreeningDesign design;

    /// Room for `numRuns` runs of `numFactors` levels each. The record asks for one replicate in one block, in standard
    /// order.
    ScreeningArrays(std::uint32_t numFactors, std::size_t numRuns, std::vector<std::uint32_t> categoricalFactors = {})
        : categorical_(std::move(categoricalFactors)),
          givenList_(categorical_),
          stride_(numFactors + kGuard),
          numRuns_(numRuns),
          levels_(stride_ * (numRuns + kGuard), kLevelPoison) {
        for (std::size_t i = 0; i < numRuns + kGuard; ++i) {
            runs_.push_back({kPoison, kPoison, kPoison, levels_.data() + i * stride_});
        }
        std::memset(&design, 0, sizeof design);
        design.numFactors = numFactors;
        design.numCategorical = static_cast<std::uint32_t>(categorical_.size());
        design.replicates = 1;
        design.numBlocks = 1;
        design.categoricalFactors = categorical_.empty() ? nullptr : categorical_.data();
        design.runs = runs_.data();
    }

    /// Room for every run that a request gives.
    explicit ScreeningArrays(const plain::Request& request)
        : ScreeningArrays(request.numFactors,
                          std::size_t{plain::baseRunCount(request.numFactors, !request.categorical.empty())} *
                              (request.replicates > 1 ? request.replicates : 1),
                          request.categorical) {
        design.replicates = request.replicates;
        design.numBlocks = request.numBlocks;
    }

    ScreeningArrays(const ScreeningArrays&) = delete;
    ScreeningArrays& operator=(const ScreeningArrays&) = delete;

    ScreeningArrays& randomized(double seed) {
        design.randomize = 1;
        design.seed = seed;
        return *this;
    }

    /// Calls the create function and checks that it left the inputs as they were.
    std::int32_t create() {
        unsigned char recordBefore[sizeof design];
        std::memcpy(recordBefore, &design, sizeof design);
        const std::vector<des_DefinitiveScreeningRun> runsBefore = runs_;
        const std::int32_t code = des_CreateDefinitiveScreeningDesign(&design);
        EXPECT_EQ(std::memcmp(recordBefore, &design, sizeof design), 0) << "the record was changed";
        EXPECT_EQ(categorical_, givenList_) << "the list of categorical factors was changed";
        for (std::size_t i = 0; i < runs_.size(); ++i) {
            EXPECT_EQ(runs_[i].levels, runsBefore[i].levels) << "the levels pointer of run " << i << " was changed";
        }
        return code;
    }

    std::size_t numRuns() const { return numRuns_; }
    des_DefinitiveScreeningRun& record(std::size_t i) { return runs_[i]; }

    plain::PlainRun run(std::size_t i) const {
        const std::int32_t* first = levels_.data() + i * stride_;
        return {runs_[i].runOrder, runs_[i].block, runs_[i].pointType, {first, first + design.numFactors}};
    }
    std::int32_t level(std::size_t run, std::size_t factor) const { return levels_[run * stride_ + factor]; }

    std::vector<std::uint32_t> runOrders() const {
        std::vector<std::uint32_t> orders;
        for (std::size_t i = 0; i < numRuns_; ++i) {
            orders.push_back(runs_[i].runOrder);
        }
        return orders;
    }
    std::vector<std::uint32_t> blocks() const {
        std::vector<std::uint32_t> result;
        for (std::size_t i = 0; i < numRuns_; ++i) {
            result.push_back(runs_[i].block);
        }
        return result;
    }

    /// Empty when exactly the given runs are written and every other cell is still poisoned; otherwise the first
    /// difference. A run without a value, or behind the end of the list, has to be untouched.
    std::string differenceFrom(const std::vector<std::optional<plain::PlainRun>>& expected) const {
        for (std::size_t i = 0; i < runs_.size(); ++i) {
            const bool written = i < expected.size() && expected[i].has_value();
            if (written && run(i) != *expected[i]) {
                return "run " + std::to_string(i) + " is " + describe(run(i)) + " instead of " + describe(*expected[i]);
            }
            if (!written &&
                (runs_[i].runOrder != kPoison || runs_[i].block != kPoison || runs_[i].pointType != kPoison)) {
                return "run " + std::to_string(i) + " was written: " + describe(run(i));
            }
            for (std::size_t j = written ? design.numFactors : 0; j < stride_; ++j) {
                if (level(i, j) != kLevelPoison) {
                    return "level " + std::to_string(j) + " of run " + std::to_string(i) + " was written";
                }
            }
        }
        return "";
    }
    std::string differenceFromUntouched() const { return differenceFrom({}); }

  private:
    std::vector<std::uint32_t> categorical_;
    std::vector<std::uint32_t> givenList_;
    std::size_t stride_;
    std::size_t numRuns_;
    std::vector<std::int32_t> levels_;
    std::vector<des_DefinitiveScreeningRun> runs_;
};

/// Only runs 0, 2, .., as they stand behind the copy of the base rows.
inline std::vector<std::optional<plain::PlainRun>> evenBaseRuns(const plain::Request& request) {
    plain::Design design;
    design.runs.resize(plain::baseRunCount(request.numFactors, true));
    plain::writeBaseRows(request, design);
    return design.runs;
}

/// The base runs of a request without its replicates.
inline std::vector<std::optional<plain::PlainRun>> completeBaseRuns(plain::Request request) {
    request.replicates = 1;
    return plain::create(request).runs;
}

}  // namespace reisti::test

#endif
