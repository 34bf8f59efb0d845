#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <limits>
#include <string>
#include <vector>

#include "mixture/simplex_lattice_design.h"
#include "reisti/reisti.h"
#include "support/plain_bounds.h"
#include "support/plain_points.h"
#include "unit/mixture/expect_plain.h"

namespace reisti::test {
namespace {

using testing::ElementsAre;

TEST(Lattice, OfDegreeTwoComesInDecreasingOrder) {
    EXPECT_THAT(mixturesOf(builtDesign(latticeRequest(3, 2))),
                ElementsAre(ElementsAre(1, 0, 0), ElementsAre(0.5, 0.5, 0), ElementsAre(0.5, 0, 0.5),
                            ElementsAre(0, 1, 0), ElementsAre(0, 0.5, 0.5), ElementsAre(0, 0, 1)));
}

TEST(Lattice, PointTypeIsTheNumberOfComponents) {
    const auto design = builtDesign(latticeRequest(3, 2));
    EXPECT_THAT(typesOf(design), ElementsAre(1, 2, 2, 1, 2, 1));
    EXPECT_THAT(design.pointsPerType, ElementsAre(3, 3, 0));
    EXPECT_EQ(design.numCenterPoints, 0U);
}

TEST(Lattice, CentreIsAddedBehind) {
    const auto design = builtDesign(latticeRequest(3, 2, 1));
    ASSERT_EQ(design.runs.size(), 7U);
    EXPECT_EQ(design.runs[6].pointType, 0);
    EXPECT_EQ(design.runs[6].runOrder, 7U);
    EXPECT_THAT(design.runs[6].proportions, ElementsAre(1.0 / 3, 1.0 / 3, 1.0 / 3));
    EXPECT_EQ(design.numCenterPoints, 1U);
}

TEST(Lattice, OfDegreeThreeHoldsTheCentroid) {
    const auto design = builtDesign(latticeRequest(3, 3));
    EXPECT_THAT(typesOf(design), ElementsAre(1, 2, 2, 2, 0, 2, 1, 2, 2, 1));
    EXPECT_THAT(design.pointsPerType, ElementsAre(3, 6, 0));
    EXPECT_EQ(design.numCenterPoints, 1U);
}

TEST(Lattice, ThatHoldsTheCentroidGetsNoSecondOne) {
    EXPECT_TRUE(sameOutcome(builtDesign(latticeRequest(3, 3, 1)), builtDesign(latticeRequest(3, 3, 0))));
    EXPECT_TRUE(sameOutcome(builtDesign(latticeRequest(3, 6, 1)), builtDesign(latticeRequest(3, 6, 0))));
}

TEST(Lattice, BlendsOfAllComponentsOffTheCentreHaveTheLastType) {
    const auto design = builtDesign(latticeRequest(3, 4));
    EXPECT_THAT(design.pointsPerType, ElementsAre(3, 9, 3));
    EXPECT_EQ(design.numCenterPoints, 0U);
}

TEST(Lattice, AxialPointsStandBehindTheCentre) {
    MixtureRequest request = latticeRequest(3, 2, 1);
    request.axialPoints = 1;
    EXPECT_THAT(typesOf(builtDesign(request)), ElementsAre(1, 2, 2, 1, 2, 1, 0, -1, -1, -1));
}

TEST(Lattice, OfDegreeOneHoldsTheVerticesOnly) {
    EXPECT_THAT(mixturesOf(builtDesign(latticeRequest(3, 1))),
                ElementsAre(ElementsAre(1, 0, 0), ElementsAre(0, 1, 0), ElementsAre(0, 0, 1)));
}

TEST(Lattice, OfTwoComponentsDividesTheLine) {
    EXPECT_THAT(mixturesOf(builtDesign(latticeRequest(2, 4))),
                ElementsAre(ElementsAre(1, 0), ElementsAre(0.75, 0.25), ElementsAre(0.5, 0.5), ElementsAre(0.25, 0.75),
                            ElementsAre(0, 1)));
}

class LatticeDegree : public testing::TestWithParam<std::uint32_t> {};

TEST_P(LatticeDegree, UpToTheLimitGivesThePlainDesign) {
    const std::uint32_t q = GetParam();
    for (std::int32_t degree = 1; degree <= plainDegreeLimit(q); ++degree) {
        for (const std::uint8_t centre : {std::uint8_t{0}, std::uint8_t{1}}) {
            SCOPED_TRACE(testing::Message() << "degree " << degree << (centre != 0 ? " with centre" : ""));
            expectPlain(latticeRequest(q, degree, centre));
        }
    }
}

TEST_P(LatticeDegree, AtTheLimitGivesAllCompositions) {
    const std::uint32_t q = GetParam();
    const std::int32_t limit = plainDegreeLimit(q);
    EXPECT_EQ(builtDesign(latticeRequest(q, limit)).runs.size(),
              plainBinomial(q + static_cast<std::uint32_t>(limit) - 1, static_cast<std::uint32_t>(limit)));
}

INSTANTIATE_TEST_SUITE_P(Components, LatticeDegree, testing::Range(2U, 18U), testing::PrintToStringParamName());

struct RefusedDegreeCase {
    std::string name;
    std::uint32_t q;
    std::int32_t degree;
};

std::vector<RefusedDegreeCase> refusedDegrees() {
    std::vector<RefusedDegreeCase> cases;
    for (std::uint32_t q = 0; q <= 20; ++q)
        cases.push_back({"AboveTheLimitFor" + std::to_string(q), q, plainDegreeLimit(q) + 1});
    for (const std::uint32_t q : {0U, 1U, 3U, 6U, 20U, 21U, 30U}) {
        cases.push_back({"ZeroFor" + std::to_string(q), q, 0});
        cases.push_back({"NegativeFor" + std::to_string(q), q, -1});
        cases.push_back({"SmallestFor" + std::to_string(q), q, std::numeric_limits<std::int32_t>::min()});
    }
    for (const std::uint32_t q : {3U, 20U})
        cases.push_back({"LargestFor" + std::to_string(q), q, std::numeric_limits<std::int32_t>::max()});
    cases.push_back({"EightForSix", 6, 8});
    cases.push_back({"ThreeForEighteen", 18, 3});
    return cases;
}

class RefusedDegree : public testing::TestWithParam<RefusedDegreeCase> {};

TEST_P(RefusedDegree, ChangesNothing) {
    MixtureRequest request = latticeRequest(GetParam().q, GetParam().degree);
    request.amounts = {5};
    MixtureRecord record(request);
    record->boundsAdjusted = 1;
    const auto before = record.bytes();
    EXPECT_EQ(record.run(), des_ErrorDegree);
    EXPECT_EQ(record.bytes(), before);
}

TEST_P(RefusedDegree, IsRefusedByTheEngineToo) {
    MixtureRecord record(latticeRequest(GetParam().q, GetParam().degree));
    const auto before = record.bytes();
    int error = 0;
    SimplexLatticeDesign(record.get(), GetParam().degree, false).Calculate(error);
    EXPECT_EQ(error, des_ErrorDegree);
    EXPECT_EQ(record.bytes(), before);
}

TEST_P(RefusedDegree, IsRefusedBeforeEverythingElse) {
    MixtureRequest request = latticeRequest(GetParam().q, GetParam().degree);
    request.amounts = {1, 2};
    request.numProcessVariables = 1;
    request.processFraction = 2;
    EXPECT_EQ(builtDesign(request).code, des_ErrorDegree);
}

INSTANTIATE_TEST_SUITE_P(All, RefusedDegree, testing::ValuesIn(refusedDegrees()),
                         [](const auto& instance) { return instance.param.name; });

TEST(Lattice, AtTheLimitOfUnboundedComponentsFailsInTheBoundsOnly) {
    EXPECT_EQ(builtDesign(latticeRequest(0, 10)).code, des_ErrorUpperBoundSum);
    EXPECT_EQ(builtDesign(latticeRequest(1, 10)).code, des_ErrorUpperBoundSum);
}

class LargeLattice : public testing::TestWithParam<std::pair<std::uint32_t, std::int32_t>> {};

// The boundary counts of so many components are not enumerated here: the region is a simplex.
TEST_P(LargeLattice, HoldsAllCompositionsInOrder) {
    const auto [q, degree] = GetParam();
    const auto design = builtDesign(latticeRequest(q, degree));
    ASSERT_EQ(design.code, des_Success);
    const auto plain = plainLatticePoints(q, degree);
    ASSERT_EQ(design.runs.size(), plain.size());
    for (std::size_t i = 0; i < plain.size(); ++i) {
        ASSERT_EQ(design.runs[i].pointType, plain[i].pointType) << i;
        ASSERT_TRUE(sameBits(design.runs[i].proportions, plain[i].proportions)) << i;
    }
    for (std::uint32_t d = 0; d < q; ++d)
        EXPECT_EQ(design.boundaryCounts[d], plainBinomial(q, d + 1)) << d;
}

INSTANTIATE_TEST_SUITE_P(All, LargeLattice,
                         testing::Values(std::pair{18U, 2}, std::pair{20U, 2}, std::pair{21U, 3}, std::pair{21U, 4},
                                         std::pair{25U, 2}, std::pair{40U, 1}, std::pair{40U, 2}, std::pair{64U, 1},
                                         std::pair{200U, 1}),
                         [](const auto& instance) {
                             return std::to_string(instance.param.first) + "OfDegree" +
                                    std::to_string(instance.param.second);
                         });

TEST(Lattice, WithMorePointsThanCanBeCountedIsOutOfMemory) {
    // 21 and more components take any degree: C(120, 100) and larger, and a degree at which q + m - 1 passes 2^31.
    for (const std::int32_t degree : {100, 1000, 1000000, std::numeric_limits<std::int32_t>::max()})
        EXPECT_EQ(builtDesign(latticeRequest(21, degree)).code, des_ErrorOutOfMemory) << degree;
}

}  // namespace
}  // namespace reisti::test
