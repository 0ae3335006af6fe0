#!/usr/bin/env bash
# Builds the benchmarks in the preset 'release' and runs them.
#
#   scripts/bench.sh [BENCHMARK_ARGUMENT...]     for example --benchmark_filter=opMPR
. "$(dirname "${BASH_SOURCE[0]}")/common.sh"

step 'Looking for the needed packages'
scripts/install-deps.sh build test
configure release
build release vorl_bench
step 'Running the benchmarks'
build/release/bench/vorl_bench "$@"
