// Whole runs through the C interface against the plain formulation: every field, every run, every bit.
#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <string>

#include "support/plain_vertices_design.h"
#include "support/random_regions.h"
#include "support/scale.h"
#include "support/vertices_record.h"

namespace reisti::test {
namespace {

/// Mostly 1, now and then 0 or more.
std::uint32_t someReplicates(RegionMaker& maker) {
    return maker.oneIn(3) ? static_cast<std::uint32_t>(maker.below(4)) : 1;
}

void chooseAmountsOrProcess(RegionMaker& maker, VerticesRequest& request) {
    const double totals[] = {1.0, 100.0, 0.3, 7.5, 1e-3};
    switch (maker.below(4)) {
        case 0:
            break;
        case 1:
            request.amounts = {totals[maker.below(5)]};
            break;
        case 2:
            request.amounts = {totals[maker.below(5)], totals[maker.below(5)], 3.0};
            break;
        default:
            request.numProcessVariables = static_cast<std::uint32_t>(1 + maker.below(5));
            if (maker.oneIn(2)) request.processFraction = static_cast<std::uint32_t>(1U << maker.below(3));
            request.fractionIndex = static_cast<std::uint32_t>(1 + maker.below(request.processFraction));
            if (maker.oneIn(3)) request.amounts = {totals[maker.below(5)]};
    }
    const double total = request.amounts.empty() ? 1.0 : request.amounts[0];
    for (double& bound : request.lowerBounds)
        bound *= total;
    for (double& bound : request.upperBounds)
        bound *= total;
}

VerticesRequest randomRequest(RegionMaker& maker, std::size_t q) {
    VerticesRequest request;
    maker.bounds(q, request.lowerBounds, request.upperBounds);
    const auto inProportions = request;
    chooseAmountsOrProcess(maker, request);
    const double total = request.amounts.empty() ? 1.0 : request.amounts[0];
    for (std::uint64_t left = maker.below(5); left > 0; --left)
        request.constraints.push_back(
            maker.constraint(inProportions.lowerBounds, inProportions.upperBounds, total, request.constraints));
    request.degree = static_cast<std::int32_t>(maker.below(q + 1));
    request.centerPoint = maker.oneIn(2) ? static_cast<std::uint8_t>(1 + maker.below(255)) : std::uint8_t{0};
    request.axialPoints = maker.oneIn(2) ? std::uint8_t{1} : std::uint8_t{0};
    request.outputUnits = static_cast<std::uint32_t>(maker.below(4));
    request.vertexReplicates = someReplicates(maker);
    request.centerReplicates = someReplicates(maker);
    request.axialReplicates = someReplicates(maker);
    request.designReplicates = someReplicates(maker);
    if (maker.oneIn(2)) {
        request.typeReplicates.emplace();
        for (std::size_t t = 2; t < q; ++t)
            request.typeReplicates->push_back(someReplicates(maker));
    }
    request.randomize = maker.oneIn(3) ? std::uint8_t{1} : std::uint8_t{0};
    request.seed = 1.0 + static_cast<double>(maker.below(1000));
    return request;
}

std::string describe(const VerticesRequest& request) {
    return describe(request.lowerBounds, request.upperBounds, request.constraints,
                    request.amounts.empty() ? 1.0 : request.amounts[0]) +
           "\n degree " + std::to_string(request.degree) + ", center " + std::to_string(request.centerPoint) +
           ", axial " + std::to_string(request.axialPoints) + ", units " + std::to_string(request.outputUnits) +
           ", amounts " + std::to_string(request.amounts.size()) + ", process " +
           std::to_string(request.numProcessVariables) + ", fraction " + std::to_string(request.processFraction) +
           ", maxPoints " + std::to_string(request.maxPoints);
}

// Also with the limit that just fits and the one that just does not.
void expectPlain(VerticesRequest request, const VerticesOutcome& expected) {
    ASSERT_TRUE(sameOutcome(builtVertices(request), expected)) << describe(request);
    if (expected.design.code != des_Success) return;
    std::uint32_t centroids =
        request.degree == static_cast<std::int32_t>(request.numComponents()) ? expected.design.numCenterPoints : 0;
    for (std::size_t t = 1; t < expected.design.pointsPerType.size(); ++t)
        centroids += expected.design.pointsPerType[t];
    if (centroids == 0) return;
    request.maxPoints = static_cast<std::int32_t>(expected.design.pointsPerType[0] + centroids);
    ASSERT_TRUE(sameOutcome(builtVertices(request), expected)) << describe(request);
    --request.maxPoints;
    ASSERT_TRUE(sameOutcome(builtVertices(request), plainVerticesDesign(request))) << describe(request);
}

struct Series {
    const char* name;
    std::size_t q;
    int requests;
};

void PrintTo(const Series& series, std::ostream* out) {
    *out << series.name;
}

class PlainDesign : public testing::TestWithParam<Series> {};

TEST_P(PlainDesign, IsMetToTheLastBit) {
    const Series& series = GetParam();
    RegionMaker maker(500 + series.q);
    const int requests = scaled(series.requests);
    int compared = 0;
    int built = 0;
    for (int i = 0; i < requests && !HasFailure(); ++i) {
        const VerticesRequest request = randomRequest(maker, series.q);
        try {
            const VerticesOutcome expected = plainVerticesDesign(request, 300);
            expectPlain(request, expected);
            ++compared;
            if (expected.design.code == des_Success) ++built;
        } catch (const OutOfPatience&) {
            // The library would need as long.
        }
    }
    EXPECT_GE(compared, requests * 95 / 100);
    EXPECT_GE(built, requests / 2);
}

INSTANTIATE_TEST_SUITE_P(Sizes, PlainDesign,
                         testing::Values(Series{"TwoComponents", 2, 1000}, Series{"ThreeComponents", 3, 5000},
                                         Series{"FourComponents", 4, 3000}, Series{"FiveComponents", 5, 1000},
                                         Series{"SixComponents", 6, 250}, Series{"SevenComponents", 7, 30}),
                         [](const auto& instance) { return instance.param.name; });

}  // namespace
}  // namespace reisti::test
