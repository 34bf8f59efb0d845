#ifndef REISTI_TESTS_SUPPORT_PLAIN_SCREENING_H
#define REISTI_TESTS_SUPPORT_PLAIN_SCREENING_H

// Definitive screening designs in the plainest formulation, the oracle for the construction of the library. A design is
// a list of runs in standard order; a run that a failed request leaves unwritten is empty.

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

#include "reisti/reisti.h"
#include "support/plain_conference.h"
#include "support/plain_signs.h"

namespace reisti::test::plain {

struct PlainRun {
    std::uint32_t runOrder = 0;
    std::uint32_t block = 0;
    std::uint32_t pointType = 0;
    std::vector<std::int32_t> levels;

    bool operator==(const PlainRun&) const = default;
};

struct Request {
    std::uint32_t numFactors = 0;
    std::vector<std::uint32_t> categorical = {};
    std::uint32_t replicates = 1;
    std::uint32_t numBlocks = 1;
};

struct Design {
    std::int32_t code = des_Success;
    std::vector<std::optional<PlainRun>> runs;
};

/// The only continuous factor, where all others are categorical: found by a walk in list order, which for lists that do
/// not ascend may stop at a categorical factor.
inline std::optional<std::uint32_t> singleContinuousFactor(const Request& request) {
    if (request.categorical.empty() || request.numFactors - request.categorical.size() != 1) return std::nullopt;
    std::uint32_t column = 0;
    for (const std::uint32_t entry : request.categorical) {
        if (column < entry) break;
        ++column;
    }
    return column;
}

inline void writeBaseRows(const Request& request, Design& design) {
    const std::uint32_t order = baseOrder(request.numFactors);
    const SignMatrix& table = conferenceMatrix(order);
    const std::optional<std::uint32_t> single = singleContinuousFactor(request);
    for (std::uint32_t i = 0; i < order; ++i) {
        PlainRun run;
        run.levels.assign(table[i].begin(), table[i].begin() + request.numFactors);
        run.block = 1;
        run.pointType = i < request.numFactors ? 2 : 1;
        if (single == i) run.pointType = 0;
        run.runOrder = 2 * i + 1;
        design.runs[2 * std::size_t{i}] = run;
    }
}

inline void writeCentreRun(const Request& request, Design& design, std::uint32_t pointType) {
    const std::uint32_t order = baseOrder(request.numFactors);
    design.runs[2 * std::size_t{order}] =
        PlainRun{2 * order + 1, 1, pointType, std::vector<std::int32_t>(request.numFactors)};
}

/// Replaces the zeros of the categorical columns and writes the centre run; des_ErrorCategoricalIndex before any write.
inline std::int32_t writeCategoricalSigns(const Request& request, Design& design) {
    const std::size_t k = request.categorical.size();
    SignMatrix m(k, std::vector<std::int32_t>(k));
    for (std::size_t a = 0; a < k; ++a) {
        if (request.categorical[a] >= request.numFactors) return des_ErrorCategoricalIndex;
    }
    for (std::size_t a = 0; a < k; ++a) {
        for (std::size_t b = 0; b < k; ++b) {
            m[a][b] = design.runs[2 * std::size_t{request.categorical[a]}]->levels[request.categorical[b]];
        }
    }
    std::vector<std::int32_t> rowSigns;
    std::vector<std::int32_t> centreSigns;
    if (const std::optional<std::vector<std::int32_t>> found = propagatedSigns(m)) {
        rowSigns = *found;
        centreSigns = *found;
    } else {
        const Fallback fallback = fallbackSigns(m);
        rowSigns = fallback.signs;
        // Only the selected position is negative in the centre run, whatever the candidate says.
        centreSigns.assign(k, 1);
        centreSigns[fallback.selected] = -1;
    }
    writeCentreRun(request, design, k == request.numFactors ? 1 : 0);
    PlainRun& centre = *design.runs[2 * std::size_t{baseOrder(request.numFactors)}];
    for (std::size_t a = 0; a < k; ++a) {
        const std::uint32_t column = request.categorical[a];
        PlainRun& run = *design.runs[2 * std::size_t{column}];
        run.levels[column] = rowSigns[a];
        run.pointType = 1;
        centre.levels[column] = centreSigns[a];
    }
    return des_Success;
}

inline PlainRun flipped(const PlainRun& run) {
    PlainRun result = run;
    for (std::int32_t& level : result.levels) {
        level = -level;
    }
    result.runOrder = run.runOrder + 1;
    return result;
}

inline void foldOver(const Request& request, Design& design) {
    const std::uint32_t pairs = baseOrder(request.numFactors) + (request.categorical.empty() ? 0 : 1);
    for (std::size_t i = 0; i < pairs; ++i) {
        design.runs[2 * i + 1] = flipped(*design.runs[2 * i]);
    }
}

/// Appends the further replicates to the base runs.
inline std::int32_t replicate(const Request& request, Design& design) {
    const std::size_t baseRuns = design.runs.size();
    const double replicates = request.replicates;
    if (replicates > 4294967295.0 / static_cast<double>(baseRuns)) return des_ErrorTooManyReplicates;
    if (request.replicates < 2) return des_Success;
    const double replicatesPerBlock = replicates / static_cast<double>(request.numBlocks);
    // Division by 0 blocks gives infinity, which is whole.
    if (std::isnan(replicatesPerBlock) || std::floor(replicatesPerBlock) != replicatesPerBlock) return des_ErrorBlocks;
    for (std::uint32_t r = 1; r < request.replicates; ++r) {
        for (std::size_t j = 0; j < baseRuns; ++j) {
            PlainRun run = *design.runs[j];
            run.block = static_cast<std::uint32_t>(static_cast<double>(r) / replicatesPerBlock) + 1;
            run.runOrder = static_cast<std::uint32_t>(r * baseRuns + j + 1);
            design.runs.push_back(run);
        }
    }
    return des_Success;
}

/// The design of a request in standard order. Where the request fails, the code and what it leaves written; the list
/// then ends with the base runs.
inline Design create(const Request& request) {
    Design design;
    if (request.numFactors < 2 || request.numFactors > 48) {
        design.code = des_ErrorNumFactors;
        return design;
    }
    const bool hasCategorical = !request.categorical.empty();
    design.runs.resize(baseRunCount(request.numFactors, hasCategorical));
    writeBaseRows(request, design);
    if (request.categorical.size() > request.numFactors) {
        design.code = des_ErrorTooManyCategorical;
        return design;
    }
    if (hasCategorical) {
        design.code = writeCategoricalSigns(request, design);
        if (design.code != des_Success) return design;
    } else {
        writeCentreRun(request, design, 0);
    }
    foldOver(request, design);
    design.code = replicate(request, design);
    return design;
}

}  // namespace reisti::test::plain

#endif
