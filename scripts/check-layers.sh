#!/usr/bin/env bash
# Fails on an #include that points up the layers, or on a Windows header in a portable file.
#   model/ <- convert/, camera/, primitives/, movie/ <- gl/ <- examples/
# movie/ sits beside convert/ and camera/: it uses model/ only.
# Usage: check-layers.sh [SOURCE_DIR]
set -euo pipefail
cd "${1:-$(dirname "$0")/..}"

# The folders of ours that each folder may include.
declare -A allowed=(
  [model]="model"
  [convert]="model convert"
  [camera]="model camera"
  [primitives]="model primitives"
  [movie]="model movie"
  [gl]="model convert camera primitives gl"
  [examples]="model convert camera primitives movie gl examples"
)
# Known exceptions, one "file:included" a line.
exceptions=(
  # The one header that names Windows handle types, through windows.h on Windows only.
  "model/platform.h:windows.h"
  # The umbrella header takes the recorders on Windows only.
  "karvel.h:movie/vfw_math_movie.h"
  # The native side-by-side benchmark calls the build machine's GLU tessellator.
  "bench/triangulation_glu_bench.cpp:GL/glu.h"
  # Built for Windows only, as the host program it stands for.
  "tests/dll/dll_import_test.cpp:movie/vfw_math_movie.h"
)
windows_tier='^(win32|wgl|gl|gdi|vfw)_'
windows_headers='^(windows\.h|winuser\.h|wingdi\.h|windowsx\.h|mmsystem\.h|vfw\.h|commctrl\.h|GL/.*)$'

exceptions_text=$(printf '%s\n' "${exceptions[@]}")
allowed_text=$(for folder in "${!allowed[@]}"; do echo "$folder ${allowed[$folder]}"; done)

# One pass of awk over every #include line of the sources: FILENAME, then the included path.
find model convert camera primitives movie gl examples tests bench \( -name '*.h' -o -name '*.cpp' \) -print |
  { cat; ls karvel.h 2>/dev/null || true; } | sort |
  xargs awk -v exceptions="$exceptions_text" -v allowed="$allowed_text" \
            -v tier="$windows_tier" -v wheaders="$windows_headers" '
    BEGIN {
      n = split(exceptions, lines, "\n")
      for (i = 1; i <= n; i++) excepted[lines[i]] = 1
      n = split(allowed, lines, "\n")
      for (i = 1; i <= n; i++) {
        m = split(lines[i], words, " ")
        layered[words[1]] = 1
        for (j = 2; j <= m; j++) may[words[1] "/" words[j]] = 1
      }
    }
    /^[ \t]*#[ \t]*include[ \t]*[<"]/ {
      included = $0
      sub(/^[^<"]*[<"]/, "", included)
      sub(/[>"].*$/, "", included)
      if ((FILENAME ":" included) in excepted) next
      folder = FILENAME; if (!sub(/\/.*$/, "", folder)) folder = ""
      name = FILENAME; sub(/^.*\//, "", name)
      target = included; sub(/^(\.\.\/)+/, "", target)
      target_folder = target; if (!sub(/\/.*$/, "", target_folder)) target_folder = ""
      target_name = target; sub(/^.*\//, "", target_name)
      if (name !~ tier && (included ~ wheaders || (target_folder != "" && target_name ~ tier))) {
        print FILENAME ": portable file includes the Windows header " included; bad = 1
      }
      if ((folder in layered) && (target_folder in layered) && !((folder "/" target_folder) in may)) {
        print FILENAME ": " folder "/ must not include " included " (layers point down only)"; bad = 1
      }
    }
    END { exit bad }' || exit 1
echo "include direction: ok"
