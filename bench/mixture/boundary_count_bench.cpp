// Counting the faces of a bounded region. The worst case is a region whose free range is about half of the sum of all
// ranges: then half of all subsets are below it. Typical regions are tighter. The bound for the worst case is one pass
// that writes as many sums as the two halves of the components have.
#include <algorithm>
#include <benchmark/benchmark.h>
#include <cstddef>
#include <cstdint>
#include <numeric>
#include <random>
#include <vector>

#include "mixture/boundary_counts.h"

namespace {

std::vector<double> randomRanges(std::size_t q) {
    std::mt19937 generator(1);
    std::uniform_real_distribution<double> range(0.1, 0.3);
    std::vector<double> ranges(q);
    std::ranges::generate(ranges, [&] { return range(generator); });
    return ranges;
}

/// @param part what the free range is of the sum of all ranges, in percent
void countSums(benchmark::State& state, double part) {
    const std::vector<double> ranges = randomRanges(static_cast<std::size_t>(state.range(0)));
    const double rStar = part / 100.0 * std::accumulate(ranges.begin(), ranges.end(), 0.0);
    std::vector<std::uint32_t> below;
    std::vector<std::uint32_t> equal;
    for (auto _ : state) {
        reisti::CalculateLE(rStar, ranges, below, equal);
        benchmark::DoNotOptimize(below.data());
    }
}

void writeSums(benchmark::State& state) {
    const std::size_t sums = std::size_t{2} << (state.range(0) / 2);
    for (auto _ : state) {
        std::vector<double> list(sums, 0.5);
        benchmark::DoNotOptimize(list.data());
        benchmark::ClobberMemory();
    }
}

void countBoundaries(benchmark::State& state) {
    const auto q = static_cast<std::uint32_t>(state.range(0));
    const std::vector<double> ranges = randomRanges(q);
    const double rStar = 0.5 * std::accumulate(ranges.begin(), ranges.end(), 0.0);
    std::vector<std::uint32_t> below;
    std::vector<std::uint32_t> equal;
    reisti::CalculateLE(rStar, ranges, below, equal);
    std::vector<int> counts;
    for (auto _ : state) {
        const auto binomials = reisti::binomialTable(q);
        reisti::CalculateNumberOfBoundaries(below, equal, binomials, counts);
        benchmark::DoNotOptimize(counts.data());
    }
}

}  // namespace

BENCHMARK_CAPTURE(countSums, worst, 50.0)->Arg(20)->Arg(30)->Arg(40)->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(countSums, typical, 10.0)->Arg(20)->Arg(30)->Arg(40)->Unit(benchmark::kMicrosecond);
BENCHMARK(writeSums)->Arg(20)->Arg(30)->Arg(40)->Unit(benchmark::kMicrosecond);
BENCHMARK(countBoundaries)->Arg(20)->Arg(30)->Arg(40)->Unit(benchmark::kMicrosecond);
