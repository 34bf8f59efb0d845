#include "digest/design_digest.h"

#include <algorithm>
#include <bit>
#include <concepts>
#include <cstddef>
#include <numeric>
#include <utility>
#include <vector>

#include "reisti/reisti.h"

namespace reisti::test {
namespace {

/// Reproducible draws. The distributions of the standard library differ from one implementation to the next.
/// Source: G. L. Steele, D. Lea and C. H. Flood, "Fast splittable pseudorandom number generators", OOPSLA 2014.
class Dice {
  public:
    explicit Dice(std::uint64_t seed) : state_(seed) {}

    std::uint32_t below(std::uint32_t count) { return static_cast<std::uint32_t>((next() >> 32) % count); }
    std::uint32_t from(std::uint32_t low, std::uint32_t high) { return low + below(high - low + 1); }
    bool oneIn(std::uint32_t count) { return below(count) == 0; }
    /// A fraction of `scale`: mostly a short decimal as people write it, sometimes with all its bits.
    double fraction(double scale) {
        const double value = oneIn(4) ? static_cast<double>(next() >> 11) * 0x1p-53 : below(1000) / 1000.0;
        return value * scale;
    }

  private:
    std::uint64_t next() {
        std::uint64_t z = (state_ += 0x9E3779B97F4A7C15U);
        z = (z ^ (z >> 30)) * 0xBF58476D1CE4E5B9U;
        z = (z ^ (z >> 27)) * 0x94D049BB133111EBU;
        return z ^ (z >> 31);
    }

    std::uint64_t state_;
};

/// FNV-1a over 64-bit words. Source: G. Fowler, L. C. Noll, K.-P. Vo and D. Eastlake, "The FNV non-cryptographic hash
/// algorithm", IETF draft-eastlake-fnv.
class Hash {
  public:
    template <std::integral Number>
    void add(Number number) {
        addWord(static_cast<std::uint64_t>(number));
    }
    void add(double number) { addWord(std::bit_cast<std::uint64_t>(number)); }
    template <typename Number>
    void add(const Number* numbers, std::size_t count) {
        for (std::size_t i = 0; i < count; ++i) {
            add(numbers[i]);
        }
    }
    std::uint64_t value() const { return value_; }

  private:
    void addWord(std::uint64_t word) {
        for (int shift = 0; shift < 64; shift += 8) {
            value_ = (value_ ^ ((word >> shift) & 0xFFU)) * 0x100000001B3U;
        }
    }

    std::uint64_t value_ = 0xCBF29CE484222325U;
};

DesignDigest screeningDesign(Dice& dice) {
    const std::uint32_t numFactors = dice.from(2, 48);
    std::vector<std::uint32_t> factors(numFactors);
    std::iota(factors.begin(), factors.end(), 0U);
    for (std::uint32_t i = numFactors - 1; i > 0; --i) {
        std::swap(factors[i], factors[dice.below(i + 1)]);
    }

    des_DefinitiveScreeningDesign design{};
    design.numFactors = numFactors;
    design.numCategorical = dice.oneIn(3) ? 0 : dice.below(numFactors + 1);
    design.categoricalFactors = factors.data();
    design.replicates = dice.from(0, 6);
    design.numBlocks = dice.from(1, 3);
    design.randomize = static_cast<std::uint8_t>(dice.below(2));
    design.seed = dice.from(1, 100000) / 8.0;

    DesignDigest result;
    const std::uint32_t numRuns = des_FindDefinitiveScreeningDesignRowCount(
        static_cast<std::int32_t>(numFactors), &result.code, design.numCategorical != 0, design.replicates);
    std::vector<std::int32_t> levels(std::size_t{numRuns} * numFactors);
    std::vector<des_DefinitiveScreeningRun> runs(numRuns);
    for (std::uint32_t i = 0; i < numRuns; ++i) {
        runs[i].levels = levels.data() + std::size_t{i} * numFactors;
    }
    design.runs = runs.data();
    result.code = des_CreateDefinitiveScreeningDesign(&design);

    Hash hash;
    hash.add(result.code);
    if (result.code == des_Success) {
        result.numRuns = numRuns;
        for (const auto& run : runs) {
            hash.add(run.runOrder);
            hash.add(run.block);
            hash.add(run.pointType);
            hash.add(run.levels, numFactors);
        }
    }
    result.digest = hash.value();
    return result;
}

/// A mixture record with the arrays of its caller.
class Mixture {
  public:
    explicit Mixture(std::uint32_t numComponents)
        : q(numComponents),
          lower(q, 0.0),
          upper(q, 1.0),
          numbers_(std::size_t{4} * q),
          counts_(std::size_t{2} * q),
          design(des_CreateMixtureDesignContainer()) {
        design->numComponents = q;
        design->lowerBounds = lower.data();
        design->upperBounds = upper.data();
        design->scaledLowerBounds = numbers_.data();
        design->scaledUpperBounds = numbers_.data() + q;
        design->pseudoLowerBounds = numbers_.data() + std::size_t{2} * q;
        design->pseudoUpperBounds = numbers_.data() + std::size_t{3} * q;
        design->pointsPerType = counts_.data();
        design->boundaryCounts = counts_.data() + q;
    }
    Mixture(const Mixture&) = delete;
    Mixture& operator=(const Mixture&) = delete;
    ~Mixture() { des_DeleteMixtureDesignContainer(&design); }

