#ifndef REISTI_DSD_CATEGORICAL_SIGNS_H
#define REISTI_DSD_CATEGORICAL_SIGNS_H

// A two-level categorical factor has no middle level, so the zero on the diagonal of each categorical column is
// replaced by a sign. The signs are chosen from the k x k matrix m of the categorical rows and columns alone
// (row-major, zero diagonal): m[a][b] is the level of categorical factor b in the base row that holds the zero of
// categorical factor a.

#include <cstddef>
#include <cstdint>
#include <vector>

#include "reisti/reisti.h"

namespace reisti {

/// Propagation search: takes the positions in order, tries -1, and lets each decided sign force others. Writes k signs.
/// False when the last position ended in a conflict; the signs are then of no use.
bool tactic1(const std::vector<std::int32_t>& m, std::size_t k, std::vector<std::int32_t>& signs);

struct FallbackSigns {
    std::vector<std::int32_t> signs;
    /// Pivot position whose candidate was taken.
    std::size_t selected;
    /// Most sign changes that the repair of any candidate took; never above k(k-1)/2.
    std::size_t mostFlips;
};

/// Repair search, for when tactic1 fails: one candidate for each pivot position, the least violated one taken. k >= 1.
FallbackSigns tactic2(const std::vector<std::int32_t>& m, std::size_t k);

/// Chooses the signs, writes them into the even base runs and writes the centre run. Needs a list of numCategorical
/// entries, at most numFactors. des_ErrorCategoricalIndex for an index that is not below numFactors; nothing is written
/// then.
std::int32_t assignCategoricalSigns(des_DefinitiveScreeningDesign& design);

}  // namespace reisti

#endif
