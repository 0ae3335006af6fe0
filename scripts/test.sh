#!/usr/bin/env bash
# Installs what is missing, builds everything and runs every test, here and for Windows.
#
#   scripts/test.sh
. "$(dirname "${BASH_SOURCE[0]}")/common.sh"

step 'Looking for the needed packages'
scripts/install-deps.sh build test windows
# The libraries for Windows are tried out more than they are built, one attempt after the other:
# that costs next to nothing beside a build that keeps every processor busy.
mkdir -p build
log=build/windows-libraries.log
scripts/windows-libraries.sh >"$log" 2>&1 &
libraries=$!
trap 'kill "$libraries" 2>/dev/null || true' EXIT
configure release
build release
step 'Waiting for the libraries for Windows'
wait "$libraries" || {
  tail -n 30 "$log" >&2
  fail "the libraries for Windows can't be built; see $log"
}
trap - EXIT
run_tests release
scripts/test-windows.sh
step 'All tests passed'
