#!/usr/bin/env bash
# Builds the fuzz targets with clang (libFuzzer, AddressSanitizer, UndefinedBehaviorSanitizer)
# and runs each for the given number of seconds (default 30) on a copy of its seed corpus.
#   scripts/fuzz.sh [seconds] [target ...]
set -euo pipefail
cd "$(dirname "$0")/.."
seconds="${1:-30}"
shift || true

scripts/setup.sh
cmake --preset fuzz >/dev/null
cmake --build --preset fuzz

targets=("$@")
if [ ${#targets[@]} -eq 0 ]; then
  for f in fuzz/*_fuzz.cpp; do targets+=("$(basename "$f" _fuzz.cpp)"); done
fi
for t in "${targets[@]}"; do
  work="build-fuzz/corpus/$t"
  mkdir -p "$work" "build-fuzz/findings/$t"
  [ -d "fuzz/corpus/$t" ] && cp -n fuzz/corpus/"$t"/* "$work"/ 2>/dev/null || true
  echo "=== fuzz_$t for ${seconds}s ==="
  "build-fuzz/fuzz_$t" -max_total_time="$seconds" -print_final_stats=1 \
    -artifact_prefix="build-fuzz/findings/$t/" "$work" 2>&1 | grep -E "^(#[0-9]+.*DONE|stat::number_of_executed_units|stat::average_exec_per_sec|==[0-9]+==ERROR|SUMMARY)" || true
  if ls "build-fuzz/findings/$t"/crash-* "build-fuzz/findings/$t"/leak-* "build-fuzz/findings/$t"/timeout-* >/dev/null 2>&1; then
    echo "fuzz_$t found a problem: see build-fuzz/findings/$t"
    exit 1
  fi
done
