#include "catalog/ff_design_catalog.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <limits>
#include <string>
#include <vector>

namespace reisti {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr int kLargest = std::numeric_limits<int>::max();
constexpr int kSmallest = std::numeric_limits<int>::min();

std::vector<std::string> wordsOf(const std::string& text) {
    std::vector<std::string> words;
    FillGeneratorVector(text, words);
    return words;
}

void expectMiss(const FF_CATALOG_DESIGN& design) {
    EXPECT_EQ(design.numFactors, 0);
    EXPECT_EQ(design.numRuns, 0);
    EXPECT_EQ(design.resolution, 0);
    EXPECT_EQ(design.maxBlocks, 0);
    EXPECT_THAT(design.generators, IsEmpty());
    EXPECT_THAT(design.blockGenerators, IsEmpty());
}

TEST(GeneratorWords, BlanksSeparateWords) {
    EXPECT_THAT(wordsOf("ABD ACD"), ElementsAre("ABD", "ACD"));
}

TEST(GeneratorWords, LeadingTrailingAndRepeatedBlanksMakeNoWords) {
    EXPECT_THAT(wordsOf("  AB  AC "), ElementsAre("AB", "AC"));
}

TEST(GeneratorWords, EmptyTextHasNoWords) {
    EXPECT_THAT(wordsOf(""), IsEmpty());
}

TEST(GeneratorWords, BlanksAloneHaveNoWords) {
    EXPECT_THAT(wordsOf("   "), IsEmpty());
}

TEST(GeneratorWords, OneWordWithoutBlanks) {
    EXPECT_THAT(wordsOf("ABCD"), ElementsAre("ABCD"));
}

TEST(GeneratorWords, TabsAndLineEndsArePartOfWords) {
    EXPECT_THAT(wordsOf("AB\tAC B\nC"), ElementsAre("AB\tAC", "B\nC"));
}

TEST(GeneratorWords, WordsAreAppendedToThoseAlreadyThere) {
    std::vector<std::string> words{"ABC"};
    FillGeneratorVector("AB AC", words);
    EXPECT_THAT(words, ElementsAre("ABC", "AB", "AC"));
}

TEST(GeneratorWords, EmptyTextLeavesTheWordsAlreadyThere) {
    std::vector<std::string> words{"ABC"};
    FillGeneratorVector(" ", words);
    EXPECT_THAT(words, ElementsAre("ABC"));
}

TEST(CatalogKey, IsAThousandTimesTheFactorsPlusTheRuns) {
    EXPECT_EQ(GetFFDesignCatalogKey(5, 16), 5016);
}

TEST(CatalogKey, OfTwoPairsCanBeTheSame) {
    EXPECT_EQ(GetFFDesignCatalogKey(3, 1016), GetFFDesignCatalogKey(4, 16));
}

TEST(CatalogLookup, HitReturnsTheEntryWhole) {
    const FF_CATALOG_DESIGN design = ReadCatalogFile(6, 16);
    EXPECT_EQ(design.numFactors, 6);
    EXPECT_EQ(design.numRuns, 16);
    EXPECT_EQ(design.resolution, 4);
    EXPECT_EQ(design.maxBlocks, 8);
    EXPECT_THAT(design.generators, ElementsAre("ABC", "BCD"));
    EXPECT_THAT(design.blockGenerators, ElementsAre("ACD", "AE", "ACD", "AB", "BC", "BF"));
}

struct Pair {
    std::string name;
    int numFactors;
    int numRuns;
};

class CatalogMiss : public testing::TestWithParam<Pair> {};

TEST_P(CatalogMiss, GivesTheZeroEntry) {
    expectMiss(ReadCatalogFile(GetParam().numFactors, GetParam().numRuns));
}

TEST_P(CatalogMiss, GivesTheZeroEntryFromACatalogObject) {
    expectMiss(FFDesignCatalog().GetFFCatalogDesign(GetParam().numFactors, GetParam().numRuns));
}

// The large arguments must neither overflow the key nor meet the key of an entry by wrapping around.
INSTANTIATE_TEST_SUITE_P(Pairs, CatalogMiss,
                         testing::Values(Pair{"SixteenFactors", 16, 32}, Pair{"RunsThatAreNoPowerOfTwo", 5, 12},
                                         Pair{"RunsBelowTheSmallest", 1, 2}, Pair{"FullFactorialOfEight", 8, 256},
                                         Pair{"TooFewRunsForTheFactors", 8, 8}, Pair{"OneFactor", 1, 4},
                                         Pair{"Zeros", 0, 0}, Pair{"SharedKeyThreeIn1016", 3, 1016},
                                         Pair{"SharedKeyZeroIn2004", 0, 2004}, Pair{"SharedKeyTwoIn1004", 2, 1004},
                                         Pair{"SharedKeySixWithNegativeRuns", 6, -984},
                                         Pair{"NegativeFactors", -1, 5016}, Pair{"LargestFactors", kLargest, 16},
                                         Pair{"LargestRuns", 4, kLargest}, Pair{"LargestBoth", kLargest, kLargest},
                                         Pair{"SmallestBoth", kSmallest, kSmallest},
                                         // 536870916 * 1000 + 16 is 4016 modulo 2^32.
                                         Pair{"FactorsThatWrapToFour", 536870916, 16},
                                         Pair{"FactorsThatWrapToFive", 536870912 + 5, 16}),
                         [](const auto& instance) { return instance.param.name; });

TEST(Catalog, FillingAFilledCatalogChangesNothing) {
    FFDesignCatalog catalog;
    catalog.AddFFCatalogDesign(4, 8, 9, 2, "AB", "AC");
    catalog.FillFFDesignCatalog();
    EXPECT_EQ(catalog.GetFFCatalogDesign(4, 8).resolution, 9);
}

TEST(Catalog, AddedEntryIsFound) {
    FFDesignCatalog catalog;
    catalog.AddFFCatalogDesign(16, 32, 4, 2, " ABC  ABD ", "AB");
    const FF_CATALOG_DESIGN design = catalog.GetFFCatalogDesign(16, 32);
    EXPECT_EQ(design.numFactors, 16);
    EXPECT_EQ(design.numRuns, 32);
    EXPECT_THAT(design.generators, ElementsAre("ABC", "ABD"));
    EXPECT_THAT(design.blockGenerators, ElementsAre("AB"));
}

TEST(Catalog, AddingForAKnownPairReplacesTheEntryWhole) {
    FFDesignCatalog catalog;
    catalog.AddFFCatalogDesign(6, 16, 7, 1, "ABCD", "");
    const FF_CATALOG_DESIGN design = catalog.GetFFCatalogDesign(6, 16);
    EXPECT_EQ(design.resolution, 7);
    EXPECT_EQ(design.maxBlocks, 1);
    EXPECT_THAT(design.generators, ElementsAre("ABCD"));
    EXPECT_THAT(design.blockGenerators, IsEmpty());
}

TEST(Catalog, ReplacingLeavesTheOtherEntries) {
    FFDesignCatalog catalog;
    catalog.AddFFCatalogDesign(6, 16, 7, 1, "ABCD", "");
    EXPECT_THAT(catalog.GetFFCatalogDesign(5, 16).generators, ElementsAre("ABCD"));
    EXPECT_THAT(catalog.GetFFCatalogDesign(7, 16).generators, ElementsAre("ABC", "BCD", "ACD"));
}

TEST(Catalog, ReturnedEntryIsACopy) {
    const FFDesignCatalog catalog;
    FF_CATALOG_DESIGN design = catalog.GetFFCatalogDesign(6, 16);
    design.generators.clear();
    EXPECT_THAT(catalog.GetFFCatalogDesign(6, 16).generators, ElementsAre("ABC", "BCD"));
}

TEST(Catalog, ChangesToOneObjectStayInIt) {
    FFDesignCatalog changed;
    changed.AddFFCatalogDesign(6, 16, 7, 1, "ABCD", "");
    EXPECT_THAT(ReadCatalogFile(6, 16).generators, ElementsAre("ABC", "BCD"));
}

}  // namespace
}  // namespace reisti
