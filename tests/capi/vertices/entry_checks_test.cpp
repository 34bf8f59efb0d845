// What des_RunExtremeVerticesDesign() refuses before it changes anything, and in which order.
#include <cstdint>
#include <cstring>
#include <functional>
#include <gtest/gtest.h>
#include <limits>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "support/vertices_record.h"

namespace reisti::test {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

VerticesRequest constrainedRequest() {
    VerticesRequest request = verticesRequest({0, 0, 0}, {10, 10, 10});
    request.amounts = {10};
    request.degree = 2;
    request.constraints = {atLeast(2.0, {1, 0, 0}), between(1.0, 8.0, {0, 1, 0})};
    return request;
}

/// Fails in every later way as well, so that the order of the tests shows.
VerticesRequest hopelessRequest() {
    VerticesRequest request = constrainedRequest();
    request.amounts = {10, 20};
    request.numProcessVariables = 3;
    request.processFraction = 4;
    request.lowerBounds = {5, 5, 5};
    request.maxPoints = 1;
    return request;
}

/// Record, arrays and constraints, byte by byte.
std::vector<unsigned char> allBytes(const VerticesRecord& record) {
    std::vector<unsigned char> bytes = record.bytes();
    const std::size_t before = bytes.size();
    const std::size_t size = record.constraints.size() * sizeof(des_MixtureDesignLinearConstraint);
    bytes.resize(before + size);
    if (size > 0) std::memcpy(bytes.data() + before, record.constraints.data(), size);
    return bytes;
}

void expectRefusal(const VerticesRequest& request, std::int32_t code,
                   const std::function<void(VerticesRecord&)>& spoil) {
    VerticesRecord record(request);
    des_MixtureRun theirs{};
    record->runs = &theirs;
    record->numRuns = 77;
    record->boundsAdjusted = 1;
    spoil(record);
    const auto before = allBytes(record);
    EXPECT_EQ(record.run(), code);
    EXPECT_EQ(allBytes(record), before);
    record->runs = nullptr;
    record->numRuns = 0;
}

TEST(VerticesEntry, AMissingRecordIsANullPointerError) {
    EXPECT_EQ(des_RunExtremeVerticesDesign(nullptr, -1, 0, 0, nullptr, 0), des_ErrorNullPointer);
}

class RefusedDegree : public testing::TestWithParam<std::int32_t> {};

TEST_P(RefusedDegree, ChangesNothing) {
    expectRefusal(constrainedRequest(), des_ErrorDegree, [](auto& record) { record.degree = GetParam(); });
}

TEST_P(RefusedDegree, IsFoundBeforeAllButAMissingRecord) {
    expectRefusal(hopelessRequest(), des_ErrorDegree, [](auto& record) {
        record.degree = GetParam();
        record->lowerBounds = nullptr;
        record.constraints[0].coefficients = nullptr;
        record.constraints[1].lowerValue = kNaN;
    });
}

INSTANTIATE_TEST_SUITE_P(All, RefusedDegree, testing::Values(-2147483647 - 1, -2147483647, -3, -1, 4, 5, 2147483647),
                         [](const auto& instance) {
                             return (instance.param < 0 ? "Minus" : "") +
                                    std::to_string(std::abs(static_cast<long long>(instance.param)));
                         });

class AcceptedDegree : public testing::TestWithParam<std::int32_t> {};

TEST_P(AcceptedDegree, GivesADesign) {
    VerticesRecord record(constrainedRequest());
    record.degree = GetParam();
    EXPECT_EQ(record.run(), des_Success);
}

INSTANTIATE_TEST_SUITE_P(All, AcceptedDegree, testing::Range(0, 4), testing::PrintToStringParamName());

struct MissingCase {
    std::string name;
    std::function<void(VerticesRecord&)> remove;
};

void PrintTo(const MissingCase& instance, std::ostream* out) {
    *out << instance.name;
}

class MissingPointer : public testing::TestWithParam<MissingCase> {};

TEST_P(MissingPointer, ChangesNothing) {
    expectRefusal(constrainedRequest(), des_ErrorNullPointer, GetParam().remove);
}

TEST_P(MissingPointer, IsFoundBeforeOtherErrors) {
    expectRefusal(hopelessRequest(), des_ErrorNullPointer, [](auto& record) {
        record.constraints[0].lowerValue = kNaN;
        record.constraints[0].status = 5;
        GetParam().remove(record);
    });
}

INSTANTIATE_TEST_SUITE_P(
    All, MissingPointer,
    testing::Values(
        MissingCase{"LowerBounds", [](auto& record) { record->lowerBounds = nullptr; }},
        MissingCase{"UpperBounds", [](auto& record) { record->upperBounds = nullptr; }},
        MissingCase{"ScaledLowerBounds", [](auto& record) { record->scaledLowerBounds = nullptr; }},
        MissingCase{"ScaledUpperBounds", [](auto& record) { record->scaledUpperBounds = nullptr; }},
        MissingCase{"PseudoLowerBounds", [](auto& record) { record->pseudoLowerBounds = nullptr; }},
        MissingCase{"PseudoUpperBounds", [](auto& record) { record->pseudoUpperBounds = nullptr; }},
        MissingCase{"PointsPerType", [](auto& record) { record->pointsPerType = nullptr; }},
        MissingCase{"BoundaryCounts", [](auto& record) { record->boundaryCounts = nullptr; }},
        MissingCase{"Amounts", [](auto& record) { record->amounts = nullptr; }},
        MissingCase{"Constraints", [](auto& record) { record.constraints.clear(); }},
        MissingCase{"FirstCoefficients", [](auto& record) { record.constraints[0].coefficients = nullptr; }},
        MissingCase{"LastCoefficients", [](auto& record) { record.constraints[1].coefficients = nullptr; }}),
    [](const auto& instance) { return instance.param.name; });

TEST(VerticesEntry, NoConstraintsNeedNoPointer) {
    VerticesRecord record(verticesRequest({0, 0, 0}, {1, 1, 1}));
    EXPECT_EQ(des_RunExtremeVerticesDesign(record.get(), 1, 0, 0, nullptr, 0), des_Success);
}

TEST(VerticesEntry, ANegativeNumberOfConstraintsCountsAsNone) {
    for (const std::int32_t count : {-1, -2147483647 - 1}) {
        VerticesRecord record(constrainedRequest());
        record.numConstraints = count;
        ASSERT_EQ(record.run(), des_Success);
        EXPECT_EQ(record->pointsPerType[0], 3U);
        EXPECT_EQ(record.constraints[0].status, STATUS_BEFORE);
    }
    VerticesRecord record(verticesRequest({0, 0, 0}, {1, 1, 1}));
    EXPECT_EQ(des_RunExtremeVerticesDesign(record.get(), 1, 0, -1, nullptr, 0), des_Success);
}

TEST(VerticesEntry, ConstraintsBehindTheCountAreNotRead) {
    VerticesRecord record(constrainedRequest());
    record.numConstraints = 1;
    record.constraints[1].coefficients = nullptr;
    record.constraints[1].lowerValue = kNaN;
    EXPECT_EQ(record.run(), des_Success);
    EXPECT_EQ(record.constraints[1].status, STATUS_BEFORE);
}

TEST(VerticesEntry, MissingReplicatesByTypeMeanOneEach) {
    VerticesRecord record(constrainedRequest());
    record->typeReplicates = nullptr;
    EXPECT_EQ(record.run(), des_Success);
}

struct NotANumberCase {
    std::string name;
    std::function<void(PlainConstraint&)> spoil;
};

void PrintTo(const NotANumberCase& instance, std::ostream* out) {
    *out << instance.name;
}

class NotANumber : public testing::TestWithParam<NotANumberCase> {};

TEST_P(NotANumber, InAnyConstraintChangesNothing) {
    for (std::size_t which = 0; which < 2; ++which) {
        VerticesRequest request = constrainedRequest();
        GetParam().spoil(request.constraints[which]);
        expectRefusal(request, des_ErrorNotANumber, [](auto&) {});
    }
}

TEST_P(NotANumber, IsFoundBeforeTheErrorsOfTheRequest) {
    VerticesRequest request = hopelessRequest();
    GetParam().spoil(request.constraints[1]);
    expectRefusal(request, des_ErrorNotANumber, [](auto&) {});
}

INSTANTIATE_TEST_SUITE_P(
    All, NotANumber,
    testing::Values(NotANumberCase{"LowerSide", [](auto& c) { c.lower = kNaN; }},
                    NotANumberCase{"UpperSide",
                                   [](auto& c) {
                                       c.hasUpper = true;
                                       c.upper = kNaN;
                                   }},
                    NotANumberCase{"LowerSideThatIsNotUsed",
                                   [](auto& c) {
                                       c.hasLower = false;
                                       c.lower = kNaN;
                                   }},
                    NotANumberCase{"UpperSideThatIsNotUsed",
                                   [](auto& c) {
                                       c.hasUpper = false;
                                       c.upper = -kNaN;
                                   }},
                    NotANumberCase{"FirstCoefficient", [](auto& c) { c.coefficients.front() = kNaN; }},
                    NotANumberCase{"LastCoefficient", [](auto& c) { c.coefficients.back() = -kNaN; }},
                    NotANumberCase{"InfiniteCoefficient", [](auto& c) { c.coefficients.front() = kInfinity; }},
                    NotANumberCase{"MinusInfiniteCoefficient", [](auto& c) { c.coefficients.back() = -kInfinity; }}),
    [](const auto& instance) { return instance.param.name; });

TEST(InfiniteSide, IsNoLimit) {
    for (const double side : {kInfinity, -kInfinity}) {
        VerticesRequest request = verticesRequest({0, 0, 0}, {1, 1, 1});
        request.constraints = {atLeast(side, {1, 0, 0}), atMost(side, {1, 0, 0}), between(side, side, {0, 1, 0}),
                               between(-kInfinity, 0.5, {0, 0, 1})};
        const VerticesOutcome built = builtVertices(request);
        EXPECT_EQ(built.design.code, des_Success);
        EXPECT_EQ(built.statuses, (std::vector<std::int32_t>{1, 2, 3, 1}));
        EXPECT_EQ(built.design.pointsPerType[0], 4U);
    }
}

TEST(VerticesEntry, FlagsAreTrueForAnyNonzeroByte) {
    VerticesRequest request = verticesRequest({0, 0, 0}, {1, 1, 1});
    request.constraints = {between(0.25, 0.5, {1, 0, 0})};
    VerticesRecord plain(request);
    plain.centerPoint = 1;
    plain->axialPoints = 1;
    ASSERT_EQ(plain.run(), des_Success);
    VerticesRecord odd(request);
    odd.centerPoint = 0x80;
    odd->axialPoints = 0xFF;
    odd.constraints[0].hasLowerValue = 2;
    odd.constraints[0].hasUpperValue = 0x40;
    ASSERT_EQ(odd.run(), des_Success);
    EXPECT_EQ(odd->numRuns, plain->numRuns);
    EXPECT_EQ(odd->pointsPerType[0], plain->pointsPerType[0]);
}

}  // namespace
}  // namespace reisti::test
