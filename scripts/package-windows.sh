#!/usr/bin/env bash
# Makes build/windows/kickvane-<version>-windows.zip from the Windows build: kickvane.exe and its
# console companion kickvane.com (without their symbols) and the tool folder beside them, with a
# short read-me in Vietnamese (DOC-TOI.txt, "read me"). The settings file of the build's own runs
# is left out: a player's copy starts with none.
set -euo pipefail
cd "$(dirname "$0")/.."

build=build/windows
version=$(sed -n 's/^CMAKE_PROJECT_VERSION:STATIC=//p' "$build/CMakeCache.txt")
name="kickvane-$version-windows"
stage="$build/package/$name"
rm -rf "$build/package"
mkdir -p "$stage"
cp -r "$build/tool/." "$stage/"
rm -f "$stage/ThietLap.ini" "$stage"/thietlap.ini
x86_64-w64-mingw32-strip "$stage/kickvane.exe" "$stage/kickvane.com"
cp packaging/windows/DOC-TOI.txt "$stage/DOC-TOI.txt"  # ASCII name: zip tools disagree on name encodings
rm -f "$build/$name.zip"
(cd "$build/package" && zip -qr -X "../$name.zip" "$name")
echo "$build/$name.zip"
