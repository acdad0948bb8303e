#!/usr/bin/env bash
# Builds the three presets and runs every test: the include-direction check, the portable tests
# natively under ASan and UBSan, the DLLs' imports and exports, a host project built against the
# installed package and through add_subdirectory, the reference check, the fuzz targets for a fixed
# number of inputs, the Windows tests under 64-bit Wine on a virtual X display, the 32-bit Windows
# tests under 32-bit Wine where the machine can run them, and the Microsoft-ABI check. Prints the
# time of each stage. Exits non-zero on any failure.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/setup.sh
karvel_require_packages "${KARVEL_BUILD_PACKAGES[@]}"

stage_start=$SECONDS
stage() {
  [ -n "${stage_name:-}" ] && echo "   ($stage_name: $((SECONDS - stage_start)) s)"
  stage_name=$1 stage_start=$SECONDS
  [ -n "$1" ] && echo "== $1"
  return 0
}

stage "include direction"
scripts/check-layers.sh

for preset in native mingw64 mingw32; do
  stage "build $preset"
  cmake --preset "$preset" >/dev/null
  cmake --build --preset "$preset" -j "$(karvel_jobs)"
done

stage "32-bit DLL imports"
scripts/check-imports.sh i686-w64-mingw32-objdump build/mingw32/bin/karvel.dll

stage "DLL exports"
scripts/check-exports.sh x86_64-w64-mingw32-objdump build/mingw64/bin/karvel.dll
scripts/check-exports.sh i686-w64-mingw32-objdump build/mingw32/bin/karvel.dll

stage "host projects: find_package against the installed tree, and add_subdirectory"
for preset in mingw64 mingw32; do
  scripts/check-package.sh "$preset"
done

status=0
stage "reference: every public class and operation documented"
scripts/docs.sh --check || status=1

stage "native tests"
ctest --preset native || status=1

# Every fuzz target for a fixed number of inputs from seed 1, about 30 s in all.
stage "fuzz targets"
scripts/fuzz.sh --runs 20000 || status=1

stage "Windows tests under Wine"
karvel_wine_env "$PWD/build/mingw64"
xvfb-run -a -s "-screen 0 1280x1024x24" ctest --preset mingw64 || status=1

stage "host programs under Wine"
for host in build/mingw64/host-installed/bin/host.exe build/mingw64/host-subdirectory/bin/host.exe; do
  if xvfb-run -a -s "-screen 0 1280x1024x24" wine "$host"; then
    echo "$host: ok"
  else
    echo "$host: failed with exit code $?"
    status=1
  fi
done
wineserver -k 2>/dev/null || true

stage "32-bit Windows tests under 32-bit Wine"
rc=0
scripts/test32.sh || rc=$?
[ $rc -eq 0 ] || [ $rc -eq 3 ] || status=1  # 3: cannot run here, and it said why

stage "Microsoft-ABI check"
scripts/check-msabi.sh || status=1
stage ""
exit $status
