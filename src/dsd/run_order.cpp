#include "dsd/run_order.h"

#include <algorithm>
#include <bit>
#include <cstddef>
#include <cstring>
#include <new>

#include "dsd/conference_matrices.h"
#include "dsd/construction.h"
#include "random/random_numbers.h"

namespace reisti {

namespace {

/// A random key with the index that it was drawn for. The key is kept as two words so that an entry takes 12 bytes:
/// with the drawn numbers themselves that is 20 bytes a run.
class KeyedIndex {
  public:
    KeyedIndex(double key, std::uint32_t index) : index_(index) {
        const std::uint64_t image = orderedImage(key);
        std::memcpy(key_, &image, sizeof image);
    }

    std::uint64_t key() const {
        std::uint64_t image = 0;
        std::memcpy(&image, key_, sizeof image);
        return image;
    }
    std::uint32_t index() const { return index_; }

    friend bool operator<(const KeyedIndex& a, const KeyedIndex& b) {
        return a.key() != b.key() ? a.key() < b.key() : a.index_ < b.index_;
    }

  private:
    /// Ascending doubles have ascending images. Unlike doubles the images are totally ordered even if a sampler hands
    /// out NaN, so that sorting stays in bounds.
    static std::uint64_t orderedImage(double key) {
        // Adding zero makes one zero of the two.
        const auto bits = std::bit_cast<std::uint64_t>(key + 0.0);
        constexpr std::uint64_t kSign = std::uint64_t{1} << 63;
        return (bits & kSign) != 0 ? ~bits : bits | kSign;
    }

    std::uint32_t key_[2]{};
    std::uint32_t index_ = 0;
};

/// Sorts entries by key and moves those whose key occurred at a smaller index behind the others, ascending by index.
void sortWithRepeatsLast(std::vector<KeyedIndex>& entries) {
    std::sort(entries.begin(), entries.end());
    const auto repeats = [](const KeyedIndex& a, const KeyedIndex& b) { return a.key() == b.key(); };
    if (std::adjacent_find(entries.begin(), entries.end(), repeats) == entries.end()) return;

    std::vector<KeyedIndex> lost;
    auto end = entries.begin();
    for (const KeyedIndex& entry : entries) {
        if (end != entries.begin() && repeats(end[-1], entry)) {
            lost.push_back(entry);
        } else {
            *end++ = entry;
        }
    }
    std::sort(lost.begin(), lost.end(), [](const KeyedIndex& a, const KeyedIndex& b) { return a.index() < b.index(); });
    std::copy(lost.begin(), lost.end(), end);
}

/// Number of runs placed before each block.
std::vector<std::uint32_t> blockOffsets(const std::vector<std::uint32_t>& blockRunCounts,
                                        const std::vector<double>& u) {
    std::vector<KeyedIndex> order;
    order.reserve(blockRunCounts.size());
    std::size_t cursor = 0;
    for (std::uint32_t b = 0; b < blockRunCounts.size(); ++b) {
        order.emplace_back(u[cursor], b);
        cursor += std::size_t{1} + blockRunCounts[b];
    }
    sortWithRepeatsLast(order);

    std::vector<std::uint32_t> offsets(blockRunCounts.size());
    std::uint32_t placed = 0;
    for (const KeyedIndex& entry : order) {
        offsets[entry.index()] = placed;
        placed += blockRunCounts[entry.index()];
    }
    return offsets;
}

/// Runs of each block; the vector ends with the largest block number met.
std::vector<std::uint32_t> countRunsPerBlock(const des_DefinitiveScreeningRun* runs, std::uint32_t total) {
    std::vector<std::uint32_t> counts;
    for (std::uint32_t t = 0; t < total; ++t) {
        if (runs[t].block > counts.size()) counts.resize(runs[t].block);
        ++counts[runs[t].block - 1];
    }
    return counts;
}

/// For each block in turn, the 0-based ranks in the order in which its runs take them.
std::vector<std::uint32_t> ranksByBlock(std::uint32_t total, const std::vector<std::uint32_t>& blockRunCounts,
                                        const std::vector<double>& u) {
    std::vector<std::uint32_t> ranks;
    ranks.reserve(total);
    std::vector<KeyedIndex> entries;
    if (!blockRunCounts.empty()) entries.reserve(*std::max_element(blockRunCounts.begin(), blockRunCounts.end()));
    std::size_t cursor = 0;
    for (const std::uint32_t count : blockRunCounts) {
        ++cursor;
        entries.clear();
        for (std::uint32_t i = 0; i < count; ++i)
            entries.emplace_back(u[cursor++], i);
        sortWithRepeatsLast(entries);
        for (const KeyedIndex& entry : entries)
            ranks.push_back(entry.index());
    }
    return ranks;
}

}  // namespace

void assignRunOrders(des_DefinitiveScreeningRun* runs, std::uint32_t total,
                     const std::vector<std::uint32_t>& blockRunCounts, const std::vector<double>& u) {
    const std::vector<std::uint32_t> offsets = blockOffsets(blockRunCounts, u);
    const std::vector<std::uint32_t> ranks = ranksByBlock(total, blockRunCounts, u);
    std::vector<std::size_t> next(blockRunCounts.size());
    std::size_t start = 0;
    for (std::size_t b = 0; b < next.size(); ++b) {
        next[b] = start;
        start += blockRunCounts[b];
    }
    for (std::uint32_t t = 0; t < total; ++t) {
        const std::size_t b = runs[t].block - 1;
        runs[t].runOrder = offsets[b] + ranks[next[b]++] + 1;
    }
}

void randomizeDesign(des_DefinitiveScreeningDesign& design) {
    if (design.randomize == 0) return;
    // Zero replicates, though they count as one when the design is built, leave the standard order.
    const std::uint32_t total = baseRunCount(design.numFactors, design.numCategorical != 0) * design.replicates;
    const std::vector<std::uint32_t> counts = countRunsPerBlock(design.runs, total);
    const std::uint64_t numbers = std::uint64_t{total} + counts.size();
    if (numbers > UINT32_MAX) throw std::bad_alloc();
    std::vector<double> u;
    generateRandomNumbers(static_cast<std::uint32_t>(numbers), design.seed, u);
    assignRunOrders(design.runs, total, counts, u);
}

}  // namespace reisti
