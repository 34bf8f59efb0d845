/* A host in plain C: the public header compiles as C99 and a design is built with nothing else. */
#include <reisti/reisti.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

static int failures = 0;

static void check(int holds, const char* what) {
    if (!holds) {
        fprintf(stderr, "failed: %s\n", what);
        ++failures;
    }
}

#define CHECK(condition) check((condition), #condition)

static void countsRuns(void) {
    int32_t error = 1;
    CHECK(des_FindDefinitiveScreeningDesignRowCount(5, &error, 0, 1) == 13);
    CHECK(error == des_Success);
    CHECK(des_FindDefinitiveScreeningDesignRowCount(5, &error, 1, 0) == 14);
    CHECK(des_FindDefinitiveScreeningDesignRowCount(49, &error, 0, 1) == 0);
    CHECK(error == des_ErrorNumFactors);
    CHECK(des_FindDefinitiveScreeningDesignRowCount(5, NULL, 0, 1) == 13);
}

static void buildsADesignInAutomaticArrays(void) {
    int32_t levels[13][4];
    des_DefinitiveScreeningRun runs[13];
    des_DefinitiveScreeningDesign design = {.numFactors = 4, .replicates = 1, .numBlocks = 1, .runs = runs};
    int i;
    for (i = 0; i < 13; ++i)
        runs[i].levels = levels[i];
    CHECK(des_CreateDefinitiveScreeningDesign(&design) == des_Success);
    CHECK(levels[0][0] == 0 && levels[0][1] == 1 && levels[0][2] == 1 && levels[0][3] == 1);
    CHECK(levels[1][0] == 0 && levels[1][1] == -1 && levels[1][2] == -1 && levels[1][3] == -1);
    CHECK(levels[12][0] == 0 && levels[12][1] == 0 && levels[12][2] == 0 && levels[12][3] == 0);
    for (i = 0; i < 13; ++i)
        CHECK(runs[i].runOrder == (uint32_t)i + 1 && runs[i].block == 1);
    CHECK(runs[0].pointType == des_ScreeningPointOneZero);
    CHECK(runs[8].pointType == des_ScreeningPointNoZero);
    CHECK(runs[12].pointType == des_ScreeningPointCenter);
}

static void buildsARandomizedDesignWithCategoricalFactors(void) {
    const uint32_t categorical[2] = {1, 3};
    des_DefinitiveScreeningDesign design;
    int32_t error = 1;
    uint32_t total, i, seen = 0;
    memset(&design, 0, sizeof design);
    design.numFactors = 6;
    design.numCategorical = 2;
    design.replicates = 2;
    design.numBlocks = 2;
    design.randomize = 1;
    design.seed = 2024.0;
    design.categoricalFactors = categorical;
    total = des_FindDefinitiveScreeningDesignRowCount((int32_t)design.numFactors, &error, 1, design.replicates);
    CHECK(error == des_Success && total == 28);
    design.runs = malloc(total * sizeof *design.runs);
    for (i = 0; i < total; ++i)
        design.runs[i].levels = malloc(design.numFactors * sizeof(int32_t));
    CHECK(des_CreateDefinitiveScreeningDesign(&design) == des_Success);
    for (i = 0; i < total; ++i) {
        CHECK(design.runs[i].levels[1] != 0 && design.runs[i].levels[3] != 0);
        CHECK(design.runs[i].block == 1 + i / 14);
        CHECK(design.runs[i].runOrder >= 1 && design.runs[i].runOrder <= total);
        seen |= UINT32_C(1) << (design.runs[i].runOrder - 1);
        free(design.runs[i].levels);
    }
    CHECK(seen == (UINT32_C(1) << 28) - 1);
    free(design.runs);
}

static void reportsErrorsInWords(void) {
    CHECK(des_CreateDefinitiveScreeningDesign(NULL) == des_ErrorNullPointer);
    CHECK(strlen(des_ErrorMessage(des_ErrorNullPointer)) > 0);
    CHECK(strlen(des_ErrorMessage(-1)) > 0);
    CHECK(strlen(des_Version()) > 0);
}

int main(void) {
    countsRuns();
    buildsADesignInAutomaticArrays();
    buildsARandomizedDesignWithCategoricalFactors();
    reportsErrorsInWords();
    if (failures == 0) puts("all checks passed");
    return failures == 0 ? EXIT_SUCCESS : EXIT_FAILURE;
}
