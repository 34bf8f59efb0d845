// Values that no caller means: the library answers with a code of its table or the design that the arithmetic gives,
// bit for bit as the plain formulation does, and never with a crash.
#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <limits>
#include <string>
#include <vector>

#include "reisti/reisti.h"
#include "support/plain_vertices_design.h"
#include "support/random_regions.h"
#include "support/scale.h"
#include "support/vertices_record.h"

namespace reisti::test {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

double oddValue(RegionMaker& maker) {
    const double values[] = {kNaN,  kInfinity, -kInfinity, 1e308, -1e308, 5e-324, -5e-324, 0.0,  -0.0,
                             1e-12, -1e-12,    1e-6,       -1e-6, 0.5,    1.0,    -1.0,    1e16, -1e16};
    return values[maker.below(18)];
}

VerticesRequest oddRequest(RegionMaker& maker, std::size_t q) {
    VerticesRequest request;
    maker.decimalBounds(q, 1, request.lowerBounds, request.upperBounds);
    if (maker.oneIn(3)) request.lowerBounds[maker.below(q)] = oddValue(maker);
    if (maker.oneIn(3)) request.upperBounds[maker.below(q)] = oddValue(maker);
    if (maker.oneIn(4)) request.amounts = {oddValue(maker)};
    for (std::uint64_t left = maker.below(3); left > 0; --left) {
        PlainConstraint constraint =
            maker.constraint(std::vector<double>(q, 0.1), std::vector<double>(q, 0.8), 1.0, {});
        // What is refused at the door is tested there.
        const auto number = [&](bool finite) {
            double x = oddValue(maker);
            while (x != x || (finite && (x == kInfinity || x == -kInfinity)))
                x = oddValue(maker);
            return x;
        };
        if (maker.oneIn(2)) constraint.coefficients[maker.below(q)] = number(true);
        if (maker.oneIn(2)) constraint.lower = number(false);
        if (maker.oneIn(2)) constraint.upper = number(false);
        request.constraints.push_back(constraint);
    }
    request.degree = static_cast<std::int32_t>(q);
    request.axialPoints = 1;
    request.outputUnits = static_cast<std::uint32_t>(maker.below(3));
    return request;
}

TEST(OddValues, GiveWhatThePlainFormulationGives) {
    RegionMaker maker(77);
    for (int i = 0; i < scaled(20000) && !testing::Test::HasFailure(); ++i) {
        const VerticesRequest request = oddRequest(maker, 2 + maker.below(4));
        try {
            const VerticesOutcome expected = plainVerticesDesign(request, 300);
            ASSERT_TRUE(sameOutcome(builtVertices(request), expected))
                << describe(request.lowerBounds, request.upperBounds, request.constraints,
                            request.amounts.empty() ? 1.0 : request.amounts[0]);
        } catch (const OutOfPatience&) {
            // The library would need as long.
        }
    }
}

TEST(InvertedRanges, BelowZeroPassTheCheckOfRangesAndGiveWhatThePlainFormulationGives) {
    // A range is refused when it is at most 1e-5 of its upper bound, and that is negative here.
    RegionMaker maker(78);
    int built = 0;
    for (int i = 0; i < scaled(500); ++i) {
        VerticesRequest request;
        const std::size_t q = 3 + maker.below(3);
        request.lowerBounds.assign(q, 0.05);
        request.upperBounds.assign(q, 0.9);
        for (std::size_t j = 0; j <= maker.below(2); ++j) {
            request.upperBounds[j] = -0.1 - 0.1 * maker.uniform();
            request.lowerBounds[j] = request.upperBounds[j] * (1.0 - 1e-5 * maker.uniform());
        }
        const VerticesOutcome expected = plainVerticesDesign(request);
        ASSERT_TRUE(sameOutcome(builtVertices(request), expected))
            << describe(request.lowerBounds, request.upperBounds, {}, 1.0);
        if (expected.design.code == des_Success) ++built;
    }
    EXPECT_GT(built, 0);
}

}  // namespace
}  // namespace reisti::test
