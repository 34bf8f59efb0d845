#ifndef REISTI_TESTS_SUPPORT_SCALE_H
#define REISTI_TESTS_SUPPORT_SCALE_H

namespace reisti::test {

/// Number of random cases to try where an optimized build tries `full`. Sanitizer builds run ten to fifty times slower
/// and divide it by the configured REISTI_TEST_SCALE; at least one case is always left.
constexpr int scaled(int full) {
    const int cases = full / REISTI_TEST_SCALE;
    return cases > 0 ? cases : 1;
}

}  // namespace reisti::test

#endif
