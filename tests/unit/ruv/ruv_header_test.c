/* The sampler's header is one for C: this unit is compiled as C99 and called by the tests. */
#include "ruv/ruv.h"

double firstNumberInC(double seed);

double firstNumberInC(double seed) {
    int32_t status = ruv_StatusNoMemory;
    double value = -1.0;
    ruv_ISampler* sampler = ruv_MakeISampler(&status, ruv_KindMersenneTwister64, seed);
    if (status == ruv_StatusOk) ruv_GetUniformSample(sampler, &value, 1, 0.0, 1.0);
    ruv_DeleteISampler(&sampler);
    return sampler == 0 ? value : -2.0;
}
