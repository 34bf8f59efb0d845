#ifndef REISTI_TESTS_SUPPORT_PLAIN_RUN_ORDER_H
#define REISTI_TESTS_SUPPORT_PLAIN_RUN_ORDER_H

// The randomized run order of a screening design with ordered maps: the oracle for the sorted arrays of the library.

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <map>
#include <set>
#include <vector>

namespace reisti::test::plain {

/// Number of runs of each block 1, 2, .. up to the largest block met.
inline std::vector<std::uint32_t> countRunsPerBlock(const std::vector<std::uint32_t>& blocks) {
    std::vector<std::uint32_t> counts;
    for (const std::uint32_t block : blocks) {
        if (counts.size() < block) counts.resize(block, 0);
        ++counts[block - 1];
    }
    return counts;
}

struct BlockRanks {
    std::map<double, std::uint32_t> byKey;
    std::set<std::uint32_t> notHandedOut;

    /// The rank of the smallest key left. Keys that repeat are lost; when none is left, the smallest rank that no run
    /// got yet.
    std::uint32_t take() {
        std::uint32_t rank = 0;
        if (!byKey.empty()) {
            rank = byKey.begin()->second;
            byKey.erase(byKey.begin());
        } else {
            rank = *notHandedOut.begin();
        }
        notHandedOut.erase(rank);
        return rank;
    }
};

/// Run orders for runs in these blocks. `keys` holds, block by block, the key of the block and one key per run of it.
inline std::vector<std::uint32_t> randomizedRunOrders(const std::vector<std::uint32_t>& blocks,
                                                      const std::vector<std::uint32_t>& runsPerBlock,
                                                      const std::vector<double>& keys) {
    std::map<double, std::uint32_t> blockByKey;
    std::vector<BlockRanks> ranks(runsPerBlock.size());
    std::size_t cursor = 0;
    for (std::uint32_t b = 1; b <= runsPerBlock.size(); ++b) {
        blockByKey.insert({keys[cursor++], b});
        for (std::uint32_t i = 1; i <= runsPerBlock[b - 1]; ++i) {
            ranks[b - 1].byKey.insert({keys[cursor++], i});
            ranks[b - 1].notHandedOut.insert(i);
        }
    }

    std::vector<std::uint32_t> sequence;
    for (const auto& [key, block] : blockByKey) {
        sequence.push_back(block);
    }
    // Blocks whose key was there already come last, by their number.
    for (std::uint32_t b = 1; b <= runsPerBlock.size(); ++b) {
        if (std::find(sequence.begin(), sequence.end(), b) == sequence.end()) sequence.push_back(b);
    }

    std::vector<std::uint32_t> offsets(runsPerBlock.size(), 0);
    for (std::size_t placed = 0; placed < sequence.size(); ++placed) {
        for (std::size_t later = placed + 1; later < sequence.size(); ++later) {
            offsets[sequence[later] - 1] += runsPerBlock[sequence[placed] - 1];
        }
    }

    std::vector<std::uint32_t> orders;
    for (const std::uint32_t block : blocks) {
        orders.push_back(ranks[block - 1].take() + offsets[block - 1]);
    }
    return orders;
}

}  // namespace reisti::test::plain

#endif
