#!/usr/bin/env bash
# Fails where a tracked source is not formatted as .clang-format says.
#
#   scripts/check-format.sh          check
#   scripts/check-format.sh --fix    format in place
. "$(dirname "${BASH_SOURCE[0]}")/common.sh"

# Other versions format some constructs differently; 14 is the one that decides.
formatter="$(command -v clang-format-14 || command -v clang-format)" ||
  fail 'clang-format is missing (scripts/install-deps.sh check)'
case "$("$formatter" --version)" in
  *' version 14.'*) ;;
  *) echo "warning: $("$formatter" --version) is not version 14" >&2 ;;
esac

case "${1:-}" in
  '') mode=(--dry-run -Werror) ;;
  --fix) mode=(-i) ;;
  *) fail "unknown argument '$1'" ;;
esac

# A clone may belong to another user than the one who checks it.
list="$(git -c safe.directory="$PWD" ls-files --cached --others --exclude-standard '*.h' '*.cpp')"
mapfile -t sources <<<"$list"
[ -n "$list" ] || fail 'no sources found'
step "Format of ${#sources[@]} sources"
"$formatter" "${mode[@]}" "${sources[@]}"
