// Each error of the construction with the state that it leaves behind.
#include <cmath>
#include <cstdint>
#include <gtest/gtest.h>
#include <limits>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "support/vertices_record.h"

namespace reisti::test {
namespace {

/// A record whose runs are somebody else's, to see that they are left alone.
class WatchedRecord : public VerticesRecord {
  public:
    explicit WatchedRecord(const VerticesRequest& request) : VerticesRecord(request) {
        (*this)->runs = &theirs_;
        (*this)->numRuns = 77;
    }
    ~WatchedRecord() {
        (*this)->runs = nullptr;
        (*this)->numRuns = 0;
    }
    WatchedRecord(const WatchedRecord&) = delete;
    WatchedRecord& operator=(const WatchedRecord&) = delete;

    bool runsAreUntouched() { return (*this)->runs == &theirs_ && (*this)->numRuns == 77; }

    bool outputsAreUntouched() const {
        for (const auto* numbers : {&scaledLowerBounds, &scaledUpperBounds, &pseudoLowerBounds, &pseudoUpperBounds})
            for (const double x : *numbers)
                if (x != POISON_NUMBER) return false;
        for (const auto* counts : {&pointsPerType, &boundaryCounts})
            for (const std::uint32_t x : *counts)
                if (x != POISON_COUNT) return false;
        return true;
    }

