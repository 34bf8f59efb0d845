#ifndef REISTI_CAPI_ERROR_TABLE_H
#define REISTI_CAPI_ERROR_TABLE_H

#include <array>
#include <cstdint>

#include "reisti/reisti.h"

namespace reisti {

struct ErrorEntry {
    std::int32_t code;
    const char* name;
    const char* text;
};

#define REISTI_ERROR(code, text) \
    ErrorEntry {                 \
        code, #code, text        \
    }

/// Every code of des_ErrorCode with the sentence that des_ErrorMessage gives for it, in ascending order.
inline constexpr std::array ERROR_TABLE = {
    REISTI_ERROR(des_Success, "Success."),
    REISTI_ERROR(des_ErrorNumFactors, "A definitive screening design needs 2 to 48 factors."),
    REISTI_ERROR(des_ErrorTooManyReplicates,
                 "The number of replicates gives more runs than can be counted in 32 bits."),
    REISTI_ERROR(des_ErrorTooManyCategorical, "There are more categorical factors than factors."),
    REISTI_ERROR(des_ErrorCategoricalIndex, "The index of a categorical factor is not below the number of factors."),
    REISTI_ERROR(des_ErrorBlocks, "The number of blocks does not divide the number of replicates."),
    REISTI_ERROR(des_ErrorNullRuns, "The array of runs is missing."),
    REISTI_ERROR(des_ErrorNullLevels, "The array of levels of the first run is missing."),
    REISTI_ERROR(des_ErrorLowerBoundSum, "The lower bounds of the components sum to the total or more."),
    REISTI_ERROR(des_ErrorUpperBoundSum, "The upper bounds of the components sum to the total or less."),
    REISTI_ERROR(des_ErrorUpperBound, "An upper bound is above the total."),
    REISTI_ERROR(des_ErrorEmptyRange, "The lower and upper bound of a component leave no range between them."),
    REISTI_ERROR(des_ErrorNotSimplex, "The bounds do not leave a simplex; use an extreme vertices design."),
    REISTI_ERROR(des_ErrorProcessFraction,
                 "The process fraction is not available for this number of process variables."),
    REISTI_ERROR(des_ErrorAmountsAndProcess, "Several mixture amounts cannot be combined with process variables."),
    REISTI_ERROR(des_ErrorDegree, "The degree is not allowed for this number of components."),
    REISTI_ERROR(des_ErrorTooManyPoints, "The region has more design points than the limit allows."),
    REISTI_ERROR(des_ErrorOutOfMemory, "Out of memory, or more runs than can be counted in 32 bits."),
    REISTI_ERROR(des_ErrorNullPointer, "A required pointer is null."),
    REISTI_ERROR(des_ErrorNotANumber, "A value that has to be a finite number is not."),
};

#undef REISTI_ERROR

}  // namespace reisti

#endif
