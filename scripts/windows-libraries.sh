#!/usr/bin/env bash
# Builds, once, what the packages of the Windows compiler lack, from the sources of this system's
# own packages, and sets up Wine to run what is built with them.
#
#   scripts/windows-libraries.sh
#
# Everything stays in build/windows-deps.
. "$(dirname "${BASH_SOURCE[0]}")/common.sh"

libraries="$PWD/build/windows-deps"
toolchain="$PWD/cmake/mingw-w64.cmake"
export WINEPREFIX="$libraries/wine" WINEDEBUG=-all

# apt COMMAND...: knows the sources of the packages that this machine gets; its own settings and
# lists stay as they are.
apt() {
  apt-get -q -o Dir::Etc::SourceList="$libraries/apt/sources.list" -o Dir::Etc::SourceParts=/dev/null \
    -o Dir::State::Lists="$libraries/apt/lists" -o Dir::Cache="$libraries/apt/cache" \
    -o APT::Sandbox::User=root "$@"
}

# apt compares every file with the checksum in the signed lists.
get_sources() {
  step 'Fetching the sources of DCMTK and libpng'
  mkdir -p "$libraries"/apt/lists/partial "$libraries"/apt/cache/archives/partial
  apt-get indextargets --format 'deb-src $(SITE) $(RELEASE) $(COMPONENT)' \
    'Created-By: Packages' 'Label: Debian' | sort -u >"$libraries/apt/sources.list"
  apt update
  rm -rf "$libraries/sources"
  mkdir "$libraries/sources"
  (cd "$libraries/sources" && apt source dcmtk libpng1.6 >"$libraries/sources.log" 2>&1) ||
    fail "the sources can't be fetched; see $libraries/sources.log"
}

# build_library NAME SOURCE [CMAKE_ARGUMENT...]
build_library() {
  local name="$1" source="$2"
  shift 2
  if ! { cmake -S "$source" -B "$libraries/build/$name" -G Ninja -DCMAKE_TOOLCHAIN_FILE="$toolchain" \
    -DCMAKE_BUILD_TYPE=Release -DCMAKE_C_FLAGS_RELEASE='-O1 -w' -DCMAKE_CXX_FLAGS_RELEASE='-O1 -w' \
    -DCMAKE_INSTALL_PREFIX="$libraries/prefix" -DBUILD_SHARED_LIBS=OFF "$@" &&
    cmake --build "$libraries/build/$name" --parallel "$jobs" --target install; } \
    >"$libraries/$name.log" 2>&1; then
    tail -n 30 "$libraries/$name.log" >&2
    fail "$name can't be built; see $libraries/$name.log"
  fi
}

# What DCMTK tries out during its configuration runs under Wine. Half of it is compiled in lumps,
# which takes a quarter of the time.
build_dcmtk() {
  local off=() part lumps=()
  for part in TIFF PNG XML OPENSSL ICONV STDLIBC_ICONV ICU SNDFILE WRAP OPENJPEG DOXYGEN; do
    off+=("-DDCMTK_WITH_$part=OFF")
  done
  printf 'set(CMAKE_UNITY_BUILD ON)\nset(CMAKE_UNITY_BUILD_BATCH_SIZE 16)\n' >"$libraries/lumps.cmake"
  for part in ofstd dcmdata dcmimgle dcmimage; do
    lumps+=("-DCMAKE_PROJECT_${part}_INCLUDE=$libraries/lumps.cmake")
  done
  printf '#!/usr/bin/env bash\n"%s/scripts/run-windows.sh" winepath.exe "$@" | tr -d "\\r"\n' \
    "$PWD" >"$libraries/winepath"
  chmod +x "$libraries/winepath"
  build_library dcmtk "$libraries"/sources/dcmtk-*/ \
    -DDCMTK_MODULES='ofstd;oflog;dcmdata;dcmimgle;dcmimage;dcmjpeg;dcmjpls' -DBUILD_APPS=OFF \
    -DDCMTK_USE_FIND_PACKAGE=ON -DDCMTK_WIDE_CHAR_FILE_IO_FUNCTIONS=ON -DDCMTK_ENABLE_CXX11=ON \
    -DDCMTK_DEFAULT_DICT=builtin -DCMAKE_INSTALL_DATADIC=share -DCMAKE_EXE_LINKER_FLAGS=-static \
    -DWINE_WINE_PROGRAM="$PWD/scripts/run-windows.sh" -DWINE_WINEPATH_PROGRAM="$libraries/winepath" \
    -DWINE_CPP_RUNTIME=none -DDCMTK_WINEPREFIX="$WINEPREFIX" "${off[@]}" "${lumps[@]}"
}

step 'Looking for the needed packages'
scripts/install-deps.sh build test windows
mkdir -p "$libraries"
if [ ! -d "$WINEPREFIX/drive_c" ]; then
  step 'Setting up Wine'
  scripts/run-windows.sh wineboot.exe -i >"$libraries/wine.log" 2>&1 ||
    fail "Wine does not start; see $libraries/wine.log"
fi
if [ ! -e "$libraries/complete" ]; then
  get_sources
  step 'Building libpng and GoogleTest for Windows'
  mkdir -p "$libraries"/prefix/include "$libraries"/prefix/share/cmake
  cp -r /usr/include/CLI "$libraries/prefix/include/"  # CLI11 is headers alone
  cp -r /usr/share/cmake/CLI11 "$libraries/prefix/share/cmake/"
  build_library libpng "$libraries"/sources/libpng1.6-*/ -DPNG_SHARED=OFF -DPNG_TESTS=OFF
  build_library googletest /usr/src/googletest
  step 'Building DCMTK for Windows'
  build_dcmtk
  touch "$libraries/complete"
fi
