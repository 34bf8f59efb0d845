// Every allocation of a run refused in turn: an error code, nothing thrown, nothing leaked, nothing half-built handed
// out.
#include <cstddef>
#include <gtest/gtest.h>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "support/failing_new.h"
#include "support/plain_mixture.h"
#include "support/plain_vertices_design.h"
#include "support/vertices_record.h"

namespace reisti::test {
namespace {

struct FailureCase {
    std::string name;
    VerticesRequest request;
};

void PrintTo(const FailureCase& instance, std::ostream* out) {
    *out << instance.name;
}

std::vector<FailureCase> failureCases() {
    const VerticesRequest simplex = simplexRequest(3, 1);

    VerticesRequest constrained = verticesRequest({0.1, 0.1, 0.0, 0.0}, {0.6, 0.5, 0.7, 0.5});
    constrained.degree = 3;
    constrained.axialPoints = constrained.randomize = 1;
    constrained.seed = 2.0;
    constrained.constraints = {atMost(0.45, {1, 0, 1, 0}), between(0.2, 0.9, {1, 2, 0, -1}), atMost(9, {1, 1, 1, 1})};

    VerticesRequest full = verticesRequest({1, 1, 0, 0, 0}, {6, 5, 7, 5, 4});
    full.amounts = {10};
    full.degree = 5;
    full.centerPoint = 1;
    full.axialPoints = full.randomize = 1;
    full.seed = 3.0;
    full.vertexReplicates = 2;
    full.numProcessVariables = 3;
    full.processFraction = 2;
    full.constraints = {atLeast(3.5, {1, 0, 1, 0, 1})};

    VerticesRequest amounts = simplexRequest(4, 2);
    amounts.upperBounds = {5, 5, 5, 5};
    amounts.amounts = {5, 10};
    amounts.designReplicates = 2;
    amounts.centerPoint = 1;
    return {{"Simplex", simplex}, {"Constrained", constrained}, {"Everything", full}, {"Amounts", amounts}};
}

class VerticesAllocationFailure : public testing::TestWithParam<FailureCase> {};

TEST_P(VerticesAllocationFailure, OfAnyAllocationIsReportedAndLeavesNothing) {
    const VerticesOutcome expected = plainVerticesDesign(GetParam().request);
    std::size_t reported = 0;
    for (std::size_t n = 1;; ++n) {
        ASSERT_LT(n, 100000U);
        SCOPED_TRACE(n);
        VerticesRecord record(GetParam().request);
        AllocationWatch watch(n);
        const std::int32_t code = record.run();
        watch.stop();
        if (!watch.counts().failed) {
            EXPECT_TRUE(sameOutcome(record.outcome(code), expected));
            EXPECT_GT(reported, expected.design.runs.size()) << "every run has an array of its own";
            break;
        }
        if (code == des_Success) {
            // Giving back unused capacity is an allocation that a vector can do without.
            ASSERT_TRUE(sameOutcome(record.outcome(code), expected));
            continue;
        }
        ++reported;
        ASSERT_EQ(code, des_ErrorOutOfMemory);
        EXPECT_EQ(record->runs, nullptr);
        EXPECT_EQ(record->numRuns, 0U);
        EXPECT_EQ(watch.counts().liveBlocks, 0);
    }
}

TEST_P(VerticesAllocationFailure, UndisturbedRunKeepsTheRunsAndNothingElse) {
    VerticesRecord record(GetParam().request);
    AllocationWatch watch;
    ASSERT_EQ(record.run(), des_Success);
    watch.stop();
    const std::uint32_t perRun = GetParam().request.numProcessVariables > 0 ? 2 : 1;
    EXPECT_EQ(watch.counts().liveBlocks, static_cast<std::ptrdiff_t>(1 + perRun * record->numRuns));
}

TEST_P(VerticesAllocationFailure, ALimitThatIsMissedKeepsNothing) {
    VerticesRequest request = GetParam().request;
    request.degree = 2;
    request.maxPoints = 1;
    VerticesRecord record(request);
    AllocationWatch watch;
    ASSERT_EQ(record.run(), des_ErrorTooManyPoints);
    watch.stop();
    EXPECT_EQ(watch.counts().liveBlocks, 0);
}

INSTANTIATE_TEST_SUITE_P(All, VerticesAllocationFailure, testing::ValuesIn(failureCases()),
                         [](const auto& instance) { return instance.param.name; });

}  // namespace
}  // namespace reisti::test
