#!/usr/bin/env bash
# The sample house, rendered by the library: on a fresh Debian machine this installs what is
# missing, builds karvel.dll and the sample viewer for 64-bit Windows, and runs the viewer in
# batch mode under Wine on a virtual display. It writes out/house.png and out/house-orbit.avi.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/setup.sh
karvel_require_packages cmake make mingw-w64 wine wine64 xvfb xauth libosmesa6 nlohmann-json3-dev libstb-dev

# A build tree of its own, without tests or benchmarks, so that the presets stay as they are.
build=build/demo
cmake -S . -B "$build" -DCMAKE_TOOLCHAIN_FILE=cmake/mingw64.cmake -DCMAKE_BUILD_TYPE=Release \
      -DKARVEL_BUILD_TESTS=OFF -DKARVEL_BUILD_BENCH=OFF >/dev/null
cmake --build "$build" --target karvel_viewer -j "$(karvel_jobs)"

karvel_wine_env "$PWD/$build"
mkdir -p out
viewer() { xvfb-run -a -s "-screen 0 1280x1024x24" wine "$build/bin/karvel_viewer.exe" "$@"; }
viewer examples/scenes/house.json --size 800x600 --snapshot out/house.png
viewer examples/scenes/house.json --size 480x360 --movie out/house-orbit.avi --frames 60 --fps 20
wineserver -k 2>/dev/null || true

echo
echo "Picture: $PWD/out/house.png"
echo "Movie:   $PWD/out/house-orbit.avi"
