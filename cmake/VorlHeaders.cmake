# Which headers are public: everything under vorl/ but the folders that are internal by name.
# The install rules, the header checks and the umbrella check all ask here, so they cannot differ.

# Sets `out` to the public headers, as paths relative to the project: vorl/Common/dStatus.h ...
# Runs in a configuration and in a script, which has to set PROJECT_SOURCE_DIR.
function(vorl_public_headers out)
  # A script has no build system that could look for new files before each build.
  if(CMAKE_SCRIPT_MODE_FILE)
    set(watch "")
  else()
    set(watch CONFIGURE_DEPENDS)
  endif()
  file(GLOB_RECURSE headers ${watch} RELATIVE "${PROJECT_SOURCE_DIR}"
    "${PROJECT_SOURCE_DIR}/vorl/*.h")
  list(FILTER headers EXCLUDE REGEX "/(detail|kernels|soft)/")
  list(SORT headers)
  set(${out} "${headers}" PARENT_SCOPE)
endfunction()
