#include "support/catalog_table.h"

#include <algorithm>

#include "support/golden_lines.h"

namespace reisti::test {

int CatalogRow::numBaseFactors() const {
    int base = 0;
    while (1 << base < numRuns)
        ++base;
    return base;
}

const std::vector<CatalogRow>& catalogTable() {
    static const std::vector<CatalogRow> table = [] {
        std::vector<CatalogRow> rows;
        for (const auto& words : GoldenLines("mixture/fractional_factorial_catalog.txt").all("entry")) {
            const auto cells = groupsOf(words);
            rows.push_back({std::stoi(cells.at(1).at(0)), std::stoi(cells.at(2).at(0)), std::stoi(cells.at(3).at(0)),
                            std::stoi(cells.at(4).at(0)), cells.at(5), cells.at(6)});
        }
        return rows;
    }();
    return table;
}

const CatalogRow* catalogRow(long long numFactors, long long numRuns) {
    const auto& table = catalogTable();
    const auto found = std::find_if(table.begin(), table.end(), [&](const CatalogRow& row) {
        return row.numFactors == numFactors && row.numRuns == numRuns;
    });
    return found != table.end() ? &*found : nullptr;
}

}  // namespace reisti::test
