// usage: region_time REGION DEGREE [once]
//
// Enumerates a region of regions/ and prints vertices, centroids, the most memory that it
// held at once as a multiple of its results, and the milliseconds of the enumeration (the best of some).
#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <exception>
#include <malloc.h>
#include <new>
#include <string>

#include "regions.h"

namespace {

std::size_t heldBytes = 0;
std::size_t mostBytes = 0;

}  // namespace

void* operator new(std::size_t size) {
    void* const block = std::malloc(size);
    if (block == nullptr) throw std::bad_alloc();
    heldBytes += malloc_usable_size(block);
    mostBytes = std::max(mostBytes, heldBytes);
    return block;
}

void operator delete(void* block) noexcept {
    heldBytes -= malloc_usable_size(block);
    std::free(block);
}

void operator delete(void* block, std::size_t) noexcept {
    operator delete(block);
}

int main(int argc, char** argv) try {
    if (argc < 3) {
        std::fprintf(stderr, "usage: region_time REGION DEGREE [once]\n");
        return 2;
    }
    const bench::Region region(std::string(REISTI_REGIONS_DIR) + "/" + argv[1] + ".txt");
    const int degree = std::min(std::atoi(argv[2]), region.numComponents());

    using Clock = std::chrono::steady_clock;
    using Milliseconds = std::chrono::duration<double, std::milli>;
    double best = 1e300;
    double spent = 0.0;
    const int fewest = argc > 3 ? 1 : 3;
    const int most = argc > 3 ? 1 : 100;
    for (int repeat = 0; repeat < fewest || (spent < 500.0 && repeat < most); ++repeat) {
        const std::size_t before = heldBytes;
        mostBytes = heldBytes;
        bench::Enumeration enumeration;
        const auto start = Clock::now();
        enumeration.run(region, degree);
        const double time = Milliseconds(Clock::now() - start).count();
        best = std::min(best, time);
        spent += time;
        if (repeat > 0) continue;
        const double results = 8.0 * (double{1} * enumeration.points.size() + enumeration.slack.size());
        std::printf("%u %d %.2f ", enumeration.numVertices, enumeration.numCentroids,
                    static_cast<double>(mostBytes - before) / results);
    }
    std::printf("%.4f\n", best);
    return 0;
} catch (const std::exception& error) {
    std::fprintf(stderr, "region_time: %s\n", error.what());
    return 1;
}
