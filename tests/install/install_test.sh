#!/usr/bin/env bash
# Installs the build into a staging folder (DESTDIR) and checks the system layout: the program,
# the data folder, a valid desktop entry, the icons; then starts the installed program from its
# read-only folder with a home of its own and checks the first-start seeding of the user's tool
# folder, that it is never overwritten, and that --tool-folder still wins. Last, cpack's .deb
# and .tar.gz.
# Usage: install_test.sh BUILD_DIR
set -euo pipefail
build=$1
work=$(mktemp -d)
trap 'chmod -R u+w "$work"; rm -rf "$work"' EXIT
fail() { echo "FAIL: $*" >&2; exit 1; }

stage=$work/stage
DESTDIR=$stage cmake --install "$build" --prefix /usr > "$work/install.log"
for f in usr/bin/kickvane usr/share/applications/kickvane.desktop \
         usr/share/icons/hicolor/16x16/apps/kickvane.png usr/share/icons/hicolor/32x32/apps/kickvane.png \
         usr/share/icons/hicolor/64x64/apps/kickvane.png usr/share/kickvane/sound.wav \
         usr/share/kickvane/data/data2 usr/share/kickvane/extras usr/share/kickvane/skin \
         usr/share/kickvane/img; do
  [ -e "$stage/$f" ] || fail "not installed: $f"
done
[ ! -e "$stage/usr/share/kickvane/ThietLap.ini" ] || fail "the build's settings were installed"
[ ! -e "$stage/usr/kickvane" ] || fail "the portable layout was installed by default"
command -v desktop-file-validate > /dev/null || fail "desktop-file-validate is missing (desktop-file-utils)"
desktop-file-validate "$stage/usr/share/applications/kickvane.desktop" || fail "desktop entry is not valid"
grep -q '^GenericName=Đổi đồ hoạ FIFA Online 2$' "$stage/usr/share/applications/kickvane.desktop" ||
  fail "desktop entry has no Vietnamese name"

# First start from a read-only program folder: the user's data folder is seeded.
chmod -R a-w "$stage/usr"
export HOME=$work/home
unset XDG_DATA_HOME WINEPREFIX
mkdir -p "$HOME"
"$stage/usr/bin/kickvane" plan > "$work/plan1.log" || fail "plan failed: $(cat "$work/plan1.log")"
user=$HOME/.local/share/kickvane
grep -q "thư mục công cụ = $user\$" "$work/plan1.log" || fail "tool folder is not $user: $(head -5 "$work/plan1.log")"
for f in data/data2 extras skin img icons sound.wav .kickvane-seeded; do
  [ -e "$user/$f" ] || fail "not seeded: $f"
done
cmp -s "$stage/usr/share/kickvane/sound.wav" "$user/sound.wav" || fail "sound differs from the installed one"

# Never overwritten afterwards; XDG_DATA_HOME is honoured.
echo mine > "$user/sound.wav"
"$stage/usr/bin/kickvane" plan > /dev/null
[ "$(cat "$user/sound.wav")" = mine ] || fail "the user's file was overwritten"
XDG_DATA_HOME=$work/xdg "$stage/usr/bin/kickvane" plan > "$work/plan2.log"
[ -e "$work/xdg/kickvane/sound.wav" ] || fail "XDG_DATA_HOME not used"

# The window's code is loaded from the installed module, and only for the window's commands.
QT_QPA_PLATFORM=offscreen "$stage/usr/bin/kickvane" skin-gallery "$work/gallery.png" 2> "$work/gallery.log" ||
  fail "the installed window module does not load: $(cat "$work/gallery.log")"
[ -s "$work/gallery.png" ] || fail "no gallery drawn"
! readelf -d "$stage/usr/bin/kickvane" | grep -q 'libQt6' || fail "the program itself needs Qt"

# --tool-folder wins and seeds nothing.
export HOME=$work/home2
mkdir -p "$HOME" "$work/mine"
"$stage/usr/bin/kickvane" plan --tool-folder "$work/mine" > "$work/plan3.log"
grep -q "thư mục công cụ = $work/mine$" "$work/plan3.log" || fail "--tool-folder not used"
[ ! -e "$HOME/.local/share/kickvane" ] || fail "seeded although --tool-folder was given"

# The packages.
(cd "$build" && cpack -B "$work/packages" > "$work/cpack.log") || fail "cpack failed: $(cat "$work/cpack.log")"
deb=$(ls "$work"/packages/*.deb)
dpkg-deb -f "$deb" Depends | grep -q 'libqt6widgets6' || fail "the .deb declares no Qt dependency"
dpkg-deb -c "$deb" > "$work/deb.list"
grep -q '\./usr/bin/kickvane$' "$work/deb.list" || fail "the .deb has no program"
grep -q '/kickvane/kickvane-window\.so$' "$work/deb.list" || fail "the .deb has no window module"
grep -q '/kickvane/kickvane-update\.so$' "$work/deb.list" || fail "the .deb has no update module"
grep -q '\./usr/share/applications/kickvane.desktop$' "$work/deb.list" || fail "the .deb has no desktop entry"
tar tzf "$work"/packages/*.tar.gz > "$work/tgz.list"
grep -q '^kickvane-[^/]*/kickvane$' "$work/tgz.list" || fail "the .tar.gz has no program at its top"
grep -q '^kickvane-[^/]*/kickvane-window\.so$' "$work/tgz.list" || fail "the .tar.gz has no window module beside the program"
grep -q '^kickvane-[^/]*/kickvane-update\.so$' "$work/tgz.list" || fail "the .tar.gz has no update module beside the program"
grep -q '^kickvane-[^/]*/data/data2/' "$work/tgz.list" || fail "the .tar.gz has no sets beside the program"
echo "install test passed"
