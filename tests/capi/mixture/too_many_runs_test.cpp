#include <ctime>
#include <gtest/gtest.h>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "support/address_space_limit.h"
#include "support/mixture_record.h"

namespace reisti::test {
namespace {

struct SizeCase {
    std::string name;
    MixtureRequest request;
};

MixtureRequest with(MixtureRequest request, void (*change)(MixtureRequest&)) {
    change(request);
    return request;
}

/// Designs with more runs than 32 bits count; several wrap to a small number when multiplied in 32 or in 64 bits.
std::vector<SizeCase> uncountable() {
    return {
        {"ThirtyThreeComponents", centroidRequest(33)},
        {"SixtyFourComponents", centroidRequest(64)},
        {"ThousandComponents", centroidRequest(1000)},
        {"TwoThousandComponents", centroidRequest(2000)},
        {"DesignReplicates", with(centroidRequest(3), [](auto& r) { r.designReplicates = 0xFFFFFFFF; })},
        {"OneRunTooMany", with(latticeRequest(2, 3), [](auto& r) { r.designReplicates = 0x40000000; })},
        {"VertexReplicates", with(centroidRequest(3), [](auto& r) { r.vertexReplicates = 0x60000000; })},
        {"TypeReplicates", with(centroidRequest(4),
                                [](auto& r) {
                                    r.typeReplicates = {0x40000000, 0};
                                })},
        {"CentreReplicatesBesideOtherRuns", with(centroidRequest(3), [](auto& r) { r.centerReplicates = 0xFFFFFFFF; })},
        {"AxialReplicates", with(centroidRequest(3),
                                 [](auto& r) {
                                     r.axialPoints = 1;
                                     r.axialReplicates = 0x60000000;
                                 })},
        {"SumOfTypes", with(centroidRequest(5),
                            [](auto& r) {
                                r.vertexReplicates = r.centerReplicates = 0xFFFFFFFF;
                                r.typeReplicates = {0xFFFFFFFF, 0xFFFFFFFF, 0xFFFFFFFF};
                            })},
        {"AmountsTimesReplicates", with(centroidRequest(3),
                                        [](auto& r) {
                                            r.amounts.assign(65536, 1.0);
                                            r.designReplicates = 65536;
                                        })},
        {"ProductThatWrapsToZeroIn32Bits", with(latticeRequest(2, 3),
                                                [](auto& r) {
                                                    r.designReplicates = 0x10000000;
                                                    r.numProcessVariables = 2;
                                                })},
        {"ProductThatWrapsToZeroIn64Bits", with(latticeRequest(2, 1),
                                                [](auto& r) {
                                                    r.vertexReplicates = 0x80000000;
                                                    r.designReplicates = 0x80000000;
                                                    r.numProcessVariables = 1;
                                                })},
        {"ProductThatWrapsIn64Bits", with(latticeRequest(2, 1),
                                          [](auto& r) {
                                              r.vertexReplicates = r.designReplicates = 0xFFFFFFFF;
                                              r.numProcessVariables = 30;
                                          })},
        {"ThirtyTwoProcessVariables", with(centroidRequest(3), [](auto& r) { r.numProcessVariables = 32; })},
        {"SixtyFourProcessVariables", with(centroidRequest(3), [](auto& r) { r.numProcessVariables = 64; })},
        {"MostProcessVariables", with(centroidRequest(3), [](auto& r) { r.numProcessVariables = 0xFFFFFFFF; })},
        {"LatticeOfHighDegree", latticeRequest(21, 1000)},
        {"LatticeOfHighestDegree", latticeRequest(21, 0x7FFFFFFF)},
        {"LatticeOfManyComponents", latticeRequest(300, 9)},
    };
}

/// Designs whose runs can be counted, but not kept.
std::vector<SizeCase> unaffordable() {
    return {
        // The array of runs alone would fit into the limit; the proportions of the runs would not.
        {"TwentyFiveComponents", centroidRequest(25)},
        {"ThirtyComponents", centroidRequest(30)},
        {"ThirtyOneComponents", centroidRequest(31)},
        // 2^32 - 1 points: as many as 32 bits count.
        {"ThirtyTwoComponents", centroidRequest(32)},
        {"ThirtyComponentsWithEverything", with(centroidRequest(30),
                                                [](auto& r) {
                                                    r.axialPoints = r.randomize = 1;
                                                    r.amounts = {1};
                                                })},
        {"MostRuns", with(latticeRequest(2, 2),
                          [](auto& r) {
                              r.centerReplicates = 1;
                              r.vertexReplicates = 0;
                              r.designReplicates = 0xFFFFFFFF;
                          })},
        {"CentreReplicates", with(centroidRequest(3), [](auto& r) { r.centerReplicates = 0xF0000000; })},
        {"TwentyNineProcessVariables", with(centroidRequest(3), [](auto& r) { r.numProcessVariables = 29; })},
        {"LatticeOfHighDegree", latticeRequest(25, 10)},
    };
}

class UncountableDesign : public testing::TestWithParam<SizeCase> {};

TEST_P(UncountableDesign, IsOutOfMemory) {
    MixtureRecord record(GetParam().request);
    EXPECT_EQ(record.run(), des_ErrorOutOfMemory);
}

TEST_P(UncountableDesign, LeavesRunsUntouched) {
    MixtureRecord record(GetParam().request);
    des_MixtureRun theirs{};
    record->runs = &theirs;
    record->numRuns = 77;
    record.run();
    EXPECT_EQ(record->runs, &theirs);
    EXPECT_EQ(record->numRuns, 77U);
    record->runs = nullptr;
    record->numRuns = 0;
}

INSTANTIATE_TEST_SUITE_P(All, UncountableDesign, testing::ValuesIn(uncountable()),
                         [](const auto& instance) { return instance.param.name; });

class UnaffordableDesign : public testing::TestWithParam<SizeCase> {
  protected:
    void SetUp() override {
        if (!canLimitMemory()) GTEST_SKIP() << "a limit of memory does not hold here";
    }
};

TEST_P(UnaffordableDesign, IsOutOfMemoryAndLeavesNoRuns) {
    const AddressSpaceLimit limit(rlim_t{4} << 30);
    MixtureRecord record(GetParam().request);
    EXPECT_EQ(record.run(), des_ErrorOutOfMemory);
    EXPECT_EQ(record->runs, nullptr);
    EXPECT_EQ(record->numRuns, 0U);
}

// Filling the limit run by run takes seconds; asking for the whole at once takes none.
TEST_P(UnaffordableDesign, IsRefusedAtOnce) {
    const AddressSpaceLimit limit(rlim_t{4} << 30);
    MixtureRecord record(GetParam().request);
    // Processor time: a busy machine must not fail the test.
    const std::clock_t start = std::clock();
    record.run();
    EXPECT_LT(std::clock() - start, CLOCKS_PER_SEC / 2);
}

INSTANTIATE_TEST_SUITE_P(All, UnaffordableDesign, testing::ValuesIn(unaffordable()),
                         [](const auto& instance) { return instance.param.name; });

TEST(LargeDesign, ThatFitsIsBuilt) {
    MixtureRecord record(with(centroidRequest(2), [](auto& r) { r.designReplicates = 100000; }));
    EXPECT_EQ(record.run(), des_Success);
    EXPECT_EQ(record->numRuns, 300000U);
    EXPECT_EQ(record->runs[299999].runOrder, 300000U);
}

}  // namespace
}  // namespace reisti::test
