#include <span>

#include "catalog/ff_design_catalog.h"
#include "reisti/reisti.h"

extern "C" const des_FractionalFactorial* des_FractionalFactorialCatalog(std::uint32_t* count) {
    const std::span<const des_FractionalFactorial> rows = reisti::catalogRows();
    if (count != nullptr) *count = static_cast<std::uint32_t>(rows.size());
    return rows.data();
}
