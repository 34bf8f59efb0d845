#ifndef REISTI_FUZZ_REQUIRE_H
#define REISTI_FUZZ_REQUIRE_H

#include <cstdio>
#include <cstdlib>

namespace fuzz {

/// Stops the program, so that the fuzzer keeps the input, when something does not hold that the interface promises.
inline void require(bool holds, const char* promise) {
    if (holds) return;
    std::fprintf(stderr, "broken promise: %s\n", promise);
    std::abort();
}

}  // namespace fuzz

#endif
