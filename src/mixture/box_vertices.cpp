#include "mixture/box_vertices.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>
#include <stdexcept>
#include <utility>

#include "mixture/id_table.h"

namespace reisti {

namespace {

/// The combinations are cut by sums that are formed in another order than those that decide; this absolute slack covers
/// the difference and the width of the ties many times over.
constexpr double kWalkSlack = 1e-10;

/// A tie this close is one in whatever order the sum is formed, as long as rounding stays below kTrustedRounding.
constexpr double kSureTie = 0.5 * kSameVertexAbsolute;
constexpr double kTrustedRounding = 0.45 * kSameVertexAbsolute;

/// With all ranges above this (none negative, then), vertices that agree within kSameVertexAbsolute agree in which
/// bounds they touch.
constexpr double kDistinctRange = 4 * kSameVertexAbsolute;

/// Lowest positions of the list whose sums are tabled: at most 2^8 sums.
constexpr std::size_t kMaxTabledPositions = 8;

/// Components one table entry of the row writer covers: 2^4 patterns of bounds.
constexpr std::size_t kGroup = 4;

/// Indices of the components in ascending order of their ranges. A range counts as smaller only by more than
/// kSameVertexAbsolute, so that components typed with equal ranges keep their order whatever their bounds round to.
std::vector<std::size_t> orderByRange(std::size_t q, const double* lower, const double* upper) {
    std::vector<std::size_t> order(q);
    for (std::size_t i = 0; i < q; ++i)
        order[i] = i;
    const auto range = [&](std::size_t component) { return upper[component] - lower[component]; };
    for (std::size_t i = 0; i + 1 < q; ++i) {
        std::size_t best = i;
        for (std::size_t j = i + 1; j < q; ++j)
            if (range(order[best]) - range(order[j]) > kSameVertexAbsolute) best = j;
        std::swap(order[i], order[best]);
    }
    return order;
}

/// Vertices in short form: which components are at their upper bounds, which one is recomputed, and its value.
class VertexCodes {
  public:
    VertexCodes(std::size_t q, const double* lower, const double* upper)
        : q_(q), words_((q + 63) / 64), lower_(lower), upper_(upper) {}

    std::size_t count() const { return value_.size(); }

    void append(const std::vector<std::uint64_t>& atUpper, std::size_t recomputed, double value) {
        // Columns of the wider table that belongs to the vertices, the slacks of their 2q bounds, are indexed by int.
        if (count() >= static_cast<std::size_t>(std::numeric_limits<int>::max()) / (2 * q_))
            throw std::length_error("more vertices than a matrix holds");
        atUpper_.insert(atUpper_.end(), atUpper.begin(), atUpper.end());
        recomputed_.push_back(static_cast<std::uint32_t>(recomputed));
        value_.push_back(value);
    }

    bool isSame(std::size_t vertex, const std::vector<std::uint64_t>& atUpper, std::size_t recomputed,
                double value) const {
        for (std::size_t j = 0; j < q_; ++j) {
            const double a = component(&atUpper_[vertex * words_], recomputed_[vertex], value_[vertex], j);
            const double b = component(atUpper.data(), recomputed, value, j);
            if (!(std::fabs(a - b) <= kSameVertexAbsolute)) return false;
        }
        return true;
    }

    std::vector<double> rows() const;

  private:
    double component(const std::uint64_t* atUpper, std::size_t recomputed, double value, std::size_t j) const {
        if (j == recomputed) return value;
        return (atUpper[j / 64] >> (j % 64) & 1U) != 0 ? upper_[j] : lower_[j];
    }

