#!/usr/bin/env bash
# Installs what is missing, builds, and opens the demo report-selection screen. Without a
# display it runs the same screen offscreen through a short scripted session, prints what the
# report receives from each control, and writes a screenshot whose path it prints.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/setup.sh
cmake --preset default >/dev/null
cmake --build --preset default --target ryx-demo
if [ -n "${DISPLAY:-}${WAYLAND_DISPLAY:-}" ]; then
  exec build/ryx-demo "$@"
fi
exec build/ryx-demo --script --screenshot "$PWD/build/ryx-demo.png" "$@"
