#ifndef REISTI_TESTS_SUPPORT_CATALOG_TABLE_H
#define REISTI_TESTS_SUPPORT_CATALOG_TABLE_H

#include <string>
#include <vector>

namespace reisti::test {

/// One two-level fractional factorial, read from the golden file and so independent of the library's catalog.
struct CatalogRow {
    int numFactors;
    int numRuns;
    int resolution;
    int maxBlocks;
    std::vector<std::string> generators;
    std::vector<std::string> blockGenerators;

    /// Factors whose levels run through all combinations: log2 of numRuns.
    int numBaseFactors() const;
    std::string name() const { return std::to_string(numFactors) + "In" + std::to_string(numRuns); }
};

const std::vector<CatalogRow>& catalogTable();

/// Null when the table has no such design.
const CatalogRow* catalogRow(long long numFactors, long long numRuns);

}  // namespace reisti::test

#endif
