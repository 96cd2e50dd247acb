#!/bin/sh
# Builds the static 32-bit Windows libraries the cross build links, Xerces-C from Debian's
# source package and GoogleTest from /usr/src/googletest, into PREFIX (default
# .cache/win32/prefix). Each is built once; a later call finds it there and does nothing.
set -eu
cd "$(dirname "$0")/.."
root=$PWD
prefix=${1:-$root/.cache/win32/prefix}
work=$(dirname "$prefix")/work
toolchain=$root/cmake/toolchain-i686-mingw.cmake
jobs=$(nproc 2>/dev/null || echo 2)

# Their compiler warnings are not ours: the output is kept in LOG and shown on failure.
quiet() {  # log, command...
  log=$1
  shift
  "$@" >>"$log" 2>&1 || { tail -n 40 "$log" >&2; return 1; }
}

configure() {  # source dir, build dir, options...
  src=$1 build=$2
  shift 2
  quiet "$build.log" cmake -S "$src" -B "$build" -DCMAKE_TOOLCHAIN_FILE="$toolchain" \
    -DCMAKE_BUILD_TYPE=Release -DCMAKE_INSTALL_PREFIX="$prefix" "$@"
}

if [ ! -f "$prefix/.xerces-c" ]; then
  echo "== Xerces-C for i686-w64-mingw32"
  rm -rf "$work/xerces-c"
  mkdir -p "$work/xerces-c"
  (cd "$work/xerces-c" && quiet source.log apt-get source -q xerces-c)
  src=$(find "$work/xerces-c" -mindepth 1 -maxdepth 1 -type d -name 'xerces-c-3.2*')
  # Only the library: the samples and tests include <Windows.h>, which a case-sensitive
  # file system does not have, and the documentation is not in the source package.
  configure "$src" "$work/xerces-c/build" -DBUILD_SHARED_LIBS=OFF -Dtranscoder=windows \
    -Dnetwork=OFF -Dxmlch-type=char16_t
  quiet "$work/xerces-c/build.log" cmake --build "$work/xerces-c/build" -j "$jobs" --target xerces-c
  quiet "$work/xerces-c/build.log" cmake --install "$work/xerces-c/build/src"
  touch "$prefix/.xerces-c"
fi

if [ ! -f "$prefix/.googletest" ]; then
  echo "== GoogleTest for i686-w64-mingw32"
  rm -rf "$work/googletest" "$work/googletest.log"
  configure /usr/src/googletest "$work/googletest" -DBUILD_SHARED_LIBS=OFF
  quiet "$work/googletest.log" cmake --build "$work/googletest" -j "$jobs"
  quiet "$work/googletest.log" cmake --install "$work/googletest"
  touch "$prefix/.googletest"
fi
