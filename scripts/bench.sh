#!/usr/bin/env bash
# Builds the benchmarks with the default preset and runs them: each figure of the agency
# control beside its baseline from the same run, then the table of ratios. About two minutes
# on two cores once built.
#   scripts/bench.sh [--rows=1000,100000,1000000] [Google Benchmark flags]
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/setup.sh
cmake --preset default >/dev/null
cmake --build --preset default --target ryx-bench
if [ ! -x build/bench/ryx-bench ]; then
  echo "ryx-bench was not built: is Google Benchmark (libbenchmark-dev) installed?" >&2
  exit 1
fi
QT_QPA_PLATFORM="${QT_QPA_PLATFORM:-offscreen}" exec build/bench/ryx-bench "$@"
