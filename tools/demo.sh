#!/usr/bin/env bash
# ./ftx demo [--headless]: the GUI library's demo window on a device root of its own
# (./root-demo), with the emulator console on root-demo/run/console.sock.
set -euo pipefail
TOP="${FTX_TOP:?run through ./ftx demo}"
BUILD="${FTX_BUILD_DIR:?run through ./ftx demo}"
headless=0
for arg in "$@"; do
  case "$arg" in
    --headless) headless=1 ;;
    -h|--help) echo "usage: ./ftx demo [--headless]"; exit 0 ;;
    *) echo "ftx demo: unknown option $arg" >&2; exit 2 ;;
  esac
done

ROOT="$TOP/root-demo"
mkdir -p "$ROOT/run" "$ROOT/log" "$ROOT/sys/class/leds/lcd-backlight" "$ROOT/sys/class/graphics/fb0"
[ -f "$ROOT/sys/class/leds/lcd-backlight/brightness" ] || echo 255 > "$ROOT/sys/class/leds/lcd-backlight/brightness"
[ -f "$ROOT/sys/class/graphics/fb0/blank" ] || echo 0 > "$ROOT/sys/class/graphics/fb0/blank"
export FTX_ROOT="$ROOT"
if [ "$headless" = 1 ]; then export FTX_DISPLAY=headless; fi

SOCK="$ROOT/run/console.sock"
rm -f "$SOCK"
"$BUILD/bin/ftx-demo" &
pid=$!
trap 'kill "$pid" 2>/dev/null || true' INT TERM EXIT
for _ in $(seq 100); do
  [ -S "$SOCK" ] && break
  kill -0 "$pid" 2>/dev/null || { echo "ftx demo: the demo ended early (see $ROOT/log/logcat.txt)" >&2; exit 1; }
  sleep 0.1
done
echo "console: $SOCK"
echo "try:     FTX_ROOT=$ROOT ./ftx console help"
echo "         FTX_ROOT=$ROOT ./ftx console screenshot demo.png"
[ "$headless" = 1 ] && echo "headless: stop with Ctrl-C"
wait "$pid"
