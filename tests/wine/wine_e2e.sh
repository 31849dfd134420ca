#!/usr/bin/env bash
# The Windows program under Wine on a virtual display of its own, in folders with Vietnamese
# names: the subcommands print what the Linux program prints for the same folders; `launch` starts
# the game's launcher minimised in the game folder; the window shows, F7 (window focused: Wine
# sees keys only for its own windows) and `kickvane.exe trigger` copy the chosen sets; the tray
# icon is there; "Lưu thiết lập" shows its popup at the work area's bottom-right corner; "Khởi
# động FIFA" starts the launcher and hides the window to the tray; a second start is refused and
# leaves the first running.
# Usage: wine_e2e.sh TOOL_FOLDER_OF_THE_WINDOWS_BUILD LINUX_KICKVANE DEMO_GAME ARTIFACTS
#        FAKE_GAMELOADER (a Windows program that records how it was started, in started.txt)
# Wine's environment (WINEPREFIX, WINEDEBUG, a running wineserver) comes from the caller.
set -euo pipefail

built_tool=$1 linux_kickvane=$2 demo_game=$3 artifacts=$4 fake_gameloader=$5
work=$(mktemp -d)
xvfb_pid=""
window_pid=""
second_pid=""
cleanup() {  # ends what the test started; its own failure is no failure of the test
  local pid
  for pid in "$window_pid" "$second_pid" "$xvfb_pid"; do
    if [ -n "$pid" ] && kill "$pid" 2>/dev/null; then
      wait "$pid" 2>/dev/null || true
    fi
  done
  rm -rf "$work" 2>/dev/null || true
}
trap cleanup EXIT

source "$(dirname "${BASH_SOURCE[0]}")/check.sh"
on_check_failed() {  # the named windows on the display, to see why a window check failed
  [ -n "${DISPLAY:-}" ] &&
    xwininfo -root -tree 2>/dev/null | grep '^     0x' | grep -v 'has no name'
  return 0
}
wait_for() {  # wait_for COMMAND... (at most 30 s, or WAIT_LIMIT; keeps a broken run from hanging)
  for _ in $(seq "$((${WAIT_LIMIT:-30} * 10))"); do "$@" && return 0; sleep 0.1; done
  return 1
}
now_ms() { date +%s%3N; }

tool="$work/Công cụ Việt"
game="$work/Trò chơi/FIFA Online 2"
mkdir -p "$tool" "$(dirname "$game")"
cp -r "$built_tool/." "$tool/"
cp -r "$demo_game" "$game"
exe="$tool/kickvane.exe"
game_windows=$(winepath -w "$game" 2>/dev/null)

# --- Subcommands: the same output as the Linux program on a copy of the same folders.
linux_tool="$work/linux/Công cụ Việt"
linux_game="$work/linux/Trò chơi/FIFA Online 2"
mkdir -p "$(dirname "$linux_tool")" "$(dirname "$linux_game")"
cp -r "$tool" "$linux_tool"
cp -r "$demo_game" "$linux_game"
rm -f "$linux_tool/kickvane.exe"

check "ini set with a Vietnamese path" \
  wine "$exe" ini set "$tool/ThietLap.ini" "Thiet lap" DuongDan "$game_windows"
"$linux_kickvane" ini set "$linux_tool/ThietLap.ini" "Thiet lap" DuongDan "$linux_game"
check "ini get gives the Windows path back" \
  test "$(wine "$exe" ini get "$tool/ThietLap.ini" "Thiet lap" DuongDan)" = "$game_windows"
check "vni converts a Vietnamese argument" \
  test "$(wine "$exe" vni "Vie65t Nam - Việt")" = "Việt Nam - Việt"
check "vni converts standard input" \
  test "$(printf 'Tho6ng ba1o\n' | wine "$exe" vni)" = "Thông báo"

