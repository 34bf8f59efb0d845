// Screening designs beside their bound: writing the same bytes into the same caller arrays, and for a randomized design
// also one sort of as many doubles as it draws.
#include <algorithm>
#include <benchmark/benchmark.h>
#include <cstdint>
#include <random>
#include <vector>

#include "reisti/reisti.h"

namespace {

/// The caller's arrays and the request.
class Request {
  public:
    Request(std::uint32_t numFactors, std::uint32_t replicates, bool randomize)
        : levels_(std::size_t{rowCount(numFactors, replicates)} * numFactors), runs_(rowCount(numFactors, replicates)) {
        for (std::size_t i = 0; i < runs_.size(); ++i)
            runs_[i].levels = &levels_[i * numFactors];
        design_.numFactors = numFactors;
        design_.replicates = replicates;
        design_.numBlocks = 1;
        design_.randomize = randomize ? 1 : 0;
        design_.seed = 42;
        design_.runs = runs_.data();
    }

    des_DefinitiveScreeningDesign& design() { return design_; }
    std::vector<des_DefinitiveScreeningRun>& runs() { return runs_; }
    std::int64_t bytes() const {
        return static_cast<std::int64_t>(levels_.size() * sizeof(std::int32_t) +
                                         runs_.size() * sizeof(des_DefinitiveScreeningRun));
    }

  private:
    static std::uint32_t rowCount(std::uint32_t numFactors, std::uint32_t replicates) {
        return des_FindDefinitiveScreeningDesignRowCount(static_cast<std::int32_t>(numFactors), nullptr, 0, replicates);
    }

    std::vector<std::int32_t> levels_;
    std::vector<des_DefinitiveScreeningRun> runs_;
    des_DefinitiveScreeningDesign design_{};
};

/// Writes the finished base design into every replicate of the caller's arrays.
void writeSameBytes(const std::vector<des_DefinitiveScreeningRun>& base, Request& target) {
    const std::size_t n = target.design().numFactors;
    std::size_t j = 0;
    for (std::size_t i = 0; i < target.runs().size(); ++i) {
        const des_DefinitiveScreeningRun& from = base[j];
        des_DefinitiveScreeningRun& run = target.runs()[i];
        std::copy_n(from.levels, n, run.levels);
        run.runOrder = static_cast<std::uint32_t>(i + 1);
        run.block = 1;
        run.pointType = from.pointType;
        if (++j == base.size()) j = 0;
    }
}

void create(benchmark::State& state, bool randomize) {
    Request request(static_cast<std::uint32_t>(state.range(0)), static_cast<std::uint32_t>(state.range(1)), randomize);
    for (auto _ : state) {
        benchmark::DoNotOptimize(des_CreateDefinitiveScreeningDesign(&request.design()));
        benchmark::ClobberMemory();
    }
    state.SetBytesProcessed(state.iterations() * request.bytes());
}

void bound(benchmark::State& state, bool randomize) {
    const auto n = static_cast<std::uint32_t>(state.range(0));
    Request base(n, 1, false);
    des_CreateDefinitiveScreeningDesign(&base.design());
    Request request(n, static_cast<std::uint32_t>(state.range(1)), randomize);
    std::vector<double> keys(randomize ? request.runs().size() : 0);
    std::mt19937_64 generator(42);
    std::vector<double> drawn(keys.size());
    for (double& key : drawn)
        key = static_cast<double>(generator() >> 11) * 0x1p-53;
    for (auto _ : state) {
        writeSameBytes(base.runs(), request);
        if (randomize) {
            std::copy(drawn.begin(), drawn.end(), keys.begin());
            std::sort(keys.begin(), keys.end());
        }
        benchmark::ClobberMemory();
    }
    state.SetBytesProcessed(state.iterations() * request.bytes());
}

void createPlain(benchmark::State& state) {
    create(state, false);
}
void boundPlain(benchmark::State& state) {
    bound(state, false);
}
void createRandomized(benchmark::State& state) {
    create(state, true);
}
void boundRandomized(benchmark::State& state) {
    bound(state, true);
}

void designs(benchmark::internal::Benchmark* benchmark) {
    benchmark->ArgNames({"factors", "replicates"})->Args({6, 1})->Args({24, 1})->Args({48, 1});
}
void largeDesign(benchmark::internal::Benchmark* benchmark) {
    benchmark->ArgNames({"factors", "replicates"})->Args({48, 100'000})->Unit(benchmark::kMillisecond);
}

BENCHMARK(createPlain)->Apply(designs);
BENCHMARK(boundPlain)->Apply(designs);
BENCHMARK(createPlain)->Apply(largeDesign);
BENCHMARK(boundPlain)->Apply(largeDesign);
BENCHMARK(createRandomized)->Apply(largeDesign);
BENCHMARK(boundRandomized)->Apply(largeDesign);

}  // namespace
