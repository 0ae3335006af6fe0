#!/usr/bin/env bash
# Measures how many lines of the library the tests reach; fails below 95 %.
#
#   scripts/coverage.sh
. "$(dirname "${BASH_SOURCE[0]}")/common.sh"

step 'Looking for the needed packages'
scripts/install-deps.sh build test coverage
configure coverage
build coverage
# Counts of earlier runs would be added to.
find build/coverage -name '*.gcda' -delete
run_tests coverage
step 'Line coverage of vorl/'
gcovr --root . --object-directory build/coverage --filter 'vorl/' build/coverage \
  --print-summary --fail-under-line 95
