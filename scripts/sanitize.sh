#!/usr/bin/env bash
# Runs every test under AddressSanitizer and UndefinedBehaviorSanitizer, and those that start
# threads under ThreadSanitizer.
#
#   scripts/sanitize.sh [asan|tsan]     without an argument: both
. "$(dirname "${BASH_SOURCE[0]}")/common.sh"

# The library starts one kind of thread, an operator's own, and shares only the log between threads.
thread_tests='OpBase|Thread|Log'

[ $# -gt 0 ] || set -- asan tsan

# The sanitizers of GCC 12 cannot place their shadow memory where the kernel randomises addresses
# by more bits than they know of. Without randomisation it always fits. A container may forbid the
# call; then the kernel's setting has to do.
if [ -z "${VORL_FIXED_ADDRESSES:-}" ] && setarch "$(uname -m)" -R true 2>/dev/null; then
  VORL_FIXED_ADDRESSES=1 exec setarch "$(uname -m)" -R "$BASH" "$PWD/scripts/sanitize.sh" "$@"
fi

step 'Looking for the needed packages'
scripts/install-deps.sh build test
for preset in "$@"; do
  case "$preset" in
    asan)
      configure asan
      build asan
      run_tests asan
      ;;
    tsan)
      configure tsan
      build tsan vorl_tests
      run_tests tsan -R "$thread_tests"
      ;;
    *) fail "unknown sanitizer '$preset' (asan, tsan)" ;;
  esac
done
step 'The sanitizers found nothing'
