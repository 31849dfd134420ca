#!/usr/bin/env bash
# "find-game" of the Windows program under Wine: a game that an uninstall entry of the registry
# records (the user's, and the 32-bit programs' view of the machine's), one that only a shortcut in
# the Start menu leads to, and one on a second fixed drive, each with where it was found. The
# entries, the shortcut and the drive are removed afterwards. Wine takes its drives from the
# prefix's dosdevices when its wineserver starts, so the test restarts the (persistent) wineserver
# after mapping the drive and after removing it; it runs alone for that.
# Usage: wine_find_game.sh TOOL_FOLDER_OF_THE_WINDOWS_BUILD MAKE_SHORTCUT
# Wine's environment (WINEPREFIX, WINEDEBUG, a running wineserver) comes from the caller.
set -euo pipefail

built_tool=$1 make_shortcut=$2
# Shortcuts in the Start menu would otherwise become menu entries of the desktop.
export WINEDLLOVERRIDES="${WINEDLLOVERRIDES:+$WINEDLLOVERRIDES,}winemenubuilder.exe=d"
work=$(mktemp -d)
key='Software\Microsoft\Windows\CurrentVersion\Uninstall'
entry="Kickvane test $$"
drive=""
restart_wineserver() {
  wineserver -k >/dev/null 2>&1 || true
  wineserver -w >/dev/null 2>&1 || true
  wineserver -p >/dev/null 2>&1 || true
}
cleanup() {
  wine reg delete "HKCU\\$key\\$entry" /f >/dev/null 2>&1 || true
  wine reg delete "HKLM\\$key\\$entry" /reg:32 /f >/dev/null 2>&1 || true
  wine "$make_shortcut" remove "$entry" >/dev/null 2>&1 || true
  if [ -n "$drive" ]; then
    rm -f "$WINEPREFIX/dosdevices/$drive:"
    restart_wineserver
  fi
  rm -rf "$work"
}
trap cleanup EXIT

source "$(dirname "${BASH_SOURCE[0]}")/check.sh"
launcher_in() { mkdir -p "$1" && printf 'MZ' >"$1/Gameloader.exe"; }
listed() {  # listed FOLDER SOURCE: find-game printed the folder with that source
  grep -qxF "$1	$2" "$work/found.txt"
}

tool="$work/Công cụ"
mkdir -p "$tool"
cp "$built_tool/kickvane.exe" "$built_tool/kickvane.com" "$tool/"

# Deep enough (below the fourth level of Z:) that only the registry or the shortcut leads there.
deep="$work/1/2/3/4"
user_game="$deep/Đăng ký/FIFA Online 2"
machine_game="$deep/Máy/FO2"
linked_game="$deep/Lối tắt/FO2"
for game in "$user_game" "$machine_game" "$linked_game"; do launcher_in "$game"; done
win() { winepath -w "$1" 2>/dev/null; }

# A second fixed drive: the first free letter from K on.
for letter in k l m n o p q r s t u v w x y; do
  if [ ! -e "$WINEPREFIX/dosdevices/$letter:" ] && [ ! -L "$WINEPREFIX/dosdevices/$letter:" ]; then
    drive=$letter
    break
  fi
done
mkdir -p "$work/drive/Games/FIFA Online 2"
launcher_in "$work/drive/Games/FIFA Online 2"
ln -s "$work/drive" "$WINEPREFIX/dosdevices/$drive:"
restart_wineserver
DRIVE=${drive^^}

wine reg add "HKCU\\$key\\$entry" /v InstallLocation /d "$(win "$user_game")\\" /f >/dev/null
wine reg add "HKLM\\$key\\$entry" /v UninstallString /reg:32 /f \
  /d "$(win "$machine_game")\\unins 000.exe /S" >/dev/null
link=$(wine "$make_shortcut" create "$entry" "$(win "$linked_game")\\Gameloader.exe" | tr -d '\r')


code=0
wine "$tool/kickvane.com" find-game >"$work/found.txt" 2>"$work/errors.txt" || code=$?
tr -d '\r' <"$work/found.txt" >"$work/found.tmp" && mv "$work/found.tmp" "$work/found.txt"
check "find-game ends well when it finds games" test "$code" = 0
check "the user's uninstall entry, its InstallLocation" \
  listed "$(win "$user_game")" "sổ đăng ký, mục gỡ cài đặt HKEY_CURRENT_USER\\$key\\$entry (InstallLocation)"
check "the 32-bit view's uninstall entry, the folder of its UninstallString" \
  listed "$(win "$machine_game")" \
  "sổ đăng ký, mục gỡ cài đặt HKEY_LOCAL_MACHINE\\Software\\WOW6432Node\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\$entry (UninstallString)"
check "the game that only a Start menu shortcut leads to" \
  listed "$(win "$linked_game")" "lối tắt: $link"
check "the game on the second fixed drive" \
  listed "$DRIVE:\\Games\\FIFA Online 2" "tìm trên ổ $DRIVE:\\"
check "no Unix path among the finds" bash -c "! grep -q '^/' '$work/found.txt'"

if [ "$failures" != 0 ]; then
  echo "--- find-game printed:"; cat "$work/found.txt"; cat "$work/errors.txt"
  exit 1
fi
