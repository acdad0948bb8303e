#!/usr/bin/env bash
# The Microsoft ABI check: compiles every library source, the viewer and the tests to objects
# with clang-cl for 32- and 64-bit Windows as Visual Studio lays classes out, so that the layout
# asserts are evaluated under that ABI, and compares CVelKarvel's virtual table slot by slot with
# the listing in scripts/msabi/CVelKarvel.vftable. Nothing is linked (there is no Microsoft C++
# runtime here). Exits non-zero on any compile error or vtable difference.
# Usage: check-msabi.sh [i686|x86_64]...   (default: both)
#        KARVEL_MSABI_ONLY=REGEX check-msabi.sh   compiles only the sources whose path matches
set -euo pipefail
cd "$(dirname "$0")/.."
clang_cl=${KARVEL_CLANG_CL:-/usr/lib/llvm-14/bin/clang-cl}
out=$PWD/build/msabi
self=$PWD/scripts/check-msabi.sh

# libc++ stands in for Microsoft's C++ library, Wine's headers for its C runtime and Windows
# headers; scripts/msabi sits between them with what Wine's lack.
msabi_flags() {
  local arch_flags=()
  [ "$1" = i686-pc-windows-msvc ] && arch_flags=(/arch:SSE2)
  flags=(--target="$1" "${arch_flags[@]}" -fms-compatibility-version=19.29 /std:c++17 /EHsc /GR
         /permissive- /utf-8 /W4 /DNOMINMAX -D_LIBCPP_NO_VCRUNTIME
         -imsvc /usr/lib/llvm-14/include/c++/v1 -imsvc "$PWD/scripts/msabi"
         -imsvc /usr/include/wine/wine/msvcrt -imsvc /usr/include/wine/wine/windows
         -imsvc "$out/include" "/FI$PWD/scripts/msabi/karvel_msabi_fixups.h" "-I$PWD")
}

# One source for one target; called back through xargs. Prints the log on failure.
if [ "${1:-}" = --compile ]; then
  target=$2 source=$3
  obj="$out/$target/obj/${source//\//_}.obj"
  msabi_flags "$target"
  case $source in
    # The host project includes <karvel/karvel.h> as installed; a one-line stand-in maps it here.
    tests/package/*) flags+=("-I$out/host-include") ;;&
    tests/*) flags+=(/DKARVEL_STATIC "/DKARVEL_SOURCE_DIR=\"$PWD\"" "/DKARVEL_VIEWER_EXE=\"karvel_viewer.exe\""
                    -Itests -Iexamples/viewer -I/usr/src/googletest/googletest/include) ;;
    examples/*) flags+=(-Iexamples/viewer) ;;
    *) flags+=(/DKARVEL_BUILD) ;;
  esac
  if ! "$clang_cl" "${flags[@]}" /c "$source" "/Fo$obj" > "$obj.log" 2>&1; then
    echo "-- $target: $source"
    grep -E 'error|note: expression evaluates' "$obj.log" | head -20
    exit 1
  fi
  exit 0
fi

targets=("$@")
[ ${#targets[@]} -gt 0 ] || targets=(i686 x86_64)
for dep in "$clang_cl" /usr/include/wine/wine/msvcrt /usr/lib/llvm-14/include/c++/v1 \
           /usr/share/mingw-w64/include/GL /usr/src/googletest /usr/include/nlohmann /usr/include/stb; do
  [ -e "$dep" ] || { echo "check-msabi: $dep is missing (clang-14 libwine-dev libc++-14-dev mingw-w64 googletest nlohmann-json3-dev libstb-dev)"; exit 1; }
done

# Third-party headers come one folder each: the rest of /usr/include is the host's C library.
mkdir -p "$out/include"
ln -sfn /usr/share/mingw-w64/include/GL "$out/include/GL"
ln -sfn /usr/include/nlohmann "$out/include/nlohmann"
ln -sfn /usr/include/stb "$out/include/stb"
mkdir -p "$out/host-include/karvel"
echo "#include \"$PWD/karvel.h\"" > "$out/host-include/karvel/karvel.h"

sources=$( (ls model/*.cpp gl/*.cpp convert/*.cpp camera/*.cpp primitives/*.cpp movie/*.cpp \
            examples/viewer/*.cpp; find tests -name '*.cpp') | grep -v '/std_' | grep -E "${KARVEL_MSABI_ONLY:-.}" | sort)
status=0
for arch in "${targets[@]}"; do
  case $arch in
    i686|x86_64) target=$arch-pc-windows-msvc ;;
    *) echo "check-msabi: unknown target $arch"; exit 2 ;;
  esac
  mkdir -p "$out/$target/obj"
  count=$(echo "$sources" | wc -l)
  if echo "$sources" | xargs -P2 -I{} "$self" --compile "$target" {}; then
    echo "$target: $count sources compile under the Microsoft ABI"
  else
    echo "$target: compile errors under the Microsoft ABI (above)"
    status=1
  fi

  # The virtual table as Visual Studio lays it out, slot by slot.
  msabi_flags "$target"
  "$clang_cl" "${flags[@]}" /DKARVEL_BUILD /c gl/vel_karvel.cpp "/Fo$out/$target/vtable.obj" \
    -Xclang -fdump-vtable-layouts 2>&1 |
    awk "/^VFTable indices for 'CVelKarvel'/ { on = 1; print; next } on && /^ *[0-9]+ \\|/ { print; next } { on = 0 }" \
    > "$out/$target/CVelKarvel.vftable"
  if diff -u scripts/msabi/CVelKarvel.vftable "$out/$target/CVelKarvel.vftable"; then
    echo "$target: CVelKarvel's virtual table matches scripts/msabi/CVelKarvel.vftable"
  else
    echo "$target: CVelKarvel's virtual table differs from scripts/msabi/CVelKarvel.vftable (- kept, + now)"
    status=1
  fi
done
exit $status
