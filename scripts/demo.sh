#!/usr/bin/env bash
# Installs what is missing, builds, and runs the demo report-selection session.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/setup.sh
cmake --preset default >/dev/null
cmake --build --preset default --target ryx-demo-headless
exec build/ryx-demo-headless "$@"
