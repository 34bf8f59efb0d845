#ifndef REISTI_TESTS_SUPPORT_ADDRESS_SPACE_LIMIT_H
#define REISTI_TESTS_SUPPORT_ADDRESS_SPACE_LIMIT_H

#include <sys/resource.h>

/// Sanitizers reserve terabytes of addresses and answer huge allocations in their own way.
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
#define REISTI_TESTS_CAN_LIMIT_MEMORY 0
#elif defined(__has_feature)
#if __has_feature(address_sanitizer) || __has_feature(thread_sanitizer) || __has_feature(memory_sanitizer)
#define REISTI_TESTS_CAN_LIMIT_MEMORY 0
#endif
#endif
#ifndef REISTI_TESTS_CAN_LIMIT_MEMORY
#define REISTI_TESTS_CAN_LIMIT_MEMORY 1
#endif

namespace reisti::test {

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
