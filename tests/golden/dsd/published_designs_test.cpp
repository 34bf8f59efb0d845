// Screening designs against the literature.
#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <map>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "dsd/conference_matrices.h"
#include "golden_text.h"
#include "reisti/reisti.h"
#include "support/screening_arrays.h"

namespace {

using reisti::test::goldenLines;
using reisti::test::ScreeningArrays;
using reisti::test::plain::Request;

constexpr double kCorrelationTolerance = 1e-12;

std::vector<std::int32_t> numbers(const std::vector<std::string>& words) {
    std::vector<std::int32_t> values;
    for (std::size_t i = 1; i < words.size(); ++i) {
        values.push_back(std::stoi(words[i]));
    }
    return values;
}

TEST(PublishedRunCounts, BaseOrderIsThatOfTheLiterature) {
    const auto lines = goldenLines("run_counts.txt");
    ASSERT_EQ(lines.size(), 47U);
    for (const auto& words : lines) {
        EXPECT_EQ(reisti::baseOrder(static_cast<std::uint32_t>(std::stoul(words[0]))), std::stoul(words[1]))
            << words[0];
    }
}

TEST(PublishedRunCounts, RowCountIsThatOfTheLiterature) {
    for (const auto& words : goldenLines("run_counts.txt")) {
        std::int32_t error = -1;
        const int n = std::stoi(words[0]);
        EXPECT_EQ(des_FindDefinitiveScreeningDesignRowCount(n, &error, 0, 1), std::stoul(words[2])) << n;
        EXPECT_EQ(des_FindDefinitiveScreeningDesignRowCount(n, &error, 1, 1), std::stoul(words[3])) << n;
    }
}

TEST(PublishedSixFactorDesign, IsReproducedUpToTheFreeChoiceOfSigns) {
    std::vector<std::vector<std::int32_t>> rows;
    std::map<std::string, std::vector<std::int32_t>> signs;
    for (const auto& words : goldenLines("six_factors.txt")) {
        if (words[0] == "row") {
            rows.push_back(numbers(words));
        } else {
            signs[words[0]] = numbers(words);
        }
    }
    ASSERT_EQ(rows.size(), 6U);
    ScreeningArrays arrays(Request{6});
    ASSERT_EQ(arrays.create(), des_Success);
    for (std::size_t i = 0; i < 6; ++i) {
        for (std::size_t j = 0; j < 6; ++j) {
            EXPECT_EQ(arrays.level(2 * i, j), rows[i][j] * signs["column_signs"][j] * signs["row_signs"][i])
                << i << ' ' << j;
        }
    }
}

using Column = std::vector<double>;

double dot(const Column& a, const Column& b) {
    double sum = 0.0;
    for (std::size_t i = 0; i < a.size(); ++i) {
        sum += a[i] * b[i];
    }
    return sum;
}

Column product(const Column& a, const Column& b) {
    Column result(a.size());
    for (std::size_t i = 0; i < a.size(); ++i) {
        result[i] = a[i] * b[i];
    }
    return result;
}

Column centred(Column values) {
    const double mean = dot(values, Column(values.size(), 1.0)) / static_cast<double>(values.size());
    for (double& value : values) {
        value -= mean;
    }
    return values;
}

double correlation(const Column& a, const Column& b) {
    const Column ca = centred(a);
    const Column cb = centred(b);
    return dot(ca, cb) / std::sqrt(dot(ca, ca) * dot(cb, cb));
}

/// Number of independent columns, counted modulo a large prime: never more than the rank over the rationals.
std::size_t rankAtLeast(const std::vector<Column>& columns) {
    constexpr std::int64_t kPrime = 2147483647;
    std::vector<std::vector<std::int64_t>> rest;
    for (const Column& column : columns) {
        std::vector<std::int64_t> values;
        for (const double value : column) {
            values.push_back((static_cast<std::int64_t>(value) + kPrime) % kPrime);
        }
        rest.push_back(values);
    }
    const auto inverse = [](std::int64_t value) {
        std::int64_t result = 1;
        for (std::int64_t exponent = kPrime - 2; exponent > 0; exponent /= 2) {
            if (exponent % 2 == 1) result = result * value % kPrime;
            value = value * value % kPrime;
        }
        return result;
    };
    std::size_t rank = 0;
    for (std::size_t row = 0; row < columns.front().size() && rank < rest.size(); ++row) {
        const auto pivot = std::find_if(rest.begin() + static_cast<std::ptrdiff_t>(rank), rest.end(),
                                        [row](const auto& values) { return values[row] != 0; });
        if (pivot == rest.end()) continue;
        std::swap(*pivot, rest[rank]);
        const std::int64_t scale = inverse(rest[rank][row]);
        for (std::size_t other = rank + 1; other < rest.size(); ++other) {
            const std::int64_t factor = rest[other][row] * scale % kPrime;
            for (std::size_t i = row; factor != 0 && i < rest[other].size(); ++i) {
                rest[other][i] = (rest[other][i] + (kPrime - factor) * rest[rank][i]) % kPrime;
            }
        }
        ++rank;
    }
    return rank;
}

struct Facts {
    std::size_t order = 0;
    std::size_t runs = 0;
    double mainEffectSumOfSquares = 0.0;
    double quadraticCorrelation = 0.0;
    double quadraticWithInteraction = 0.0;
    double interactionsSharingAFactor = 0.0;
    std::map<int, std::size_t> fourColumnSums;
    std::vector<double> distinctInteractions;
    std::size_t rank = 0;
};

double fraction(const std::string& text) {
    const std::size_t slash = text.find('/');
    return std::stod(text.substr(0, slash)) / std::stod(text.substr(slash + 1));
}

std::vector<Facts> publishedFacts() {
    std::vector<Facts> all;
    for (const auto& words : goldenLines("correlations.txt")) {
        const std::string& key = words[0];
        if (key == "order") all.emplace_back().order = std::stoul(words[1]);
        Facts& facts = all.back();
        if (key == "runs") facts.runs = std::stoul(words[1]);
        if (key == "main_effect_sum_of_squares") facts.mainEffectSumOfSquares = std::stod(words[1]);
        if (key == "quadratic_quadratic_correlation") facts.quadraticCorrelation = fraction(words[1]);
        if (key == "abs_corr_xi2_with_xjxk") facts.quadraticWithInteraction = std::stod(words[1]);
        if (key == "abs_corr_xixj_with_xixk") facts.interactionsSharingAFactor = std::stod(words[1]);
        if (key == "four_column_sum") facts.fourColumnSums[std::stoi(words[1])] = std::stoul(words[2]);
        if (key == "rank_of_intercept_mains_quadratics") facts.rank = std::stoul(words[1]);
        if (key == "abs_corr_xixj_with_xkxl") {
            for (std::size_t i = 1; i < words.size(); ++i) {
                facts.distinctInteractions.push_back(std::stod(words[i]));
            }
        }
    }
    return all;
}

class PublishedFacts : public testing::TestWithParam<Facts> {
  protected:
    void SetUp() override {
        ScreeningArrays arrays(Request{static_cast<std::uint32_t>(facts.order)});
        ASSERT_EQ(arrays.create(), des_Success);
        ASSERT_EQ(arrays.numRuns(), facts.runs);
        for (std::size_t j = 0; j < facts.order; ++j) {
            Column column;
            for (std::size_t i = 0; i < arrays.numRuns(); ++i) {
                column.push_back(arrays.level(i, j));
            }
            x.push_back(column);
            square.push_back(product(column, column));
        }
    }

