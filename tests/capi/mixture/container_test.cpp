#include <gtest/gtest.h>

#include "reisti/reisti.h"
#include "support/mixture_record.h"

namespace reisti::test {
namespace {

class NewRecord : public testing::Test {
  protected:
    ~NewRecord() override { des_DeleteMixtureDesignContainer(&design_); }
    des_MixtureDesign* design_ = des_CreateMixtureDesignContainer();
};

TEST_F(NewRecord, HasThreeComponents) {
    EXPECT_EQ(design_->numComponents, 3U);
}

TEST_F(NewRecord, RunsEverythingOnce) {
    EXPECT_EQ(design_->vertexReplicates, 1U);
    EXPECT_EQ(design_->centerReplicates, 1U);
    EXPECT_EQ(design_->axialReplicates, 1U);
    EXPECT_EQ(design_->designReplicates, 1U);
}

TEST_F(NewRecord, HasNoProcessVariablesAndTheFirstOfOneFraction) {
    EXPECT_EQ(design_->numProcessVariables, 0U);
    EXPECT_EQ(design_->processFraction, 1U);
    EXPECT_EQ(design_->fractionIndex, 1U);
}

TEST_F(NewRecord, HasNoAmounts) {
    EXPECT_EQ(design_->numAmounts, 0U);
}

TEST_F(NewRecord, HasEveryFlagFalse) {
    EXPECT_EQ(design_->axialPoints, 0);
    EXPECT_EQ(design_->boundsAdjusted, 0);
    EXPECT_EQ(design_->randomize, 0);
}

TEST_F(NewRecord, HasUnitsAmountAndSeedZero) {
    EXPECT_EQ(design_->outputUnits, 0U);
    EXPECT_EQ(design_->seed, 0.0);
}

TEST_F(NewRecord, HasNoResults) {
    EXPECT_EQ(design_->numRuns, 0U);
    EXPECT_EQ(design_->runs, nullptr);
    EXPECT_EQ(design_->numCenterPoints, 0U);
    EXPECT_EQ(design_->numAxialPoints, 0U);
    EXPECT_EQ(design_->reserved, 0U);
}

TEST_F(NewRecord, HasNoArrays) {
    EXPECT_EQ(design_->lowerBounds, nullptr);
    EXPECT_EQ(design_->upperBounds, nullptr);
    EXPECT_EQ(design_->scaledLowerBounds, nullptr);
    EXPECT_EQ(design_->scaledUpperBounds, nullptr);
    EXPECT_EQ(design_->pseudoLowerBounds, nullptr);
    EXPECT_EQ(design_->pseudoUpperBounds, nullptr);
    EXPECT_EQ(design_->pointsPerType, nullptr);
    EXPECT_EQ(design_->boundaryCounts, nullptr);
    EXPECT_EQ(design_->typeReplicates, nullptr);
    EXPECT_EQ(design_->amounts, nullptr);
}

TEST_F(NewRecord, IsAnotherOneEachTime) {
    des_MixtureDesign* other = des_CreateMixtureDesignContainer();
    EXPECT_NE(other, design_);
    des_DeleteMixtureDesignContainer(&other);
}

TEST(DeletingARecord, WithoutRunsNullsThePointer) {
    des_MixtureDesign* design = des_CreateMixtureDesignContainer();
    des_DeleteMixtureDesignContainer(&design);
    EXPECT_EQ(design, nullptr);
}

TEST(DeletingARecord, WithRunsNullsThePointer) {
    MixtureRequest request = centroidRequest(3);
    request.numProcessVariables = 2;
    MixtureRecord record(request);
    ASSERT_EQ(record.run(), des_Success);
    des_DeleteMixtureDesignContainer(record.address());
    EXPECT_EQ(record.get(), nullptr);
}

TEST(DeletingARecord, TwiceDoesNothing) {
    des_MixtureDesign* design = des_CreateMixtureDesignContainer();
    des_DeleteMixtureDesignContainer(&design);
    des_DeleteMixtureDesignContainer(&design);
    EXPECT_EQ(design, nullptr);
}

TEST(DeletingARecord, ThroughANullPointerDoesNothing) {
    des_DeleteMixtureDesignContainer(nullptr);
}

TEST(DeletingARecord, LeavesTheCallersArrays) {
    MixtureRecord record(centroidRequest(3));
    ASSERT_EQ(record.run(), des_Success);
    des_DeleteMixtureDesignContainer(record.address());
    EXPECT_EQ(record.upperBounds, std::vector<double>({1, 1, 1}));
    EXPECT_EQ(record.pointsPerType, std::vector<std::uint32_t>({3, 3, 0}));
}

TEST(FailedRecord, CanBeRunAgainOnceItsBoundsAreSetAgain) {
    MixtureRequest request = centroidRequest(3);
    request.amounts = {50};
    request.lowerBounds = {50, 0, 0};
    request.upperBounds = {50, 50, 50};
    MixtureRecord record(request);
    ASSERT_EQ(record.run(), des_ErrorLowerBoundSum);
    record.lowerBounds = {10, 0, 0};
    record.upperBounds = {50, 50, 50};
    record->lowerBounds = record.lowerBounds.data();
    record->upperBounds = record.upperBounds.data();
    EXPECT_EQ(record.run(), des_Success);
    EXPECT_EQ(record->numRuns, 7U);
}

}  // namespace
}  // namespace reisti::test
