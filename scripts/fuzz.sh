#!/usr/bin/env bash
# Builds the libFuzzer targets (clang, ASan + UBSan) and runs them.
#   scripts/fuzz.sh run [TARGET...]      each target FUZZ_SECONDS (60) from its corpus
#   scripts/fuzz.sh regress [TARGET...]  every corpus file once, then FUZZ_SHORT_SECONDS (10) each
# New corpus entries and crash files go to $FUZZ_BUILD/corpus (regress: $FUZZ_BUILD/regress-corpus)
# and $FUZZ_BUILD/artifacts, never into
# tests/fuzz-corpus. FUZZ_RESULTS=FILE appends one line of figures per run. Any crash, hang (over
# 1 s per input), leak, sanitizer report or memory over 2 GB fails the script.
set -euo pipefail
cd "$(dirname "$0")/.."

mode=${1:-run}
shift || true
build=${FUZZ_BUILD:-build-fuzz}
seconds=${FUZZ_SECONDS:-60}
short=${FUZZ_SHORT_SECONDS:-10}
corpus_root=tests/fuzz-corpus
all_targets=(fuzz_track_lines fuzz_track_file fuzz_waypoint_file fuzz_nmea fuzz_aprs_position fuzz_mic_e
             fuzz_settings fuzz_track_data fuzz_date)
targets=("$@")
[ ${#targets[@]} -eq 0 ] && targets=("${all_targets[@]}")

case "$mode" in run|regress) ;; *) echo "usage: $0 run|regress [TARGET...]" >&2; exit 1 ;; esac

cmake -S . -B "$build" -G Ninja -DCMAKE_CXX_COMPILER=clang++ -DCMAKE_BUILD_TYPE=Debug -DMOLVAR_FUZZ=ON \
  -DMOLVAR_TESTS=OFF >/dev/null
cmake --build "$build" -j "${JOBS:-1}" >/dev/null

export ASAN_OPTIONS=${ASAN_OPTIONS:-detect_leaks=1:abort_on_error=0:allocator_may_return_null=0}
export UBSAN_OPTIONS=${UBSAN_OPTIONS:-print_stacktrace=1:halt_on_error=1}

# Whole files need room for a few lines of each kind; a date or a packet does not.
max_len() {
  case "$1" in
    fuzz_date) echo 256 ;;
    fuzz_mic_e|fuzz_aprs_position|fuzz_nmea) echo 1024 ;;
    *) echo 4096 ;;
  esac
}

# One fuzzing run of `target` for `secs` seconds, seeded from its corpus and from the scratch
# folder `scratch_root`/TARGET, which gets the new entries.
fuzz_for() {
  local target=$1 secs=$2 scratch_root=$3
  local exe="$build/fuzz/$target" scratch="$scratch_root/$target" artifacts="$build/artifacts/$target/"
  local log="$build/logs/$target.log"
  mkdir -p "$scratch" "$artifacts" "$(dirname "$log")" "$corpus_root/$target"
  local status=0
  "$exe" -max_total_time="$secs" -timeout=1 -rss_limit_mb=2048 -detect_leaks=1 -max_len="$(max_len "$target")" \
    -print_final_stats=1 -artifact_prefix="$artifacts" "$scratch" "$corpus_root/$target" >"$log" 2>&1 || status=$?
  local done_line execs
  done_line=$(grep -E '^#[0-9]+[[:space:]]+DONE' "$log" | tail -1 || true)
  execs=$(sed -n 's/^stat::number_of_executed_units: *//p' "$log" | tail -1)
  local cov ft
  cov=$(sed -n 's/.* cov: \([0-9]*\).*/\1/p' <<<"$done_line")
  ft=$(sed -n 's/.* ft: \([0-9]*\).*/\1/p' <<<"$done_line")
  local line="$target seconds=$secs executions=${execs:-?} cov=${cov:-?} ft=${ft:-?} status=$status"
  echo "$line"
  [ -n "${FUZZ_RESULTS:-}" ] && echo "$(date -u +%FT%TZ) $line" >>"$FUZZ_RESULTS"
  if [ "$status" -ne 0 ]; then
    echo "$target FAILED; log $log, reproducer in $artifacts" >&2
    grep -E 'ERROR|SUMMARY|==fuzz==|runtime error' "$log" | head -5 >&2 || true
    return 1
  fi
}

# Every corpus file of `target` once.
replay() {
  local target=$1
  local exe="$build/fuzz/$target" log="$build/logs/$target.replay.log"
  mkdir -p "$(dirname "$log")"
  local files=("$corpus_root/$target"/*)
  [ -e "${files[0]}" ] || { echo "$target: no corpus" >&2; return 1; }
  if ! "$exe" -timeout=1 -rss_limit_mb=2048 -detect_leaks=1 "${files[@]}" >"$log" 2>&1; then
    echo "$target FAILED on its corpus; log $log" >&2
    grep -E 'Running:|ERROR|SUMMARY|==fuzz==|runtime error' "$log" | tail -6 >&2 || true
    return 1
  fi
  echo "$target corpus: ${#files[@]} files replayed"
}

failed=0
for t in "${targets[@]}"; do
  if [ "$mode" = regress ]; then
    replay "$t" || { failed=1; continue; }
    # The short run starts from the committed corpus alone, so its length does not grow with the
    # scratch corpus of earlier long runs.
    rm -rf "$build/regress-corpus/$t"
    fuzz_for "$t" "$short" "$build/regress-corpus" || failed=1
  else
    fuzz_for "$t" "$seconds" "$build/corpus" || failed=1
  fi
done
exit $failed
