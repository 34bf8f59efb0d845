# reisti_flags travels with every target: the language level and what keeps results and messages the same everywhere.
add_library(reisti_flags INTERFACE)
target_compile_features(reisti_flags INTERFACE cxx_std_20 c_std_99)
target_compile_options(reisti_flags INTERFACE
  # A fused multiply-add rounds once instead of twice: designs would depend on the processor.
  -ffp-contract=off
  # Assertion texts read src/matrix/... in every build folder.
  -fmacro-prefix-map=${PROJECT_SOURCE_DIR}/=)

# reisti_warnings serves developers only; it is never exported.
add_library(reisti_warnings INTERFACE)
if(REISTI_DEVELOPER OR REISTI_BUILD_FUZZERS)
  target_compile_options(reisti_warnings INTERFACE
    -Wall -Wextra -Wpedantic -Werror -Wshadow
    $<$<COMPILE_LANGUAGE:CXX>:-Wconversion -Wsign-conversion -Wnon-virtual-dtor -Wold-style-cast>)
endif()
