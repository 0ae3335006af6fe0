#!/usr/bin/env bash
# Runs a program for Windows, with the compiler's DLLs within its reach.
#
#   scripts/run-windows.sh PROGRAM [ARGUMENT...]
#
# VORL_WINE names the program that runs it, WINEPREFIX the folder with its drives and settings.
set -euo pipefail
project="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"

wine="${VORL_WINE:-}"
for candidate in wine64 /usr/lib/wine/wine64 wine; do
  [ -n "$wine" ] || wine="$(command -v "$candidate" || true)"
done
[ -n "$wine" ] || {
  echo 'error: there is no Wine here (scripts/install-deps.sh windows)' >&2
  exit 1
}

compiler=x86_64-w64-mingw32-g++-posix
folders=
for library in libstdc++-6.dll libwinpthread-1.dll; do
  folders+="Z:$(dirname "$("$compiler" -print-file-name="$library")" | tr / '\\');"
done

export WINEPREFIX="${WINEPREFIX:-$project/build/windows-deps/wine}"
export WINEDEBUG="${WINEDEBUG:--all}"
export WINEPATH="$folders${WINEPATH:-}"

# Wine leaves processes of its own behind, which hold on to the output of the program that started
# them; whoever reads that output to its end would wait for them. So they get a file instead.
output="$(mktemp -d)"
trap 'rm -rf "$output"' EXIT
result=0
"$wine" "$@" >"$output/out" 2>"$output/err" || result=$?
cat "$output/out"
cat "$output/err" >&2
exit "$result"
