#!/usr/bin/env bash
# Sets up a fresh Debian 12 machine, builds Kickvane and runs its main job on the bundled demo:
# the demo tool folder's sets are copied into the demo game folder.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/install-deps.sh
cmake --preset default >/dev/null
cmake --build --preset default -j "$(nproc)"

tool=build/default/tool
"$tool/kickvane" apply --tool-folder "$tool"
echo "The demo game folder now holds the copied sets: build/default/demo-game"
