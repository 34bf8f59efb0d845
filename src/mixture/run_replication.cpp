#include "mixture/run_replication.h"

#include <algorithm>
#include <cstddef>
#include <utility>
#include <vector>

#include "mixture/run_array.h"
#include "random/random_numbers.h"

namespace reisti {

namespace {

/// The first `written` runs by class, within a class in their own order.
std::vector<std::uint32_t> sortByClass(const des_MixtureDesign& design, std::size_t numClasses, std::uint32_t written) {
    const auto classOfRun = [&design](std::uint32_t run) {
        return classOfType(design.runs[run].pointType, design.numComponents);
    };
    std::vector<std::uint32_t> place(numClasses + 1, 0);
    for (std::uint32_t i = 0; i < written; ++i)
        ++place[classOfRun(i) + 1];
    for (std::size_t c = 1; c <= numClasses; ++c)
        place[c] += place[c - 1];
    std::vector<std::uint32_t> sorted(written);
    for (std::uint32_t i = 0; i < written; ++i)
        sorted[place[classOfRun(i)]++] = i;
    return sorted;
}

}  // namespace

void repeatPoints(des_MixtureDesign& design, const PointClasses& classes, std::uint32_t& written) {
    if (std::ranges::all_of(classes.replicates, [](std::uint32_t replicates) { return replicates < 2; })) return;
    for (const std::uint32_t point : sortByClass(design, classes.replicates.size(), written)) {
        const std::size_t pointClass = classOfType(design.runs[point].pointType, design.numComponents);
        for (std::uint32_t r = 1; r < classes.replicates[pointClass]; ++r)
            copyMixture(design, point, written++);
    }
}

void repeatDesign(des_MixtureDesign& design, std::uint32_t& written) {
    const std::uint32_t points = written;
    if (points == 0) return;
    for (std::uint32_t r = 1; r < design.designReplicates; ++r) {
        for (std::uint32_t i = 0; i < points; ++i)
            copyMixture(design, i, written++);
    }
}

void runAtEveryAmount(des_MixtureDesign& design, std::uint32_t& written) {
    if (design.numAmounts == 0) return;
    if (design.numAmounts == 1) {
        for (std::uint32_t i = 0; i < design.numRuns; ++i)
            design.runs[i].amount = design.amounts[0];
        return;
    }
    const std::uint32_t mixtures = written;
    if (mixtures == 0) return;
    for (std::uint32_t i = 0; i < mixtures; ++i)
        design.runs[i].amount = design.amounts[0];
    for (std::uint32_t a = 1; a < design.numAmounts; ++a) {
        for (std::uint32_t i = 0; i < mixtures; ++i) {
            design.runs[written].amount = design.amounts[a];
            copyMixture(design, i, written++);
        }
    }
}

void randomizeRunOrder(des_MixtureDesign& design) {
    std::vector<double> values;
    generateRandomNumbers(design.numRuns, design.seed, values);
    std::vector<std::pair<double, std::uint32_t>> order(design.numRuns);
    for (std::uint32_t i = 0; i < design.numRuns; ++i)
        order[i] = {values[i], i};
    const auto pairCompare = [](const auto& a, const auto& b) { return a.first < b.first; };
    std::sort(order.begin(), order.end(), pairCompare);
    for (std::uint32_t k = 0; k < design.numRuns; ++k)
        design.runs[order[k].second].runOrder = k + 1;
}

}  // namespace reisti
