#include <functional>
#include <gtest/gtest.h>
#include <string>

#include "reisti/reisti.h"
#include "support/mixture_record.h"

namespace reisti::test {
namespace {

TEST(MissingRecord, IsANullPointerError) {
    EXPECT_EQ(des_RunSimplexCentroidDesign(nullptr), des_ErrorNullPointer);
    EXPECT_EQ(des_RunSimplexLatticeDesign(nullptr, 2, 0), des_ErrorNullPointer);
}

struct MissingArrayCase {
    std::string name;
    std::function<void(des_MixtureDesign&)> remove;
};

/// A request that would fail in several other ways too, so that the order of the tests shows.
MixtureRequest hopelessRequest(bool lattice) {
    MixtureRequest request = lattice ? latticeRequest(3, 2) : centroidRequest(3);
    request.amounts = {10, 20};
    request.numProcessVariables = 3;
    request.processFraction = 4;
    request.lowerBounds = {5, 5, 5};
    return request;
}

MixtureRequest plainRequest(bool lattice) {
    MixtureRequest request = lattice ? latticeRequest(3, 2) : centroidRequest(3);
    request.amounts = {10};
    request.upperBounds = {10, 10, 10};
    return request;
}

class MissingArray : public testing::TestWithParam<MissingArrayCase> {
  protected:
    void expectNothingChanged(const MixtureRequest& request) {
        MixtureRecord record(request);
        GetParam().remove(*record.get());
        record->numRuns = 77;
        record->boundsAdjusted = 1;
        const auto before = record.bytes();
        EXPECT_EQ(record.run(), des_ErrorNullPointer);
        EXPECT_EQ(record.bytes(), before);
        record->numRuns = 0;
    }
};

TEST_P(MissingArray, OfACentroidIsFoundBeforeAnythingIsChanged) {
    expectNothingChanged(plainRequest(false));
}

TEST_P(MissingArray, OfALatticeIsFoundBeforeAnythingIsChanged) {
    expectNothingChanged(plainRequest(true));
}

TEST_P(MissingArray, OfACentroidIsFoundBeforeOtherErrors) {
    expectNothingChanged(hopelessRequest(false));
}

TEST_P(MissingArray, OfALatticeIsFoundBeforeOtherErrors) {
    expectNothingChanged(hopelessRequest(true));
}

INSTANTIATE_TEST_SUITE_P(
    All, MissingArray,
    testing::Values(
        MissingArrayCase{"LowerBounds", [](des_MixtureDesign& design) { design.lowerBounds = nullptr; }},
        MissingArrayCase{"UpperBounds", [](des_MixtureDesign& design) { design.upperBounds = nullptr; }},
        MissingArrayCase{"ScaledLowerBounds", [](des_MixtureDesign& design) { design.scaledLowerBounds = nullptr; }},
        MissingArrayCase{"ScaledUpperBounds", [](des_MixtureDesign& design) { design.scaledUpperBounds = nullptr; }},
        MissingArrayCase{"PseudoLowerBounds", [](des_MixtureDesign& design) { design.pseudoLowerBounds = nullptr; }},
        MissingArrayCase{"PseudoUpperBounds", [](des_MixtureDesign& design) { design.pseudoUpperBounds = nullptr; }},
        MissingArrayCase{"PointsPerType", [](des_MixtureDesign& design) { design.pointsPerType = nullptr; }},
        MissingArrayCase{"BoundaryCounts", [](des_MixtureDesign& design) { design.boundaryCounts = nullptr; }},
        MissingArrayCase{"Amounts", [](des_MixtureDesign& design) { design.amounts = nullptr; }}),
    [](const auto& instance) { return instance.param.name; });

TEST(OptionalArray, OfAmountsIsNotNeededWithoutAmounts) {
    MixtureRecord record(centroidRequest(3));
    record->amounts = nullptr;
    EXPECT_EQ(record.run(), des_Success);
}

TEST(OptionalArray, OfAmountsIsNotReadWithoutAmounts) {
    MixtureRequest request = centroidRequest(3);
    request.amounts = {1000};
    MixtureRecord record(request);
    record->numAmounts = 0;
    EXPECT_EQ(record.run(), des_Success);
    EXPECT_EQ(record->runs[0].amount, 1.0);
}

TEST(OptionalArray, OfTypeReplicatesMayBeNull) {
    MixtureRecord record(centroidRequest(5));
    record->typeReplicates = nullptr;
    EXPECT_EQ(record.run(), des_Success);
    EXPECT_EQ(record->numRuns, 31U);
}

TEST(OptionalArray, OfTypeReplicatesIsNotChanged) {
    MixtureRequest request = centroidRequest(4);
    request.typeReplicates = {2, 3};
    MixtureRecord record(request);
    ASSERT_EQ(record.run(), des_Success);
    EXPECT_EQ(record.typeReplicates, std::vector<std::uint32_t>({2, 3}));
}

}  // namespace
}  // namespace reisti::test
