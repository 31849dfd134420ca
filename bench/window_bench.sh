#!/usr/bin/env bash
# Measures the window against its performance budget on a virtual display of its own.
#   bench/window_bench.sh [BUILD_DIR]      (default: build/default)
set -euo pipefail
cd "$(dirname "$0")/.."
build=${1:-build/default}

display=:$((300 + RANDOM % 300))
Xvfb "$display" -screen 0 1280x800x24 -nolisten tcp -noreset >/dev/null 2>&1 &
xvfb=$!
runtime=$(mktemp -d)
trap 'kill $xvfb 2>/dev/null; rm -rf "$runtime"' EXIT
for _ in $(seq 100); do [ -S "/tmp/.X11-unix/X${display#:}" ] && break; sleep 0.05; done

DISPLAY=$display XDG_RUNTIME_DIR=$runtime "$build/bench/window_bench" "$build/tool/kickvane"
