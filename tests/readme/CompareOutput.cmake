# Runs PROGRAM, under EMULATOR if there is one, and compares what it prints with the block behind
# "example output" in README.
cmake_minimum_required(VERSION 3.20)
include(${CMAKE_CURRENT_LIST_DIR}/ExtractBlock.cmake)
extract_block("${README}" "example output" expected)
execute_process(COMMAND ${EMULATOR} ${PROGRAM} OUTPUT_VARIABLE printed RESULT_VARIABLE result)
string(REPLACE "\r\n" "\n" printed "${printed}")
if(NOT result EQUAL 0)
  message(FATAL_ERROR "the example ended with ${result}, having printed:\n${printed}")
endif()
if(NOT printed STREQUAL expected)
  message(FATAL_ERROR "the example printed:\n${printed}README.md says:\n${expected}")
endif()
