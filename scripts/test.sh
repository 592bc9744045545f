#!/usr/bin/env bash
# Installs what is missing, builds, and runs every test.
#   scripts/test.sh          the normal build (build/)
#   scripts/test.sh asan     with AddressSanitizer and UndefinedBehaviorSanitizer (build-asan/)
set -euo pipefail
cd "$(dirname "$0")/.."
preset="${1:-default}"

scripts/setup.sh
cmake --preset "$preset"
cmake --build --preset "$preset"
ctest --preset "$preset"
