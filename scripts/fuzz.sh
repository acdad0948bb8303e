#!/usr/bin/env bash
# Builds the fuzz targets (the fuzz preset: clang 14, libFuzzer, ASan and UBSan) and runs each one
# from its checked-in seeds in tests/fuzz/corpus.
# Usage: scripts/fuzz.sh [SECONDS]   each target for SECONDS (default 60); what it finds new is
#                                    kept in build/fuzz/corpus/TARGET for the next run
#        scripts/fuzz.sh --runs N    each target for N inputs from seed 1, from the seeds alone
#                                    (the fixed stage of scripts/test.sh)
# A finding stops the run: its input is left in build/fuzz/findings and the script exits non-zero.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/setup.sh
karvel_require_packages cmake make clang-14 libclang-rt-14-dev nlohmann-json3-dev libstb-dev

limit=(-max_total_time="${1:-60}")
fresh=0
if [ "${1:-}" = "--runs" ]; then
  limit=(-runs="${2:?--runs needs a count}" -seed=1)
  fresh=1
fi

export CCACHE_BASEDIR="$PWD"
launcher=()
command -v ccache >/dev/null && launcher=(-DCMAKE_CXX_COMPILER_LAUNCHER=ccache -DCMAKE_C_COMPILER_LAUNCHER=ccache)
cmake --preset fuzz "${launcher[@]}" >/dev/null
cmake --build --preset fuzz -j "$(karvel_jobs)"

mkdir -p build/fuzz/findings
status=0
for target in shape scene; do
  corpus=build/fuzz/corpus/$target
  # A deterministic run starts from the seeds alone, not from what earlier runs found.
  [ $fresh -eq 1 ] && rm -rf "$corpus"
  mkdir -p "$corpus"
  start=$SECONDS
  if build/fuzz/bin/fuzz_$target "$corpus" "tests/fuzz/corpus/$target" "${limit[@]}" -max_len=4096 -timeout=10 \
       -artifact_prefix=build/fuzz/findings/$target- -print_final_stats=1 >build/fuzz/$target.log 2>&1; then
    echo "fuzz_$target: $(grep -o 'stat::number_of_executed_units: *[0-9]*' build/fuzz/$target.log | grep -o '[0-9]*$') inputs in $((SECONDS - start)) s, no finding"
  else
    echo "fuzz_$target: FINDING (build/fuzz/$target.log):"
    grep -E 'runtime error|ERROR|broken' build/fuzz/$target.log | head -5
    status=1
  fi
done
exit $status
