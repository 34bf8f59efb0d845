// Simplex designs through the C interface, each beside its bound: the same arrays allocated, filled once and freed.
// Both sides count the freeing.
#include <benchmark/benchmark.h>
#include <cstdint>
#include <cstdlib>

#include "mixture/mixture_record.h"
#include "reisti/reisti.h"

namespace {

using reisti::bench::MixtureRecord;

enum class Kind { kCentroid, kLattice };

struct Request {
    Kind kind;
    std::uint32_t q;
    std::int32_t degree = 0;
    std::uint32_t processVariables = 0;
    bool bounded = false;
};

/// Fills the record anew; a run changes the bounds that it is given.
void fill(MixtureRecord& record, const Request& request) {
    record->numProcessVariables = request.processVariables;
    if (!request.bounded) return;
    record.lower.assign(request.q, 0.5 / request.q);
    record.upper.assign(request.q, 1.0);
    record->lowerBounds = record.lower.data();
    record->upperBounds = record.upper.data();
}

std::uint32_t run(MixtureRecord& record, const Request& request) {
    const std::int32_t code = request.kind == Kind::kCentroid
                                  ? des_RunSimplexCentroidDesign(record.get())
                                  : des_RunSimplexLatticeDesign(record.get(), request.degree, 1);
    if (code != des_Success) std::abort();
    return record->numRuns;
}

void design(benchmark::State& state, const Request& request) {
    std::uint32_t numRuns = 0;
    for (auto _ : state) {
        MixtureRecord record(request.q);
        fill(record, request);
        numRuns = run(record, request);
        benchmark::DoNotOptimize(record->runs);
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations() * numRuns);
}

void bound(benchmark::State& state, const Request& request) {
    MixtureRecord record(request.q);
    fill(record, request);
    const std::uint32_t numRuns = run(record, request);
    for (auto _ : state) {
        des_MixtureRun* runs = reisti::bench::allocateAndFill(numRuns, request.q, request.processVariables);
        benchmark::DoNotOptimize(runs);
        benchmark::ClobberMemory();
        reisti::bench::release(runs, numRuns);
    }
    state.SetItemsProcessed(state.iterations() * numRuns);
}

}  // namespace

#define REISTI_DESIGN_BENCH(name, ...)                                                    \
    BENCHMARK_CAPTURE(design, name, Request{__VA_ARGS__})->Unit(benchmark::kMicrosecond); \
    BENCHMARK_CAPTURE(bound, name, Request{__VA_ARGS__})->Unit(benchmark::kMicrosecond)

REISTI_DESIGN_BENCH(centroid_10, Kind::kCentroid, 10);
REISTI_DESIGN_BENCH(centroid_16, Kind::kCentroid, 16);
REISTI_DESIGN_BENCH(centroid_20, Kind::kCentroid, 20);
REISTI_DESIGN_BENCH(centroid_16_bounded, Kind::kCentroid, 16, 0, 0, true);
REISTI_DESIGN_BENCH(lattice_17_3, Kind::kLattice, 17, 3);
REISTI_DESIGN_BENCH(lattice_5_10, Kind::kLattice, 5, 10);
REISTI_DESIGN_BENCH(centroid_8_times_2_to_7, Kind::kCentroid, 8, 0, 7);
REISTI_DESIGN_BENCH(centroid_3_times_2_to_7, Kind::kCentroid, 3, 0, 7);
