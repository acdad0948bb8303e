#!/usr/bin/env bash
# Fails unless every DLL that the given Windows binaries import is a system DLL (or karvel.dll).
# Usage: check-imports.sh OBJDUMP BINARY...
set -euo pipefail
objdump=$1
shift
allowed='^(karvel|kernel32|user32|gdi32|opengl32|glu32|avifil32|msvfw32|winmm|msvcrt|advapi32|shell32|comdlg32|ole32|oleaut32|api-ms-win-.*)\.dll$'
status=0
for binary in "$@"; do
  imports=$("$objdump" -p "$binary" | sed -n 's/^\s*DLL Name: //p' | tr 'A-Z' 'a-z')
  for dll in $imports; do
    if [[ ! $dll =~ $allowed ]]; then
      echo "$(basename "$binary") imports $dll, which is not a system DLL"
      status=1
    fi
  done
  echo "$(basename "$binary") imports:" $imports
done
exit $status
