/* Prints size, alignment and every offset of the public records, as a C host sees them. */
#include <reisti/reisti.h>
#include <stddef.h>
#include <stdio.h>

#define RECORD(type) printf("%s size %zu\n", #type, sizeof(type))
#define FIELD(type, field) \
    printf("%s.%s offset %zu size %zu\n", #type, #field, offsetof(type, field), sizeof(((type*)0)->field))

int main(void) {
    RECORD(des_DefinitiveScreeningRun);
    FIELD(des_DefinitiveScreeningRun, runOrder);
    FIELD(des_DefinitiveScreeningRun, block);
    FIELD(des_DefinitiveScreeningRun, pointType);
    FIELD(des_DefinitiveScreeningRun, levels);
    RECORD(des_DefinitiveScreeningDesign);
    FIELD(des_DefinitiveScreeningDesign, numFactors);
    FIELD(des_DefinitiveScreeningDesign, numCategorical);
    FIELD(des_DefinitiveScreeningDesign, replicates);
    FIELD(des_DefinitiveScreeningDesign, numBlocks);
    FIELD(des_DefinitiveScreeningDesign, randomize);
    FIELD(des_DefinitiveScreeningDesign, seed);
    FIELD(des_DefinitiveScreeningDesign, categoricalFactors);
    FIELD(des_DefinitiveScreeningDesign, runs);
    RECORD(des_MixtureRun);
    FIELD(des_MixtureRun, runOrder);
    FIELD(des_MixtureRun, reserved);
    FIELD(des_MixtureRun, pointType);
    FIELD(des_MixtureRun, proportions);
    FIELD(des_MixtureRun, amount);
    FIELD(des_MixtureRun, processLevels);
    RECORD(des_MixtureDesign);
    FIELD(des_MixtureDesign, numComponents);
    FIELD(des_MixtureDesign, lowerBounds);
    FIELD(des_MixtureDesign, upperBounds);
    FIELD(des_MixtureDesign, scaledLowerBounds);
    FIELD(des_MixtureDesign, scaledUpperBounds);
    FIELD(des_MixtureDesign, pseudoLowerBounds);
    FIELD(des_MixtureDesign, pseudoUpperBounds);
    FIELD(des_MixtureDesign, pointsPerType);
    FIELD(des_MixtureDesign, numCenterPoints);
    FIELD(des_MixtureDesign, numAxialPoints);
    FIELD(des_MixtureDesign, boundaryCounts);
    FIELD(des_MixtureDesign, vertexReplicates);
    FIELD(des_MixtureDesign, typeReplicates);
    FIELD(des_MixtureDesign, centerReplicates);
    FIELD(des_MixtureDesign, axialReplicates);
    FIELD(des_MixtureDesign, designReplicates);
    FIELD(des_MixtureDesign, reserved);
    FIELD(des_MixtureDesign, numProcessVariables);
    FIELD(des_MixtureDesign, processFraction);
    FIELD(des_MixtureDesign, fractionIndex);
    FIELD(des_MixtureDesign, numAmounts);
    FIELD(des_MixtureDesign, amounts);
    FIELD(des_MixtureDesign, axialPoints);
    FIELD(des_MixtureDesign, boundsAdjusted);
    FIELD(des_MixtureDesign, outputUnits);
    FIELD(des_MixtureDesign, randomize);
    FIELD(des_MixtureDesign, seed);
    FIELD(des_MixtureDesign, numRuns);
    FIELD(des_MixtureDesign, runs);
    RECORD(des_MixtureDesignLinearConstraint);
    FIELD(des_MixtureDesignLinearConstraint, hasLowerValue);
    FIELD(des_MixtureDesignLinearConstraint, lowerValue);
    FIELD(des_MixtureDesignLinearConstraint, hasUpperValue);
    FIELD(des_MixtureDesignLinearConstraint, upperValue);
    FIELD(des_MixtureDesignLinearConstraint, coefficients);
    FIELD(des_MixtureDesignLinearConstraint, status);
    RECORD(des_FractionalFactorial);
    FIELD(des_FractionalFactorial, numFactors);
    FIELD(des_FractionalFactorial, numRuns);
    FIELD(des_FractionalFactorial, resolution);
    FIELD(des_FractionalFactorial, maxBlocks);
    FIELD(des_FractionalFactorial, generators);
    FIELD(des_FractionalFactorial, blockGenerators);
    return 0;
}
