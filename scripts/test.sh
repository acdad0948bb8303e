#!/usr/bin/env bash
# Builds the three presets and runs every test: the portable tests natively under ASan and
# UBSan, then the Windows tests under Wine on a virtual X display, then a host project built
# against the installed package and through add_subdirectory. Exits non-zero on any failure.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/setup.sh
karvel_require_packages "${KARVEL_BUILD_PACKAGES[@]}"

echo "== include direction"
scripts/check-layers.sh

for preset in native mingw64 mingw32; do
  echo "== build $preset"
  cmake --preset "$preset" >/dev/null
  cmake --build --preset "$preset" -j "$(karvel_jobs)"
done

echo "== 32-bit DLL imports"
scripts/check-imports.sh i686-w64-mingw32-objdump build/mingw32/bin/karvel.dll

echo "== DLL exports"
scripts/check-exports.sh x86_64-w64-mingw32-objdump build/mingw64/bin/karvel.dll
scripts/check-exports.sh i686-w64-mingw32-objdump build/mingw32/bin/karvel.dll

echo "== host projects: find_package against the installed tree, and add_subdirectory"
for preset in mingw64 mingw32; do
  scripts/check-package.sh "$preset"
done

status=0
echo "== reference: every public class and operation documented"
scripts/docs.sh --check || status=1

echo "== native tests"
ctest --preset native || status=1

echo "== Windows tests under Wine"
karvel_wine_env "$PWD/build/mingw64"
xvfb-run -a -s "-screen 0 1280x1024x24" ctest --preset mingw64 || status=1

echo "== host programs under Wine"
for host in build/mingw64/host-installed/bin/host.exe build/mingw64/host-subdirectory/bin/host.exe; do
  if xvfb-run -a -s "-screen 0 1280x1024x24" wine "$host"; then
    echo "$host: ok"
  else
    echo "$host: failed with exit code $?"
    status=1
  fi
done
wineserver -k 2>/dev/null || true
exit $status
