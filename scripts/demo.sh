#!/usr/bin/env bash
# Cuts a volume along four planes, draws a sheet of it, and saves the pictures.
#
#   scripts/demo.sh             the built-in phantom
#   scripts/demo.sh FOLDER      a folder with a DICOM series
#
# Installs what is missing and builds first. VORL_DEMO_WINDOW chooses the window: bone, soft, lung
# or auto (default).
caller_dir="$PWD"
. "$(dirname "${BASH_SOURCE[0]}")/common.sh"

[ $# -le 1 ] || fail 'at most one argument: the folder with the series'
if [ $# -eq 1 ]; then
  input="$(cd "$caller_dir" && realpath -- "$1")"
  [ -d "$input" ] || fail "'$1' is not a folder"
else
  input=--phantom
fi
window="${VORL_DEMO_WINDOW:-auto}"
output="$PWD/demo-output"

step 'Looking for the needed packages'
scripts/install-deps.sh build test
configure release
build release vorl_cli
tool=build/release/apps/cli/vorl

step 'The volume'
"$tool" info "$input"
mkdir -p "$output"
for plane in axial coronal sagittal oblique; do
  step "Plane: $plane"
  "$tool" mpr "$input" --plane "$plane" --window "$window" -o "$output/$plane.png"
done

step 'The sheet'
"$tool" render "$input" --window "$window" -o "$output/sheet.png"

step 'Done. The pictures:'
for picture in axial coronal sagittal oblique sheet; do
  [ -s "$output/$picture.png" ] || fail "$output/$picture.png was not written"
  printf '  %s\n' "$output/$picture.png"
done
