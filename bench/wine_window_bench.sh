#!/usr/bin/env bash
# Start to window and resident memory of the Windows program under Wine, against the floor (one Qt
# Widgets window with one label, built against the same static Qt for Windows) and against the
# Linux program, in one run on a virtual display and a Wine prefix of its own. Medians of RUNS
# starts each (default 5), with a warm wineserver.
#   bench/wine_window_bench.sh [RUNS]
# Needs build/windows (scripts/build-windows.sh) and, for the Linux figure, build/default.
set -euo pipefail
cd "$(dirname "$0")/.."
runs=${1:-5}
root=$PWD
build=$root/build/windows
floor_build=$root/build/windows-floor
export KICKVANE_QT_WINDOWS_DIR=${KICKVANE_QT_WINDOWS_DIR:-$(scripts/build-qt-windows.sh | tail -n 1)}

cmake -S bench/wine_floor -B "$floor_build" -G Ninja -DCMAKE_BUILD_TYPE=Release \
  -DCMAKE_TOOLCHAIN_FILE="$root/cmake/windows-qt.cmake" >/dev/null
cmake --build "$floor_build" >/dev/null
floor_exe=$floor_build/floor_window.exe

work=$(mktemp -d)
export WINEPREFIX=${BENCH_WINEPREFIX:-$build/wineprefix-bench} WINEDEBUG=-all
export WINEDLLOVERRIDES="mscoree,mshtml=,winemenubuilder.exe=d"
display=${BENCH_DISPLAY:-:$((400 + RANDOM % 200))}
Xvfb "$display" -screen 0 1280x800x24 -nolisten tcp -noreset >/dev/null 2>&1 &
xvfb=$!
export DISPLAY=$display
cleanup() {
  wineserver -k >/dev/null 2>&1 || true
  kill "$xvfb" 2>/dev/null || true
  rm -rf "$work"
}
trap cleanup EXIT
for _ in $(seq 100); do [ -S "/tmp/.X11-unix/X${display#:}" ] && break; sleep 0.05; done
mkdir -p "$WINEPREFIX"
wineserver -p >/dev/null 2>&1
wineboot -i >/dev/null 2>&1 || true

# A tool folder of its own, so that the runs leave the build's settings alone.
tool="$work/tool"
cp -r "$build/tool" "$tool"

now_ms() { date +%s%3N; }
median() { sort -n | awk '{a[NR]=$1} END {print a[int((NR+1)/2)]}'; }

# measure TITLE COMMAND...: prints "start_ms rss_kb" for one start: from starting the program to
# its window on the display, then its resident memory once it has settled.
measure() {
  local title=$1
  shift
  local started pid window="" shown
  started=$(now_ms)
  "$@" >/dev/null 2>&1 &
  pid=$!
  for _ in $(seq 3000); do
    window=$(xdotool search --onlyvisible --name "^$title\$" 2>/dev/null | head -n 1 || true)
    [ -n "$window" ] && break
    sleep 0.005
  done
  shown=$(now_ms)
  sleep 2
  local rss
  rss=$(awk '/^VmRSS:/ {print $2}' "/proc/$pid/status" 2>/dev/null || echo 0)
  kill "$pid" 2>/dev/null || true
  wait "$pid" 2>/dev/null || true
  # Wine's side of a killed program goes with its wineserver connection; give it a moment.
  for _ in $(seq 50); do
    [ -z "$(xdotool search --name "^$title\$" 2>/dev/null)" ] && break
    sleep 0.1
  done
  if [ -z "$window" ]; then
    echo "no window" >&2
    echo "0 $rss"
  else
    echo "$((shown - started)) $rss"
  fi
}

# series NAME TITLE COMMAND...: RUNS starts, then "NAME start_ms rss_mb" (medians).
series() {
  local name=$1 title=$2
  shift 2
  measure "$title" "$@" >/dev/null  # a first start warms the caches
  for _ in $(seq "$runs"); do measure "$title" "$@"; done >"$work/$name"
  printf '%-24s start %5s ms   resident %5s MB\n' "$name" \
    "$(cut -d' ' -f1 "$work/$name" | median)" \
    "$(( $(cut -d' ' -f2 "$work/$name" | median) / 1024 ))"
}

series "wine: floor" "kickvane-floor" wine "$floor_exe"
series "wine: kickvane.exe" "Kickvane v2.0" wine "$tool/kickvane.exe" --tool-folder "$tool"
series "wine: notepad" "Untitled - Notepad" wine notepad
if [ -x "$root/build/default/tool/kickvane" ]; then
  linux_tool="$work/linux-tool"
  cp -r "$root/build/default/tool" "$linux_tool"
  series "linux: kickvane" "Kickvane v2.0" "$linux_tool/kickvane" --tool-folder "$linux_tool"
fi
for name in "wine: floor" "wine: kickvane.exe"; do
  echo "$name: $(cut -d' ' -f1 "$work/$name" | tr '\n' ' ')ms"
done