    /// Replicates, amounts, process variables, units and order.
    void drawEverythingElse(Dice& dice) {
        design->vertexReplicates = dice.from(0, 2);
        design->centerReplicates = dice.from(0, 3);
        design->axialReplicates = dice.from(0, 2);
        design->designReplicates = dice.from(1, 2);
        design->axialPoints = static_cast<std::uint8_t>(dice.below(2));
        design->outputUnits = dice.below(3);
        design->randomize = static_cast<std::uint8_t>(dice.below(2));
        design->seed = dice.from(1, 100000) / 8.0;
        if (dice.oneIn(2)) {
            for (std::uint32_t t = 2; t < q; ++t) {
                typeReplicates_.push_back(dice.from(0, 2));
            }
            design->typeReplicates = typeReplicates_.empty() ? nullptr : typeReplicates_.data();
        }
        switch (dice.below(3)) {
            case 0:
                return;
            case 1:
                drawAmounts(dice);
                return;
            default:
                drawProcessVariables(dice);
        }
    }

    DesignDigest digest(std::int32_t code, const std::vector<des_MixtureDesignLinearConstraint>& constraints) const {
        Hash hash;
        hash.add(code);
        if (code != des_Success) {
            return {code, 0, hash.value()};
        }
        for (const auto& constraint : constraints) {
            hash.add(constraint.status);
        }
        hash.add(lower.data(), q);
        hash.add(upper.data(), q);
        hash.add(numbers_.data(), numbers_.size());
        hash.add(counts_.data(), counts_.size());
        hash.add(design->numCenterPoints);
        hash.add(design->numAxialPoints);
        hash.add(design->boundsAdjusted);
        hash.add(design->numRuns);
        for (std::uint32_t i = 0; i < design->numRuns; ++i) {
            const des_MixtureRun& run = design->runs[i];
            hash.add(run.runOrder);
            hash.add(run.reserved);
            hash.add(run.pointType);
            hash.add(run.proportions, q);
            hash.add(run.amount);
            hash.add(run.processLevels, design->numProcessVariables);
        }
        return {code, design->numRuns, hash.value()};
    }

    const std::uint32_t q;
    std::vector<double> lower, upper;

  private:
    /// The first amount scales the bounds.
    void drawAmounts(Dice& dice) {
        for (std::uint32_t count = dice.from(1, 3); count > 0; --count) {
            amounts_.push_back(dice.from(1, 4000) / 16.0);
        }
        design->numAmounts = static_cast<std::uint32_t>(amounts_.size());
        design->amounts = amounts_.data();
        for (auto* bounds : {&lower, &upper}) {
            for (double& bound : *bounds) {
                bound *= amounts_[0];
            }
        }
    }