    const Facts facts = GetParam();
    std::vector<Column> x;
    std::vector<Column> square;
};

TEST_P(PublishedFacts, MainEffectsHaveTheSumOfSquares) {
    for (const Column& column : x) {
        EXPECT_EQ(dot(column, column), facts.mainEffectSumOfSquares);
    }
}

TEST_P(PublishedFacts, EveryColumnIsZeroInThreeRuns) {
    for (const Column& column : x) {
        EXPECT_EQ(std::count(column.begin(), column.end(), 0.0), 3);
    }
}

TEST_P(PublishedFacts, QuadraticsHaveTheCorrelation) {
    EXPECT_NEAR(facts.quadraticCorrelation, 1.0 / 3.0 - 1.0 / (static_cast<double>(facts.order) - 1.0),
                kCorrelationTolerance);
    for (std::size_t i = 0; i < x.size(); ++i) {
        for (std::size_t j = i + 1; j < x.size(); ++j) {
            ASSERT_NEAR(correlation(square[i], square[j]), facts.quadraticCorrelation, kCorrelationTolerance);
        }
    }
}

TEST_P(PublishedFacts, QuadraticsHaveTheCorrelationWithInteractions) {
    for (std::size_t j = 0; j < x.size(); ++j) {
        for (std::size_t k = j + 1; k < x.size(); ++k) {
            const Column interaction = product(x[j], x[k]);
            for (std::size_t i = 0; i < x.size(); ++i) {
                const double expected = i == j || i == k ? 0.0 : facts.quadraticWithInteraction;
                ASSERT_NEAR(std::abs(correlation(square[i], interaction)), expected, kCorrelationTolerance);
            }
        }
    }
}

TEST_P(PublishedFacts, InteractionsThatShareAFactorHaveTheCorrelation) {
    for (std::size_t i = 0; i < x.size(); ++i) {
        for (std::size_t j = 0; j < x.size(); ++j) {
            for (std::size_t k = j + 1; k < x.size(); ++k) {
                if (i == j || i == k) continue;
                ASSERT_NEAR(std::abs(correlation(product(x[i], x[j]), product(x[i], x[k]))),
                            facts.interactionsSharingAFactor, kCorrelationTolerance);
            }
        }
    }
}

TEST_P(PublishedFacts, FourColumnSumsAreThoseCounted) {
    std::map<int, std::size_t> counts;
    for (std::size_t i = 0; i < x.size(); ++i) {
        for (std::size_t j = i + 1; j < x.size(); ++j) {
            const Column ij = product(x[i], x[j]);
            for (std::size_t k = j + 1; k < x.size(); ++k) {
                const Column ijk = product(ij, x[k]);
                for (std::size_t l = k + 1; l < x.size(); ++l) {
                    // A run and its negative have the same product, the centre run has 0.
                    const int sum = static_cast<int>(std::abs(dot(ijk, x[l])));
                    ++counts[sum / 2];
                }
            }
        }
    }
    EXPECT_EQ(counts, facts.fourColumnSums);
}

TEST_P(PublishedFacts, InteractionsOfFourFactorsHaveTheCorrelations) {
    std::set<std::size_t> met;
    const std::size_t step = x.size() > 20 ? 3 : 1;  // All 600,000 pairs of order 48 would take most of the test time.
    for (std::size_t i = 0; i < x.size(); ++i) {
        for (std::size_t j = i + 1; j < x.size(); ++j) {
            const Column ij = product(x[i], x[j]);
            for (std::size_t k = i + 1; k < x.size(); k += step) {
                for (std::size_t l = k + 1; l < x.size(); l += step) {
                    if (k == j || l == j) continue;
                    const double value = std::abs(correlation(ij, product(x[k], x[l])));
                    const auto known = std::find_if(
                        facts.distinctInteractions.begin(), facts.distinctInteractions.end(),
                        [value](double published) { return std::abs(published - value) <= kCorrelationTolerance; });
                    ASSERT_NE(known, facts.distinctInteractions.end()) << value;
                    met.insert(static_cast<std::size_t>(known - facts.distinctInteractions.begin()));
                }
            }
        }
    }
    EXPECT_EQ(met.size(), facts.distinctInteractions.size());
}

TEST_P(PublishedFacts, InterceptMainEffectsAndQuadraticsAreEstimable) {
    std::vector<Column> model = {Column(facts.runs, 1.0)};
    model.insert(model.end(), x.begin(), x.end());
    model.insert(model.end(), square.begin(), square.end());
    EXPECT_EQ(rankAtLeast(model), facts.rank);
}

TEST_P(PublishedFacts, FullQuadraticIsEstimableInAnyThreeFactors) {
    for (std::size_t i = 0; i < x.size(); ++i) {
        for (std::size_t j = i + 1; j < x.size(); ++j) {
            for (std::size_t k = j + 1; k < x.size(); ++k) {
                const std::vector<Column> model = {Column(facts.runs, 1.0),
                                                   x[i],
                                                   x[j],
                                                   x[k],
                                                   square[i],
                                                   square[j],
                                                   square[k],
                                                   product(x[i], x[j]),
                                                   product(x[i], x[k]),
                                                   product(x[j], x[k])};
                ASSERT_EQ(rankAtLeast(model), 10U) << i << ' ' << j << ' ' << k;
            }
        }
    }
}

INSTANTIATE_TEST_SUITE_P(, PublishedFacts, testing::ValuesIn(publishedFacts()),
                         [](const testing::TestParamInfo<Facts>& param) {
                             return "Order" + std::to_string(param.param.order);
                         });

}  // namespace
