// A host in C++20: a screening design and a constrained mixture design, errors as exceptions.
#include <array>
#include <cstdint>
#include <exception>
#include <iostream>
#include <memory>
#include <reisti/reisti.h>
#include <stdexcept>
#include <vector>

namespace {

void check(std::int32_t code) {
    if (code != des_Success) throw std::runtime_error(des_ErrorMessage(code));
}

/// Four continuous factors and a categorical one. The caller owns every array.
void screeningDesign() {
    constexpr std::uint32_t kFactors = 5;
    const std::array<std::uint32_t, 1> categorical{4};
    std::int32_t code = des_Success;
    const std::uint32_t numRuns = des_FindDefinitiveScreeningDesignRowCount(kFactors, &code, 1, 1);
    check(code);

    std::vector<std::array<std::int32_t, kFactors>> levels(numRuns);
    std::vector<des_DefinitiveScreeningRun> runs(numRuns);
    for (std::size_t i = 0; i < numRuns; ++i)
        runs[i].levels = levels[i].data();
    des_DefinitiveScreeningDesign design{};
    design.numFactors = kFactors;
    design.numCategorical = categorical.size();
    design.categoricalFactors = categorical.data();
    design.randomize = 1;
    design.replicates = 1;
    design.seed = 42;
    design.runs = runs.data();
    check(des_CreateDefinitiveScreeningDesign(&design));
    for (const des_DefinitiveScreeningRun& run : runs) {
        std::cout << "run " << run.runOrder << ':';
        for (std::size_t j = 0; j < kFactors; ++j)
            std::cout << ' ' << run.levels[j];
        std::cout << '\n';
    }
}

struct DeleteMixture {
    void operator()(des_MixtureDesign* design) const { des_DeleteMixtureDesignContainer(&design); }
};

/// Three components with bounds and A >= 1.5 B. The library owns the record and its runs, the caller all other arrays.
void mixtureDesign() {
    constexpr std::size_t q = 3;
    std::array<double, q> lower{0.1, 0.1, 0.0};
    std::array<double, q> upper{0.7, 0.7, 1.0};
    std::array<std::array<double, q>, 4> bounds{};
    std::array<std::array<std::uint32_t, q>, 2> counts{};
    const std::array<double, q> coefficients{1.0, -1.5, 0.0};
    des_MixtureDesignLinearConstraint constraint{};
    constraint.hasLowerValue = 1;
    constraint.coefficients = coefficients.data();

    const std::unique_ptr<des_MixtureDesign, DeleteMixture> design(des_CreateMixtureDesignContainer());
    if (design == nullptr) throw std::bad_alloc();
    design->numComponents = q;
    design->lowerBounds = lower.data();
    design->upperBounds = upper.data();
    design->scaledLowerBounds = bounds[0].data();
    design->scaledUpperBounds = bounds[1].data();
    design->pseudoLowerBounds = bounds[2].data();
    design->pseudoUpperBounds = bounds[3].data();
    design->pointsPerType = counts[0].data();
    design->boundaryCounts = counts[1].data();
    check(des_RunExtremeVerticesDesign(design.get(), 1, 1, 1, &constraint, 0));
    for (std::uint32_t i = 0; i < design->numRuns; ++i) {
        const des_MixtureRun& run = design->runs[i];
        std::cout << "type " << run.pointType << ':';
        for (std::size_t j = 0; j < q; ++j)
            std::cout << ' ' << run.proportions[j];
        std::cout << '\n';
    }
}

}  // namespace

int main() {
    try {
        screeningDesign();
        mixtureDesign();
    } catch (const std::exception& error) {
        std::cerr << error.what() << '\n';
        return 1;
    }
    return 0;
}
