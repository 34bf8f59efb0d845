#include <algorithm>

#include "capi/error_table.h"
#include "reisti/reisti.h"

extern "C" const char* des_ErrorMessage(std::int32_t code) {
    const auto* entry = std::ranges::find(reisti::ERROR_TABLE, code, &reisti::ErrorEntry::code);
    return entry != reisti::ERROR_TABLE.end() ? entry->text : "Unknown error code.";
}
