#ifndef REISTI_DSD_CONSTRUCTION_H
#define REISTI_DSD_CONSTRUCTION_H

// From a conference matrix to the runs of a screening design, in the order in which createDesign calls the steps. Each
// step writes into the caller's runs; each std::int32_t returned is an error code, 0 for success.

#include <cstdint>

#include "reisti/reisti.h"

namespace reisti {

/// Copies the base matrix for the design's number of factors into the even runs.
std::int32_t fillInitialDesign(des_DefinitiveScreeningDesign& design);

/// Copies the first numFactors columns of a table of order s into runs 0, 2, .., 2s-2.
std::int32_t copyFromArrayToDesign(const std::int32_t* table, std::uint32_t s, des_DefinitiveScreeningDesign& design);

/// Writes run 2s as a centre run with all levels 0.
void addTrueCenterpoint(des_DefinitiveScreeningDesign& design);

/// Writes the odd runs as the negations of the even ones, and unless withoutCentre also run 2s+1 as that of run 2s.
void addFlippedRows(des_DefinitiveScreeningDesign& design, bool withoutCentre);

/// Copies the base runs for each further replicate and numbers the blocks.
std::int32_t addReplicates(des_DefinitiveScreeningDesign& design);

/// Builds the whole design.
std::int32_t createDesign(des_DefinitiveScreeningDesign& design);

/// Number of runs of a design; 0 on an error. The error code goes to `error` unless it is null.
std::uint32_t findRowCount(std::int32_t numFactors, std::int32_t* error, bool hasCategorical, std::uint32_t replicates);

}  // namespace reisti

#endif
