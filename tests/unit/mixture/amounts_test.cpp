#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <vector>

#include "reisti/reisti.h"
#include "unit/mixture/expect_plain.h"

namespace reisti::test {
namespace {

using testing::DoubleNear;
using testing::Each;
using testing::ElementsAre;
using testing::ElementsAreArray;

MixtureRequest withTotals(std::vector<double> amounts, std::uint32_t outputUnits) {
    MixtureRequest request = centroidRequest(3);
    for (double& bound : request.upperBounds)
        bound *= amounts.at(0);
    request.amounts = std::move(amounts);
    request.outputUnits = outputUnits;
    return request;
}

/// Lower bounds of a tenth and two tenths of the first total.
MixtureRequest boundedWithTotals(std::vector<double> amounts, std::uint32_t outputUnits) {
    MixtureRequest request = withTotals(std::move(amounts), outputUnits);
    request.lowerBounds = {0.1 * request.amounts[0], 0.2 * request.amounts[0], 0};
    return request;
}

TEST(OneAmount, IsTheAmountOfEveryRun) {
    EXPECT_THAT(amountsOf(builtDesign(withTotals({40}, des_UnitsAmount))), Each(40.0));
}

TEST(OneAmount, DoesNotAddRuns) {
    EXPECT_EQ(builtDesign(withTotals({40}, des_UnitsAmount)).runs.size(), 7U);
}

TEST(OneAmount, MultipliesTheProportions) {
    const auto mixtures = mixturesOf(builtDesign(withTotals({40}, des_UnitsAmount)));
    EXPECT_THAT(mixtures[0], ElementsAre(40, 0, 0));
    EXPECT_THAT(mixtures[3], ElementsAre(20, 20, 0));
}

TEST(OneAmount, IsKeptWithProcessVariables) {
    MixtureRequest request = withTotals({40}, des_UnitsAmount);
    request.numProcessVariables = 2;
    const auto design = builtDesign(request);
    EXPECT_EQ(design.code, des_Success);
    EXPECT_THAT(amountsOf(design), testing::AllOf(testing::SizeIs(28), Each(40.0)));
}

TEST(SeveralAmounts, RepeatTheDesignForEach) {
    const auto design = builtDesign(withTotals({10, 20, 40}, des_UnitsAmount));
    ASSERT_EQ(design.runs.size(), 21U);
    EXPECT_THAT(ordersOf(design), ElementsAreArray(standardOrder(21)));
    for (std::size_t i = 0; i < 21; ++i) {
        EXPECT_EQ(design.runs[i].amount, std::vector<double>({10, 20, 40})[i / 7]);
        EXPECT_EQ(design.runs[i].pointType, design.runs[i % 7].pointType);
    }
}

TEST(SeveralAmounts, EachMultiplyTheirOwnRuns) {
    const auto mixtures = mixturesOf(builtDesign(withTotals({10, 20}, des_UnitsAmount)));
    EXPECT_THAT(mixtures[0], ElementsAre(10, 0, 0));
    EXPECT_THAT(mixtures[7], ElementsAre(20, 0, 0));
    EXPECT_THAT(mixtures[10], ElementsAre(10, 10, 0));
}

TEST(SeveralAmounts, ComeAfterTheDesignReplicates) {
    MixtureRequest request = withTotals({10, 20}, des_UnitsAmount);
    request.designReplicates = 2;
    const auto amounts = amountsOf(builtDesign(request));
    ASSERT_EQ(amounts.size(), 28U);
    EXPECT_EQ(amounts[13], 10.0);
    EXPECT_EQ(amounts[14], 20.0);
}

TEST(SeveralAmounts, ScaleTheBoundsByTheFirst) {
    const auto design = builtDesign(boundedWithTotals({50, 200}, des_UnitsProportion));
    EXPECT_THAT(design.scaledLowerBounds, ElementsAre(DoubleNear(0.1, 1e-15), DoubleNear(0.2, 1e-15), 0));
    EXPECT_THAT(design.lowerBounds, ElementsAre(DoubleNear(5, 1e-14), DoubleNear(10, 1e-14), 0));
}

TEST(SeveralAmounts, MayContainZero) {
    const auto design = builtDesign(withTotals({10, 0}, des_UnitsAmount));
    EXPECT_EQ(design.code, des_Success);
    EXPECT_THAT(design.runs[7].proportions, Each(0.0));
}

TEST(SeveralAmounts, BehindTheFirstAreTakenAsTheyAre) {
    expectPlain(boundedWithTotals({10, -5}, des_UnitsAmount));
    expectPlain(boundedWithTotals({10, 1e300}, des_UnitsAmount));
}

TEST(SeveralAmounts, WithProcessVariablesAreRefused) {
    MixtureRequest request = withTotals({10, 20}, des_UnitsAmount);
    request.numProcessVariables = 1;
    EXPECT_EQ(builtDesign(request).code, des_ErrorAmountsAndProcess);
}

TEST(SeveralAmounts, WithProcessVariablesChangeNothing) {
    MixtureRequest request = boundedWithTotals({10, 20}, des_UnitsAmount);
    request.numProcessVariables = 1;
    MixtureRecord record(request);
    record->boundsAdjusted = 1;
    const auto before = record.bytes();
    record.run();
    EXPECT_EQ(record.bytes(), before);
}

TEST(SeveralAmounts, WithProcessVariablesAreRefusedBeforeTheFraction) {
    MixtureRequest request = withTotals({10, 20}, des_UnitsAmount);
    request.numProcessVariables = 1;
    request.processFraction = 2;
    EXPECT_EQ(builtDesign(request).code, des_ErrorAmountsAndProcess);
}

TEST(SeveralAmounts, WithProcessVariablesAreRefusedBeforeTheBounds) {
    MixtureRequest request = withTotals({10, 20}, des_UnitsAmount);
    request.numProcessVariables = 1;
    request.lowerBounds = {10, 10, 10};
    EXPECT_EQ(builtDesign(request).code, des_ErrorAmountsAndProcess);
}

TEST(OutputUnits, OfProportionLeaveTheTotalOut) {
    const auto mixtures = mixturesOf(builtDesign(boundedWithTotals({50}, des_UnitsProportion)));
    EXPECT_THAT(mixtures[0], ElementsAre(DoubleNear(0.8, 1e-15), DoubleNear(0.2, 1e-15), 0));
}

TEST(OutputUnits, OfAmountMultiplyByTheTotal) {
    const auto mixtures = mixturesOf(builtDesign(boundedWithTotals({50}, des_UnitsAmount)));
    EXPECT_THAT(mixtures[0], ElementsAre(DoubleNear(40, 1e-13), DoubleNear(10, 1e-13), 0));
}

TEST(OutputUnits, OfPseudoComponentsAreTheUnboundedDesign) {
    EXPECT_EQ(mixturesOf(builtDesign(boundedWithTotals({50}, des_UnitsPseudo))),
              mixturesOf(builtDesign(centroidRequest(3))));
}

TEST(OutputUnits, OfPseudoComponentsRestoreTheBoundsAllTheSame) {
    const auto design = builtDesign(boundedWithTotals({50}, des_UnitsPseudo));
    EXPECT_THAT(design.lowerBounds, ElementsAre(DoubleNear(5, 1e-14), DoubleNear(10, 1e-14), 0));
}

TEST(OutputUnits, WithoutAmountsOfAmountAreProportions) {
    MixtureRequest request = centroidRequest(3);
    request.lowerBounds = {0.1, 0.2, 0};
    request.outputUnits = des_UnitsAmount;
    const auto amounts = mixturesOf(builtDesign(request));
    request.outputUnits = des_UnitsProportion;
    EXPECT_EQ(amounts, mixturesOf(builtDesign(request)));
}

TEST(OutputUnits, OfAnUnknownKindAreAmounts) {
    const auto amounts = mixturesOf(builtDesign(boundedWithTotals({50}, des_UnitsAmount)));
    EXPECT_EQ(mixturesOf(builtDesign(boundedWithTotals({50}, 3))), amounts);
    EXPECT_EQ(mixturesOf(builtDesign(boundedWithTotals({50}, 0xFFFFFFFF))), amounts);
}

TEST(OutputUnits, DoNotChangeWhatIsReportedOfTheBounds) {
    const auto amount = builtDesign(boundedWithTotals({50, 70}, des_UnitsAmount));
    for (const std::uint32_t units : {1U, 2U}) {
        const auto other = builtDesign(boundedWithTotals({50, 70}, units));
        EXPECT_TRUE(sameBits(other.lowerBounds, amount.lowerBounds));
        EXPECT_TRUE(sameBits(other.upperBounds, amount.upperBounds));
        EXPECT_TRUE(sameBits(other.scaledUpperBounds, amount.scaledUpperBounds));
        EXPECT_TRUE(sameBits(other.pseudoUpperBounds, amount.pseudoUpperBounds));
    }
}

TEST(AmountsAndUnits, InEveryCombinationAreThePlainDesign) {
    const std::vector<std::vector<double>> totals = {{0.1}, {3}, {1e6}, {3, 7}, {7, 3, 0.1}, {1e-3, 1e3}};
    for (const auto& amounts : totals) {
        for (std::uint32_t units = 0; units < 4; ++units) {
            SCOPED_TRACE(testing::PrintToString(amounts) + " in units " + std::to_string(units));
            MixtureRequest request = boundedWithTotals(amounts, units);
            request.axialPoints = 1;
            expectPlain(request);
            request.lattice = true;
            request.degree = 3;
            expectPlain(request);
        }
    }
}

}  // namespace
}  // namespace reisti::test
