#!/usr/bin/env bash
# Builds the Windows program on Linux: build/windows/tool/kickvane.exe with its tool folder, and
# the cross-built tests. Qt for Windows comes from scripts/build-qt-windows.sh (its cache, the
# prebuilt archive, or a build from Debian's source); the artwork generator from the native
# `default` build, since it runs at build time. Options: --zip also makes the release zip.
set -euo pipefail
cd "$(dirname "$0")/.."

jobs="${KICKVANE_JOBS:-2}"
KICKVANE_QT_WINDOWS_DIR=$(scripts/build-qt-windows.sh | tail -n 1)
export KICKVANE_QT_WINDOWS_DIR

cmake --preset default >/dev/null
cmake --build --preset default -j "$jobs" --target kickvane_artwork kickvane
cmake --preset windows >/dev/null
cmake --build --preset windows -j "$jobs"
if [ "${1:-}" = "--zip" ]; then
  scripts/package-windows.sh
fi