    void drawProcessVariables(Dice& dice) {
        design->numProcessVariables = dice.from(1, 7);
        design->processFraction = 1U << dice.below(std::min(4U, design->numProcessVariables));
        design->fractionIndex = dice.from(1, design->processFraction);
    }

    std::vector<double> numbers_, amounts_;
    std::vector<std::uint32_t> counts_, typeReplicates_;

  public:
    des_MixtureDesign* design;
};

/// Lower bounds alone leave a simplex.
void drawLowerBounds(Mixture& mixture, Dice& dice) {
    if (dice.oneIn(3)) {
        return;
    }
    for (double& bound : mixture.lower) {
        bound = dice.fraction(0.9 / mixture.q);
    }
}

DesignDigest centroidDesign(Dice& dice) {
    Mixture mixture(dice.from(2, 8));
    drawLowerBounds(mixture, dice);
    mixture.drawEverythingElse(dice);
    return mixture.digest(des_RunSimplexCentroidDesign(mixture.design), {});
}

DesignDigest latticeDesign(Dice& dice) {
    Mixture mixture(dice.from(2, 8));
    drawLowerBounds(mixture, dice);
    mixture.drawEverythingElse(dice);
    const auto degree = static_cast<std::int32_t>(dice.from(1, 5));
    return mixture.digest(des_RunSimplexLatticeDesign(mixture.design, degree, static_cast<std::uint8_t>(dice.below(2))),
                          {});
}

DesignDigest verticesDesign(Dice& dice) {
    Mixture mixture(dice.from(2, 7));
    const double equalShare = 1.0 / mixture.q;
    for (std::uint32_t i = 0; i < mixture.q; ++i) {
        mixture.lower[i] = dice.oneIn(3) ? 0.0 : dice.fraction(0.9 * equalShare);
        mixture.upper[i] = dice.oneIn(3) ? 1.0 : equalShare + dice.fraction(1.0 - equalShare);
    }
    // Sides near the value at equal shares, in the units of the total once amounts have scaled the bounds.
    mixture.drawEverythingElse(dice);
    const double total = mixture.design->numAmounts == 0 ? 1.0 : mixture.design->amounts[0];
    const std::uint32_t count = dice.below(4);
    std::vector<double> coefficients(std::size_t{count} * mixture.q);
    std::vector<des_MixtureDesignLinearConstraint> constraints(count);
    for (std::uint32_t c = 0; c < count; ++c) {
        double* row = coefficients.data() + std::size_t{c} * mixture.q;
        double middle = 0.0;
        for (std::uint32_t i = 0; i < mixture.q; ++i) {
            row[i] = dice.from(0, 8) - 4.0;
            middle += row[i] * equalShare;
        }
        constraints[c].coefficients = row;
        constraints[c].hasLowerValue = static_cast<std::uint8_t>(dice.below(2));
        constraints[c].hasUpperValue = static_cast<std::uint8_t>(dice.below(2));
        constraints[c].lowerValue = (middle - dice.fraction(1.0)) * total;
        constraints[c].upperValue = (middle + dice.fraction(1.0)) * total;
    }
    const auto degree = static_cast<std::int32_t>(dice.from(1, mixture.q));
    const auto center = static_cast<std::uint8_t>(dice.below(2));
    const std::int32_t code = des_RunExtremeVerticesDesign(
        mixture.design, degree, center, static_cast<std::int32_t>(count), count == 0 ? nullptr : constraints.data(), 0);
    return mixture.digest(code, constraints);
}

struct Family {
    const char* name;
    DesignDigest (*build)(Dice&);
};

constexpr Family FAMILIES[DIGEST_FAMILIES] = {
    {"screening", screeningDesign},
    {"centroid", centroidDesign},
    {"lattice", latticeDesign},
    {"vertices", verticesDesign},
};

}  // namespace

DesignDigest digestOfDesign(std::uint32_t number) {
    Dice dice(number);
    return FAMILIES[number % DIGEST_FAMILIES].build(dice);
}

const char* familyOfDesign(std::uint32_t number) {
    return FAMILIES[number % DIGEST_FAMILIES].name;
}

}  // namespace reisti::test
