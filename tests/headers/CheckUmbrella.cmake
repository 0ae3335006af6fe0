# Fails unless vorl/vorl.h includes exactly the public headers.
cmake_minimum_required(VERSION 3.20)
include(${PROJECT_SOURCE_DIR}/cmake/VorlHeaders.cmake)

vorl_public_headers(public)
list(REMOVE_ITEM public vorl/vorl.h)
list(LENGTH public count)
if(count LESS 8)
  message(FATAL_ERROR "found only ${count} public headers: the search itself is broken")
endif()

file(STRINGS ${PROJECT_SOURCE_DIR}/vorl/vorl.h included REGEX "^#include <vorl/")
list(TRANSFORM included REPLACE "^#include <(.*)>.*$" "\\1")

set(missing ${public})
list(REMOVE_ITEM missing ${included})
set(foreign ${included})
list(REMOVE_ITEM foreign ${public})
if(missing OR foreign)
  list(JOIN missing "\n  " missing)
  list(JOIN foreign "\n  " foreign)
  message(FATAL_ERROR "vorl/vorl.h does not match the public headers\n"
    "missing:\n  ${missing}\nnot public, or gone:\n  ${foreign}")
endif()
message(STATUS "vorl/vorl.h includes all ${count} public headers")
