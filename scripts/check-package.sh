#!/usr/bin/env bash
# Installs a built preset and builds the host project in tests/package twice: with
# find_package(karvel) against the installed tree, and with add_subdirectory of this source tree.
# The programs land in build/PRESET/host-installed/bin and build/PRESET/host-subdirectory/bin.
# Usage: check-package.sh PRESET   (mingw64 or mingw32, already built)
set -euo pipefail
cd "$(dirname "$0")/.."
preset=$1
build="$PWD/build/$preset"
jobs=$(nproc 2>/dev/null || echo 2)

rm -rf "$build/install" "$build/host-installed" "$build/host-subdirectory"
cmake --install "$build" --prefix "$build/install" >/dev/null
for dir in bin/karvel.dll lib/libkarvel.dll.a include/karvel/karvel.h lib/cmake/karvel/karvelConfig.cmake \
           lib/cmake/karvel/karvelConfigVersion.cmake; do
  [ -e "$build/install/$dir" ] || { echo "install tree lacks $dir"; exit 1; }
done

common=(-DCMAKE_BUILD_TYPE=Release -DCMAKE_TOOLCHAIN_FILE="$PWD/cmake/$preset.cmake")
# NOTE: the MinGW toolchain files confine package searches to the MinGW sysroot (so that the
# build machine's own packages stay out), which re-roots CMAKE_PREFIX_PATH; karvel_DIR is taken as given.
cmake -S tests/package -B "$build/host-installed" "${common[@]}" -Dkarvel_DIR="$build/install/lib/cmake/karvel" >/dev/null
cmake --build "$build/host-installed" -j "$jobs"
cmake -S tests/package -B "$build/host-subdirectory" "${common[@]}" -DKARVEL_SOURCE_DIR="$PWD" >/dev/null
cmake --build "$build/host-subdirectory" -j "$jobs"
echo "$preset: host built both ways"