same_as_linux() {  # same_as_linux NAME ARGS... (after the command name, folders added)
  local name=$1
  shift
  local windows_code=0 linux_code=0
  wine "$exe" "$name" "$@" --tool-folder "$tool" >"$work/$name.windows" 2>&1 || windows_code=$?
  "$linux_kickvane" "$name" "${@//$work/$work/linux}" --tool-folder "$linux_tool" \
    >"$work/$name.linux" 2>&1 || linux_code=$?
  [ "$windows_code" = "$linux_code" ] && diff <(grep -v ' = ' "$work/$name.linux") \
    <(grep -v ' = ' "$work/$name.windows")
}
check "plan lists the same steps as on Linux" same_as_linux plan
check "apply copies and reports as on Linux" same_as_linux apply
check "apply again finds everything up to date, as on Linux" same_as_linux apply
mkdir -p "$work/Khuôn mặt" "$work/linux/Khuôn mặt"
for folder in "$work/Khuôn mặt" "$work/linux/Khuôn mặt"; do
  printf 'face' >"$folder/face1.dds"
  printf 'ball' >"$folder/ball.dds"
done
check "quick-load from a Vietnamese folder as on Linux" same_as_linux quick-load "$work/Khuôn mặt"
check "trigger without a running copy fails" bash -c '! wine "$0" trigger 2>/dev/null' "$exe"

# --- The game's launcher: a stand-in that records its working folder and show state.
cp "$fake_gameloader" "$game/Gameloader.exe"
started_record="$game/started.txt"
launcher_started_minimised_in_game() {
  [ -s "$started_record" ] || return 1
  local folder state
  { read -r folder && read -r state; } <"$started_record"
  [ "${folder%\\}" = "$game_windows" ] && [ "$state" = minimised ] && return 0
  echo "launcher recorded: $(tr '\n' ' ' <"$started_record")(wanted $game_windows, minimised)"
  return 1
}
check "launch says it started the launcher directly" test \
  "$(wine "$exe" launch --tool-folder "$tool")" = "đã khởi động Gameloader.exe trực tiếp"
check "the launcher runs" wait_for test -s "$started_record"
check "its record names the game folder and the minimised state" launcher_started_minimised_in_game
rm -f "$started_record"
# A launcher that ends at once with an error has not started the game: the command says so.
: >"$game/fail.txt"
code=0
wine "$exe" launch --tool-folder "$tool" >"$work/launch.out" 2>"$work/launch.err" || code=$?
rm -f "$game/fail.txt"
check "a launcher that fails at once fails the command" test "$code" = 1
check "and says how it ended" grep -q "Gameloader.exe dừng ngay với mã lỗi 3" "$work/launch.err"

# --- The window on a virtual display: the caller's (KICKVANE_TEST_DISPLAY), which Wine's desktop
# was started on, else one of our own.
mkdir -p "$artifacts"
if [ -n "${KICKVANE_TEST_DISPLAY:-}" ]; then
  export DISPLAY="$KICKVANE_TEST_DISPLAY"
else
  Xvfb -displayfd 1 -nolisten tcp -noreset -screen 0 1280x800x24 >"$work/display" 2>/dev/null &
  xvfb_pid=$!
  wait_for test -s "$work/display" || { echo "Xvfb did not start"; exit 1; }
  export DISPLAY=":$(head -n 1 "$work/display")"
fi

files_in_game() { find "$game" -type f | wc -l; }
fresh_game() {  # the running copy may still be writing: wait until the count stands still
  local count=-1
  while [ "$count" != "$(files_in_game)" ]; do count=$(files_in_game); sleep 0.5; done
  rm -rf "$game/data2" "$game/zdata"
  cp -r "$demo_game/." "$game/"
}
fresh_game
before=$(files_in_game)
# Windows are found by the process that owns them (Wine gives each its _NET_WM_PID), not by their
# title alone: another program on the display may show a window of the same title.
windows_of() {  # windows_of PID TITLE [--onlyvisible]
  xdotool search --all ${3:-} --pid "$1" --name "^$2\$" 2>/dev/null
}
find_window() { windows_of "$window_pid" 'Kickvane v2.0' | head -n 1; }
# Wine gives a window's title to more than one X window of it; the one to focus is mapped.
visible_window() { windows_of "$window_pid" 'Kickvane v2.0' --onlyvisible | head -n 1; }
window_shown() { [ -n "$(visible_window)" ]; }
notice_shown() { [ -n "$(windows_of "$second_pid" 'Thông báo')" ]; }
game_has_more_files() { [ "$(files_in_game)" -gt "$before" ]; }

