# Installs the tool and the library, moves both, and runs the tool. See CMakeLists.txt for what is
# passed in.
cmake_minimum_required(VERSION 3.20)

file(REMOVE_RECURSE ${SCRATCH_DIR})
foreach(component vorl_Runtime vorl_Tools)
  execute_process(COMMAND ${CMAKE_COMMAND} --install ${BUILD_DIR} --config ${CONFIG}
    --prefix ${SCRATCH_DIR}/staging --component ${component} RESULT_VARIABLE result)
  if(NOT result EQUAL 0)
    message(FATAL_ERROR "the installation of ${component} failed (${result})")
  endif()
endforeach()
file(RENAME ${SCRATCH_DIR}/staging ${SCRATCH_DIR}/prefix)
execute_process(COMMAND ${SCRATCH_DIR}/prefix/${TOOL} --help RESULT_VARIABLE result)
if(NOT result EQUAL 0)
  message(FATAL_ERROR "the installed tool ended with ${result}")
endif()
