# Builds one consumer and runs it. See CMakeLists.txt for what is passed in.
cmake_minimum_required(VERSION 3.20)
include(${SOURCE_DIR}/cmake/VorlHeaders.cmake)

function(run)
  execute_process(COMMAND ${ARGN} RESULT_VARIABLE result)
  if(NOT result EQUAL 0)
    list(JOIN ARGN " " command)
    message(FATAL_ERROR "failed (${result}): ${command}")
  endif()
endfunction()

# Configures the project in `source` and builds it. No optimisation: linking is what counts here.
function(build source build_dir)
  run(${CMAKE_COMMAND} -S ${source} -B ${build_dir} -G ${GENERATOR} -DCMAKE_BUILD_TYPE=Debug
    -DCMAKE_CXX_COMPILER=${CXX_COMPILER} -DCMAKE_CXX_COMPILER_LAUNCHER=${LAUNCHER} ${ARGN})
  run(${CMAKE_COMMAND} --build ${build_dir} --config Debug --parallel 2)
endfunction()

# Exactly the public headers arrive, and nothing internal.
function(check_installed_headers prefix)
  set(PROJECT_SOURCE_DIR ${SOURCE_DIR})
  vorl_public_headers(expected)
  file(GLOB_RECURSE installed RELATIVE ${prefix}/include ${prefix}/include/*)
  list(SORT installed)
  if(NOT installed STREQUAL expected)
    message(FATAL_ERROR "installed headers:\n${installed}\nexpected:\n${expected}")
  endif()
endfunction()

if(WAY STREQUAL "add_subdirectory")
  # The build is kept, so that a second run only looks whether something changed.
  build(${SOURCE_DIR}/tests/consumer/add_subdirectory ${EMBEDDED_BUILD_DIR}
    -DBUILD_SHARED_LIBS=${SHARED} -DVORL_SOURCE_DIR=${SOURCE_DIR})
  run(${EMBEDDED_BUILD_DIR}/consumer)
else()
  if(SHARED STREQUAL MAIN_SHARED)
    set(library_build_dir ${MAIN_BUILD_DIR})
    set(library_config ${CONFIG})
  else()
    set(library_build_dir ${EMBEDDED_BUILD_DIR}/vorl)
    set(library_config Debug)
  endif()
  file(REMOVE_RECURSE ${SCRATCH_DIR})
  foreach(component vorl_Runtime vorl_Development)
    run(${CMAKE_COMMAND} --install ${library_build_dir} --config ${library_config}
      --prefix ${SCRATCH_DIR}/staging --component ${component})
  endforeach()
  # An installation can be moved: no path of the machine that built it may stand in its files.
  file(RENAME ${SCRATCH_DIR}/staging ${SCRATCH_DIR}/prefix)
  check_installed_headers(${SCRATCH_DIR}/prefix)
  build(${SOURCE_DIR}/tests/consumer/find_package ${SCRATCH_DIR}/build
    -DCMAKE_PREFIX_PATH=${SCRATCH_DIR}/prefix -DEXPECTED_VERSION=${VERSION})
  run(${SCRATCH_DIR}/build/consumer)
endif()
