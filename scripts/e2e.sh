#!/usr/bin/env bash
# End-to-end check of the demo screen on a real X server (Xvfb) with real X key events:
# types a period into the date fields with xdotool, moves the focus, quits, and checks the
# criteria that the demo prints.
#   scripts/e2e.sh path/to/ryx-demo
set -euo pipefail
# Under the sanitizers, the memory that X and D-Bus libraries keep for the process is no leak.
export LSAN_OPTIONS="${LSAN_OPTIONS:-suppressions=$(realpath "$(dirname "$0")/../tests/lsan.supp")}"

# Inside the X server: start the demo, type, quit.
if [ "${1:-}" = "--inside" ]; then
  demo="$2"
  out="$3"
  QT_QPA_PLATFORM=xcb "$demo" --print-on-exit >"$out" 2>"$out.err" &
  pid=$!
  win=""
  for _ in $(seq 1 100); do
    win="$(xdotool search --name "RYXReport demo" 2>/dev/null | head -n 1 || true)"
    [ -n "$win" ] && break
    sleep 0.1
  done
  [ -n "$win" ] || { echo "the demo window did not appear"; kill "$pid"; exit 1; }
  xdotool windowactivate --sync "$win" 2>/dev/null || xdotool windowfocus --sync "$win"
  sleep 0.5
  # The focus starts in the start date: type a period in one financial year and leave it.
  xdotool type --delay 40 "15/05/2001"
  xdotool key --delay 40 Down
  xdotool type --delay 40 "10/02/2003"
  xdotool key --delay 40 Tab
  sleep 0.3
  xdotool key --delay 40 ctrl+q
  wait "$pid"
  exit 0
fi

demo="$(realpath "$1")"
out="$(mktemp)"
trap 'rm -f "$out" "$out.err"' EXIT
xvfb-run -a -s "-screen 0 1280x800x24" "$0" --inside "$demo" "$out"
cat "$out"
if [ -s "$out.err" ] && grep -q "ERROR" "$out.err"; then cat "$out.err"; exit 1; fi
grep -q "Date( 2001,05,15)" "$out"
grep -q "Date( 2002,02,10)" "$out"
echo "e2e: the typed period reached the criteria"
