#!/usr/bin/env bash
# Provides a static Qt for 64-bit Windows (MinGW-w64) and prints its install prefix on the last
# line of standard output. In order:
#   1. KICKVANE_QT_WINDOWS_DIR names an existing Qt for Windows: it is used as it is.
#   2. The cache ${XDG_CACHE_HOME:-~/.cache}/kickvane/qt-<version>-mingw-w64 holds one already.
#   3. The prebuilt archive (KICKVANE_QT_WINDOWS_ARCHIVE, else ../shared/qt-windows/ beside the
#      checkout) is unpacked into the cache.
#   4. Otherwise qtbase is built from Debian's own qt6-base source package, the same version as
#      the host Qt whose tools (moc, rcc, uic) it uses. About 40 minutes on 2 cores.
# Options: --configure-only (step 4 stops after CMake configured Qt; nothing is installed),
#          --from-source (skip step 3).
set -euo pipefail

root=$(cd "$(dirname "$0")/.." && pwd)
version=6.4.2
cache="${XDG_CACHE_HOME:-$HOME/.cache}/kickvane"
prefix="$cache/qt-$version-mingw-w64"
archive="${KICKVANE_QT_WINDOWS_ARCHIVE:-$root/../shared/qt-windows/qt$version-mingw-w64-static.tar.xz}"
configure_only=0
from_source=0
for arg in "$@"; do
  case "$arg" in
    --configure-only) configure_only=1 ;;
    --from-source) from_source=1 ;;
    *) echo "usage: $0 [--configure-only] [--from-source]" >&2; exit 2 ;;
  esac
done

log() { echo "build-qt-windows: $*" >&2; }

if [ -n "${KICKVANE_QT_WINDOWS_DIR:-}" ]; then
  if [ ! -f "$KICKVANE_QT_WINDOWS_DIR/lib/cmake/Qt6/qt.toolchain.cmake" ]; then
    log "KICKVANE_QT_WINDOWS_DIR=$KICKVANE_QT_WINDOWS_DIR holds no Qt 6 (lib/cmake/Qt6 missing)"
    exit 1
  fi
  echo "$KICKVANE_QT_WINDOWS_DIR"
  exit 0
fi

if [ -f "$prefix/lib/cmake/Qt6/qt.toolchain.cmake" ] && [ "$configure_only" = 0 ]; then
  echo "$prefix"
  exit 0
fi

if [ "$from_source" = 0 ] && [ "$configure_only" = 0 ] && [ -f "$archive" ]; then
  log "unpacking $archive into $prefix"
  mkdir -p "$cache"
  unpack=$(mktemp -d "$cache/unpack.XXXXXX")
  trap 'rm -rf "$unpack"' EXIT
  tar -xJf "$archive" -C "$unpack"
  top=$(find "$unpack" -mindepth 1 -maxdepth 1 -type d | head -n 1)
  rm -rf "$prefix"
  mv "$top" "$prefix"
  echo "$prefix"
  exit 0
fi

# Build from Debian's source. apt runs with a private configuration: its own sources list (one
# deb-src entry), lists and cache folders, so the system's apt setup is left as it is.
host_version=$(dpkg-query -W -f='${Version}' qt6-base-dev 2>/dev/null || true)
if [ -z "$host_version" ]; then
  log "the host Qt (qt6-base-dev) is not installed; run scripts/install-deps.sh"
  exit 1
fi
case "$host_version" in
  "$version"+*) ;;
  *) log "host Qt is $host_version, expected $version"; exit 1 ;;
esac

work="$cache/qt-$version-source"
mkdir -p "$work"
apt_dir="$work/apt"
mkdir -p "$apt_dir/lists/partial" "$apt_dir/cache/archives/partial" "$apt_dir/sources.list.d"
mirror="${KICKVANE_DEBIAN_MIRROR:-http://deb.debian.org/debian}"
echo "deb-src [signed-by=/usr/share/keyrings/debian-archive-keyring.gpg] $mirror bookworm main" \
  >"$apt_dir/sources.list"
apt_options=(
  -o "Dir::Etc::SourceList=$apt_dir/sources.list"
  -o "Dir::Etc::SourceParts=$apt_dir/sources.list.d"
  -o "Dir::State::Lists=$apt_dir/lists"
  -o "Dir::Cache=$apt_dir/cache"
  -o "APT::Sandbox::User=$(id -un)"
)

source_dir=$(find "$work" -mindepth 1 -maxdepth 1 -type d -name 'qt6-base-*' | head -n 1)
if [ -z "$source_dir" ]; then
  log "fetching Debian's qt6-base $host_version source"
  apt-get "${apt_options[@]}" -qq update
  (cd "$work" && apt-get "${apt_options[@]}" -qq source "qt6-base=$host_version")
  source_dir=$(find "$work" -mindepth 1 -maxdepth 1 -type d -name 'qt6-base-*' | head -n 1)
fi
[ -n "$source_dir" ] || { log "no source folder after apt-get source"; exit 1; }

build="$work/build"
rm -rf "$build"
mkdir -p "$build"
log "configuring qtbase in $build"
cmake -S "$source_dir" -B "$build" -G Ninja \
  -DCMAKE_TOOLCHAIN_FILE="$root/cmake/mingw-w64.cmake" \
  -DCMAKE_INSTALL_PREFIX="$prefix" \
  -DQT_HOST_PATH=/usr \
  -DQT_HOST_PATH_CMAKE_DIR=/usr/lib/x86_64-linux-gnu/cmake \
  -DBUILD_SHARED_LIBS=OFF -DCMAKE_BUILD_TYPE=Release \
  -DQT_BUILD_EXAMPLES=OFF -DQT_BUILD_TESTS=OFF \
  -DFEATURE_sql=OFF -DFEATURE_dbus=OFF -DFEATURE_printsupport=OFF -DFEATURE_concurrent=OFF \
  -DFEATURE_xml=OFF \
  -DFEATURE_opengl=ON -DINPUT_opengl=desktop \
  -DFEATURE_tabletevent=OFF \
  -DINPUT_openssl=no \
  -DFEATURE_system_zlib=OFF -DFEATURE_system_pcre2=OFF -DFEATURE_system_harfbuzz=OFF \
  -DFEATURE_system_freetype=OFF -DFEATURE_system_doubleconversion=OFF \
  -DFEATURE_system_jpeg=OFF -DFEATURE_system_png=OFF \
  >"$work/configure.log" 2>&1 || { tail -n 40 "$work/configure.log" >&2; exit 1; }
# The 6.4.2 Windows platform plugin needs OpenGL on (Qt resolves it as "dynamic": opengl32 is
# loaded only when used). Tablet events are off because Debian's source leaves out the Wacom
# wintab header that they need.
if [ "$configure_only" = 1 ]; then
  log "configured (see $work/configure.log); stopping before the build as asked"
  exit 0
fi

jobs="${KICKVANE_JOBS:-2}"
log "building qtbase with $jobs jobs (about 40 minutes on 2 cores)"
cmake --build "$build" --parallel "$jobs"
cmake --install "$build"
rm -rf "$prefix/doc"
# The toolchain that Qt's qt.toolchain.cmake chain-loads, as in the prebuilt archive.
cp "$root/cmake/mingw-w64.cmake" "$prefix/mingw-w64-toolchain.cmake"
rm -rf "$build"
echo "$prefix"
