#ifndef REISTI_FUZZ_SAME_BYTES_H
#define REISTI_FUZZ_SAME_BYTES_H

#include <cstring>
#include <span>

namespace fuzz {

/// Whether two arrays are equal bit by bit, which unlike == tells zeros apart and knows NaN as itself.
template <typename A, typename B>
bool haveSameBytes(const A& a, const B& b) {
    const auto left = std::as_bytes(std::span(a));
    const auto right = std::as_bytes(std::span(b));
    return left.size() == right.size() && (left.empty() || std::memcmp(left.data(), right.data(), left.size()) == 0);
}

}  // namespace fuzz

#endif
