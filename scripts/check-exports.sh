#!/usr/bin/env bash
# Fails unless the names that a karvel.dll exports belong to exactly the classes listed in
# scripts/exports.txt: the exported classes and nothing internal. Every exported symbol (member,
# virtual table, type information) is reduced to the class or function that owns it.
# Usage: check-exports.sh OBJDUMP DLL...
set -euo pipefail
objdump=$1
shift
expected="$(dirname "$0")/exports.txt"
status=0
for dll in "$@"; do
  actual=$("$objdump" -p "$dll" |
    sed -n '/^\[Ordinal\/Name Pointer\] Table/,/^$/s/^[[:space:]]*\[[[:space:]]*[0-9]*\][[:space:]]*//p' |
    c++filt |
    sed -E 's/^(vtable|typeinfo|typeinfo name|VTT|construction vtable) for //; s/^(non-)?virtual thunk to //' |
    sed -E 's/[<(].*$//; s/::.*$//' | sort -u)
  if ! diff -u <(grep -v '^#' "$expected" | sort -u) <(echo "$actual") > /tmp/karvel-exports.$$; then
    echo "$(basename "$dll") ($dll) exports differ from $expected (- expected, + exported):"
    tail -n +3 /tmp/karvel-exports.$$ | grep '^[-+]'
    status=1
  else
    echo "$(basename "$dll") exports the $(echo "$actual" | wc -l) expected classes"
  fi
  rm -f /tmp/karvel-exports.$$
done
exit $status
