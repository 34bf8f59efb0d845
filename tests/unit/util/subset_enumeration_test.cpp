#include <algorithm>
#include <climits>
#include <gtest/gtest.h>
#include <set>
#include <type_traits>
#include <vector>

#include "util/math_routines.h"

namespace reisti::test {
namespace {

using Subset = std::vector<int>;

static_assert(std::has_virtual_destructor_v<SubsetsOfNChooseK>);

std::vector<Subset> allSubsets(SubsetsOfNChooseK& enumerator, int count) {
    std::vector<Subset> result;
    for (int i = 0; i < count; ++i) {
        Subset out;
        enumerator.NextSubset(out);
        result.push_back(out);
    }
    return result;
}

TEST(SubsetEnumeration, DeliversPairsOfFourInLexicographicOrder) {
    SubsetsOfNChooseK enumerator;
    EXPECT_EQ(enumerator.Initialize(4, 2), 6);
    EXPECT_EQ(allSubsets(enumerator, 6), (std::vector<Subset>{{0, 1}, {0, 2}, {0, 3}, {1, 2}, {1, 3}, {2, 3}}));
}

TEST(SubsetEnumeration, LeavesTheOutputOnceExhausted) {
    SubsetsOfNChooseK enumerator;
    const int count = enumerator.Initialize(4, 2);
    allSubsets(enumerator, count);
    for (int extra = 0; extra < 5; ++extra) {
        Subset out{42, 43, 44};
        enumerator.NextSubset(out);
        EXPECT_EQ(out, (Subset{42, 43, 44}));
    }
}

TEST(SubsetEnumeration, LeavesTheOutputBeforeInitialize) {
    SubsetsOfNChooseK enumerator;
    Subset out{42};
    enumerator.NextSubset(out);
    EXPECT_EQ(out, (Subset{42}));
}

TEST(SubsetEnumeration, ReplacesWhateverTheOutputHeld) {
    SubsetsOfNChooseK enumerator;
    enumerator.Initialize(5, 2);
    Subset out{9, 9, 9, 9, 9};
    enumerator.NextSubset(out);
    EXPECT_EQ(out, (Subset{0, 1}));
}

TEST(SubsetEnumeration, DoesNotReadBackWhatTheCallerDoesToTheOutput) {
    SubsetsOfNChooseK enumerator;
    enumerator.Initialize(3, 2);
    Subset out;
    enumerator.NextSubset(out);
    out = {77, 78};
    enumerator.NextSubset(out);
    EXPECT_EQ(out, (Subset{0, 2}));
}

TEST(SubsetEnumeration, OfNoElementsDeliversOneEmptySubset) {
    for (const int n : {0, 1, 5, 30}) {
        SubsetsOfNChooseK enumerator;
        EXPECT_EQ(enumerator.Initialize(n, 0), 1);
        Subset out{42};
        enumerator.NextSubset(out);
        EXPECT_TRUE(out.empty());
        out = {42};
        enumerator.NextSubset(out);
        EXPECT_EQ(out, (Subset{42}));
    }
}

TEST(SubsetEnumeration, OfAllElementsDeliversTheWholeSet) {
    SubsetsOfNChooseK enumerator;
    EXPECT_EQ(enumerator.Initialize(4, 4), 1);
    EXPECT_EQ(allSubsets(enumerator, 1), (std::vector<Subset>{{0, 1, 2, 3}}));
}

TEST(SubsetEnumeration, CanBeRestartedInTheMiddle) {
    SubsetsOfNChooseK enumerator;
    enumerator.Initialize(6, 3);
    allSubsets(enumerator, 7);
    EXPECT_EQ(enumerator.Initialize(3, 1), 3);
    EXPECT_EQ(allSubsets(enumerator, 3), (std::vector<Subset>{{0}, {1}, {2}}));
    EXPECT_EQ(enumerator.Initialize(3, 1), 3);
    EXPECT_EQ(allSubsets(enumerator, 1), (std::vector<Subset>{{0}}));
}

TEST(SubsetEnumeration, IsCompleteAndAscendingForEverySmallCase) {
    for (int n = 0; n <= 12; ++n) {
        for (int k = 0; k <= n; ++k) {
            SubsetsOfNChooseK enumerator;
            const int count = enumerator.Initialize(n, k);
            ASSERT_EQ(count, NChooseK(n, k));
            const std::vector<Subset> subsets = allSubsets(enumerator, count);
            for (const Subset& subset : subsets) {
                ASSERT_EQ(subset.size(), static_cast<std::size_t>(k));
                for (std::size_t i = 0; i < subset.size(); ++i) {
                    ASSERT_GE(subset[i], i == 0 ? 0 : subset[i - 1] + 1);
                    ASSERT_LT(subset[i], n);
                }
            }
            ASSERT_TRUE(std::is_sorted(subsets.begin(), subsets.end())) << n << ", " << k;
            ASSERT_EQ(std::set<Subset>(subsets.begin(), subsets.end()).size(), subsets.size()) << n << ", " << k;
        }
    }
}

TEST(SubsetEnumeration, EndsAtTheLastSubsetOfALargerCase) {
    SubsetsOfNChooseK enumerator;
    const int count = enumerator.Initialize(20, 6);
    EXPECT_EQ(count, 38760);
    EXPECT_EQ(allSubsets(enumerator, count).back(), (Subset{14, 15, 16, 17, 18, 19}));
}

TEST(SubsetEnumeration, CountSaturatesWhileSubsetsStillCome) {
    SubsetsOfNChooseK enumerator;
    EXPECT_EQ(enumerator.Initialize(100, 50), INT_MAX);
    const std::vector<Subset> subsets = allSubsets(enumerator, 52);
    EXPECT_EQ(subsets[0].back(), 49);
    EXPECT_EQ(subsets[50].back(), 99);
    EXPECT_EQ(subsets[51][48], 49);
}

TEST(SubsetEnumeration, OutsideItsDomainKeepsTheCountOfTheFormula) {
    SubsetsOfNChooseK enumerator;
    EXPECT_EQ(enumerator.Initialize(3, 5), 0);
    Subset out{42};
    enumerator.NextSubset(out);
    EXPECT_EQ(out, (Subset{42}));

    EXPECT_EQ(enumerator.Initialize(0, 3), 1);
    enumerator.NextSubset(out);
    EXPECT_EQ(out, (Subset{0, 1, 2}));
    enumerator.NextSubset(out = {42});
    EXPECT_EQ(out, (Subset{42}));
}

TEST(SubsetEnumeration, NegativeSizesGiveNoElements) {
    SubsetsOfNChooseK enumerator;
    Subset out{42};
    for (const int k : {-1, -5, INT_MIN}) {
        EXPECT_EQ(enumerator.Initialize(3, k), 0) << k;
        enumerator.NextSubset(out);
        EXPECT_EQ(out, (Subset{42}));
    }
    EXPECT_EQ(enumerator.Initialize(0, -1), 1);
    enumerator.NextSubset(out);
    EXPECT_TRUE(out.empty());
}

TEST(SubsetEnumeration, CopiesContinueIndependently) {
    SubsetsOfNChooseK first;
    first.Initialize(4, 2);
    allSubsets(first, 2);
    SubsetsOfNChooseK second(first);
    EXPECT_EQ(allSubsets(first, 2), (std::vector<Subset>{{0, 3}, {1, 2}}));
    EXPECT_EQ(allSubsets(second, 2), (std::vector<Subset>{{0, 3}, {1, 2}}));
}

}  // namespace
}  // namespace reisti::test
