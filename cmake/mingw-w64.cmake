# Builds for 64-bit Windows with the compiler that Debian calls g++-mingw-w64-x86-64-posix.
set(CMAKE_SYSTEM_NAME Windows)
set(CMAKE_SYSTEM_PROCESSOR x86_64)

set(CMAKE_C_COMPILER x86_64-w64-mingw32-gcc-posix)
set(CMAKE_CXX_COMPILER x86_64-w64-mingw32-g++-posix)
set(CMAKE_RC_COMPILER x86_64-w64-mingw32-windres)

# Libraries and headers are the target's, programs that run during the build are this machine's.
# scripts/windows-libraries.sh puts what the target lacks into the first folder.
get_filename_component(vorl_windows_libraries
  ${CMAKE_CURRENT_LIST_DIR}/../build/windows-deps/prefix ABSOLUTE)
set(CMAKE_FIND_ROOT_PATH ${vorl_windows_libraries} /usr/x86_64-w64-mingw32)
set(CMAKE_FIND_ROOT_PATH_MODE_PROGRAM NEVER)
set(CMAKE_FIND_ROOT_PATH_MODE_LIBRARY ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_INCLUDE ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_PACKAGE ONLY)

# Beside the archive stands the import library of a DLL that nobody needs to carry along.
set(ZLIB_LIBRARY /usr/x86_64-w64-mingw32/lib/libz.a CACHE FILEPATH "zlib")

# What is built here runs under Wine.
get_filename_component(CMAKE_CROSSCOMPILING_EMULATOR
  ${CMAKE_CURRENT_LIST_DIR}/../scripts/run-windows.sh ABSOLUTE)
