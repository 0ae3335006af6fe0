# shellcheck shell=bash
# Sourced by the scripts beside it: where the project is, step headings with the time that has
# passed, and configure-build-test of one preset.

set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/.."

# Scripts that call each other share one clock.
export VORL_SCRIPT_START="${VORL_SCRIPT_START:-$(date +%s)}"
jobs="$(nproc 2>/dev/null || echo 2)"

step() {
  local seconds=$(($(date +%s) - VORL_SCRIPT_START))
  printf '\n==> [%02d:%02d] %s\n' $((seconds / 60)) $((seconds % 60)) "$*"
}

fail() {
  printf 'error: %s\n' "$*" >&2
  exit 1
}

# configure PRESET [CMAKE_ARGUMENT...]
configure() {
  step "Configuring the preset '$1'"
  cmake --preset "$@"
}

# build PRESET [TARGET...]: everything, or only these targets.
build() {
  local preset="$1"
  shift
  step "Building the preset '$preset'${*:+ ($*)} with $jobs jobs"
  cmake --build --preset "$preset" --parallel "$jobs" ${1:+--target "$@"}
}

# run_tests PRESET [CTEST_ARGUMENT...]
run_tests() {
  step "Testing the preset '$1'"
  ctest --parallel "$jobs" --preset "$@"
}
