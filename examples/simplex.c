/* A host in C99: simplex designs. Three components are blended at a fraction of the settings of five process variables,
 * which the catalog offers, and on a lattice. Build: cc -std=c99 simplex.c -lreisti */
#include <reisti/reisti.h>
#include <stdio.h>
#include <stdlib.h>

enum { q = 3 };

/* The arrays that a host owns. A run may change the bounds, so each design starts with its own. */
typedef struct Arrays {
    double lower[q], upper[q], scaledLower[q], scaledUpper[q], pseudoLower[q], pseudoUpper[q];
    uint32_t pointsPerType[q], boundaryCounts[q];
} Arrays;

static des_MixtureDesign* newDesign(Arrays* arrays) {
    des_MixtureDesign* design = des_CreateMixtureDesignContainer();
    if (design == NULL) return NULL;
    for (int i = 0; i < q; ++i) {
        arrays->lower[i] = 0.0;
        arrays->upper[i] = 1.0;
    }
    design->numComponents = q;
    design->lowerBounds = arrays->lower;
    design->upperBounds = arrays->upper;
    design->scaledLowerBounds = arrays->scaledLower;
    design->scaledUpperBounds = arrays->scaledUpper;
    design->pseudoLowerBounds = arrays->pseudoLower;
    design->pseudoUpperBounds = arrays->pseudoUpper;
    design->pointsPerType = arrays->pointsPerType;
    design->boundaryCounts = arrays->boundaryCounts;
    return design;
}

/* Prints the runs, or why there are none, and frees them. */
static int finish(const char* name, int32_t code, des_MixtureDesign* design) {
    if (code != des_Success) fprintf(stderr, "%s: %s\n", name, des_ErrorMessage(code));
    for (uint32_t i = 0; code == des_Success && i < design->numRuns; ++i) {
        const des_MixtureRun* run = &design->runs[i];
        printf("%s:", name);
        for (int j = 0; j < q; ++j)
            printf(" %.4f", run->proportions[j]);
        for (uint32_t j = 0; j < design->numProcessVariables; ++j)
            printf(" %2d", (int)run->processLevels[j]);
        printf("\n");
    }
    des_DeleteMixtureDesignContainer(&design);
    return code == des_Success ? EXIT_SUCCESS : EXIT_FAILURE;
}

/* The seven blends at the fewest settings of so many process variables that leave main effects clear of two-factor
 * interactions: resolution 4 at least. */
static int centroidWithProcessVariables(uint32_t numProcessVariables) {
    Arrays arrays;
    des_MixtureDesign* design = newDesign(&arrays);
    if (design == NULL) return finish("centroid", des_ErrorOutOfMemory, NULL);
    design->numProcessVariables = numProcessVariables;
    uint32_t count = 0;
    const des_FractionalFactorial* entries = des_FractionalFactorialCatalog(&count);
    for (uint32_t i = count; i-- > 0;) {
        if (entries[i].numFactors == (int32_t)numProcessVariables && entries[i].resolution >= 4)
            design->processFraction = (UINT32_C(1) << numProcessVariables) / (uint32_t)entries[i].numRuns;
    }
    design->fractionIndex = design->processFraction;
    return finish("centroid", des_RunSimplexCentroidDesign(design), design);
}

static int lattice(int32_t degree) {
    Arrays arrays;
    des_MixtureDesign* design = newDesign(&arrays);
    if (design == NULL) return finish("lattice", des_ErrorOutOfMemory, NULL);
    return finish("lattice", des_RunSimplexLatticeDesign(design, degree, 1), design);
}

int main(void) {
    printf("reisti %s\n", des_Version());
    const int centroid = centroidWithProcessVariables(5);
    return lattice(2) == EXIT_SUCCESS ? centroid : EXIT_FAILURE;
}
