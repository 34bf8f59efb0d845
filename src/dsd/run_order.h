#ifndef REISTI_DSD_RUN_ORDER_H
#define REISTI_DSD_RUN_ORDER_H

#include <cstdint>
#include <vector>

#include "reisti/reisti.h"

namespace reisti {

/// When the design asks for it, rewrites the run orders at random: the blocks in random sequence, and the runs at
/// random within their block. The runs stay where they are. Throws std::bad_alloc; nothing is written then.
void randomizeDesign(des_DefinitiveScreeningDesign& design);

/// The run orders that the random keys u give to the first `total` runs. Block b+1 has blockRunCounts[b] of them; u
/// holds, block by block, the key of the block and then one key for each of its runs.
///
/// Blocks are placed by ascending key. In a block the t-th run in array order gets the index of the t-th smallest key.
/// A key that occurred before counts for nothing: such a block comes behind the others, by ascending number, and the
/// ranks that such keys stood for are given, ascending, to the runs that find no key left. Run orders are a permutation
/// of 1..total for any keys.
void assignRunOrders(des_DefinitiveScreeningRun* runs, std::uint32_t total,
                     const std::vector<std::uint32_t>& blockRunCounts, const std::vector<double>& u);

}  // namespace reisti

#endif
