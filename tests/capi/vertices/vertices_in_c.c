/* A host in plain C: extreme vertices designs built and read through the public header alone. Prints what is wrong and
 * returns it. */
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

static double absolute(double x) {
    return x < 0 ? -x : x;
}

/* The arrays of a host with up to four components. */
typedef struct Host {
    double lower[4], upper[4], scaledLower[4], scaledUpper[4], pseudoLower[4], pseudoUpper[4];
    uint32_t pointsPerType[4], boundaryCounts[4];
    des_MixtureDesign* design;
} Host;

static void begin(Host* host, uint32_t numComponents, const double* lower, const double* upper) {
    memset(host, 0, sizeof *host);
    memcpy(host->lower, lower, numComponents * sizeof *lower);
    memcpy(host->upper, upper, numComponents * sizeof *upper);
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

static void end(Host* host) {
    des_DeleteMixtureDesignContainer(&host->design);
    expect(host->design == NULL, "deleting sets the pointer to null");
}

static int isMixture(const des_MixtureRun* run, uint32_t numComponents, const Host* host) {
    double sum = 0.0;
    for (uint32_t j = 0; j < numComponents; ++j) {
        const double x = run->proportions[j];
        if (x < host->lower[j] - 1e-12 || x > host->upper[j] + 1e-12) return 0;
        sum += x;
    }
    return absolute(sum - 1.0) <= 1e-12;
}

/* The flare of McLean and Anderson: 8 vertices, 12 edges, 6 faces, the overall centroid. */
static void boundsAlone(void) {
    const double lower[] = {0.4, 0.1, 0.1, 0.03};
    const double upper[] = {0.6, 0.5, 0.5, 0.08};
    Host host;
    begin(&host, 4, lower, upper);
    expect(des_RunExtremeVerticesDesign(host.design, 4, 0, 0, NULL, 0) == des_Success, "the flare is built");
    expect(host.design->numRuns == 27, "8 + 12 + 6 + 1 runs");
    expect(host.pointsPerType[0] == 8 && host.pointsPerType[1] == 12 && host.pointsPerType[2] == 6, "faces by type");
    expect(host.design->numCenterPoints == 1, "one overall centroid");
    expect(host.design->boundsAdjusted == 1, "0.5 is out of reach");
    expect(absolute(host.upper[1] - 0.47) < 1e-12, "0.47 is not");
    for (uint32_t i = 0; i < host.design->numRuns; ++i)
        expect(isMixture(&host.design->runs[i], 4, &host), "every run is a mixture within the bounds");
    end(&host);
}

static void constraintsWithStatus(void) {
    const double lower[] = {0, 0, 0};
    const double upper[] = {1, 1, 1};
    const double first[] = {1, 0, 0};
    const double second[] = {0, 1, 0};
    des_MixtureDesignLinearConstraint constraints[3];
    Host host;
    memset(constraints, 0, sizeof constraints);
    constraints[0].hasLowerValue = 1;
    constraints[0].lowerValue = 0.25;
    constraints[0].hasUpperValue = 1;
    constraints[0].upperValue = 0.5;
    constraints[0].coefficients = first;
    constraints[1].upperValue = 2.0;
    constraints[1].coefficients = second;
    constraints[2].hasLowerValue = 1;
    constraints[2].lowerValue = -1.0;
    constraints[2].coefficients = second;
    begin(&host, 3, lower, upper);
    host.design->axialPoints = 1;
    expect(des_RunExtremeVerticesDesign(host.design, 1, 1, 3, constraints, 100) == des_Success, "the strip is built");
    expect(constraints[0].status == 0, "both sides of the first cut");
    expect(constraints[1].status == 2, "the upper side of the second does not");
    expect(constraints[2].status == 1, "the lower side of the third does not");
    expect(host.design->numRuns == 9, "4 vertices, the centre, 4 axial points");
    expect(host.design->runs[4].pointType == des_MixturePointCentroid, "the centre follows the vertices");
    expect(host.design->runs[8].pointType == des_MixturePointAxial, "axial points come last");
    expect(host.lower[0] == 0.25 && host.upper[0] == 0.5, "the bounds are those implied");
    end(&host);
}

static void refusals(void) {
    const double lower[] = {0, 0, 0};
    const double upper[] = {1, 1, 1};
    Host host;
    begin(&host, 3, lower, upper);
    expect(des_RunExtremeVerticesDesign(NULL, 1, 0, 0, NULL, 0) == des_ErrorNullPointer, "no record");
    expect(des_RunExtremeVerticesDesign(host.design, 4, 0, 0, NULL, 0) == des_ErrorDegree, "degree above q");
    expect(des_RunExtremeVerticesDesign(host.design, -1, 0, 0, NULL, 0) == des_ErrorDegree, "negative degree");
    expect(des_RunExtremeVerticesDesign(host.design, 1, 0, 1, NULL, 0) == des_ErrorNullPointer, "no constraints");
    expect(des_RunExtremeVerticesDesign(host.design, 2, 0, 0, NULL, 3) == des_ErrorTooManyPoints, "no room for edges");
    expect(host.design->runs == NULL && host.design->numRuns == 0, "a refused run leaves no runs");
    end(&host);
}

int main(void) {
    boundsAlone();
    constraintsWithStatus();
    refusals();
    return failures;
}
