#!/usr/bin/env bash
# Runs every benchmark and prints its figures: the portable ones natively (optimised build),
# the Windows-tier ones under Wine on a virtual display. Benchmarks report; they never fail.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/setup.sh
karvel_require_packages "${KARVEL_BUILD_PACKAGES[@]}"

cmake --preset bench >/dev/null
cmake --build --preset bench -j "$(karvel_jobs)"
for program in build/bench/bin/*_bench; do
  [ -x "$program" ] || continue
  echo "== $(basename "$program")"
  "$program"
done

cmake --preset mingw64 >/dev/null
cmake --build --preset mingw64 -j "$(karvel_jobs)"
karvel_wine_env "$PWD/build/mingw64"
for program in build/mingw64/bin/*_bench.exe; do
  [ -f "$program" ] || continue
  echo "== $(basename "$program") (under Wine)"
  xvfb-run -a -s "-screen 0 1280x1024x24" wine "$program"
done
wineserver -k 2>/dev/null || true
