#!/usr/bin/env bash
# Builds the fuzz targets with clang (libFuzzer, AddressSanitizer, UndefinedBehaviorSanitizer)
# and runs each for the given number of seconds (default 30), from its seed corpus in
# fuzz/corpus/<target> and the inputs that earlier runs kept in build-fuzz/corpus/<target>.
#   scripts/fuzz.sh [seconds] [target ...]          every target when none is named
#   RYX_FUZZ_JOBS=2 scripts/fuzz.sh 600             two targets at a time
#   RYX_FUZZ_CLEAN=1 scripts/fuzz.sh                 configured and built afresh first
# A finding (crash, leak, hang, running out of memory) is kept in build-fuzz/findings/<target>/
# and makes the script fail; build-fuzz/fuzz_<target> <file> runs it again.
set -euo pipefail
cd "$(dirname "$0")/.."
seconds="${1:-30}"
shift || true
jobs="${RYX_FUZZ_JOBS:-1}"

scripts/setup.sh
if [ -n "${RYX_FUZZ_CLEAN:-}" ]; then
  cmake --preset fuzz --fresh >/dev/null
  cmake --build --preset fuzz --clean-first
else
  cmake --preset fuzz >/dev/null
  cmake --build --preset fuzz
fi

targets=("$@")
if [ ${#targets[@]} -eq 0 ]; then
  for f in fuzz/*_fuzz.cpp; do targets+=("$(basename "$f" _fuzz.cpp)"); done
fi

run() {
  local t="$1"
  local work="build-fuzz/corpus/$t" findings="build-fuzz/findings/$t"
  rm -rf "$findings"
  mkdir -p "$work" "$findings" build-fuzz/logs
  if [ -d "fuzz/corpus/$t" ]; then cp -n fuzz/corpus/"$t"/* "$work"/; fi
  # An input that runs for more than 20 seconds counts as a hang.
  "build-fuzz/fuzz_$t" -max_total_time="$seconds" -timeout=20 -print_final_stats=1 \
    -artifact_prefix="$findings/" "$work" >"build-fuzz/logs/$t.log" 2>&1 || true
}

echo "=== ${#targets[@]} fuzz target(s) for ${seconds}s each, $jobs at a time ==="
for t in "${targets[@]}"; do
  [ -x "build-fuzz/fuzz_$t" ] || { echo "no fuzz target $t"; exit 2; }
  while [ "$(jobs -rp | wc -l)" -ge "$jobs" ]; do wait -n; done
  run "$t" &
done
wait

failed=0
for t in "${targets[@]}"; do
  log="build-fuzz/logs/$t.log"
  runs=$(sed -n 's/^stat::number_of_executed_units: *//p' "$log")
  rate=$(sed -n 's/^stat::average_exec_per_sec: *//p' "$log")
  if compgen -G "build-fuzz/findings/$t/*-*" >/dev/null; then
    echo "fuzz_$t FOUND A PROBLEM after ${runs:-?} executions: see build-fuzz/findings/$t and $log"
    grep -E "^(form actions|range selector|date text):|ERROR|SUMMARY|runtime error" "$log" | head -5
    failed=1
  else
    echo "fuzz_$t: ${runs:-?} executions in ${seconds}s (${rate:-?} per second), no finding"
  fi
done
exit "$failed"
