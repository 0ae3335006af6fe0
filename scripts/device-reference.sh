#!/usr/bin/env bash
# Draws the device scenes with the system's own device and stores what it prints as the expected
# output of the tests: builds the scenes for Windows with MinGW and runs them under Wine, twice.
# Scenes whose lines differ between the two runs are reported and left out.
#
#   scripts/device-reference.sh        MINGW_CXX, WINE and WINEPREFIX may be set
. "$(dirname "${BASH_SOURCE[0]}")/common.sh"

folder=tests/device
work="$(mktemp -d)"
trap 'rm -rf "$work"' EXIT
cxx="${MINGW_CXX:-x86_64-w64-mingw32-g++}"
wine="${WINE:-}"
for candidate in wine64 /usr/lib/wine/wine64 wine; do
  [ -n "$wine" ] || ! command -v "$candidate" >/dev/null || wine="$candidate"
done
[ -n "$wine" ] || fail 'Wine is missing (wine64)'
export WINEPREFIX="${WINEPREFIX:-$work/prefix}" WINEDEBUG=-all

step 'Building the scenes for Windows'
"$cxx" -std=c++20 -O1 -static "$folder"/*.cpp -o "$work/scenes.exe" -lgdi32 -luser32

step 'Drawing them twice'
for run in one two; do
  "$wine" "$work/scenes.exe" 2>/dev/null | tr -d '\r' >"$work/$run"
done
if ! cmp -s "$work/one" "$work/two"; then
  echo 'Different in the two runs, left out:'
  diff "$work/one" "$work/two" || true
fi
awk 'NR == FNR { seen[$0] = 1; next } ($0 in seen)' "$work/two" "$work/one" >"$work/both"
[ -s "$work/both" ] || fail 'nothing was drawn'

rm -f "$folder"/expected/*.txt
mkdir -p "$folder/expected"
awk -F/ -v folder="$folder/expected" '{ print > (folder "/" $1 ".txt") }' "$work/both"
step "$(wc -l <"$work/both") scenes stored in $folder/expected"
