#ifndef REISTI_TESTS_SUPPORT_ADDRESS_SPACE_LIMIT_H
#define REISTI_TESTS_SUPPORT_ADDRESS_SPACE_LIMIT_H

#include <cstddef>
#include <sys/mman.h>
#include <sys/resource.h>

namespace reisti::test {

/// Sanitizers reserve terabytes of addresses and answer huge allocations in their own way: no limit there.
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
inline constexpr bool kSanitizerHoldsMemory = true;
#elif defined(__has_feature)
inline constexpr bool kSanitizerHoldsMemory =
    __has_feature(address_sanitizer) || __has_feature(thread_sanitizer) || __has_feature(memory_sanitizer);
#else
inline constexpr bool kSanitizerHoldsMemory = false;
#endif

/// Limits the memory of the process while it lives: what a test asks for too much of fails here on any machine, instead
/// of being promised by a system that overcommits.
class AddressSpaceLimit {
  public:
    explicit AddressSpaceLimit(rlim_t bytes) {
        getrlimit(RLIMIT_AS, &before_);
        rlimit limited = before_;
        limited.rlim_cur = bytes;
        setrlimit(RLIMIT_AS, &limited);
    }
    ~AddressSpaceLimit() { setrlimit(RLIMIT_AS, &before_); }
    AddressSpaceLimit(const AddressSpaceLimit&) = delete;
    AddressSpaceLimit& operator=(const AddressSpaceLimit&) = delete;

  private:
    rlimit before_{};
};

/// Whether a limit holds here: sanitizers live above it, and emulators of other processors ignore it.
inline bool canLimitMemory() {
    if (kSanitizerHoldsMemory) return false;
    constexpr std::size_t kLimit = std::size_t{4} << 30;
    const AddressSpaceLimit limit(kLimit);
    void* const block = mmap(nullptr, 2 * kLimit, PROT_NONE, MAP_PRIVATE | MAP_ANONYMOUS | MAP_NORESERVE, -1, 0);
    if (block == MAP_FAILED) return true;
    munmap(block, 2 * kLimit);
    return false;
}

}  // namespace reisti::test

#endif
