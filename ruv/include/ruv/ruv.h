/**
 * @file ruv.h
 * @brief Uniform random samples from a seed that is a double.
 *
 * A small C library of its own: another one with these four functions can be linked in its place. A sampler belongs to
 * one thread at a time; different samplers and ruv_Seeder() may be used from several threads at once.
 */
#ifndef RUV_RUV_H
#define RUV_RUV_H

#include <stdint.h>

#ifdef __cplusplus
extern "C" {
#endif

/** A sampler: a generator and its position in the sequence. */
typedef struct ruv_ISampler ruv_ISampler;

/** Values of the status word that ruv_MakeISampler() writes. */
enum {
    ruv_StatusOk = 0,
    /** The generator kind is not known; no sampler was made. */
    ruv_StatusUnknownKind = 1,
    /** There was no memory; no sampler was made. */
    ruv_StatusNoMemory = 2
};

/** Generator kinds. */
enum {
    /** The 64-bit Mersenne Twister of Matsumoto and Nishimura (2000). */
    ruv_KindMersenneTwister64 = 10
};

/** @brief A seed that differs from call to call and from process to process. Never 0.0, never NaN. */
double ruv_Seeder(void);

/**
 * @brief Makes a sampler.
 * @param[out] status receives one of the ruv_Status... values; may be null
 * @param kind        ruv_KindMersenneTwister64
 * @param seed        any double: the sequence depends on its bit pattern, NaN included
 * @return a sampler to be freed with ruv_DeleteISampler(), or null as the status tells
 */
ruv_ISampler* ruv_MakeISampler(int32_t* status, int32_t kind, double seed);

/**
 * @brief Fills an array with the next numbers of a sampler.
 * @param sampler from ruv_MakeISampler(); null leaves the array as it is
 * @param[out] values [count]
 * @param count   how many
 * @param lower   lower bound, included
 * @param upper   upper bound, excluded; each number carries 53 random bits before it is scaled to the bounds
 */
void ruv_GetUniformSample(ruv_ISampler* sampler, double* values, uint32_t count, double lower, double upper);

/** @brief Frees a sampler and sets the caller's pointer to null. Null, or a pointer to null, is accepted. */
void ruv_DeleteISampler(ruv_ISampler** sampler);

#ifdef __cplusplus
}
#endif

#endif
