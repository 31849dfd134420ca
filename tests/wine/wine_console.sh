#!/usr/bin/env bash
# The console companion kickvane.com under Wine: redirected, it passes on the windowed program's
# UTF-8 output, error output and exit code; in a console (a terminal, as Wine gives its programs
# one) Vietnamese shows whole whatever the console's code page, and the program waits for the
# command to end.
# Usage: wine_console.sh TOOL_FOLDER_OF_THE_WINDOWS_BUILD
# Wine's environment (WINEPREFIX, WINEDEBUG, a running wineserver) comes from the caller.
set -euo pipefail

built_tool=$1
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT

source "$(dirname "${BASH_SOURCE[0]}")/check.sh"

tool="$work/Công cụ"
mkdir -p "$tool"
cp "$built_tool/kickvane.exe" "$built_tool/kickvane.com" "$tool/"
com="$tool/kickvane.com"

# Redirected: the bytes the program writes, and its exit code.
wine "$com" vni "Vie65t Nam - Co6ng cu5" >"$work/out.txt" 2>"$work/err.txt"
check "redirected output is the UTF-8 text" \
  test "$(cat "$work/out.txt")" = "Việt Nam - Công cụ"
printf 'Tho6ng ba1o\n' | wine "$com" vni >"$work/in.txt"
check "standard input reaches the program" test "$(cat "$work/in.txt")" = "Thông báo"
code=0
wine "$com" no-such-command >"$work/out.txt" 2>"$work/err.txt" || code=$?
check "the program's exit code comes back" test "$code" = 2
check "error output comes back" grep -q "không có lệnh no-such-command" "$work/err.txt"

# In a console: script(1) gives Wine a terminal, which Wine makes its console; the code page stays
# Wine's default (not UTF-8), so only text written through the wide console functions arrives
# whole.
in_console() {  # in_console OUTPUT ARGS...
  local output=$1
  shift
  local command
  printf -v command '%q ' wine "$com" "$@"
  # Wine's console draws on the terminal with control sequences, a blank sometimes as a step
  # of the cursor: back to plain text.
  LC_ALL=C.UTF-8 script -qec "$command" /dev/null </dev/null 2>&1 |
    sed 's/\x1b\[1C/ /g; s/\x1b\[[0-9;?]*[A-Za-z]//g' | tr -d '\r' >"$output" || true
}
in_console "$work/console.txt" vni "Vie65t Nam - Co6ng cu5 - Ho65i"
check "Vietnamese shows whole in a console" grep -q "Việt Nam - Công cụ - Hội" "$work/console.txt"
in_console "$work/console-error.txt" no-such-command
check "Vietnamese error output shows whole in a console" \
  grep -q "không có lệnh no-such-command" "$work/console-error.txt"

if [ "$failures" != 0 ]; then
  echo "--- console output:"; od -c "$work/console.txt" | head -20
  exit 1
fi
