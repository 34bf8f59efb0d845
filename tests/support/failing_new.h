#ifndef REISTI_TESTS_SUPPORT_FAILING_NEW_H
#define REISTI_TESTS_SUPPORT_FAILING_NEW_H

#include <cstddef>

namespace reisti::test {

/// What a thread asked of operator new while a watch was on.
struct AllocationCounts {
    std::size_t attempts = 0;       ///< allocations asked for, the failed one included
    std::ptrdiff_t liveBlocks = 0;  ///< allocated minus freed; anything but 0 at the end is a leak
    std::ptrdiff_t liveBytes = 0;
    std::ptrdiff_t peakBytes = 0;  ///< most live bytes at any moment, as the allocator rounds them
    bool failed = false;           ///< whether the chosen allocation was reached and refused
};

/// Counts the allocations of the calling thread and refuses one of them.
///
/// A program that lists failing_new.cpp among its sources replaces every form of operator new and delete. Without a
/// watch they behave as usual, so that the test framework allocates undisturbed:
///
///     for (std::size_t n = 1;; ++n) {
///         AllocationWatch watch(n);
///         const std::int32_t code = des_Some...(&record);
///         watch.stop();
///         if (!watch.counts().failed) break;  // fewer than n allocations: the call ran undisturbed
///         EXPECT_EQ(code, des_ErrorOutOfMemory);
///         EXPECT_EQ(watch.counts().liveBlocks, 0);
///     }
///
/// Only one watch is on per thread. Link the static library: the replacement is then sure to reach its allocations.
class AllocationWatch {
  public:
    static constexpr std::size_t kNeverFail = 0;

    /// @param failNth which allocation from now on to refuse, counted from 1; only that one fails
    explicit AllocationWatch(std::size_t failNth = kNeverFail);
    ~AllocationWatch();
    AllocationWatch(const AllocationWatch&) = delete;
    AllocationWatch& operator=(const AllocationWatch&) = delete;

    /// Ends counting and refusing; the counts stay.
    void stop();
    const AllocationCounts& counts() const { return counts_; }

    /// For the replaced operators: whether this allocation may go on.
    bool admit();
    void noteAllocated(void* block);
    void noteFreed(void* block);

  private:
    AllocationCounts counts_;
    std::size_t failNth_;
};

}  // namespace reisti::test

#endif
