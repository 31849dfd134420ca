# Sourced by the Wine test scripts: `check DESCRIPTION COMMAND...` runs a check, says ok or
# FAILED, and counts the failures in $failures. A script may define `on_check_failed` to show
# more when one fails.
failures=0
check() {
  local what=$1
  shift
  if "$@"; then
    echo "ok: $what"
  else
    echo "FAILED: $what"
    failures=$((failures + 1))
    if declare -F on_check_failed >/dev/null; then
      on_check_failed
    fi
  fi
}
