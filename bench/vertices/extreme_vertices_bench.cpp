// Extreme vertices designs: the enumeration of vertices and centroids by itself, and the whole call through the C
// interface, which also allocates and writes two arrays for each run.
#include <benchmark/benchmark.h>
#include <cstdint>
#include <string>
#include <vector>

#include "regions.h"
#include "reisti/reisti.h"

namespace {

struct Case {
    const char* name;
    const char* region;
    int degree;
};

constexpr int kAllFaces = -1;

const std::vector<Case> CASES = {
    {"nominal15/vertices", "nominal15", 1},
    {"nominal20/vertices", "nominal20", 1},
    {"typical30/vertices", "typical30", 1},
    {"typical20/edges", "typical20", 2},
    {"typical12cut3/faces", "typical12cut3", kAllFaces},
    {"simplex20/faces", "simplex20", kAllFaces},
    {"nominal15cut5/vertices", "nominal15cut5", 1},
};

void enumerate(benchmark::State& state, const bench::Region& region, int degree) {
    std::int64_t points = 0;
    for (auto _ : state) {
        bench::Enumeration enumeration;
        enumeration.run(region, degree);
        points = std::int64_t{enumeration.numVertices} + enumeration.numCentroids;
    }
    state.counters["points"] = static_cast<double>(points);
    state.SetItemsProcessed(state.iterations() * points);
}

void callInterface(benchmark::State& state, const bench::Region& region, int degree) {
    const auto q = region.lower.size();
    std::vector<double> outputs(4 * q);
    std::vector<std::uint32_t> counts(2 * q);
    std::vector<des_MixtureDesignLinearConstraint> constraints = region.constraints();
    std::int64_t runs = 0;
    for (auto _ : state) {
        std::vector<double> lower = region.lower;
        std::vector<double> upper = region.upper;
        des_MixtureDesign* design = des_CreateMixtureDesignContainer();
        design->numComponents = static_cast<std::uint32_t>(q);
        design->lowerBounds = lower.data();
        design->upperBounds = upper.data();
        design->scaledLowerBounds = outputs.data();
        design->scaledUpperBounds = outputs.data() + q;
        design->pseudoLowerBounds = outputs.data() + 2 * q;
        design->pseudoUpperBounds = outputs.data() + 3 * q;
        design->pointsPerType = counts.data();
        design->boundaryCounts = counts.data() + q;
        const std::int32_t code = des_RunExtremeVerticesDesign(
            design, degree, 0, static_cast<std::int32_t>(constraints.size()), constraints.data(), 0);
        if (code != des_Success) state.SkipWithError(des_ErrorMessage(code));
        runs = design->numRuns;
        des_DeleteMixtureDesignContainer(&design);
    }
    state.counters["points"] = static_cast<double>(runs);
    state.SetItemsProcessed(state.iterations() * runs);
}

const bool registered = [] {
    for (const Case& c : CASES) {
        const bench::Region region(std::string(REISTI_REGIONS_DIR) + "/" + c.region + ".txt");
        const int degree = c.degree == kAllFaces ? region.numComponents() : c.degree;
        const auto add = [&](const char* what, auto* function) {
            const std::string name = std::string(what) + "/" + c.name;
            benchmark::RegisterBenchmark(name.c_str(), [=](benchmark::State& state) {
                function(state, region, degree);
            })->Unit(benchmark::kMillisecond);
        };
        add("enumeration", &enumerate);
        add("call", &callInterface);
    }
    return true;
}();

}  // namespace
