# Compiler settings shared by the library, its applications and its tests.
include(GNUInstallDirs)

add_library(vorl_options INTERFACE)
target_compile_features(vorl_options INTERFACE cxx_std_20)
target_compile_options(vorl_options INTERFACE
  -Wall -Wextra -Wpedantic -Wshadow -Wconversion
  $<$<BOOL:${VORL_WARNINGS_AS_ERRORS}>:-Werror>
  # Every build gives the same bits: no fused multiply-add behind two written roundings.
  -ffp-contract=off
  # Log records and diagnostics name sources relative to the project.
  -fmacro-prefix-map=${PROJECT_SOURCE_DIR}/=)

if(VORL_SANITIZE)
  target_compile_options(vorl_options INTERFACE
    -fsanitize=${VORL_SANITIZE} -fno-sanitize-recover=all -fno-omit-frame-pointer)
  target_link_options(vorl_options INTERFACE -fsanitize=${VORL_SANITIZE})
endif()

if(VORL_COVERAGE)
  # The library alone is measured (see vorl/CMakeLists.txt); everything is linked with the counters.
  target_link_options(vorl_options INTERFACE --coverage)
endif()
