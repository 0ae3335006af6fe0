#!/usr/bin/env bash
# Installs what is missing, builds everything and runs every test, here and for Windows.
#
#   scripts/test.sh
. "$(dirname "${BASH_SOURCE[0]}")/common.sh"

step 'Looking for the needed packages'
scripts/install-deps.sh build test
configure release
build release
run_tests release
scripts/test-windows.sh
step 'All tests passed'
