# An outside sampler library: a header ruv/ruv.h and a library named ruv with the four functions declared there. Makes the
# target ruv::ruv. Installed with a static library that needs it.
find_path(RUV_INCLUDE_DIR ruv/ruv.h)
find_library(RUV_LIBRARY ruv)
include(FindPackageHandleStandardArgs)
find_package_handle_standard_args(ruv REQUIRED_VARS RUV_LIBRARY RUV_INCLUDE_DIR)
if(ruv_FOUND AND NOT TARGET ruv::ruv)
  add_library(ruv::ruv UNKNOWN IMPORTED GLOBAL)
  set_target_properties(ruv::ruv PROPERTIES
    IMPORTED_LOCATION "${RUV_LIBRARY}"
    INTERFACE_INCLUDE_DIRECTORIES "${RUV_INCLUDE_DIR}")
endif()
mark_as_advanced(RUV_INCLUDE_DIR RUV_LIBRARY)
