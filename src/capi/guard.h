#ifndef REISTI_CAPI_GUARD_H
#define REISTI_CAPI_GUARD_H

#include <cstdint>

#include "reisti/reisti.h"

namespace reisti {

/// Runs the body of an exported function and turns whatever it throws into an error code: a host in another language
/// cannot catch it. The engines report their own errors as codes, and with checked inputs the matrix package has no
/// reason to throw, so what arrives here is a failed allocation (std::bad_alloc, or the length error of a vector that
/// could never be allocated).
template <typename Body>
std::int32_t guard(Body&& body) noexcept {
    try {
        return body();
    } catch (...) {
        return des_ErrorOutOfMemory;
    }
}

}  // namespace reisti

#endif
