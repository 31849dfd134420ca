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

echo "== windows-core: cross-build"
cmake --preset windows-core >/dev/null
cmake --build --preset windows-core -j "$jobs"

echo "== fuzz: a short run of every target"
scripts/fuzz.sh --runs 20000
