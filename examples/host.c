/* A host in C99: a screening design and a constrained mixture design. Build: cc -std=c99 host.c -lreisti */
#include <reisti/reisti.h>
#include <stdio.h>
#include <stdlib.h>

static int fail(const char* what, int32_t code) {
    fprintf(stderr, "%s: %s\n", what, des_ErrorMessage(code));
    return EXIT_FAILURE;
}

/* Four continuous factors and a categorical one. The caller owns every array. */
static int screeningDesign(void) {
    const uint32_t numFactors = 5;
    const uint32_t categorical[] = {4};
    int32_t code = des_Success;
    const uint32_t numRuns = des_FindDefinitiveScreeningDesignRowCount((int32_t)numFactors, &code, 1, 1);
    if (code != des_Success) return fail("screening design", code);

    des_DefinitiveScreeningRun* runs = calloc(numRuns, sizeof *runs);
    int32_t* levels = calloc((size_t)numRuns * numFactors, sizeof *levels);
    if (runs == NULL || levels == NULL) {
        free(runs);
        free(levels);
        return fail("screening design", des_ErrorOutOfMemory);
    }
    for (uint32_t i = 0; i < numRuns; ++i)
        runs[i].levels = levels + (size_t)i * numFactors;

    des_DefinitiveScreeningDesign design = {0};
    design.numFactors = numFactors;
    design.numCategorical = 1;
    design.categoricalFactors = categorical;
    design.replicates = 1;
    design.numBlocks = 1;
    design.randomize = 1;
    design.seed = 42;
    design.runs = runs;
    code = des_CreateDefinitiveScreeningDesign(&design);
    for (uint32_t i = 0; code == des_Success && i < numRuns; ++i) {
        printf("run %2u:", (unsigned)runs[i].runOrder);
        for (uint32_t j = 0; j < numFactors; ++j)
            printf(" %2d", (int)runs[i].levels[j]);
        printf("\n");
    }
    free(levels);
    free(runs);
    return code == des_Success ? EXIT_SUCCESS : fail("screening design", code);
}

/* Three components with bounds and A >= 1.5 B. The library owns the record and its runs, the caller all other arrays.
 */
static int mixtureDesign(void) {
    enum { q = 3 };
    double lower[q] = {0.1, 0.1, 0.0}, upper[q] = {0.7, 0.7, 1.0};
    double scaledLower[q], scaledUpper[q], pseudoLower[q], pseudoUpper[q];
    uint32_t pointsPerType[q], boundaryCounts[q];
    const double coefficients[q] = {1.0, -1.5, 0.0};
    des_MixtureDesignLinearConstraint constraint = {0};
    constraint.hasLowerValue = 1;
    constraint.lowerValue = 0.0;
    constraint.coefficients = coefficients;

    des_MixtureDesign* design = des_CreateMixtureDesignContainer();
    if (design == NULL) return fail("mixture design", des_ErrorOutOfMemory);
    design->numComponents = q;
    design->lowerBounds = lower;
    design->upperBounds = upper;
    design->scaledLowerBounds = scaledLower;
    design->scaledUpperBounds = scaledUpper;
    design->pseudoLowerBounds = pseudoLower;
    design->pseudoUpperBounds = pseudoUpper;
    design->pointsPerType = pointsPerType;
    design->boundaryCounts = boundaryCounts;

    const int32_t code = des_RunExtremeVerticesDesign(design, 1, 1, 1, &constraint, 0);
    for (uint32_t i = 0; code == des_Success && i < design->numRuns; ++i) {
        const des_MixtureRun* run = &design->runs[i];
        printf("type %d:", (int)run->pointType);
        for (int j = 0; j < q; ++j)
            printf(" %.4f", run->proportions[j]);
        printf("\n");
    }
    des_DeleteMixtureDesignContainer(&design);
    return code == des_Success ? EXIT_SUCCESS : fail("mixture design", code);
}

int main(void) {
    const int screening = screeningDesign();
    const int mixture = mixtureDesign();
    return screening != EXIT_SUCCESS ? screening : mixture;
}
