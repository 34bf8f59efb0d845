# An outside sampler library: a header ruv/ruv.h and a library named ruv with the four functions declared there.
find_path(RUV_INCLUDE_DIR ruv/ruv.h REQUIRED)
find_library(RUV_LIBRARY ruv REQUIRED)
add_library(ruv UNKNOWN IMPORTED GLOBAL)
set_target_properties(ruv PROPERTIES
  IMPORTED_LOCATION "${RUV_LIBRARY}"
  INTERFACE_INCLUDE_DIRECTORIES "${RUV_INCLUDE_DIR}")
