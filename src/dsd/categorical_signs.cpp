#include "dsd/categorical_signs.h"

#include <algorithm>

#include "dsd/conference_matrices.h"
#include "dsd/construction.h"

namespace reisti {

namespace {

enum class Pass { kSettled, kChanged, kConflict };

/// Lets every decided, not yet propagated position force its neighbours once.
Pass propagate(const std::vector<std::int32_t>& m, std::size_t k, std::vector<std::int32_t>& signs,
               std::vector<char>& fixed) {
    bool changed = false;
    for (std::size_t r = 0; r < k; ++r) {
        if (fixed[r] != 0 || signs[r] == 0) continue;
        for (std::size_t j = 0; j < k; ++j) {
            if (j == r || m[r * k + j] != signs[r]) continue;
            const std::int32_t required = -m[j * k + r];
            if (fixed[j] != 0 && signs[j] == -required) return Pass::kConflict;
            changed = changed || signs[j] != required;
            signs[j] = required;
        }
        fixed[r] = 1;
    }
    return changed ? Pass::kChanged : Pass::kSettled;
}

/// The matrix m with its symmetric sum: what a pair of positions has to say about its two signs.
class PairVotes {
  public:
    PairVotes(const std::vector<std::int32_t>& m, std::size_t k) : m_(m), k_(k) {}

    std::int32_t m(std::size_t a, std::size_t b) const { return m_[a * k_ + b]; }
    std::int32_t sum(std::size_t a, std::size_t b) const { return m(a, b) + m(b, a); }

    /// What position j wants of its own sign because of the pivot.
    std::int32_t ownVote(std::size_t j, std::size_t pivot) const {
        const std::int32_t t = sum(j, pivot);
        if (t == 0 && m(j, pivot) == -1) return 1;
        return t == -2 ? -1 : 0;
    }

    /// What position j, with sign wj, wants of the sign of l.
    std::int32_t vote(std::size_t j, std::size_t l, std::int32_t wj) const {
        switch (sum(j, l)) {
            case 2:
                return wj == 1 ? -1 : 0;
            case 0:
                if (m(j, l) == 1 && wj == -1) return -1;
                return m(j, l) == -1 && wj == 1 ? 1 : 0;
            case -2:
                return wj == -1 ? 1 : 0;
            default:
                return 0;
        }
    }

