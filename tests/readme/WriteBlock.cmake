# Writes the block behind MARKER in README to OUTPUT.
cmake_minimum_required(VERSION 3.20)
include(${CMAKE_CURRENT_LIST_DIR}/ExtractBlock.cmake)
extract_block("${README}" "${MARKER}" block)
file(WRITE "${OUTPUT}" "${block}")
