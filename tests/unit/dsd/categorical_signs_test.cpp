#include "dsd/categorical_signs.h"

#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <optional>
#include <random>
#include <string>
#include <vector>

#include "dsd/construction.h"
#include "support/plain_signs.h"
#include "support/scale.h"
#include "support/screening_arrays.h"

namespace {

using reisti::test::evenBaseRuns;
using reisti::test::scaled;
using reisti::test::ScreeningArrays;
using reisti::test::plain::PlainRun;
using reisti::test::plain::Request;
using reisti::test::plain::SignMatrix;
using reisti::test::plain::Signs;

std::vector<std::int32_t> flat(const SignMatrix& m) {
    std::vector<std::int32_t> values;
    for (const Signs& row : m) {
        values.insert(values.end(), row.begin(), row.end());
    }
    return values;
}

std::string text(const SignMatrix& m) {
    std::string result;
    for (const Signs& row : m) {
        for (const std::int32_t value : row) {
            result += value == 0 ? '0' : (value == 1 ? '+' : '-');
        }
        result += ' ';
    }
    return result;
}

/// What tactic1 gives, in the terms of the plain formulation.
std::optional<Signs> tactic1(const SignMatrix& m) {
    Signs signs;
    if (!reisti::tactic1(flat(m), m.size(), signs)) return std::nullopt;
    return signs;
}

// How the off-diagonal entries of an arbitrary matrix are drawn. The tables give symmetric and skew ones, and zeros in
// mirrored places where a factor is listed twice.
struct Family {
    const char* name;
    std::int32_t (*upper)(std::mt19937& engine);
    std::int32_t (*lower)(std::mt19937& engine, std::int32_t upper);
};

std::int32_t anySign(std::mt19937& engine) {
    return engine() % 2 == 0 ? 1 : -1;
}
std::int32_t anyValue(std::mt19937& engine) {
    return static_cast<std::int32_t>(engine() % 3) - 1;
}
std::int32_t negative(std::mt19937&) {
    return -1;
}
std::int32_t positive(std::mt19937&) {
    return 1;
}
std::int32_t mirrored(std::mt19937&, std::int32_t upper) {
    return upper;
}
std::int32_t negated(std::mt19937&, std::int32_t upper) {
    return -upper;
}
std::int32_t independentSign(std::mt19937& engine, std::int32_t) {
    return anySign(engine);
}
std::int32_t signWhereMirrorIsNotZero(std::mt19937& engine, std::int32_t upper) {
    return upper == 0 ? 0 : anySign(engine);
}
std::int32_t independentValue(std::mt19937& engine, std::int32_t) {
    return anyValue(engine);
}
std::int32_t mostlyMirrored(std::mt19937& engine, std::int32_t upper) {
    return engine() % 8 == 0 ? -upper : upper;
}
std::int32_t mostlyNegated(std::mt19937& engine, std::int32_t upper) {
    return engine() % 8 == 0 ? upper : -upper;
}

SignMatrix arbitraryMatrix(const Family& family, std::size_t k, std::mt19937& engine) {
    SignMatrix m(k, Signs(k, 0));
    for (std::size_t a = 0; a < k; ++a) {
        for (std::size_t b = a + 1; b < k; ++b) {
            m[a][b] = family.upper(engine);
            m[b][a] = family.lower(engine, m[a][b]);
        }
    }
    return m;
}

/// Calls check(m) on many small and a few large matrices of a family.
template <typename Check>
void forMany(const Family& family, Check check) {
    std::mt19937 engine(20240229);
    for (int i = 0; i < scaled(3000) && !testing::Test::HasFailure(); ++i) {
        const std::size_t most = i % 20 == 0 ? 48 : 12;
        const SignMatrix m = arbitraryMatrix(family, 1 + engine() % most, engine);
        SCOPED_TRACE(text(m));
        check(m);
    }
}

void expectPlainFallback(const SignMatrix& m) {
    const reisti::FallbackSigns found = reisti::tactic2(flat(m), m.size());
    const reisti::test::plain::Fallback expected = reisti::test::plain::fallbackSigns(m);
    EXPECT_EQ(found.signs, expected.signs);
    EXPECT_EQ(found.selected, expected.selected);
    EXPECT_EQ(found.mostFlips, expected.mostFlips);
}

void expectAtMostOneFlipPerPair(const SignMatrix& m) {
    EXPECT_LE(reisti::tactic2(flat(m), m.size()).mostFlips, m.size() * (m.size() - 1) / 2);
}

class ArbitraryMatrices : public testing::TestWithParam<Family> {};

TEST_P(ArbitraryMatrices, PropagationGivesThePlainSigns) {
    forMany(GetParam(), [](const SignMatrix& m) { EXPECT_EQ(tactic1(m), reisti::test::plain::propagatedSigns(m)); });
}

TEST_P(ArbitraryMatrices, FallbackGivesThePlainSigns) {
    forMany(GetParam(), expectPlainFallback);
}

TEST_P(ArbitraryMatrices, FallbackFlipsAtMostOncePerPair) {
    forMany(GetParam(), expectAtMostOneFlipPerPair);
}

INSTANTIATE_TEST_SUITE_P(
    , ArbitraryMatrices,
    testing::Values(Family{"Symmetric", anySign, mirrored}, Family{"Skew", anySign, negated},
                    Family{"Independent", anySign, independentSign}, Family{"AllPositive", positive, mirrored},
                    Family{"AllNegative", negative, mirrored}, Family{"UpperNegativeSkew", negative, negated},
                    Family{"UpperPositiveSkew", positive, negated}, Family{"NearlySymmetric", anySign, mostlyMirrored},
                    Family{"NearlySkew", anySign, mostlyNegated},
                    Family{"ZerosInMirroredPlaces", anyValue, signWhereMirrorIsNotZero}),
    [](const testing::TestParamInfo<Family>& param) { return std::string(param.param.name); });

// A zero opposite a sign: propagation has no meaning there, but the fallback still has to end.
TEST(MatricesWithZerosAnywhere, FallbackGivesThePlainSigns) {
    forMany({"ZerosAnywhere", anyValue, independentValue}, expectPlainFallback);
}

TEST(MatricesWithZerosAnywhere, FallbackFlipsAtMostOncePerPair) {
    forMany({"ZerosAnywhere", anyValue, independentValue}, expectAtMostOneFlipPerPair);
}

TEST(SmallMatrices, AllSignsOfOrderFourGiveThePlainSigns) {
    for (unsigned code = 0; code < 4096; ++code) {
        SignMatrix m(4, Signs(4, 0));
        unsigned bit = 0;
        for (std::size_t a = 0; a < 4; ++a) {
            for (std::size_t b = 0; b < 4; ++b) {
                if (a != b) m[a][b] = (code >> bit++ & 1) != 0 ? 1 : -1;
            }
        }
        SCOPED_TRACE(text(m));
        ASSERT_EQ(tactic1(m), reisti::test::plain::propagatedSigns(m));
        const reisti::FallbackSigns found = reisti::tactic2(flat(m), 4);
        const reisti::test::plain::Fallback expected = reisti::test::plain::fallbackSigns(m);
        ASSERT_EQ(found.signs, expected.signs);
        ASSERT_EQ(found.selected, expected.selected);
    }
}

TEST(Propagation, OnePositionIsNegative) {
    EXPECT_EQ(tactic1({{0}}), (Signs{-1}));
}

TEST(Propagation, PositionWhoseEntryIsPositiveForcesNothing) {
    // The sign of position 0 is -1 and its entry +1, so position 1 is decided on its own.
    EXPECT_EQ(tactic1({{0, 1}, {1, 0}}), (Signs{-1, -1}));
}

TEST(Propagation, MatchingEntryForcesTheNegatedMirrorEntry) {
    EXPECT_EQ(tactic1({{0, -1}, {-1, 0}}), (Signs{-1, 1}));
    EXPECT_EQ(tactic1({{0, -1}, {1, 0}}), (Signs{-1, -1}));
}

TEST(Propagation, ConflictBeforeTheLastPositionMakesItPositiveAndGoesOn) {
    // -1 at position 0 forces +1 at both others, which exclude each other.
    EXPECT_EQ(tactic1({{0, -1, -1}, {-1, 0, 1}, {-1, 1, 0}}), (Signs{1, -1, -1}));
}

TEST(Propagation, ConflictAtTheLastPositionIsAFailure) {
    // Each position in turn ends in a conflict; +1 at the last one is not tried any more.
    EXPECT_EQ(tactic1({{0, -1, -1, 1}, {-1, 0, 1, -1}, {-1, 1, 0, -1}, {1, -1, -1, 0}}), std::nullopt);
}

TEST(Propagation, SignsGivenAreReplaced) {
    Signs signs = {7, 7, 7, 7, 7};
    ASSERT_TRUE(reisti::tactic1({0, 1, 1, 0}, 2, signs));
    EXPECT_EQ(signs, (Signs{-1, -1}));
}

TEST(Fallback, OnePositionIsPositive) {
    const reisti::FallbackSigns found = reisti::tactic2({0}, 1);
    EXPECT_EQ(found.signs, (Signs{1}));
    EXPECT_EQ(found.selected, 0U);
    EXPECT_EQ(found.mostFlips, 0U);
}

TEST(Fallback, StartIsNegativeWhereBothEntriesOfThePivotAre) {
    EXPECT_EQ(reisti::tactic2({0, -1, -1, 0}, 2).signs, reisti::test::plain::fallbackSigns({{0, -1}, {-1, 0}}).signs);
    EXPECT_EQ(reisti::tactic2({0, -1, -1, 0}, 2).signs.at(1), -1);
}

/// The even base runs written, the rest of the arrays poisoned.
std::int32_t assign(ScreeningArrays& arrays) {
    EXPECT_EQ(reisti::fillInitialDesign(arrays.design), des_Success);
    return reisti::assignCategoricalSigns(arrays.design);
}

/// Even base runs and centre run after the signs were chosen.
std::vector<std::optional<PlainRun>> plainAssigned(const Request& request) {
    reisti::test::plain::Design design;
    design.runs = evenBaseRuns(request);
    EXPECT_EQ(reisti::test::plain::writeCategoricalSigns(request, design), des_Success);
    return design.runs;
}

class AssignedSigns : public testing::TestWithParam<Request> {};

TEST_P(AssignedSigns, AreThePlainOnes) {
    ScreeningArrays arrays(GetParam());
    EXPECT_EQ(assign(arrays), des_Success);
    EXPECT_EQ(arrays.differenceFrom(plainAssigned(GetParam())), "");
}

INSTANTIATE_TEST_SUITE_P(, AssignedSigns,
                         testing::Values(Request{6, {2}}, Request{6, {0, 1, 2, 3, 4, 5}},
                                         Request{6, {5, 4, 3, 2, 1, 0}}, Request{6, {0, 0}}, Request{6, {3, 1, 3}},
                                         Request{2, {1, 0}}, Request{14, {4, 4, 4, 4, 4}},
                                         Request{14, {0, 1, 2, 3, 4, 4, 3, 2, 1, 0}},
                                         Request{42, {41, 3, 17, 22, 9, 30, 30, 1}}),
                         [](const testing::TestParamInfo<Request>& param) {
                             std::string name = "Of" + std::to_string(param.param.numFactors) + "Factors";
                             for (const std::uint32_t column : param.param.categorical) {
                                 name += '_';
                                 name += std::to_string(column);
                             }
                             return name;
                         });

TEST(AssignCategoricalSigns, FallbackMarksOnlyTheSelectedPositionInTheCentreRun) {
    const Request request{6, {0, 1, 2, 3, 4, 5}};
    const auto found = reisti::test::plain::fallbackSigns(reisti::test::plain::conferenceMatrix(6));
    ASSERT_FALSE(reisti::test::plain::propagatedSigns(reisti::test::plain::conferenceMatrix(6)).has_value());
    ScreeningArrays arrays(request);
    ASSERT_EQ(assign(arrays), des_Success);
    for (std::size_t a = 0; a < 6; ++a) {
        EXPECT_EQ(arrays.level(2 * a, a), found.signs[a]) << a;
        EXPECT_EQ(arrays.level(12, a), a == found.selected ? -1 : 1) << a;
    }
}

TEST(AssignCategoricalSigns, BadIndexWritesNothing) {
    for (const std::vector<std::uint32_t>& list :
         {std::vector<std::uint32_t>{6}, {0, 1, 6}, {7, 0}, {0, 4294967295U}}) {
        ScreeningArrays arrays(Request{6, list});
        EXPECT_EQ(assign(arrays), des_ErrorCategoricalIndex);
        EXPECT_EQ(arrays.differenceFrom(evenBaseRuns({6, list})), "");
    }
}

}  // namespace
