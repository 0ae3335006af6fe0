#!/usr/bin/env bash
# Installs what is missing, builds everything and runs every test.
#
#   scripts/test.sh
. "$(dirname "${BASH_SOURCE[0]}")/common.sh"

step 'Looking for the needed packages'
scripts/install-deps.sh build test
configure release
build release
run_tests release
step 'All tests passed'