  private:
    const std::vector<std::int32_t>& m_;
    std::size_t k_;
};

/// Flips the most opposed sign until no position has more votes against its sign than for it; returns the flips made.
///
/// It always ends: each pair of positions other than the pivot forbids one combination of their two signs, seen alike
/// from both ends, and the vote of a position because of the pivot is constant. Flipping a sign that more votes oppose
/// than support therefore lowers the number of violated votes, of which there are at most k(k-1)/2.
std::size_t repair(const PairVotes& votes, std::size_t k, std::size_t pivot, std::vector<std::int32_t>& w) {
    std::vector<std::int32_t> total(k);
    for (std::size_t flips = 0;; ++flips) {
        std::fill(total.begin(), total.end(), 0);
        for (std::size_t j = 0; j < k; ++j) {
            if (j == pivot) continue;
            for (std::size_t l = 0; l < k; ++l) {
                if (l == pivot) continue;
                total[l] += l == j ? votes.ownVote(j, pivot) : votes.vote(j, l, w[j]);
            }
        }
        for (std::size_t l = 0; l < k; ++l)
            total[l] *= w[l];
        const auto least = std::min_element(total.begin(), total.end());
        if (*least >= 0) return flips;
        std::int32_t& sign = w[static_cast<std::size_t>(least - total.begin())];
        sign = -sign;
    }
}

/// Violated pairs of a candidate. Only the pairs of position 1 are looked at, and not all pairs: which candidate wins,
/// and so every published design with these factors, depends on it.
std::int32_t violations(const PairVotes& votes, std::size_t k, std::size_t pivot, const std::vector<std::int32_t>& w) {
    std::int32_t count = 0;
    for (std::size_t r = 0; k >= 2 && r < k; ++r) {
        const std::int32_t v = votes.m(1, r) * w[r] + votes.m(r, 1) * w[1];
        const std::int32_t violated = pivot == 1 || pivot == r ? -2 : 2;
        if (v == violated) ++count;
    }
    return count;
}

/// The k x k matrix of the categorical rows and columns, read from the even base runs.
std::vector<std::int32_t> gather(const des_DefinitiveScreeningDesign& design) {
    const std::size_t k = design.numCategorical;
    std::vector<std::int32_t> m(k * k);
    for (std::size_t a = 0; a < k; ++a) {
        const std::int32_t* row = design.runs[std::size_t{2} * design.categoricalFactors[a]].levels;
        for (std::size_t b = 0; b < k; ++b)
            m[a * k + b] = row[design.categoricalFactors[b]];
    }
    return m;
}

}  // namespace

bool tactic1(const std::vector<std::int32_t>& m, std::size_t k, std::vector<std::int32_t>& signs) {
    signs.assign(k, 0);
    std::vector<char> fixed(k, 0);
    Pass outcome = Pass::kSettled;
    for (std::size_t a = 0; a < k; ++a) {
        if (signs[a] == 0) signs[a] = -1;
        do {
            outcome = propagate(m, k, signs, fixed);
        } while (outcome == Pass::kChanged);
        if (outcome == Pass::kConflict) {
            // The next position starts over from the signs up to a, with +1 here; a conflict at the last position has
            // no next one and goes to the fallback without +1 being tried.
            std::fill(fixed.begin(), fixed.end(), char{0});
            std::fill(signs.begin() + static_cast<std::ptrdiff_t>(a) + 1, signs.end(), 0);
            signs[a] = 1;
        }
    }
    return outcome != Pass::kConflict;
}

FallbackSigns tactic2(const std::vector<std::int32_t>& m, std::size_t k) {
    const PairVotes votes(m, k);
    FallbackSigns best{};
    std::int32_t fewest = 0;
    for (std::size_t pivot = 0; pivot < k; ++pivot) {
        std::vector<std::int32_t> w(k);
        for (std::size_t a = 0; a < k; ++a)
            w[a] = votes.sum(a, pivot) == -2 ? -1 : 1;
        best.mostFlips = std::max(best.mostFlips, repair(votes, k, pivot, w));
        const std::int32_t count = violations(votes, k, pivot, w);
        if (pivot == 0 || count < fewest) {
            fewest = count;
            best.selected = pivot;
            best.signs = std::move(w);
        }
    }
    return best;
}

std::int32_t assignCategoricalSigns(des_DefinitiveScreeningDesign& design) {
    const std::size_t k = design.numCategorical;
    // The whole list is examined before a level is read through it.
    for (std::size_t a = 0; a < k; ++a) {
        if (design.categoricalFactors[a] >= design.numFactors) return des_ErrorCategoricalIndex;
    }
    const std::vector<std::int32_t> m = gather(design);
    std::vector<std::int32_t> signs;
    std::vector<std::int32_t> centreSigns;
    if (tactic1(m, k, signs)) {
        centreSigns = signs;
    } else {
        FallbackSigns fallback = tactic2(m, k);
        signs = std::move(fallback.signs);
        // The fallback's centre run does not repeat its signs: it is all +1 but for the pivot.
        centreSigns.assign(k, 1);
        centreSigns[fallback.selected] = -1;
    }

    addTrueCenterpoint(design);
    des_DefinitiveScreeningRun& centre = design.runs[2 * baseOrder(design.numFactors)];
    if (k == design.numFactors) centre.pointType = des_ScreeningPointNoZero;
    for (std::size_t a = 0; a < k; ++a) {
        const std::uint32_t factor = design.categoricalFactors[a];
        des_DefinitiveScreeningRun& run = design.runs[std::size_t{2} * factor];
        run.levels[factor] = signs[a];
        run.pointType = des_ScreeningPointNoZero;
        centre.levels[factor] = centreSigns[a];
    }
    return des_Success;
}

}  // namespace reisti
