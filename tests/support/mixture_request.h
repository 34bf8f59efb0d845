#ifndef REISTI_TESTS_SUPPORT_MIXTURE_REQUEST_H
#define REISTI_TESTS_SUPPORT_MIXTURE_REQUEST_H

#include <cstdint>
#include <optional>
#include <vector>

namespace reisti::test {

/// What a caller fills into a mixture record, as values; the members bear the names of the record's fields.
struct MixtureRequest {
    bool lattice = false;
    std::int32_t degree = 1;
    std::uint8_t centerPoint = 0;

    std::vector<double> lowerBounds;
    std::vector<double> upperBounds;
    std::uint32_t vertexReplicates = 1;
    std::optional<std::vector<std::uint32_t>> typeReplicates;
    std::uint32_t centerReplicates = 1;
    std::uint32_t axialReplicates = 1;
    std::uint32_t designReplicates = 1;
    std::uint32_t numProcessVariables = 0;
    std::uint32_t processFraction = 1;
    std::uint32_t fractionIndex = 1;
    std::vector<double> amounts;
    std::uint8_t axialPoints = 0;
    std::uint32_t outputUnits = 0;
    std::uint8_t randomize = 0;
    double seed = 0.0;

    std::uint32_t numComponents() const { return static_cast<std::uint32_t>(lowerBounds.size()); }
};

/// Bounds 0 and 1, everything else as a new record has it.
MixtureRequest centroidRequest(std::uint32_t numComponents);
MixtureRequest latticeRequest(std::uint32_t numComponents, std::int32_t degree, std::uint8_t centerPoint = 0);

/// One run as a value.
struct MixtureRunValue {
    std::uint32_t runOrder = 0;
    std::int32_t pointType = 0;
    std::vector<double> proportions;
    double amount = 1.0;
    std::vector<std::int32_t> processLevels;
};

/// What every output entry holds before a run, so that a test sees which ones were written.
inline constexpr double POISON_NUMBER = -7.75e77;
inline constexpr std::uint32_t POISON_COUNT = 0xDEADBEEF;

/// Everything that a run leaves in a record and in the caller's arrays.
struct MixtureOutcome {
    std::int32_t code = 0;
    std::vector<double> lowerBounds;
    std::vector<double> upperBounds;
    bool boundsAdjusted = false;
    std::vector<double> scaledLowerBounds;
    std::vector<double> scaledUpperBounds;
    std::vector<double> pseudoLowerBounds;
    std::vector<double> pseudoUpperBounds;
    std::vector<std::uint32_t> pointsPerType;
    std::uint32_t numCenterPoints = 0;
    std::uint32_t numAxialPoints = 0;
    std::vector<std::uint32_t> boundaryCounts;
    std::vector<MixtureRunValue> runs;

    /// An outcome before anything has been written.
    static MixtureOutcome untouched(const MixtureRequest& request);
};

}  // namespace reisti::test

#endif
