#ifndef REISTI_TESTS_SUPPORT_PLAIN_SIGNS_H
#define REISTI_TESTS_SUPPORT_PLAIN_SIGNS_H

// The two searches for the signs of categorical factors, in the plainest formulation. Every flag, vector and proposal
// is spelled out and nothing is accumulated from step to step.

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

#include "support/plain_conference.h"

namespace reisti::test::plain {

using Signs = std::vector<std::int32_t>;

struct Propagation {
    Signs signs;
    std::vector<bool> fixed;
    bool changed = false;
    bool conflict = false;
};

/// One pass over all positions whose sign is decided but not yet propagated.
inline void propagate(const SignMatrix& m, Propagation& state) {
    const std::size_t k = m.size();
    state.changed = false;
    for (std::size_t r = 0; r < k; ++r) {
        if (state.fixed[r] || state.signs[r] == 0) continue;
        for (std::size_t j = 0; j < k; ++j) {
            if (j == r || m[r][j] != state.signs[r]) continue;
            const std::int32_t required = -m[j][r];
            if (state.fixed[j] && required != 0 && state.signs[j] == -required) {
                state.conflict = true;
                return;
            }
            if (state.signs[j] != required) {
                state.signs[j] = required;
                state.changed = true;
            }
        }
        state.fixed[r] = true;
    }
}

/// Nothing when the search ends in a conflict at its last position.
inline std::optional<Signs> propagatedSigns(const SignMatrix& m) {
    const std::size_t k = m.size();
    Propagation state{Signs(k, 0), std::vector<bool>(k, false)};
    for (std::size_t a = 0; a < k; ++a) {
        state.conflict = false;
        if (state.signs[a] == 0) state.signs[a] = -1;
        do {
            propagate(m, state);
        } while (state.changed && !state.conflict);
        if (state.conflict) {
            state.fixed.assign(k, false);
            for (std::size_t later = a + 1; later < k; ++later) {
                state.signs[later] = 0;
            }
            state.signs[a] = 1;
        }
    }
    if (state.conflict) return std::nullopt;
    return state.signs;
}

struct Fallback {
    Signs signs;
    std::size_t selected = 0;
    std::size_t mostFlips = 0;
    std::vector<std::size_t> violations;
};

/// What position j proposes for every position, given the signs w and the pivot i.
inline Signs proposal(const SignMatrix& m, const SignMatrix& sum, const Signs& w, std::size_t i, std::size_t j) {
    const std::size_t k = m.size();
    Signs p(k, 0);
    for (std::size_t l = 0; l < k; ++l) {
        if (l == j) {
            if (sum[j][i] == 0 && m[j][i] == -1) p[j] = 1;
            if (sum[j][i] == -2) p[j] = -1;
        } else if (l != i) {
            const std::int32_t t = sum[j][l];
            if (t == 2 && w[j] == 1) p[l] = -1;
            if (t == 0 && m[j][l] == 1 && w[j] == -1) p[l] = -1;
            if (t == 0 && m[j][l] == -1 && w[j] == 1) p[l] = 1;
            if (t == -2 && w[j] == -1) p[l] = 1;
        }
    }
    return p;
}

/// The candidate of pivot i and the number of signs flipped on the way.
inline Signs repairedCandidate(const SignMatrix& m, const SignMatrix& sum, std::size_t i, std::size_t& flips) {
    const std::size_t k = m.size();
    Signs w(k);
    for (std::size_t a = 0; a < k; ++a) {
        w[a] = sum[a][i] == -2 ? -1 : 1;
    }
    for (flips = 0;; ++flips) {
        Signs total(k, 0);
        for (std::size_t j = 0; j < k; ++j) {
            if (j == i) continue;
            const Signs p = proposal(m, sum, w, i, j);
            for (std::size_t l = 0; l < k; ++l) {
                total[l] += p[l];
            }
        }
        for (std::size_t l = 0; l < k; ++l) {
            total[l] *= w[l];
        }
        const auto lowest = std::min_element(total.begin(), total.end());
        if (*lowest >= 0) return w;
        std::int32_t& flippedSign = w[static_cast<std::size_t>(lowest - total.begin())];
        flippedSign = -flippedSign;
    }
}

/// Pairs of position 1 only: the scoring is not one over all pairs.
inline std::size_t countViolations(const SignMatrix& m, const Signs& w, std::size_t i) {
    std::size_t count = 0;
    if (m.size() < 2) return count;
    for (std::size_t r = 0; r < m.size(); ++r) {
        const std::int32_t v = m[1][r] * w[r] + m[r][1] * w[1];
        if (i == 1 || i == r) {
            if (v == -2) ++count;
        } else {
            if (v == 2) ++count;
        }
    }
    return count;
}

inline Fallback fallbackSigns(const SignMatrix& m) {
    const std::size_t k = m.size();
    SignMatrix sum(k, Signs(k));
    for (std::size_t a = 0; a < k; ++a) {
        for (std::size_t b = 0; b < k; ++b) {
            sum[a][b] = m[a][b] + m[b][a];
        }
    }
    Fallback result;
    std::vector<Signs> candidates;
    for (std::size_t i = 0; i < k; ++i) {
        std::size_t flips = 0;
        candidates.push_back(repairedCandidate(m, sum, i, flips));
        result.mostFlips = std::max(result.mostFlips, flips);
        result.violations.push_back(countViolations(m, candidates.back(), i));
    }
    const auto best = std::min_element(result.violations.begin(), result.violations.end());
    result.selected = static_cast<std::size_t>(best - result.violations.begin());
    result.signs = candidates[result.selected];
    return result;
}

}  // namespace reisti::test::plain

#endif