    std::size_t q_;
    std::size_t words_;
    const double* lower_;
    const double* upper_;
    std::vector<std::uint64_t> atUpper_;  // words_ per vertex; bit j belongs to component j
    std::vector<std::uint32_t> recomputed_;
    std::vector<double> value_;
};

std::vector<double> VertexCodes::rows() const {
    const std::size_t groups = (q_ + kGroup - 1) / kGroup;
    constexpr std::size_t kPatterns = std::size_t{1} << kGroup;
    std::vector<double> patterns(groups * kPatterns * kGroup, 0.0);
    for (std::size_t j = 0; j < q_; ++j) {
        for (std::size_t bits = 0; bits < kPatterns; ++bits) {
            patterns[(j / kGroup * kPatterns + bits) * kGroup + j % kGroup] =
                (bits >> (j % kGroup) & 1U) != 0 ? upper_[j] : lower_[j];
        }
    }

    std::vector<double> rows;
    rows.reserve(count() * q_);
    std::vector<double> row(groups * kGroup);
    for (std::size_t vertex = 0; vertex < count(); ++vertex) {
        const std::uint64_t* const atUpper = &atUpper_[vertex * words_];
        for (std::size_t g = 0; g < groups; ++g) {
            const std::size_t bits = atUpper[g * kGroup / 64] >> (g * kGroup % 64) & (kPatterns - 1);
            std::copy_n(&patterns[(g * kPatterns + bits) * kGroup], kGroup, &row[g * kGroup]);
        }
        row[recomputed_[vertex]] = value_[vertex];
        rows.insert(rows.end(), row.begin(), row.begin() + static_cast<std::ptrdiff_t>(q_));
    }
    return rows;
}

/// Walks the combinations of bounds of the fixed components depth first, the last position of the list first and lower
/// bounds first, which is the order in which they count up. A branch is left as soon as no sum within its reach can
/// give a vertex.
///
/// Between two steps, positions >= level_ are set, and the arrays by position describe them:
/// 1. sum_[p] is the sum of positions p and above, formed from the top;
/// 2. widestAtLower_[p], widestAtUpper_[p] are the widest ranges among those at their lower, their upper bound;
/// 3. atUpper_ and, for positions below tabled_, lowBits_ tell the same combination as upper_[p].
class BoxVertexWalk {
  public:
    BoxVertexWalk(std::size_t q, const double* lower, const double* upper);
    VertexCodes run();

  private:
    void tableLowSums();
    void set(std::size_t position, bool upper);
    double roomFor(std::size_t position, bool belowLower) const;
    bool canYieldVertex() const;
    void visitCombination();
    void visitRepairs(double freeValue, bool belowLower);
    double sumOfFixed() const;
    double sumWithout(std::size_t position, double freeBound) const;
    void found(std::size_t component, double value, bool free, bool freeUpper);
    bool isKnown(const std::vector<std::uint64_t>& atUpper, std::size_t component, double value, bool settled);

    static void setBit(std::vector<std::uint64_t>& words, std::size_t bit, bool on) {
        const std::uint64_t mask = std::uint64_t{1} << (bit % 64);
        words[bit / 64] = on ? words[bit / 64] | mask : words[bit / 64] & ~mask;
    }

    std::size_t fixed_;  // number of fixed components: q - 1
    const double* lowerBound_;
    const double* upperBound_;
    std::vector<std::size_t> order_;
    std::size_t free_;
    double freeLower_;
    double freeUpper_;
    double freeLeast_;
    double freeMost_;

    // By position of the list, over the positions below it:
    std::vector<double> lowerBelow_;
    std::vector<double> upperBelow_;
    std::vector<double> widestBelow_;
    std::vector<double> narrowestBelow_;

    std::size_t level_;
    std::vector<double> range_;
    std::vector<char> inverted_;
    std::vector<double> setting_;
    std::vector<char> upper_;
    std::vector<double> sum_;
    std::vector<double> widestAtLower_;
    std::vector<double> widestAtUpper_;
    std::vector<std::uint64_t> atUpper_;
    std::vector<std::uint64_t> candidate_;

    std::size_t tabled_;
    std::size_t lowBits_ = 0;
    std::vector<double> lowSums_;

