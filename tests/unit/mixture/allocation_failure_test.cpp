// Every allocation of a run refused in turn: an error code, nothing thrown, nothing leaked, nothing half-built handed
// out.
#include <cstddef>
#include <gtest/gtest.h>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "support/failing_new.h"
#include "support/mixture_record.h"
#include "support/plain_mixture.h"

namespace reisti::test {
namespace {

struct FailureCase {
    std::string name;
    MixtureRequest request;
};

std::vector<FailureCase> failureCases() {
    MixtureRequest centroid = centroidRequest(3);
    MixtureRequest full = centroidRequest(3);
    full.axialPoints = full.randomize = 1;
    full.seed = 2.0;
    full.numProcessVariables = 3;
    full.processFraction = 2;
    full.vertexReplicates = 2;
    MixtureRequest lattice = latticeRequest(4, 3, 1);
    lattice.axialPoints = lattice.randomize = 1;
    lattice.seed = 2.0;
    lattice.amounts = {10, 20};
    lattice.upperBounds = {10, 10, 10, 10};
    MixtureRequest bounded = centroidRequest(4);
    bounded.lowerBounds = {0.1, 0.2, 0.1, 0.05};
    return {
        {"Centroid", centroid}, {"CentroidWithEverything", full}, {"Lattice", lattice}, {"BoundedCentroid", bounded}};
}

class AllocationFailure : public testing::TestWithParam<FailureCase> {};

TEST_P(AllocationFailure, OfAnyAllocationIsReportedAndLeavesNothing) {
    const MixtureOutcome expected = plainDesign(GetParam().request);
    for (std::size_t n = 1;; ++n) {
        ASSERT_LT(n, 100000U);
        SCOPED_TRACE(n);
        MixtureRecord record(GetParam().request);
        AllocationWatch watch(n);
        const std::int32_t code = record.run();
        watch.stop();
        if (!watch.counts().failed) {
            EXPECT_TRUE(sameOutcome(record.outcome(code), expected));
            EXPECT_GT(n, expected.runs.size()) << "every run has an array of its own";
            break;
        }
        ASSERT_EQ(code, des_ErrorOutOfMemory);
        EXPECT_EQ(record->runs, nullptr);
        EXPECT_EQ(record->numRuns, 0U);
        EXPECT_EQ(watch.counts().liveBlocks, 0);
    }
}

TEST_P(AllocationFailure, LeavesRunsUntouchedBeforeTheyAreCountedAndNullAfterwards) {
    bool counted = false;
    for (std::size_t n = 1;; ++n) {
        ASSERT_LT(n, 100000U);
        SCOPED_TRACE(n);
        MixtureRecord record(GetParam().request);
        des_MixtureRun theirs{};
        record->runs = &theirs;
        record->numRuns = 77;
        AllocationWatch watch(n);
        record.run();
        watch.stop();
        if (!watch.counts().failed) break;
        const bool untouched = record->runs == &theirs && record->numRuns == 77;
        const bool cleared = record->runs == nullptr && record->numRuns == 0;
        EXPECT_TRUE(cleared || (untouched && !counted));
        counted = cleared;
        record->runs = nullptr;
        record->numRuns = 0;
    }
    EXPECT_TRUE(counted);
}

TEST_P(AllocationFailure, UndisturbedRunKeepsTheRunsAndNothingElse) {
    MixtureRecord record(GetParam().request);
    AllocationWatch watch;
    ASSERT_EQ(record.run(), des_Success);
    watch.stop();
    const std::uint32_t perRun = GetParam().request.numProcessVariables > 0 ? 2 : 1;
    EXPECT_EQ(watch.counts().liveBlocks, static_cast<std::ptrdiff_t>(1 + perRun * record->numRuns));
}

INSTANTIATE_TEST_SUITE_P(All, AllocationFailure, testing::ValuesIn(failureCases()),
                         [](const auto& instance) { return instance.param.name; });

TEST(AllocationFailureOfTheRecord, GivesNull) {
    AllocationWatch watch(1);
    des_MixtureDesign* design = des_CreateMixtureDesignContainer();
    watch.stop();
    EXPECT_EQ(design, nullptr);
    des_DeleteMixtureDesignContainer(&design);
}

TEST(DeletedRecord, FreesRecordAndRuns) {
    MixtureRequest request = failureCases()[1].request;
    AllocationWatch watch;
    {
        MixtureRecord record(request);
        ASSERT_EQ(record.run(), des_Success);
    }
    watch.stop();
    EXPECT_EQ(watch.counts().liveBlocks, 0);
}

TEST(LateProcessFractionError, KeepsTheRunsForTheCallerToDelete) {
    MixtureRequest request = centroidRequest(3);
    request.numProcessVariables = 9;
    request.processFraction = 2;
    AllocationWatch watch;
    {
        MixtureRecord record(request);
        EXPECT_EQ(record.run(), des_ErrorProcessFraction);
        EXPECT_NE(record->runs, nullptr);
    }
    watch.stop();
    EXPECT_EQ(watch.counts().liveBlocks, 0);
}

}  // namespace
}  // namespace reisti::test
