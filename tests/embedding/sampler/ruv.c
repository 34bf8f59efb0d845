/* A sampler library of somebody else's: its sequences are not those of ruv/. */
#include <ruv/ruv.h>
#include <stdlib.h>

struct ruv_ISampler {
    uint64_t state;
};

double ruv_Seeder(void) {
    static uint32_t calls = 0;
    return ++calls;
}

ruv_ISampler* ruv_MakeISampler(int32_t* status, int32_t kind, double seed) {
    ruv_ISampler* sampler = kind == ruv_KindMersenneTwister64 ? malloc(sizeof *sampler) : NULL;
    if (sampler != NULL) sampler->state = (uint64_t)seed;
    if (status != NULL) {
        *status = sampler != NULL                     ? ruv_StatusOk
                  : kind != ruv_KindMersenneTwister64 ? ruv_StatusUnknownKind
                                                      : ruv_StatusNoMemory;
    }
    return sampler;
}

void ruv_GetUniformSample(ruv_ISampler* sampler, double* values, uint32_t count, double lower, double upper) {
    for (uint32_t i = 0; sampler != NULL && i < count; ++i) {
        /* Multiplier and increment of Knuth's MMIX generator. */
        sampler->state = sampler->state * 6364136223846793005U + 1442695040888963407U;
        values[i] = lower + (upper - lower) * ((double)(sampler->state >> 11) * 0x1p-53);
    }
}

void ruv_DeleteISampler(ruv_ISampler** sampler) {
    if (sampler == NULL) return;
    free(*sampler);
    *sampler = NULL;
}
