#ifndef REISTI_MIXTURE_COMPONENT_BOUNDS_H
#define REISTI_MIXTURE_COMPONENT_BOUNDS_H

#include <cstdint>

#include "reisti/reisti.h"

namespace reisti {

/// The total in whose units the bounds are given: the first amount, 1 when there are none.
double totalAmount(const des_MixtureDesign& design);

/// Divides the bounds by the total, checks them, and tightens those that the others never let a mixture reach. On an
/// error the bounds stay divided, and tightened as far as the check has come.
/// @param requireSimplex whether the region has to be a simplex, similar to the whole one
/// @return 0 or one of the codes from des_ErrorLowerBoundSum to des_ErrorNotSimplex
std::int32_t checkBounds(des_MixtureDesign& design, bool requireSimplex);

/// Turns the proportions of all runs, taken as those of the L-pseudo-components, into the units that the record asks
/// for. The bounds are those that checkBounds() left.
void convertFromPseudoComponents(des_MixtureDesign& design);

/// Multiplies the bounds by the total again.
void restoreBounds(des_MixtureDesign& design);

/// Fills the scaled and the pseudo-component bounds from the restored bounds.
void writeScaledBounds(des_MixtureDesign& design);

}  // namespace reisti

#endif