  private:
    des_MixtureRun theirs_{};
};

/// Two constraints on the whole simplex of a total of 8: one cuts, one does not.
VerticesRequest requestOfEight() {
    VerticesRequest request = verticesRequest({0, 0, 0}, {8, 8, 8});
    request.amounts = {8};
    request.constraints = {atMost(4, {1, 0, 0}), atMost(16, {1, 0, 0})};
    return request;
}

TEST(VerticesFailure, AmountsWithProcessVariablesChangeNothing) {
    VerticesRequest request = requestOfEight();
    request.amounts = {8, 16};
    request.numProcessVariables = 1;
    WatchedRecord record(request);
    const auto before = record.bytes();
    EXPECT_EQ(record.run(), des_ErrorAmountsAndProcess);
    EXPECT_EQ(record.bytes(), before);
}

TEST(VerticesFailure, AProcessFractionThatDoesNotFitChangesNothing) {
    VerticesRequest request = requestOfEight();
    request.numProcessVariables = 2;
    request.processFraction = 2;
    WatchedRecord record(request);
    const auto before = record.bytes();
    EXPECT_EQ(record.run(), des_ErrorProcessFraction);
    EXPECT_EQ(record.bytes(), before);
}

struct BoundsCase {
    std::string name;
    std::vector<double> lower;
    std::vector<double> upper;
    std::int32_t code;
    std::vector<double> lowerAfter;
    std::vector<double> upperAfter;
    bool adjusted = false;
};

void PrintTo(const BoundsCase& instance, std::ostream* out) {
    *out << instance.name;
}

class RefusedBounds : public testing::TestWithParam<BoundsCase> {};

TEST_P(RefusedBounds, StayDividedAndTightenedAsFarAsChecked) {
    const BoundsCase& bounds = GetParam();
    VerticesRequest request = requestOfEight();
    request.lowerBounds = bounds.lower;
    request.upperBounds = bounds.upper;
    WatchedRecord record(request);
    record->boundsAdjusted = 9;
    EXPECT_EQ(record.run(), bounds.code);
    EXPECT_EQ(record.lowerBounds, bounds.lowerAfter);
    EXPECT_EQ(record.upperBounds, bounds.upperAfter);
    EXPECT_EQ(record->boundsAdjusted, bounds.adjusted ? 1 : 0);
    EXPECT_EQ(record.constraints[0].status, STATUS_BEFORE);
    EXPECT_EQ(record.constraints[1].status, STATUS_BEFORE);
    EXPECT_TRUE(record.runsAreUntouched());
    EXPECT_TRUE(record.outputsAreUntouched());
}

INSTANTIATE_TEST_SUITE_P(
    All, RefusedBounds,
    testing::Values(
        BoundsCase{
            "LowerBoundsSumToTheTotal", {2, 2, 4}, {8, 8, 8}, des_ErrorLowerBoundSum, {0.25, 0.25, 0.5}, {1, 1, 1}},
        BoundsCase{
            "UpperBoundsSumToTheTotal", {0, 0, 0}, {2, 2, 4}, des_ErrorUpperBoundSum, {0, 0, 0}, {0.25, 0.25, 0.5}},
        BoundsCase{"UpperBoundAboveTheTotal", {0, 0, 0}, {8, 16, 8}, des_ErrorUpperBound, {0, 0, 0}, {1, 2, 1}},
        BoundsCase{"NoRange", {0, 2, 0}, {8, 2, 8}, des_ErrorEmptyRange, {0, 0.25, 0}, {0.75, 0.25, 1}, true},
        BoundsCase{"UpperBelowLower", {0, 2, 0}, {8, 1, 8}, des_ErrorEmptyRange, {0, 0.25, 0}, {0.75, 0.125, 1}, true}),
    [](const auto& instance) { return instance.param.name; });

TEST(VerticesFailure, BoundsThatAreNoSimplexAreNoError) {
    VerticesRecord record(verticesRequest({0.1, 0.2, 0.0}, {0.5, 0.4, 0.7}));
    EXPECT_EQ(record.run(), des_Success);
}

struct NonFiniteCase {
    std::string name;
    std::vector<double> lower;
    std::vector<double> upper;
    std::int32_t code;
};

void PrintTo(const NonFiniteCase& instance, std::ostream* out) {
    *out << instance.name;
}

class NonFiniteBounds : public testing::TestWithParam<NonFiniteCase> {};

TEST_P(NonFiniteBounds, AreDecidedByTheChecksOfTheBounds) {
    WatchedRecord record(verticesRequest(GetParam().lower, GetParam().upper));
    EXPECT_EQ(record.run(), GetParam().code);
    EXPECT_TRUE(record.runsAreUntouched());
    EXPECT_TRUE(record.outputsAreUntouched());
}

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

INSTANTIATE_TEST_SUITE_P(
    All, NonFiniteBounds,
    testing::Values(
        NonFiniteCase{"LowerNaN", {0, kNaN, 0}, {1, 1, 1}, des_ErrorLowerBoundSum},
        NonFiniteCase{"LowerInfinite", {kInfinity, 0, 0}, {1, 1, 1}, des_ErrorLowerBoundSum},
        NonFiniteCase{"LowerMinusInfinite", {0, 0, -kInfinity}, {1, 1, 1}, des_ErrorLowerBoundSum},
        NonFiniteCase{"LowerOppositeInfinities", {kInfinity, -kInfinity, 0}, {1, 1, 1}, des_ErrorLowerBoundSum},
        NonFiniteCase{"UpperInfinite", {0, 0, 0}, {1, kInfinity, 1}, des_ErrorUpperBoundSum},
        NonFiniteCase{"UpperMinusInfinite", {0, 0, 0}, {1, -kInfinity, 1}, des_ErrorUpperBoundSum},
        NonFiniteCase{"FirstUpperNaN", {0, 0, 0}, {kNaN, 1, 1}, des_ErrorUpperBound},
        NonFiniteCase{"LastUpperNaN", {0, 0, 0}, {1, 1, kNaN}, des_ErrorUpperBound},
        NonFiniteCase{"UpperOppositeInfinities", {0, 0, 0}, {kInfinity, -kInfinity, 1}, des_ErrorEmptyRange}),
    [](const auto& instance) { return instance.param.name; });

class UselessTotal : public testing::TestWithParam<double> {};

TEST_P(UselessTotal, IsRefusedThroughTheBounds) {
    VerticesRequest request = verticesRequest({0.1, 0.1, 0.1}, {0.8, 0.8, 0.8});
    request.amounts = {GetParam()};
    WatchedRecord record(request);
    EXPECT_NE(record.run(), des_Success);
    EXPECT_TRUE(record.runsAreUntouched());
}

INSTANTIATE_TEST_SUITE_P(All, UselessTotal,
                         testing::Values(0.0, -0.0, kNaN, kInfinity, -kInfinity, -1.0, 1e-310, 1e300));

class TooManyPoints : public testing::Test {
  protected:
    // Four vertices, four edges, one overall centroid.
    static VerticesRequest request(std::int32_t degree, std::int32_t maxPoints) {
        VerticesRequest made = requestOfEight();
        made.degree = degree;
        made.maxPoints = maxPoints;
        return made;
    }
};

TEST_F(TooManyPoints, IsReportedAtTheFirstCentroidThatDoesNotFit) {
    EXPECT_EQ(builtVertices(request(2, 4)).design.code, des_ErrorTooManyPoints);
    EXPECT_EQ(builtVertices(request(2, 7)).design.code, des_ErrorTooManyPoints);
    EXPECT_EQ(builtVertices(request(2, 8)).design.code, des_Success);
    EXPECT_EQ(builtVertices(request(3, 8)).design.code, des_ErrorTooManyPoints);
    EXPECT_EQ(builtVertices(request(3, 9)).design.code, des_Success);
}

TEST_F(TooManyPoints, IsNotReportedForVerticesAlone) {
    EXPECT_EQ(builtVertices(request(1, 1)).design.code, des_Success);
    EXPECT_EQ(builtVertices(request(0, 1)).design.code, des_Success);
}

TEST_F(TooManyPoints, DoesNotCountTheAppendedCentreOrAxialPoints) {
    VerticesRequest extended = request(1, 4);
    extended.centerPoint = 1;
    extended.axialPoints = 1;
    EXPECT_EQ(builtVertices(extended).design.code, des_Success);
}

TEST_F(TooManyPoints, NeverHappensWithoutALimit) {
    for (const std::int32_t none : {0, -1, -2147483647 - 1})
        EXPECT_EQ(builtVertices(request(3, none)).design.code, des_Success);
}

TEST_F(TooManyPoints, LeavesBoundsDividedAndTightenedAndStatusesWritten) {
    WatchedRecord record(request(2, 4));
    ASSERT_EQ(record.run(), des_ErrorTooManyPoints);
    EXPECT_EQ(record.lowerBounds, (std::vector<double>{0, 0, 0}));
    EXPECT_EQ(record.upperBounds, (std::vector<double>{0.5, 1, 1}));
    EXPECT_EQ(record->boundsAdjusted, 1);
    EXPECT_EQ(record.constraints[0].status, STATUS_BEFORE);
    EXPECT_EQ(record.constraints[1].status, 2);
}

TEST_F(TooManyPoints, LeavesRunsAndOutputsUntouched) {
    WatchedRecord record(request(2, 4));
    ASSERT_EQ(record.run(), des_ErrorTooManyPoints);
    EXPECT_TRUE(record.runsAreUntouched());
    EXPECT_TRUE(record.outputsAreUntouched());
}

struct UncountableCase {
    std::string name;
    void (*change)(VerticesRequest&);
};

void PrintTo(const UncountableCase& instance, std::ostream* out) {
    *out << instance.name;
}

class UncountableVertices : public testing::TestWithParam<UncountableCase> {};

TEST_P(UncountableVertices, AreOutOfMemoryAndLeaveRunsUntouched) {
    VerticesRequest request = requestOfEight();
    GetParam().change(request);
    WatchedRecord record(request);
    EXPECT_EQ(record.run(), des_ErrorOutOfMemory);
    EXPECT_TRUE(record.runsAreUntouched());
}

INSTANTIATE_TEST_SUITE_P(
    All, UncountableVertices,
    testing::Values(UncountableCase{"VertexReplicates", [](auto& r) { r.vertexReplicates = 0x40000000; }},
                    UncountableCase{"DesignReplicates", [](auto& r) { r.designReplicates = 0x40000000; }},
                    UncountableCase{"AxialReplicates",
                                    [](auto& r) {
                                        r.axialPoints = 1;
                                        r.axialReplicates = 0x40000000;
                                    }},
                    UncountableCase{"CentreReplicatesBesideVertices",
                                    [](auto& r) {
                                        r.centerPoint = 1;
                                        r.centerReplicates = 0xFFFFFFFF;
                                    }},
                    UncountableCase{"TypeReplicates",
                                    [](auto& r) {
                                        r.degree = 2;
                                        r.typeReplicates = {0x40000000};
                                    }},
                    UncountableCase{"ProcessVariables", [](auto& r) { r.numProcessVariables = 31; }}),
    [](const auto& instance) { return instance.param.name; });

TEST(VerticesFailure, AFractionThatTheCatalogLacksLeavesTheRuns) {
    VerticesRequest request = requestOfEight();
    request.numProcessVariables = 8;
    request.processFraction = 64;
    VerticesRecord record(request);
    EXPECT_EQ(record.run(), des_ErrorProcessFraction);
    ASSERT_NE(record->runs, nullptr);
    EXPECT_EQ(record->numRuns, 16U);
    for (std::uint32_t i = 0; i < record->numRuns; ++i)
        for (std::uint32_t p = 0; p < 8; ++p)
            EXPECT_EQ(record->runs[i].processLevels[p], 0);
    EXPECT_EQ(record.upperBounds, (std::vector<double>{0.5, 1, 1}));
}

}  // namespace
}  // namespace reisti::test
