#!/usr/bin/env bash
# Starts the factory application on the simulated handset (./ftx run).
# Usage: ./ftx run [--headless] [--root DIR] [--fresh] [--screen WxH]
# Prepares the device root from sim/image when it is missing (--fresh makes it anew),
# restarts the application when it asks for a reboot (exit status 101) and stops on a
# power-off (100), on Ctrl-C or on any other end. After a power-off with the RTC alarm
# (ROOT/sys/class/rtc/rtc0/wakealarm) armed in the future, it waits until the alarm time,
# clears the alarm and starts the application again.
# The log, ROOT/log/logcat.txt, keeps every priority: FTX_LOG_LEVEL=I (or W, E) raises the
# floor, FTX_LOG_STDERR=1 echoes it here. It is a ring: past FTX_LOG_ROTATE_KB (4096) the
# file becomes logcat.txt.1 and the oldest of FTX_LOG_ROTATE_COUNT (4) rotated files goes.
set -uo pipefail

TOP="${FTX_TOP:?run through ./ftx run}"
BUILD="${FTX_BUILD_DIR:-$TOP/build}"
ROOT="$TOP/root"
FRESH=0
SCREEN=""
HEADLESS=0

say() { printf 'ftx run: %s\n' "$*" >&2; }

while [ $# -gt 0 ]; do
  case "$1" in
    --headless) HEADLESS=1 ;;
    --fresh) FRESH=1 ;;
    --root) shift; ROOT="${1:?--root needs a folder}" ;;
    --root=*) ROOT="${1#--root=}" ;;
    --screen) shift; SCREEN="${1:?--screen needs WxH}" ;;
    --screen=*) SCREEN="${1#--screen=}" ;;
    -h|--help) sed -n '2,/^set /s/^# \{0,1\}//p' "$0"; exit 0 ;;
    *) say "unknown option: $1"; exit 2 ;;
  esac
  shift
done

if [ -n "$SCREEN" ] && ! [[ "$SCREEN" =~ ^[0-9]+x[0-9]+$ ]]; then
  say "--screen wants WxH, e.g. 720x1280"; exit 2
fi
[ -x "$BUILD/bin/ftx-mmi" ] || { say "no $BUILD/bin/ftx-mmi: build first (./ftx build)"; exit 1; }

ROOT="$(mkdir -p "$(dirname "$ROOT")" && cd "$(dirname "$ROOT")" && pwd)/$(basename "$ROOT")"
if [ "$FRESH" = 1 ] && [ -d "$ROOT" ]; then
  say "recreating $ROOT"
  rm -rf -- "$ROOT"
fi
if [ ! -d "$ROOT/etc" ]; then
  say "preparing the device root $ROOT from sim/image"
  mkdir -p "$ROOT"
  cp -a "$TOP/sim/image/." "$ROOT/"
fi
# What the build adds to the image (the calibration pictures), also into an older root.
if [ -d "$BUILD/image" ]; then
  cp -a -u "$BUILD/image/." "$ROOT/"
fi
mkdir -p "$ROOT/log" "$ROOT/run"

export FTX_ROOT="$ROOT"
export LD_LIBRARY_PATH="$BUILD/lib${LD_LIBRARY_PATH:+:$LD_LIBRARY_PATH}"
[ -n "$SCREEN" ] && export FTX_SCREEN="$SCREEN"
if [ "$HEADLESS" = 1 ]; then
  export FTX_DISPLAY=headless
elif [ -z "${FTX_DISPLAY:-}" ] && [ -z "${DISPLAY:-}" ] && [ -z "${WAYLAND_DISPLAY:-}" ]; then
  say "no display found: running headless"
  export FTX_DISPLAY=headless
fi

PORT="${FTX_PC_PORT:-$(sed -n '/^\[pc\]/,/^\[/s/^port=//p' "$ROOT/sim/device.ini" | head -n1)}"
PORT="${PORT:-20051}"
export FTX_PC_PORT="$PORT"

# Sleeps until the epoch second $1 (Ctrl-C still stops at once: the trap kills the sleep).
sleep_until() {
  local left=$(( $1 * 1000000000 - $(date +%s%N) ))
  [ "$left" -gt 0 ] || return 0
  sleep "$(( left / 1000000000 )).$(printf '%09d' $(( left % 1000000000 )))" &
  wait $!
}

# The RTC alarm after a power-off: 0 when the application is to stay off.
ALARM_FILE="$ROOT/sys/class/rtc/rtc0/wakealarm"
rtc_alarm() {
  local at
  at="$(tr -d '[:space:]' < "$ALARM_FILE" 2>/dev/null)"
  if [[ "$at" =~ ^[0-9]{1,12}$ ]] && (( 10#$at > $(date +%s) )); then
    echo "$(( 10#$at ))"
  else
    echo 0
  fi
}

CHILD=0
stop() {
  # Every child still running: the application, or the sleep until the RTC alarm.
  local pids
  pids="$(jobs -p)"
  if [ -n "$pids" ]; then
    kill -TERM $pids 2>/dev/null
    wait $pids 2>/dev/null
  fi
  say "stopped"
  exit 130
}
trap stop INT TERM

while :; do
  say "PC port: 127.0.0.1:$PORT   (./ftx pc COMMAND)"
  say "console: $ROOT/run/console.sock   (./ftx console -s $ROOT/run/console.sock LINE)"
  say "log:     $ROOT/log/logcat.txt   (floor ${FTX_LOG_LEVEL:-V}: FTX_LOG_LEVEL=W keeps warnings and errors only)"
  say "         ring of ${FTX_LOG_ROTATE_KB:-4096} KB x (1 + ${FTX_LOG_ROTATE_COUNT:-4} rotated logcat.txt.N): FTX_LOG_ROTATE_KB, FTX_LOG_ROTATE_COUNT"
  "$BUILD/bin/ftx-mmi" &
  CHILD=$!
  wait "$CHILD"
  STATUS=$?
  CHILD=0
  case "$STATUS" in
    101) say "reboot requested: starting again" ;;
    100)
      AT="$(rtc_alarm)"
      [ "$AT" = 0 ] && { say "powered off"; exit 0; }
      say "powered off: the RTC alarm starts it again at $(date -d "@$AT" '+%Y-%m-%d %H:%M:%S')"
      sleep_until "$AT"
      : > "$ALARM_FILE"
      say "RTC alarm: starting again" ;;
    *) say "ftx-mmi ended with status $STATUS"; exit "$STATUS" ;;
  esac
done
