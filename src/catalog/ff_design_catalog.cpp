#include "catalog/ff_design_catalog.h"

#include <cstddef>
#include <cstdint>
#include <utility>

namespace reisti {

namespace {

// Ascending by runs, then by factors. 5 factors in 8 runs is said to have 2 blocks though no word makes them; hosts
// rely on both.
// clang-format off
constexpr des_FractionalFactorial FF_DESIGNS[] = {
    {2, 4, 0, 2, "", "AB"},
    {3, 4, 3, 0, "AB", ""},
    {3, 8, 0, 4, "", "ABC AB AC"},
    {4, 8, 4, 4, "ABC", "AB AB AC"},
    {5, 8, 3, 2, "AB AC", ""},
    {6, 8, 3, 2, "AB AC BC", "BE"},
    {7, 8, 3, 0, "AB AC BC ABC", ""},
    {4, 16, 0, 8, "", "ABCD BC ABD AB BC CD"},
    {5, 16, 5, 8, "ABCD", "AB AB AC AB AC AD"},
    {6, 16, 4, 8, "ABC BCD", "ACD AE ACD AB BC BF"},
    {7, 16, 4, 8, "ABC BCD ACD", "ABD AB AC AB AC AD"},
    {8, 16, 4, 8, "BCD ACD ABC ABD", "AB AB AC AB AC AD"},
    {9, 16, 3, 4, "ABC BCD ACD ABD ABCD", "AB AB AC"},
    {10, 16, 3, 4, "ABC BCD ACD ABD ABCD AB", "AC AD AG"},
    {11, 16, 3, 4, "ABC BCD ACD ABD ABCD AB AC", "AD AE AH"},
    {12, 16, 3, 4, "ABC ABD ACD BCD ABCD AB AC AD", "AG AF AG"},
    {13, 16, 3, 2, "ABC ABD ACD BCD ABCD AB AC AD BC", "AG"},
    {14, 16, 3, 2, "ABC ABD ACD BCD ABCD AB AC AD BC BD", "AG"},
    {15, 16, 3, 0, "ABC ABD ACD BCD ABCD AB AC AD BC BD CD", ""},
    {5, 32, 0, 16, "", "ABCDE ABC CDE AC BD ADE AB AC CD DE"},
    {6, 32, 6, 16, "ABCDE", "ABF BC ABF AD BC ABF AB BC CD DE"},
    {7, 32, 4, 8, "ABCD ABDE", "CDE CF CDE AB AD CG"},
    {8, 32, 4, 8, "ABC ABD BCDE", "ABE EH ABE AB AC BD"},
    {9, 32, 4, 8, "BCDE ACDE ABDE ABCE", "AEF AB CD AB AC CD"},
    {10, 32, 4, 8, "ABCD ABCE ABDE ACDE BCDE", "AB AB BC AB AC AH"},
    {11, 32, 4, 8, "ABC BCD CDE ACD ADE BDE", "ABD AK ABD AB AC AD"},
    {12, 32, 4, 8, "ACE ACD ABD ABE CDE ABCDE ADE", "ABC DG DH AB AC AD"},
    {13, 32, 4, 8, "ACE BCE ABC CDE ABCDE ABE ACD ADE", "ABD CG GH AB AC AD"},
    {14, 32, 4, 8, "ABC ABD ABE ACD ACE ADE BCD BCE BDE", "ACL AB ACL AC AL AO"},
    {15, 32, 4, 8, "ABC ABD ABE ACD ACE ADE BCD BCE BDE CDE", "ABP AB BP AB AD AK"},
    {6, 64, 0, 32, "", "ABCDEF ABCF ABDE ACE ADF BCF AD BE CE ABF AB BC CD DE EF"},
    {7, 64, 7, 16, "ABCDEF", "CDE ACF CDE ACF ADG CDE AB AC EF EG"},
    {8, 64, 5, 16, "ABCD ABEF", "ACE ACE BDF BC FH BDF BC DE FH BDF"},
    {9, 64, 4, 16, "ABCD ACEF CDEF", "BCE ABF ACJ AD AH BDE AC AD AJ BF"},
    {10, 64, 4, 16, "BCDF ACDF ABDE ABCE", "AGJ CD AGJ AG CJ CK AC AG CJ CK"},
    {11, 64, 4, 16, "CDE ABCD ABF BDEF ADEF", "AHJ FL AHJ CD CE DL AB AC AE AF"},
    {12, 64, 4, 16, "DEF ABC BCDE BCDF ABEF ACEF", "ABM AB AC AB AC BM AB AD BE BM"},
    {13, 64, 4, 16, "ABC DEF BCDF BCDE ABEF ACEF BCEF", "AB AB AC AB AC AN AB AD BE BM"},
    {14, 64, 4, 16, "BEF BCF DEF CEF BCE CDF ACDE BCDEF", "ABC BC BE BC BE BG AB BC BE BG"},
    {15, 64, 4, 16, "ABC ABD ABE BCDE ACF ADF AEF CDEF ABCDEF", "ABL AM ABL AB AC AD AB AC AD AE"},
    {7, 128, 0, 64, "", "ABCDEFG ABDE ABCFG ABC AFG DEF ABE ADG CDE EFG AC BD CE DF ABG AB BC CD DE EF FG"},
    {8, 128, 8, 32, "ABCDEFG", "ABCD ABCD ABEF ABCD ABEF BCEG BF DE ABG AEH AC BD BF DE AEH"},
    {9, 128, 6, 16, "ACDFG BCEFG", "CDEJ ABFJ CDEJ ACF AHJ BCJ AE CG BCJ BDE"},
    {10, 128, 5, 16, "ABCG BCDE ACDF", "ADG ADG BDF AEH AGK CDH BH EG JK ADG"},
    {11, 128, 5, 16, "ABCG BCDE ACDF ABCDEFG", "ADJ ADJ BFH ADJ AHL BFH BC DF GL BFH"},
    {12, 128, 4, 16, "ACDG ABCD BCFG ABDEFG CDEF", "ACF BG BJ BG BJ AGM BG BJ FM AGM"},
    {13, 128, 4, 16, "DEFG BCEG BCDFG ABDEF ACEF ABC", "ADE AB AC AB AC AGK AB AC ABM AGK"},
    {14, 128, 4, 16, "EFG BCFG BCEG ABEF ACEF BCDEF ABC", "ADE AB AC AB AC BM AB AC BM DG"},
    {15, 128, 4, 16, "ABFG ACDEF BEF ABCEG CDFG ACDEG EFG ABDEFG", "ADE EG GP EG GP OP BO EG GP OP"},
};
// clang-format on

}  // namespace

std::span<const des_FractionalFactorial> catalogRows() {
    return FF_DESIGNS;
}

FFDesignCatalog::FFDesignCatalog() {
    FillFFDesignCatalog();
}

void FFDesignCatalog::FillFFDesignCatalog() {
    if (!designs_.empty()) return;
    for (const des_FractionalFactorial& row : FF_DESIGNS) {
        AddFFCatalogDesign(row.numFactors, row.numRuns, row.resolution, row.maxBlocks, row.generators,
                           row.blockGenerators);
    }
}

void FFDesignCatalog::AddFFCatalogDesign(int numFactors, int numRuns, int resolution, int maxBlocks,
                                         const std::string& generators, const std::string& blockGenerators) {
    FF_CATALOG_DESIGN design{numFactors, numRuns, resolution, maxBlocks, {}, {}};
    FillGeneratorVector(generators, design.generators);
    FillGeneratorVector(blockGenerators, design.blockGenerators);
    designs_.insert_or_assign(GetFFDesignCatalogKey(numFactors, numRuns), std::move(design));
}

FF_CATALOG_DESIGN FFDesignCatalog::GetFFCatalogDesign(int numFactors, int numRuns) const {
    const auto found = designs_.find(GetFFDesignCatalogKey(numFactors, numRuns));
    // 3 factors in 1016 runs have the key of 4 factors in 16.
    if (found == designs_.end() || found->second.numFactors != numFactors || found->second.numRuns != numRuns)
        return {};
    return found->second;
}

int GetFFDesignCatalogKey(int numFactors, int numRuns) {
    return static_cast<int>(static_cast<std::uint32_t>(numFactors) * 1000U + static_cast<std::uint32_t>(numRuns));
}

void FillGeneratorVector(const std::string& text, std::vector<std::string>& words) {
    constexpr char kBlank = ' ';
    std::size_t begin = text.find_first_not_of(kBlank);
    while (begin != std::string::npos) {
        const std::size_t end = text.find(kBlank, begin);
        words.push_back(text.substr(begin, end - begin));
        begin = text.find_first_not_of(kBlank, end);
    }
}

FF_CATALOG_DESIGN ReadCatalogFile(int numFactors, int numRuns) {
    return FFDesignCatalog().GetFFCatalogDesign(numFactors, numRuns);
}

}  // namespace reisti
