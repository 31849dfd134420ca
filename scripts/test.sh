#!/usr/bin/env bash
# Sets up a fresh Debian 12 machine, builds Kickvane and runs every test: once in the normal
# build, once built with AddressSanitizer and UndefinedBehaviorSanitizer.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/install-deps.sh

jobs=$(nproc)
for preset in default asan; do
  echo "== $preset: build"
  cmake --preset "$preset" >/dev/null
  cmake --build --preset "$preset" -j "$jobs"
  echo "== $preset: test"
  ctest --preset "$preset" -j "$jobs"
done

echo "== fuzz: a short run of every target"
scripts/fuzz.sh --runs 20000

# The Windows program: cross-built against a static Qt for Windows (unpacked from the prebuilt
# archive into the cache on a fresh machine), its tests run under Wine in a prefix of its own with
# one wineserver for the whole run.
echo "== windows: build"
windows_started=$(date +%s)
KICKVANE_JOBS="$jobs" scripts/build-windows.sh
echo "== windows: test under Wine"
export WINEPREFIX="$PWD/build/windows/wineprefix" WINEDEBUG=-all WINEDLLOVERRIDES="mscoree,mshtml="
mkdir -p "$WINEPREFIX"
# Wine's desktop lives as long as its wineserver and shows windows on the display it was started
# with, so one virtual display serves the whole Wine run.
display_file=$(mktemp)
Xvfb -displayfd 3 -nolisten tcp -noreset -screen 0 1280x800x24 3>"$display_file" 2>/dev/null &
xvfb_pid=$!
for _ in $(seq 100); do [ -s "$display_file" ] && break; sleep 0.1; done
export DISPLAY=":$(head -n 1 "$display_file")" KICKVANE_TEST_DISPLAY=":$(head -n 1 "$display_file")"
rm -f "$display_file"
wineserver -p </dev/null >/dev/null 2>&1
wineboot -i </dev/null >/dev/null 2>&1 || true
windows_status=0
ctest --preset windows -j "$jobs" || windows_status=$?
wineserver -k </dev/null >/dev/null 2>&1 || true
kill "$xvfb_pid" 2>/dev/null || true
unset DISPLAY KICKVANE_TEST_DISPLAY
if [ "$windows_status" != 0 ]; then
  echo "== windows: tests under Wine failed"
  exit "$windows_status"
fi
scripts/package-windows.sh
echo "== windows: $(($(date +%s) - windows_started)) s"