started=$(now_ms)
(cd "$tool" && exec wine "$exe") >"$artifacts/wine-window.log" 2>&1 &
window_pid=$!
# The first window of a fresh Wine prefix waits for Wine's own set-up (fonts, desktop): allow more.
WAIT_LIMIT=180 check "the window shows" wait_for window_shown
echo "start to window under Wine: $(($(now_ms) - started)) ms"
window=$(visible_window)
focus_window() {
  xdotool windowactivate --sync "$window" 2>/dev/null || xdotool windowfocus --sync "$window"
}
sleep 1  # let it paint before the screenshot
import -window root "$artifacts/wine-window.png" 2>/dev/null || true

focus_window
pressed=$(now_ms)
xdotool key F7
check "F7 copies the chosen sets" wait_for game_has_more_files
echo "key to first copy under Wine: $(($(now_ms) - pressed)) ms"

fresh_game
check "trigger reaches the running copy" wine "$exe" trigger
check "the running copy applies on trigger" wait_for game_has_more_files

# --- The tray icon: with no tray host on the display, Wine's desktop shows the icons in a window
# of its own.
tray_shown() { [ -n "$(xdotool search --onlyvisible --name '^Wine System Tray$' 2>/dev/null)" ]; }
check "the tray icon is there" wait_for tray_shown

# --- Popups: the one of "Lưu thiết lập" (Alt+L) settles at the bottom-right corner of the work
# area, inside the screen (no window manager here: the work area is the whole screen).
# The corner popups are titled "Thông báo", as a box is; none of the steps here shows a box.
no_popup_shown() { [ -z "$(windows_of "$window_pid" 'Thông báo' --onlyvisible)" ]; }
read -r screen_width screen_height < <(xdotool getdisplaygeometry)
popup_at_corner() {
  local id WINDOW X Y WIDTH HEIGHT SCREEN
  for id in $(windows_of "$window_pid" 'Thông báo' --onlyvisible); do
    eval "$(xdotool getwindowgeometry --shell "$id")"
    [ "$X" -ge 0 ] && [ "$Y" -ge 0 ] &&
      [ $((X + WIDTH)) -le "$screen_width" ] && [ $((X + WIDTH)) -ge $((screen_width - 4)) ] &&
      [ $((Y + HEIGHT)) -le "$screen_height" ] && [ $((Y + HEIGHT)) -ge $((screen_height - 4)) ] &&
      return 0
  done
  return 1
}
wait_for no_popup_shown || true  # the ones of F7 and trigger go first: one popup, one corner
focus_window
xdotool key alt+l
check "the saved-settings popup settles at the bottom-right corner" wait_for popup_at_corner

# --- "Khởi động FIFA" (Alt+F) starts the launcher and hides the window to the tray.
cp "$fake_gameloader" "$game/Gameloader.exe"  # fresh_game brought back the demo game's own
focus_window
xdotool key alt+f
check "the button starts the launcher" wait_for test -s "$started_record"
check "minimised in the game folder" launcher_started_minimised_in_game
window_hidden() { [ -z "$(windows_of "$window_pid" 'Kickvane v2.0' --onlyvisible)" ]; }
check "the window hides to the tray" wait_for window_hidden
check "the tool runs on in the tray" kill -0 "$window_pid"

# --- A second start, last: its notice takes Wine's focus from the first window.
(cd "$tool" && exec wine "$exe") >"$work/second.log" 2>&1 &
second_pid=$!
check "a second start shows its notice" wait_for notice_shown
kill "$second_pid" 2>/dev/null || true
check "the first copy runs on" kill -0 "$window_pid"
# Hidden to the tray, a Wine window need not keep its process's _NET_WM_PID, and Wine may be
# busy with it a moment after the second copy ended: its title finds it (the second copy's window
# is gone, and no other test shows windows on this display meanwhile).
first_copy_window() { [ -n "$(xdotool search --name '^Kickvane v2\.0$' 2>/dev/null)" ]; }
check "its window is still there" wait_for first_copy_window

if [ "$failures" -gt 0 ]; then
  echo "$failures checks failed"
  exit 1
fi
echo "all checks passed"
