#include "random/random_numbers.h"

#include <memory>
#include <new>

#include "ruv/ruv.h"

namespace reisti {

namespace {

struct SamplerDeleter {
    void operator()(ruv_ISampler* sampler) const { ruv_DeleteISampler(&sampler); }
};

}  // namespace

ruv_ISampler* constructActualRandomNumberGenerator(double seed) {
    if (seed == 0.0) seed = ruv_Seeder();
    std::int32_t status = 0;
    return ruv_MakeISampler(&status, ruv_KindMersenneTwister64, seed);
}

void generateRandomNumbers(std::uint32_t count, double seed, std::vector<double>& out) {
    out.resize(count);
    const std::unique_ptr<ruv_ISampler, SamplerDeleter> sampler(constructActualRandomNumberGenerator(seed));
    // The kind is always a known one, so only missing memory leaves us without a sampler.
    if (sampler == nullptr) throw std::bad_alloc();
    ruv_GetUniformSample(sampler.get(), out.data(), count, 0.0, 1.0);
}

}  // namespace reisti
