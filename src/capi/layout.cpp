// The records are a binary interface: compiled hosts depend on every offset below.
#include <cstddef>
#include <type_traits>

#include "reisti/reisti.h"

static_assert(sizeof(void*) == 8, "the record layouts are those of a 64-bit target");

#define REISTI_LAYOUT(record, size)                                                                        \
    static_assert(sizeof(record) == (size) && alignof(record) == 8 && std::is_standard_layout_v<record> && \
                  std::is_trivial_v<record>)
#define REISTI_OFFSET(record, field, offset) static_assert(offsetof(record, field) == (offset))

REISTI_LAYOUT(des_DefinitiveScreeningRun, 24);
REISTI_OFFSET(des_DefinitiveScreeningRun, runOrder, 0);
REISTI_OFFSET(des_DefinitiveScreeningRun, block, 4);
REISTI_OFFSET(des_DefinitiveScreeningRun, pointType, 8);
REISTI_OFFSET(des_DefinitiveScreeningRun, levels, 16);

REISTI_LAYOUT(des_DefinitiveScreeningDesign, 48);
REISTI_OFFSET(des_DefinitiveScreeningDesign, numFactors, 0);
REISTI_OFFSET(des_DefinitiveScreeningDesign, numCategorical, 4);
REISTI_OFFSET(des_DefinitiveScreeningDesign, replicates, 8);
REISTI_OFFSET(des_DefinitiveScreeningDesign, numBlocks, 12);
REISTI_OFFSET(des_DefinitiveScreeningDesign, randomize, 16);
REISTI_OFFSET(des_DefinitiveScreeningDesign, seed, 24);
REISTI_OFFSET(des_DefinitiveScreeningDesign, categoricalFactors, 32);
REISTI_OFFSET(des_DefinitiveScreeningDesign, runs, 40);

REISTI_LAYOUT(des_MixtureRun, 40);
REISTI_OFFSET(des_MixtureRun, runOrder, 0);
REISTI_OFFSET(des_MixtureRun, reserved, 4);
REISTI_OFFSET(des_MixtureRun, pointType, 8);
REISTI_OFFSET(des_MixtureRun, proportions, 16);
REISTI_OFFSET(des_MixtureRun, amount, 24);
REISTI_OFFSET(des_MixtureRun, processLevels, 32);

REISTI_LAYOUT(des_MixtureDesign, 176);
REISTI_OFFSET(des_MixtureDesign, numComponents, 0);
REISTI_OFFSET(des_MixtureDesign, lowerBounds, 8);
REISTI_OFFSET(des_MixtureDesign, upperBounds, 16);
REISTI_OFFSET(des_MixtureDesign, scaledLowerBounds, 24);
REISTI_OFFSET(des_MixtureDesign, scaledUpperBounds, 32);
REISTI_OFFSET(des_MixtureDesign, pseudoLowerBounds, 40);
REISTI_OFFSET(des_MixtureDesign, pseudoUpperBounds, 48);
REISTI_OFFSET(des_MixtureDesign, pointsPerType, 56);
REISTI_OFFSET(des_MixtureDesign, numCenterPoints, 64);
REISTI_OFFSET(des_MixtureDesign, numAxialPoints, 68);
REISTI_OFFSET(des_MixtureDesign, boundaryCounts, 72);
REISTI_OFFSET(des_MixtureDesign, vertexReplicates, 80);
REISTI_OFFSET(des_MixtureDesign, typeReplicates, 88);
REISTI_OFFSET(des_MixtureDesign, centerReplicates, 96);
REISTI_OFFSET(des_MixtureDesign, axialReplicates, 100);
REISTI_OFFSET(des_MixtureDesign, designReplicates, 104);
REISTI_OFFSET(des_MixtureDesign, reserved, 108);
REISTI_OFFSET(des_MixtureDesign, numProcessVariables, 112);
REISTI_OFFSET(des_MixtureDesign, processFraction, 116);
REISTI_OFFSET(des_MixtureDesign, fractionIndex, 120);
REISTI_OFFSET(des_MixtureDesign, numAmounts, 124);
REISTI_OFFSET(des_MixtureDesign, amounts, 128);
REISTI_OFFSET(des_MixtureDesign, axialPoints, 136);
REISTI_OFFSET(des_MixtureDesign, boundsAdjusted, 137);
REISTI_OFFSET(des_MixtureDesign, outputUnits, 140);
REISTI_OFFSET(des_MixtureDesign, randomize, 144);
REISTI_OFFSET(des_MixtureDesign, seed, 152);
REISTI_OFFSET(des_MixtureDesign, numRuns, 160);
REISTI_OFFSET(des_MixtureDesign, runs, 168);

REISTI_LAYOUT(des_MixtureDesignLinearConstraint, 48);
REISTI_OFFSET(des_MixtureDesignLinearConstraint, hasLowerValue, 0);
REISTI_OFFSET(des_MixtureDesignLinearConstraint, lowerValue, 8);
REISTI_OFFSET(des_MixtureDesignLinearConstraint, hasUpperValue, 16);
REISTI_OFFSET(des_MixtureDesignLinearConstraint, upperValue, 24);
REISTI_OFFSET(des_MixtureDesignLinearConstraint, coefficients, 32);
REISTI_OFFSET(des_MixtureDesignLinearConstraint, status, 40);

REISTI_LAYOUT(des_FractionalFactorial, 32);
REISTI_OFFSET(des_FractionalFactorial, numFactors, 0);
REISTI_OFFSET(des_FractionalFactorial, numRuns, 4);
REISTI_OFFSET(des_FractionalFactorial, resolution, 8);
REISTI_OFFSET(des_FractionalFactorial, maxBlocks, 12);
REISTI_OFFSET(des_FractionalFactorial, generators, 16);
REISTI_OFFSET(des_FractionalFactorial, blockGenerators, 24);
