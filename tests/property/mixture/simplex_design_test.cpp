#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>
#include <map>
#include <numeric>
#include <vector>

#include "reisti/reisti.h"
#include "support/mixture_record.h"
#include "support/plain_mixture.h"
#include "support/random_mixture.h"
#include "support/scale.h"

namespace reisti::test {
namespace {

/// Proportions are sums and products of a handful of numbers up to the total: a few units in the last place of it.
constexpr double kRelativeToTotal = 1e-12;

double totalOf(const MixtureRequest& request, const MixtureRunValue& run) {
    return request.outputUnits == des_UnitsProportion || request.outputUnits == des_UnitsPseudo ? 1.0 : run.amount;
}

/// Calls check(request, outcome) for random requests that have to succeed.
template <typename Check>
void forRandomDesigns(std::uint64_t seed, int count, Check check) {
    Random random(seed);
    for (int i = 0; i < scaled(count); ++i) {
        SCOPED_TRACE(testing::Message() << "case " << i << " of seed " << seed);
        const MixtureRequest request = randomDesignRequest(random);
        const MixtureOutcome design = builtDesign(request);
        ASSERT_EQ(design.code, des_Success);
        check(request, design);
        if (testing::Test::HasFailure()) return;
    }
}

TEST(RandomDesigns, AreThePlainDesignsBitForBit) {
    forRandomDesigns(1, 3000, [](const auto& request, const auto& design) {
        EXPECT_TRUE(sameOutcome(design, plainDesign(request)));
    });
}

TEST(RandomDesigns, ProportionsSumToTheTotal) {
    forRandomDesigns(2, 2000, [](const auto& request, const auto& design) {
        for (const auto& run : design.runs) {
            const double total = totalOf(request, run);
            EXPECT_NEAR(std::accumulate(run.proportions.begin(), run.proportions.end(), 0.0), total,
                        kRelativeToTotal * total);
        }
    });
}

TEST(RandomDesigns, RunsLieInsideTheReportedBounds) {
    forRandomDesigns(3, 2000, [](const auto& request, const auto& design) {
        const bool pseudo = request.outputUnits == des_UnitsPseudo;
        const auto& lower = pseudo ? design.pseudoLowerBounds : design.scaledLowerBounds;
        const auto& upper = pseudo ? design.pseudoUpperBounds : design.scaledUpperBounds;
        for (const auto& run : design.runs) {
            const double total = totalOf(request, run);
            for (std::size_t i = 0; i < run.proportions.size(); ++i) {
                EXPECT_GE(run.proportions[i], (lower[i] - kRelativeToTotal) * total);
                EXPECT_LE(run.proportions[i], (upper[i] + kRelativeToTotal) * total);
            }
        }
    });
}

TEST(RandomDesigns, ReportedBoundsLieInsideThoseGiven) {
    forRandomDesigns(4, 2000, [](const auto& request, const auto& design) {
        const double slack = kRelativeToTotal * (request.amounts.empty() ? 1.0 : request.amounts[0]);
        for (std::size_t i = 0; i < request.lowerBounds.size(); ++i) {
            EXPECT_GE(design.lowerBounds[i], request.lowerBounds[i] - slack);
            EXPECT_LE(design.upperBounds[i], request.upperBounds[i] + slack);
        }
    });
}

TEST(RandomDesigns, PseudoComponentsAreFoundAgainFromTheProportions) {
    Random random(5);
    for (int i = 0; i < scaled(1000); ++i) {
        MixtureRequest request = randomDesignRequest(random);
        request.outputUnits = des_UnitsPseudo;
        const auto pseudo = builtDesign(request);
        request.outputUnits = des_UnitsProportion;
        const auto actual = builtDesign(request);
        ASSERT_EQ(pseudo.runs.size(), actual.runs.size());
        const auto& lower = actual.scaledLowerBounds;
        const double room = 1.0 - std::accumulate(lower.begin(), lower.end(), 0.0);
        for (std::size_t run = 0; run < actual.runs.size(); ++run) {
            for (std::size_t j = 0; j < lower.size(); ++j) {
                EXPECT_NEAR((actual.runs[run].proportions[j] - lower[j]) / room, pseudo.runs[run].proportions[j],
                            kRelativeToTotal / room);
            }
        }
    }
}

TEST(RandomDesigns, PointTypeCountsTheNonzeroPseudoProportions) {
    Random random(6);
    for (int i = 0; i < scaled(1000); ++i) {
        MixtureRequest request = randomDesignRequest(random);
        request.outputUnits = des_UnitsPseudo;
        for (const auto& run : builtDesign(request).runs) {
            const auto& z = run.proportions;
            const auto nonzero = std::count_if(z.begin(), z.end(), [](double part) { return part != 0.0; });
            const bool equal = std::all_of(z.begin(), z.end(), [&](double part) { return part == z[0]; });
            const auto largest = *std::max_element(z.begin(), z.end());
            const auto q = static_cast<std::ptrdiff_t>(z.size());
            if (run.pointType == 0) {
                EXPECT_TRUE(equal);
            } else if (run.pointType == -1) {
                EXPECT_EQ(nonzero, q);
                EXPECT_EQ(std::count(z.begin(), z.end(), largest), 1);
            } else {
                EXPECT_EQ(nonzero, run.pointType);
                EXPECT_FALSE(equal);
            }
        }
    }
}

/// Stated count of runs: points of each class times its replicates, times the replicates of the design, the amounts and
/// the process settings.
std::uint64_t statedRuns(const MixtureRequest& request, const MixtureOutcome& design) {
    const std::uint32_t q = request.numComponents();
    std::uint64_t runs = std::uint64_t{design.numCenterPoints} * request.centerReplicates +
                         std::uint64_t{design.numAxialPoints} * request.axialReplicates +
                         std::uint64_t{design.pointsPerType[0]} * request.vertexReplicates;
    for (std::uint32_t type = 2; type <= q; ++type) {
        runs += std::uint64_t{design.pointsPerType[type - 1]} *
                (type < q && request.typeReplicates ? request.typeReplicates->at(type - 2) : 1);
    }
    return runs * request.designReplicates * std::max<std::size_t>(request.amounts.size(), 1) *
           ((std::uint64_t{1} << request.numProcessVariables) / request.processFraction);
}

TEST(RandomDesigns, NumRunsIsTheStatedProduct) {
    forRandomDesigns(7, 2000, [](const auto& request, const auto& design) {
        EXPECT_EQ(design.runs.size(), statedRuns(request, design));
    });
}

TEST(RandomDesigns, EveryRunIsWritten) {
    forRandomDesigns(8, 2000, [](const auto& request, const auto& design) {
        std::vector<bool> seen(design.runs.size() + 1, false);
        for (const auto& run : design.runs) {
            ASSERT_GE(run.runOrder, 1U);
            ASSERT_LE(run.runOrder, design.runs.size());
            EXPECT_FALSE(seen[run.runOrder]);
            seen[run.runOrder] = true;
            EXPECT_GT(*std::max_element(run.proportions.begin(), run.proportions.end()), 0.0);
            ASSERT_EQ(run.processLevels.size(), request.numProcessVariables);
            for (const std::int32_t level : run.processLevels)
                EXPECT_EQ(std::abs(level), 1);
        }
    });
}

TEST(RandomDesigns, EveryMixtureMeetsEveryProcessSettingEquallyOften) {
    forRandomDesigns(9, 500, [](const auto& request, const auto& design) {
        if (request.numProcessVariables == 0) return;
        std::map<std::vector<std::int32_t>, std::map<std::vector<double>, int>> crossed;
        for (const auto& run : design.runs)
            ++crossed[run.processLevels][run.proportions];
        for (const auto& [levels, mixtures] : crossed)
            EXPECT_EQ(mixtures, crossed.begin()->second);
        const std::size_t settings = (std::size_t{1} << request.numProcessVariables) / request.processFraction;
        EXPECT_EQ(crossed.size(), design.runs.empty() ? 0 : settings);
    });
}

TEST(RandomDesigns, AreTheSameWhenBuiltAgain) {
    Random random(10);
    for (int i = 0; i < scaled(500); ++i) {
        const MixtureRequest request = randomDesignRequest(random);
        EXPECT_TRUE(sameOutcome(builtDesign(request), builtDesign(request)));
    }
}

TEST(RandomBounds, OfASimplexAreAccepted) {
    Random random(11);
    for (int i = 0; i < scaled(3000); ++i) {
        const MixtureRequest request = randomSimplexRequest(random);
        ASSERT_EQ(builtDesign(request).code, des_Success);
    }
}

TEST(RandomBounds, OfAnyKindGiveThePlainOutcome) {
    Random random(12);
    std::map<std::int32_t, int> codes;
    for (int i = 0; i < scaled(20000); ++i) {
        const MixtureRequest request = randomBoundsRequest(random);
        const MixtureOutcome design = builtDesign(request);
        ++codes[design.code];
        ASSERT_TRUE(sameOutcome(design, plainDesign(request)));
    }
    // The generator is to reach all six outcomes, also in the shortened runs of sanitizer builds.
    for (const std::int32_t code : {des_Success, des_ErrorLowerBoundSum, des_ErrorUpperBoundSum, des_ErrorUpperBound,
                                    des_ErrorEmptyRange, des_ErrorNotSimplex})
        EXPECT_GT(codes[code], 0) << code;
}

}  // namespace
}  // namespace reisti::test
