#include "capi/guard.h"
#include "dsd/construction.h"
#include "reisti/reisti.h"

extern "C" std::uint32_t des_FindDefinitiveScreeningDesignRowCount(std::int32_t numFactors, std::int32_t* error,
                                                                   std::uint8_t hasCategorical,
                                                                   std::uint32_t replicates) {
    return reisti::findRowCount(numFactors, error, hasCategorical != 0, replicates);
}

extern "C" std::int32_t des_CreateDefinitiveScreeningDesign(des_DefinitiveScreeningDesign* design) {
    if (design == nullptr) return des_ErrorNullPointer;
    return reisti::guard([design] { return reisti::createDesign(*design); });
}
