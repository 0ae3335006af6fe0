#!/usr/bin/env bash
# Builds the benchmarks in the preset 'release' and runs them.
#
#   scripts/bench.sh [BENCHMARK_ARGUMENT...]     for example --benchmark_filter=opMPR
#
# Or times vorl beside other libraries, which it installs, and prints one table of all works:
#
#   scripts/bench.sh --peers [ROUNDS [BENCHMARK_ARGUMENT...]]     5 rounds unless given
#
# In each round everybody takes a turn at each work, so that what else the machine does meets all
# alike. Files are written to memory where /dev/shm is there.
. "$(dirname "${BASH_SOURCE[0]}")/common.sh"

compare() {
  local rounds="${1:-5}" folder=build/release/bench/peers round
  case "$rounds" in
    '' | *[!0-9]* | 0) fail "'$rounds' is no number of rounds" ;;
  esac
  step 'Looking for the needed packages'
  scripts/install-deps.sh build test peers
  configure release -DVORL_BUILD_PEERS=ON
  build release vorl_peers
  if [ -d /dev/shm ] && [ -w /dev/shm ]; then
    export TMPDIR=/dev/shm
  fi
  rm -f "$folder"/round*.json
  for ((round = 1; round <= rounds; ++round)); do
    step "Round $round of $rounds"
    "$folder/vorl_peers" --benchmark_min_time=0.1 "${@:2}" \
      --benchmark_out="$folder/round$round.json" >"$folder/round$round.txt"
  done
  step 'Medians of all rounds, in millions of samples or pixels per second'
  python3 bench/peers/report.py "$folder"/round*.json
}

if [ "${1:-}" = --peers ]; then
  compare "${@:2}"
  exit
fi

step 'Looking for the needed packages'
scripts/install-deps.sh build test
configure release
build release vorl_bench
step 'Running the benchmarks'
build/release/bench/vorl_bench "$@"
