#ifndef REISTI_MIXTURE_ID_TABLE_H
#define REISTI_MIXTURE_ID_TABLE_H

#include <algorithm>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace reisti {

/// Spreads the bits of a value over all 64 (the finalizer of S. Vigna's splitmix64). Neighbouring values, and values
/// that differ in their high bits only, get unrelated results.
inline std::uint64_t mixBits(std::uint64_t x) {
    x += 0x9E3779B97F4A7C15U;
    x = (x ^ (x >> 30U)) * 0xBF58476D1CE4E5B9U;
    x = (x ^ (x >> 27U)) * 0x94D049BB133111EBU;
    return x ^ (x >> 31U);
}

/// 32-bit ids filed under hashes. Several ids may share a hash; nothing is ever taken out. The table knows only the
/// hashes: whoever looks up compares what the ids stand for.
///
/// Open addressing with linear probing, at most half full. A slot keeps the hash beside the id, so that growing needs
/// no look at what was filed and most foreign ids are passed over without one.
class IdTable {
  public:
    void insert(std::uint64_t hash, std::uint32_t id) {
        if (2 * (count_ + 1) > slots_.size()) grow();
        place({fold(hash), id + 1});
        ++count_;
    }

    /// Makes room for so many ids in all.
    void reserve(std::size_t count) {
        const std::size_t size = std::bit_ceil(2 * count);
        if (size > slots_.size()) resize(std::max(size, kFirstSize));
    }

    /// Fetches the slots of a hash into the cache, for a look-up a little later: most of the time of a look-up in a
    /// large table is the wait for them.
    void prefetch(std::uint64_t hash) const {
        if (!slots_.empty()) __builtin_prefetch(&slots_[fold(hash) & mask_]);
    }

    /// Calls match(id) for every id filed under the hash, and perhaps for others, until it returns true.
    /// @return whether it did
    template <typename Match>
    bool any(std::uint64_t hash, Match&& match) const {
        if (count_ == 0) return false;
        const std::uint32_t key = fold(hash);
        for (std::size_t i = key & mask_; slots_[i].idPlusOne != 0; i = (i + 1) & mask_)
            if (slots_[i].key == key && match(slots_[i].idPlusOne - 1)) return true;
        return false;
    }

  private:
    struct Slot {
        std::uint32_t key;
        std::uint32_t idPlusOne;  ///< 0 marks an empty slot
    };

    static std::uint32_t fold(std::uint64_t hash) { return static_cast<std::uint32_t>(hash >> 32U); }

    void place(Slot slot) {
        std::size_t i = slot.key & mask_;
        while (slots_[i].idPlusOne != 0)
            i = (i + 1) & mask_;
        slots_[i] = slot;
    }

    void grow() { resize(slots_.empty() ? kFirstSize : 2 * slots_.size()); }

    void resize(std::size_t size) {
        std::vector<Slot> old(size);
        old.swap(slots_);
        mask_ = slots_.size() - 1;
        for (const Slot& slot : old)
            if (slot.idPlusOne != 0) place(slot);
    }

    static constexpr std::size_t kFirstSize = 64;

    std::vector<Slot> slots_;
    std::size_t mask_ = 0;
    std::size_t count_ = 0;
};

}  // namespace reisti

#endif
