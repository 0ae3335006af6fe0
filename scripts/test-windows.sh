#!/usr/bin/env bash
# Builds everything for Windows, against the system's own headers and its graphics device, and runs
# the tests under Wine.
#
#   scripts/test-windows.sh
. "$(dirname "${BASH_SOURCE[0]}")/common.sh"

export WINEPREFIX="$PWD/build/windows-deps/wine" WINEDEBUG=-all

scripts/windows-libraries.sh
configure windows
build windows
# Wine finds the DLL of the library as Windows would find it in PATH.
folder="$PWD/build/windows/vorl"
export WINEPATH="Z:${folder//\//\\}"
run_tests windows
step 'All tests passed under Wine'
