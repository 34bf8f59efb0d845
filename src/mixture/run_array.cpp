#include "mixture/run_array.h"

#include <algorithm>
#include <cstddef>
#include <limits>
#include <new>
#include <stdexcept>

#include "mixture/run_counts.h"

namespace reisti {

namespace {

/// What an allocator needs beside the bytes of each array: its own bookkeeping and the rounding to its granule.
constexpr std::uint64_t kAllocatorOverhead = 16;

std::uint64_t bytesOfRuns(std::uint32_t count, std::uint32_t numComponents, std::uint32_t numProcessVariables) {
    std::uint64_t perRun = sizeof(des_MixtureRun) + kAllocatorOverhead + std::uint64_t{numComponents} * sizeof(double);
    if (numProcessVariables != 0)
        perRun += kAllocatorOverhead + std::uint64_t{numProcessVariables} * sizeof(std::int32_t);
    return saturatingProduct(perRun, count);
}

/// Asks for the memory of all runs at once and gives it back. A design that the machine cannot hold fails here, at no
/// cost, instead of run by run after everything else on the machine has been pushed out. That works although the
/// operating system lends more than it has: it still refuses a single request that exceeds all memory and swap space,
/// which is the size of request that a slip in the number of components gives. A design that would fit an idle machine
/// but not a busy one is not refused here, nor is anything by a system told to lend without limit.
void probeMemory(std::uint64_t bytes) {
    if (bytes > static_cast<std::uint64_t>(std::numeric_limits<std::ptrdiff_t>::max())) throw std::bad_alloc();
    void* const probe = ::operator new(static_cast<std::size_t>(bytes), std::nothrow);
    if (probe == nullptr) throw std::bad_alloc();
    ::operator delete(probe);
}

}  // namespace

des_MixtureRun* allocateRuns(std::uint32_t count, std::uint32_t numComponents, std::uint32_t numProcessVariables) {
    probeMemory(bytesOfRuns(count, numComponents, numProcessVariables));
    auto* const runs = new des_MixtureRun[count];
    const des_MixtureRun unwritten{
        .runOrder = 0, .reserved = 1, .pointType = 0, .proportions = nullptr, .amount = 1.0, .processLevels = nullptr};
    std::fill_n(runs, count, unwritten);
    return runs;
}

void releaseRuns(des_MixtureRun* runs, std::uint32_t count) noexcept {
    if (runs == nullptr) return;
    for (std::uint32_t i = 0; i < count; ++i) {
        delete[] runs[i].proportions;
        delete[] runs[i].processLevels;
    }
    delete[] runs;
}

void copyMixture(des_MixtureDesign& design, std::uint32_t from, std::uint32_t to) {
    if (to >= design.numRuns) throw std::length_error("more runs than counted");
    const des_MixtureRun& source = design.runs[from];
    des_MixtureRun& copy = design.runs[to];
    allocateArrays(design, copy);
    copy.runOrder = to + 1;
    copy.pointType = source.pointType;
    std::copy_n(source.proportions, design.numComponents, copy.proportions);
}

}  // namespace reisti
