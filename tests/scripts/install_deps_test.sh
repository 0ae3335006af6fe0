#!/usr/bin/env bash
# One case of the tests of install-deps.sh: install_deps_test.sh CASE SCRIPT
#
# The script runs with a PATH that holds nothing but stand-ins: dpkg-query knows the packages listed
# in `installed`, apt-get and sudo write down how they were called.
set -u

script="$2"
machine="$(mktemp -d)"
trap 'rm -rf "$machine"' EXIT
mkdir "$machine/bin"
: >"$machine/installed"
: >"$machine/calls"

# stand_in NAME BODY
stand_in() {
  printf '#!%s\n%s\n' "$BASH" "$2" >"$machine/bin/$1"
  chmod +x "$machine/bin/$1"
}

is_debian() {
  ln -s "$(command -v env)" "$machine/bin/env"
  stand_in dpkg-query "while read -r p; do
    [ \"\$p\" = \"\${@: -1}\" ] && printf installed && exit 0
  done <'$machine/installed'; exit 1"
  stand_in apt-get "echo \"apt-get \$*\" >>'$machine/calls'"
}

user_is() {
  stand_in id "echo $1"
}

has_tools() {
  stand_in cmake ''
  stand_in c++ ''
}

install_deps() {
  output="$(PATH="$machine/bin" CXX='' "$BASH" "$script" "$@" 2>&1 </dev/null)"
  result=$?
  calls="$(cat "$machine/calls")"
}

expect() { # WHAT ACTUAL EXPECTED
  if [ "$2" != "$3" ]; then
    printf '%s is:\n%s\nexpected:\n%s\noutput was:\n%s\n' "$1" "$2" "$3" "$output" >&2
    exit 1
  fi
}

expect_output_contains() {
  case "$output" in
    *"$1"*) ;;
    *) expect "output" "$output" "... $1 ..." ;;
  esac
}

build_packages='ca-certificates cmake g++ ninja-build fonts-dejavu-core libcli11-dev libdcmtk-dev'
build_packages+=' libfontconfig-dev libfreetype-dev libpixman-1-dev libpng-dev pkg-config'
test_packages='libbenchmark-dev libgmock-dev libgtest-dev python3'
windows_packages='dpkg-dev g++-mingw-w64-x86-64-posix googletest libz-mingw-w64-dev wine64'
install='apt-get install -y --no-install-recommends'

NothingMissingTouchesNothing() {
  is_debian
  user_is 1000
  printf '%s\n' $build_packages $test_packages clang-format clang-tidy gcovr $windows_packages >"$machine/installed"
  install_deps
  expect result "$result" 0
  expect calls "$calls" ''
}

MissingPackagesAreInstalledInOneGo() {
  is_debian
  user_is 0
  printf '%s\n' $build_packages $test_packages >"$machine/installed"
  install_deps
  expect result "$result" 0
  expect calls "$calls" "apt-get update
$install clang-format clang-tidy gcovr $windows_packages"
}

GroupsLimitWhatIsInstalled() {
  is_debian
  user_is 0
  install_deps build test
  expect result "$result" 0
  expect calls "$calls" "apt-get update
$install $build_packages $test_packages"
}

LibrariesToCompareWithAreInstalledOnRequest() {
  is_debian
  user_is 0
  install_deps peers
  expect result "$result" 0
  expect calls "$calls" "apt-get update
$install libopencv-dev libvtk9-dev libyuv-dev"
}

AnotherUserInstallsThroughSudo() {
  is_debian
  user_is 1000
  stand_in sudo "echo sudo >>'$machine/calls'; \"\$@\""
  install_deps check
  expect result "$result" 0
  expect calls "$calls" "sudo
apt-get update
sudo
$install clang-format"
}

FailedInstallationFails() {
  is_debian
  user_is 0
  stand_in apt-get '[ "$1" = update ] || exit 100'
  install_deps
  expect result "$result" 100
}

WithoutAptTheListIsPrinted() {
  has_tools
  install_deps
  expect result "$result" 0
  for package in $build_packages $test_packages clang-format clang-tidy gcovr $windows_packages; do
    expect_output_contains "  $package "
  done
  expect_output_contains 'reads DICOM series'
}

WithoutAptAndCompilerItFails() {
  stand_in cmake ''
  install_deps
  expect result "$result" 1
  expect_output_contains 'error: a C++ compiler is missing'
  stand_in c++ ''
  rm "$machine/bin/cmake"
  install_deps
  expect result "$result" 1
  expect_output_contains 'error: cmake is missing'
}

WithoutSudoTheListIsPrinted() {
  is_debian
  has_tools
  user_is 1000
  install_deps check
  expect result "$result" 0
  expect calls "$calls" ''
  expect_output_contains 'Missing: clang-format. Only root can install them'
}

UnknownGroupIsRefused() {
  is_debian
  user_is 0
  install_deps build tests
  expect result "$result" 1
  expect calls "$calls" ''
  expect_output_contains "error: unknown group 'tests'"
}

"$1"
