# Runs PROGRAM in FOLDER, under EMULATOR if there is one, and compares what it prints with the comment
# at the end of SOURCE, behind the line "// Prints:".
cmake_minimum_required(VERSION 3.20)
file(READ ${SOURCE} text)
string(FIND "${text}" "\n// Prints:\n" start REVERSE)
if(start EQUAL -1)
  message(FATAL_ERROR "${SOURCE} does not say what it prints")
endif()
string(SUBSTRING "${text}" ${start} -1 expected)
string(REPLACE "\n// Prints:\n" "\n" expected "${expected}")
string(REGEX REPLACE "\n//   ?" "\n" expected "${expected}")
string(SUBSTRING "${expected}" 1 -1 expected)

file(REMOVE_RECURSE ${FOLDER})
file(MAKE_DIRECTORY ${FOLDER})
execute_process(COMMAND ${EMULATOR} ${PROGRAM} WORKING_DIRECTORY ${FOLDER}
  OUTPUT_VARIABLE printed RESULT_VARIABLE result)
string(REPLACE "\r\n" "\n" printed "${printed}")
if(NOT result EQUAL 0)
  message(FATAL_ERROR "the example ended with ${result}, having printed:\n${printed}")
endif()
if(printed STREQUAL "" OR NOT printed STREQUAL expected)
  message(FATAL_ERROR "the example printed:\n${printed}its source says:\n${expected}")
endif()
