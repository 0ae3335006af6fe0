#!/usr/bin/env bash
# Static analysis of the library and the applications by .clang-tidy; takes minutes.
#
#   scripts/check-tidy.sh [REGEX]     only sources whose path matches
. "$(dirname "${BASH_SOURCE[0]}")/common.sh"

step 'Looking for the needed packages'
scripts/install-deps.sh build test tidy
configure debug
step 'Static analysis'
run-clang-tidy -p build/debug -j "$jobs" -quiet "${1:-$PWD/(vorl|apps)/.*\\.cpp\$}"
step 'No findings'
