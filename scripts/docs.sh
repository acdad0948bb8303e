#!/usr/bin/env bash
# Builds the reference of the public headers (docs/Doxyfile) as HTML into build/docs/html.
# With --check it writes no HTML and fails on any Doxygen warning (an undocumented public class
# or operation, a broken reference), as scripts/test.sh runs it.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/setup.sh
karvel_require_packages doxygen

if [ "${1:-}" = "--check" ]; then
  out=$(mktemp -d)
  trap 'rm -rf "$out"' EXIT
  # NOTE: Doxygen refuses a run without any output format, so the check writes throwaway XML.
  ( cat docs/Doxyfile
    echo "OUTPUT_DIRECTORY = $out"
    echo "GENERATE_HTML = NO"
    echo "GENERATE_XML = YES"
    echo "XML_PROGRAMLISTING = NO" ) | doxygen -
  echo "reference: no warnings"
else
  mkdir -p build/docs
  doxygen docs/Doxyfile
  echo "reference: build/docs/html/index.html"
fi
