#ifndef REISTI_TESTS_SUPPORT_ADDRESS_SPACE_LIMIT_H
#define REISTI_TESTS_SUPPORT_ADDRESS_SPACE_LIMIT_H

#include <sys/resource.h>

namespace reisti::test {

/// Sanitizers reserve terabytes of addresses and answer huge allocations in their own way: no limit there.
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
inline constexpr bool kCanLimitMemory = false;
#elif defined(__has_feature)
inline constexpr bool kCanLimitMemory =
    !(__has_feature(address_sanitizer) || __has_feature(thread_sanitizer) || __has_feature(memory_sanitizer));
#else
inline constexpr bool kCanLimitMemory = true;
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

}  // namespace reisti::test

#endif
