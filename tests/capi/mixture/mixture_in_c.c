/* A host in plain C: designs built and read through the public header alone. Prints what is wrong and returns it. */
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include "reisti/reisti.h"

static int failures = 0;

static void expect(int holds, const char* what) {
    if (holds) return;
    printf("failed: %s\n", what);
    ++failures;
}

/* The arrays of a host with up to four components. */
typedef struct Host {
    double lower[4], upper[4], scaledLower[4], scaledUpper[4], pseudoLower[4], pseudoUpper[4];
    uint32_t pointsPerType[4], boundaryCounts[4];
    des_MixtureDesign* design;
} Host;

static void begin(Host* host, uint32_t numComponents) {
    memset(host, 0, sizeof *host);
    for (uint32_t i = 0; i < numComponents; ++i)
        host->upper[i] = 1.0;
    host->design = des_CreateMixtureDesignContainer();
    if (host->design == NULL) exit(2);
    host->design->numComponents = numComponents;
    host->design->lowerBounds = host->lower;
    host->design->upperBounds = host->upper;
    host->design->scaledLowerBounds = host->scaledLower;
    host->design->scaledUpperBounds = host->scaledUpper;
    host->design->pseudoLowerBounds = host->pseudoLower;
    host->design->pseudoUpperBounds = host->pseudoUpper;
    host->design->pointsPerType = host->pointsPerType;
    host->design->boundaryCounts = host->boundaryCounts;
}

static double absolute(double x) {
    return x < 0 ? -x : x;
}

static void everyRunSumsTo(const Host* host, double total) {
    for (uint32_t i = 0; i < host->design->numRuns; ++i) {
        double sum = 0.0;
        for (uint32_t j = 0; j < host->design->numComponents; ++j)
            sum += host->design->runs[i].proportions[j];
        expect(absolute(sum - total) <= 1e-12 * total, "the proportions of a run sum to the total");
    }
}

static void centroidWithAxialPoints(void) {
    Host host;
    begin(&host, 3);
    host.design->axialPoints = 1;
    expect(des_RunSimplexCentroidDesign(host.design) == des_Success, "the centroid design is built");
    expect(host.design->numRuns == 10, "seven centroids and three axial points");
    expect(host.design->numCenterPoints == 1, "one overall centroid");
    expect(host.design->numAxialPoints == 3, "three axial points");
    expect(host.pointsPerType[0] == 3 && host.pointsPerType[1] == 3 && host.pointsPerType[2] == 0, "points by type");
    expect(host.boundaryCounts[0] == 3 && host.boundaryCounts[1] == 3 && host.boundaryCounts[2] == 1, "a triangle");
    expect(host.design->runs[6].pointType == des_MixturePointCentroid, "the centroid is the seventh run");
    expect(host.design->runs[9].pointType == des_MixturePointAxial, "the last run is axial");
    expect(host.design->runs[0].processLevels == NULL, "no process variables, no levels");
    everyRunSumsTo(&host, 1.0);
    des_DeleteMixtureDesignContainer(&host.design);
    expect(host.design == NULL, "the pointer is null after deletion");
}

static void latticeWithTotalAndProcessVariables(void) {
    const double total = 80.0;
    Host host;
    begin(&host, 4);
    for (int i = 0; i < 4; ++i)
        host.upper[i] = total;
    host.lower[0] = 8.0;
    host.design->amounts = &total;
    host.design->numAmounts = 1;
    host.design->numProcessVariables = 3;
    host.design->processFraction = 2;
    host.design->fractionIndex = 2;
    expect(des_RunSimplexLatticeDesign(host.design, 2, 1) == des_Success, "the lattice design is built");
    expect(host.design->numRuns == 11 * 4, "ten points and the centre at four settings");
    expect(host.design->boundsAdjusted == 1, "the upper bounds are tightened");
    expect(absolute(host.upper[1] - 72.0) < 1e-10, "to what the lower bound leaves");
    everyRunSumsTo(&host, total);
    for (uint32_t i = 0; i < host.design->numRuns; ++i) {
        const int32_t* levels = host.design->runs[i].processLevels;
        expect(levels[2] == levels[0] * levels[1], "the third level is the product of the others");
        expect(host.design->runs[i].amount == total, "the amount of a run");
    }
    des_DeleteMixtureDesignContainer(&host.design);
}

static void errors(void) {
    Host host;
    begin(&host, 3);
    host.lower[0] = 0.5;
    host.lower[1] = 0.5;
    expect(des_RunSimplexCentroidDesign(host.design) == des_ErrorLowerBoundSum, "lower bounds that leave nothing");
    expect(host.design->runs == NULL && host.design->numRuns == 0, "no runs after an error");
    expect(des_RunSimplexLatticeDesign(host.design, 11, 0) == des_ErrorDegree, "a degree above the limit");
    host.design->lowerBounds = NULL;
    expect(des_RunSimplexCentroidDesign(host.design) == des_ErrorNullPointer, "a missing array");
    expect(des_RunSimplexCentroidDesign(NULL) == des_ErrorNullPointer, "a missing record");
    des_DeleteMixtureDesignContainer(&host.design);
    des_DeleteMixtureDesignContainer(&host.design);
    des_DeleteMixtureDesignContainer(NULL);
}

static void catalogOfFractions(void) {
    uint32_t count = 0;
    const des_FractionalFactorial* entries = des_FractionalFactorialCatalog(&count);
    expect(entries != NULL && count > 0, "the catalog has entries");
    for (uint32_t i = 0; i < count; ++i) {
        expect(entries[i].numRuns > 0 && (entries[i].numRuns & (entries[i].numRuns - 1)) == 0, "a power of two runs");
        expect(entries[i].generators != NULL && entries[i].blockGenerators != NULL, "words, if only an empty text");
    }
    expect(des_FractionalFactorialCatalog(NULL) == entries, "the count need not be asked for");
}

int main(void) {
    catalogOfFractions();
    centroidWithAxialPoints();
    latticeWithTotalAndProcessVariables();
    errors();
    return failures;
}