    // Ranges near the width of a tie, or sums so large that rounding is: no shortcut holds, every vertex is compared.
    bool narrow_ = false;
    std::vector<std::uint64_t> distinct_;  // components whose ranges exceed kDistinctRange
    VertexCodes vertices_;
    IdTable known_;
};

BoxVertexWalk::BoxVertexWalk(std::size_t q, const double* lower, const double* upper)
    : fixed_(q - 1),
      lowerBound_(lower),
      upperBound_(upper),
      order_(orderByRange(q, lower, upper)),
      free_(order_.back()),
      freeLower_(lower[free_]),
      freeUpper_(upper[free_]),
      freeLeast_(std::min(freeLower_, freeUpper_)),
      freeMost_(std::max(freeLower_, freeUpper_)),
      lowerBelow_(q, 0.0),
      upperBelow_(q, 0.0),
      widestBelow_(q, 0.0),
      narrowestBelow_(q, std::numeric_limits<double>::infinity()),
      level_(fixed_),
      range_(fixed_),
      inverted_(fixed_, 0),
      setting_(fixed_),
      upper_(fixed_, 0),
      sum_(q, 0.0),
      widestAtLower_(q, 0.0),
      widestAtUpper_(q, 0.0),
      atUpper_((q + 63) / 64, 0),
      tabled_(std::min(fixed_, kMaxTabledPositions)),
      distinct_((q + 63) / 64, 0),
      vertices_(q, lower, upper) {
    for (std::size_t p = 0; p < fixed_; ++p) {
        const std::size_t component = order_[p];
        // The check of the bounds lets a negative upper bound lie a hair below the lower one.
        range_[p] = std::fabs(upper[component] - lower[component]);
        inverted_[p] = upper[component] < lower[component] ? 1 : 0;
        lowerBelow_[p + 1] = lowerBelow_[p] + std::min(lower[component], upper[component]);
        upperBelow_[p + 1] = upperBelow_[p] + std::max(lower[component], upper[component]);
        widestBelow_[p + 1] = std::max(widestBelow_[p], range_[p]);
        narrowestBelow_[p + 1] = std::min(narrowestBelow_[p], range_[p]);
    }

    // No partial sum that can matter exceeds the total and one repair, but for what negative bounds add and take away.
    double magnitude = 2.0;
    for (std::size_t j = 0; j < q; ++j) {
        magnitude += 2.0 * std::max(0.0, -lower[j]);
        const bool distinct = upper[j] - lower[j] > kDistinctRange;
        setBit(distinct_, j, distinct);
        narrow_ = narrow_ || !distinct;
    }
    const double rounding = static_cast<double>(q) * magnitude * std::numeric_limits<double>::epsilon();
    narrow_ = narrow_ || rounding > kTrustedRounding;
    tableLowSums();
}

void BoxVertexWalk::tableLowSums() {
    lowSums_.resize(std::size_t{1} << tabled_);
    for (std::size_t bits = 0; bits < lowSums_.size(); ++bits) {
        double sum = 0.0;
        for (std::size_t p = 0; p < tabled_; ++p)
            sum += (bits >> p & 1U) != 0 ? upperBound_[order_[p]] : lowerBound_[order_[p]];
        lowSums_[bits] = sum;
    }
}

VertexCodes BoxVertexWalk::run() {
    while (true) {
        const bool worth = canYieldVertex();
        if (worth && level_ > 0) {
            set(--level_, false);
            continue;
        }
        if (worth) visitCombination();
        // Back to the lowest position still at its lower bound, which moves up.
        while (level_ < fixed_ && upper_[level_] != 0)
            ++level_;
        if (level_ == fixed_) break;
        set(level_, true);
    }
    return std::move(vertices_);
}

void BoxVertexWalk::set(std::size_t position, bool upper) {
    const std::size_t component = order_[position];
    upper_[position] = upper ? 1 : 0;
    setting_[position] = upper ? upperBound_[component] : lowerBound_[component];
    sum_[position] = sum_[position + 1] + setting_[position];
    widestAtLower_[position] = std::max(widestAtLower_[position + 1], roomFor(position, false));
    widestAtUpper_[position] = std::max(widestAtUpper_[position + 1], roomFor(position, true));
    setBit(atUpper_, component, upper);
    if (position < tabled_) {
        const std::size_t bit = std::size_t{1} << position;
        lowBits_ = upper ? lowBits_ | bit : lowBits_ & ~bit;
    }
}

/// How far a component can move off its bound to make up for what the free component is too low or too high.
double BoxVertexWalk::roomFor(std::size_t position, bool belowLower) const {
    return inverted_[position] != 0 || (upper_[position] != 0) == belowLower ? range_[position] : 0.0;
}

/// Whether a combination within reach puts the free component within its bounds, or outside by no more than one
/// component can make up for.
bool BoxVertexWalk::canYieldVertex() const {
    const double gain = std::max(widestAtLower_[level_], widestBelow_[level_]);
    const double highest = sum_[level_] + upperBelow_[level_];
    if (highest < 1.0 - freeMost_ - gain - kWalkSlack) return false;

    const double loss = std::max(widestAtUpper_[level_], widestBelow_[level_]);
    const double lowest = sum_[level_] + lowerBelow_[level_];
    const double limit = 1.0 - freeLeast_ + loss;
    if (lowest > limit + kWalkSlack) return false;
    // The repair would take the component from its upper to its lower bound: an earlier combination has been there.
    return narrow_ || std::fabs(lowest - limit) > kSureTie || loss <= 3 * kWalkSlack ||
           narrowestBelow_[level_] <= 3 * kWalkSlack;
}

double BoxVertexWalk::sumOfFixed() const {
    double sum = lowSums_[lowBits_];
    for (std::size_t p = tabled_; p < fixed_; ++p)
        sum += setting_[p];
    return sum;
}

double BoxVertexWalk::sumWithout(std::size_t position, double freeBound) const {
    double sum = 0.0;
    std::size_t p = 0;
    if (position >= tabled_) {
        sum = lowSums_[lowBits_];
        p = tabled_;
    }
    for (; p < position; ++p)
        sum += setting_[p];
    for (p = position + 1; p < fixed_; ++p)
        sum += setting_[p];
    return sum + freeBound;
}

void BoxVertexWalk::visitCombination() {
    const double computed = 1.0 - sumOfFixed();
    double freeValue = computed;
    if (settleWithinBounds(freeValue, freeLower_, freeUpper_)) {
        found(free_, freeValue, true, false);
    } else if (computed < freeLower_ || computed > freeUpper_) {
        visitRepairs(computed, computed < freeLower_);
    }
}

void BoxVertexWalk::visitRepairs(double freeValue, bool belowLower) {
    const double freeBound = belowLower ? freeLower_ : freeUpper_;
    const double excess = std::fabs(freeValue - freeBound);
    for (std::size_t p = 0; p < fixed_; ++p) {
        const double room = roomFor(p, belowLower);
        if (excess > room + kWalkSlack) continue;
        // As in canYieldVertex().
        if (belowLower && !narrow_ && room > 3 * kWalkSlack && std::fabs(excess - room) <= kSureTie) continue;

        const std::size_t component = order_[p];
        double value = 1.0 - sumWithout(p, freeBound);
        if (settleWithinBounds(value, lowerBound_[component], upperBound_[component]))
            found(component, value, false, !belowLower);
    }
}

void BoxVertexWalk::found(std::size_t component, double value, bool free, bool freeUpper) {
    candidate_ = atUpper_;
    if (!free) setBit(candidate_, free_, freeUpper);
    const bool settled = value == lowerBound_[component] || value == upperBound_[component];
    setBit(candidate_, component, settled && value != lowerBound_[component]);
    if ((settled || narrow_) && isKnown(candidate_, component, value, settled)) return;
    vertices_.append(candidate_, component, value);
}

/// Looks a vertex up among those that could be the same, and files it where it is not. A vertex with a component apart
/// from its bounds can be met only once while ranges are distinct: two combinations would have to differ in a component
/// that is at one of its bounds in both.
bool BoxVertexWalk::isKnown(const std::vector<std::uint64_t>& atUpper, std::size_t component, double value,
                            bool settled) {
    std::uint64_t hash = 0;
    for (std::size_t w = 0; w < atUpper.size(); ++w)
        hash = mixBits(hash ^ (atUpper[w] & distinct_[w]));
    const bool distinct = (distinct_[component / 64] >> (component % 64) & 1U) != 0;
    if (distinct && !settled) hash = mixBits(hash ^ component);
    const bool known =
        known_.any(hash, [&](std::uint32_t vertex) { return vertices_.isSame(vertex, atUpper, component, value); });
    if (!known) known_.insert(hash, static_cast<std::uint32_t>(vertices_.count()));
    return known;
}

}  // namespace

bool settleWithinBounds(double& component, double lower, double upper) {
    if (std::fabs(component - lower) <= kSameVertexAbsolute) {
        component = lower;
        return true;
    }
    if (std::fabs(component - upper) <= kSameVertexAbsolute) {
        component = upper;
        return true;
    }
    return lower < component && component < upper;
}

std::vector<double> enumerateBoxVertices(std::size_t q, const double* lower, const double* upper) {
    if (q == 0) return {};
    return BoxVertexWalk(q, lower, upper).run().rows();
}

}  // namespace reisti
