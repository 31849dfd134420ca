#!/usr/bin/env bash
# Sets up a fresh Debian 12 machine, builds Kickvane and opens its window on the bundled demo:
# the demo tool folder with the demo game folder chosen. Press F7 anywhere (or run
# `build/default/tool/kickvane trigger`) and the chosen sets are copied into the demo game.
# Without a display the same job runs on the command line.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/install-deps.sh
cmake --preset default >/dev/null
cmake --build --preset default -j "$(nproc)"

tool=build/default/tool
if [ -n "${DISPLAY:-}" ] || [ -n "${WAYLAND_DISPLAY:-}" ]; then
  exec "$tool/kickvane" --tool-folder "$tool"
fi
echo "No display: copying the demo sets on the command line instead."
echo "(To see the window here: xvfb-run -s '-screen 0 1280x800x24' $tool/kickvane --tool-folder $tool)"
"$tool/kickvane" apply --tool-folder "$tool"
echo "The demo game folder now holds the copied sets: build/default/demo-game"
