#!/usr/bin/env bash
# Builds the libFuzzer targets (preset "fuzz") and runs each of them in turn.
#
#   scripts/fuzz.sh [SECONDS]      each target for SECONDS (default 60)
#   scripts/fuzz.sh --runs N       each target for N inputs (what scripts/test.sh does)
#   FUZZ_TARGETS="settings text"   only these targets; FUZZ_JOBS=N runs N processes per target
#
# New inputs that reach new code go to build/fuzz/corpus/TARGET (the seeds of tests/fuzz/corpus
# stay as they are); a failing input is written to build/fuzz/artifacts and ends the script.
set -euo pipefail
cd "$(dirname "$0")/.."

limit=(-max_total_time="${1:-60}")
if [ "${1:-}" = "--runs" ]; then
  limit=(-runs="${2:?--runs needs a number}")
fi
targets=(${FUZZ_TARGETS:-settings text update_answer quick_load_match vdf wine_registry desktop_entry})

cmake --preset fuzz >/dev/null
cmake --build --preset fuzz -j "$(nproc)"

artifacts=build/fuzz/artifacts
mkdir -p "$artifacts"
for target in "${targets[@]}"; do
  corpus=build/fuzz/corpus/$target
  mkdir -p "$corpus"
  echo "== fuzz: $target (${limit[*]})"
  jobs=()
  if [ -n "${FUZZ_JOBS:-}" ]; then
    jobs=(-jobs="$FUZZ_JOBS" -workers="$FUZZ_JOBS")
  fi
  log=build/fuzz/$target.log
  status=0
  build/fuzz/tests/fuzz/"${target}"_fuzz "${limit[@]}" "${jobs[@]}" -max_len=4096 -timeout=10 \
    -rss_limit_mb=2048 -print_final_stats=1 -artifact_prefix="$artifacts/$target-" \
    "$corpus" tests/fuzz/corpus/"$target" >"$log" 2>&1 || status=$?
  grep -E '^(Done|stat::number_of_executed_units|stat::new_units_added)|ERROR|SUMMARY|property failed|Test unit written' "$log" || true
  if [ "$status" -ne 0 ]; then
    tail -n 40 "$log"
    echo "fuzz: $target failed (see $log)" >&2
    exit 1
  fi
done
