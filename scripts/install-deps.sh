#!/usr/bin/env bash
# Installs every Debian 12 package that building, running and testing Kickvane need.
# Safe to run again: apt-get skips what is already there.
set -euo pipefail

packages=(
  # build (MinGW-w64 cross-compiles the core for Windows, to keep those backends building)
  cmake ninja-build g++ pkg-config clang-format g++-mingw-w64-x86-64-posix
  # libraries
  qt6-base-dev libqt6network6 libgl-dev
  # Qt's translation tools: the Vietnamese words of Qt's own dialogs are compiled at build time
  qt6-l10n-tools qt6-tools-dev
  libx11-dev libxi-dev libxtst-dev libcanberra-dev
  libgtest-dev libgmock-dev
  # run and test: virtual X server, key presses, a tray host, screenshots
  xvfb xauth xdotool x11-utils trayer imagemagick
  # fonts with Vietnamese glyphs for the window and the artwork
  fonts-dejavu-core
  # the game managers' files: Lutris's database (read-only), their YAML and JSON; desktop entry
  # check and packages of the install test
  libsqlite3-dev libyaml-cpp-dev nlohmann-json3-dev desktop-file-utils dpkg-dev
  # fuzzing (clang brings libFuzzer and the sanitizers) and the apply benchmark's baselines
  clang rsync
  # the Windows program: its tests run under Wine; the release is a zip
  wine wine64 zip
  # DejaVu's math font: Wine shows the host's fonts, and Qt's last resort for a missing font is
  # the first family by name, this one; the Wine test of the window's text boxes needs that case
  fonts-dejavu-extra
)

missing=()
for p in "${packages[@]}"; do
  dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q 'install ok installed' || missing+=("$p")
done

if ((${#missing[@]})); then
  SUDO=""
  [ "$(id -u)" -eq 0 ] || SUDO="sudo"
  export DEBIAN_FRONTEND=noninteractive
  $SUDO apt-get update -qq
  $SUDO apt-get install -y -qq --no-install-recommends "${missing[@]}"
fi
