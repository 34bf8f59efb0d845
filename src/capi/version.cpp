#include "capi/version.h"

#include "reisti/reisti.h"

extern "C" const char* des_Version() {
    return REISTI_VERSION_STRING;
}
