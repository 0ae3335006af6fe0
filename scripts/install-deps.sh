#!/usr/bin/env bash
# Installs the packages that the project needs and this machine lacks (Debian and relatives).
#
#   scripts/install-deps.sh [GROUP...]     groups: build test check tidy coverage windows peers;
#                                          without any: all but peers
#
# Asks the package database first: when nothing is missing, nothing is downloaded and no rights are
# needed. Without apt-get, or without the right to use it, prints what is needed and what for, and
# fails only when there is no CMake or no C++ compiler to go on with.
set -euo pipefail

# group  package            what it is for
packages='
build    ca-certificates    secure downloads
build    cmake              the build system, 3.20 or newer
build    g++                the compiler; any C++20 compiler will do
build    ninja-build        runs the build
build    fonts-dejavu-core  the fonts that texts are drawn with
build    libcli11-dev       the command line of the tool
build    libdcmtk-dev       reads DICOM series
build    libfontconfig-dev  finds fonts
build    libfreetype-dev    draws glyphs
build    libpixman-1-dev    clip regions
build    libpng-dev         writes pictures
build    pkg-config         finds the libraries that the graphics device uses
test     libbenchmark-dev   the benchmarks
test     libgmock-dev       the tests
test     libgtest-dev       the tests
test     python3            the test of a report
check    clang-format       the format check; version 14 decides
tidy     clang-tidy         static analysis
coverage gcovr              the line coverage report
windows  dpkg-dev           unpacks the sources of what the target lacks
windows  g++-mingw-w64-x86-64-posix  the compiler for Windows
windows  googletest         the sources of GoogleTest
windows  libz-mingw-w64-dev  zlib for Windows
windows  wine64             runs programs for Windows
peers    libopencv-dev      a library that the benchmarks compare with
peers    libvtk9-dev        a library that the benchmarks compare with
peers    libyuv-dev         a library that the benchmarks compare with
'

die() {
  printf 'error: %s\n' "$*" >&2
  exit 1
}

for group in "$@"; do
  case "$group" in
    build | test | check | tidy | coverage | windows | peers) ;;
    *) die "unknown group '$group' (build, test, check, tidy, coverage, windows, peers)" ;;
  esac
done

# wanted GROUP GROUP...: is the first among the others? Without others, everything is but the
# libraries to compare with: they are large, and nothing else needs them.
wanted() {
  local group="$1" choice
  shift
  if [ $# -eq 0 ]; then
    [ "$group" != peers ]
    return
  fi
  for choice in "$@"; do
    [ "$choice" = "$group" ] && return 0
  done
  return 1
}

is_installed() {
  local state
  state="$(dpkg-query --show --showformat='${db:Status-Status}' "$1" 2>/dev/null)" || return 1
  [ "$state" = installed ]
}

# Prints the table of what is needed and ends the script: with success as long as the tools are
# here without which nothing can be built.
print_and_end() {
  printf '%s\nPlease install these packages (Debian names), or what corresponds to them:\n\n' "$1"
  while read -r group package purpose; do
    if [ -n "$group" ] && wanted "$group" "${@:2}"; then
      printf '  %-18s %s\n' "$package" "$purpose"
    fi
  done <<<"$packages"
  printf '\n'
  command -v cmake >/dev/null || die 'cmake is missing'
  command -v "${CXX:-c++}" >/dev/null || command -v g++ >/dev/null ||
    command -v clang++ >/dev/null || die 'a C++ compiler is missing'
  echo 'CMake and a compiler are here: going on.'
  exit 0
}

if ! command -v apt-get >/dev/null || ! command -v dpkg-query >/dev/null; then
  print_and_end 'There is no apt-get on this machine.' "$@"
fi

missing=()
while read -r group package _; do
  if [ -n "$group" ] && wanted "$group" "$@" && ! is_installed "$package"; then
    missing+=("$package")
  fi
done <<<"$packages"

if [ ${#missing[@]} -eq 0 ]; then
  echo 'All needed packages are installed.'
  exit 0
fi

as_root=()
if [ "$(id -u)" -ne 0 ]; then
  command -v sudo >/dev/null ||
    print_and_end "Missing: ${missing[*]}. Only root can install them, and there is no sudo." "$@"
  as_root=(sudo)
fi

echo "Installing: ${missing[*]}"
"${as_root[@]}" apt-get update
"${as_root[@]}" env DEBIAN_FRONTEND=noninteractive \
  apt-get install -y --no-install-recommends "${missing[@]}"
