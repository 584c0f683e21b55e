#!/usr/bin/env bash
# Bounded fuzzing run: builds the libFuzzer targets with clang into
# build-fuzz/ and runs each for a fixed time, one after another.
#
# Usage: scripts/fuzz.sh [-t SECONDS] [-m] [TARGET...]
#   -t SECONDS  time per target (default 60; $FUZZ_SECONDS also sets it)
#   -m          afterwards merge what raised coverage into fuzz/corpus/<target>
#   TARGET      e.g. is_this_eps eps_wrapper (default: every target)
# Environment: FUZZ_BUILD_DIR (default <repo>/build-fuzz), FUZZ_JOBS (build
# jobs, default 2), FUZZ_ARGS (extra libFuzzer flags).
#
# New inputs go to build-fuzz/corpus/<target>; the committed seeds in
# fuzz/corpus/<target> are only read unless -m is given. Crashes, leaks and
# time-outs are written as build-fuzz/artifacts/<target>/crash-* etc., and
# the script exits non-zero when any target found one. Each run's log is
# build-fuzz/logs/<target>.log; the last status line (#runs, cov:, ft:)
# of each is printed at the end.
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
build=${FUZZ_BUILD_DIR:-$root/build-fuzz}
seconds=${FUZZ_SECONDS:-60}
merge=0
while getopts "t:mh" option; do
  case $option in
    t) seconds=$OPTARG ;;
    m) merge=1 ;;
    *) sed -n '2,19p' "$0"; exit 2 ;;
  esac
done
shift $((OPTIND - 1))

# The target list lives in fuzz/FuzzTargets.cmake, beside the build rules.
read -r -a all_targets < <(cmake -DHF_PRINT_FUZZ_TARGETS=ON -P "$root/fuzz/FuzzTargets.cmake" 2>&1)
targets=("$@")
[ "${#targets[@]}" -eq 0 ] && targets=("${all_targets[@]}")

cmake --preset fuzz -S "$root" -B "$build" >/dev/null
build_targets=()
for t in "${targets[@]}"; do build_targets+=("fuzz_$t"); done
cmake --build "$build" -j"${FUZZ_JOBS:-2}" --target "${build_targets[@]}"

export ASAN_OPTIONS=${ASAN_OPTIONS:-detect_leaks=1}
export UBSAN_OPTIONS=${UBSAN_OPTIONS:-print_stacktrace=1:halt_on_error=1}

failed=()
for t in "${targets[@]}"; do
  work="$build/corpus/$t"
  artifacts="$build/artifacts/$t"
  log="$build/logs/$t.log"
  mkdir -p "$work" "$artifacts" "$(dirname "$log")"
  echo "fuzz: $t for ${seconds}s (log $log)"
  # Read-only seeds come last: libFuzzer writes new inputs to the first directory.
  # shellcheck disable=SC2086
  if ! "$build/bin/fuzz_$t" -max_total_time="$seconds" -timeout=10 -rss_limit_mb=2048 \
      -print_final_stats=1 -artifact_prefix="$artifacts/" ${FUZZ_ARGS:-} \
      "$work" "$root/fuzz/corpus/$t" >"$log" 2>&1; then
    failed+=("$t")
  fi
  if [ "$merge" -eq 1 ]; then
    "$build/bin/fuzz_$t" -merge=1 "$root/fuzz/corpus/$t" "$work" >>"$log" 2>&1 || true
  fi
done

printf '\n%-20s %s\n' target "last status"
for t in "${targets[@]}"; do
  status=$(grep -E '^#[0-9]+' "$build/logs/$t.log" | tail -n 1 || true)
  printf '%-20s %s\n' "$t" "${status:-no status line; see the log}"
done
if [ "${#failed[@]}" -gt 0 ]; then
  echo "fuzz: findings in ${failed[*]}; inputs in $build/artifacts/" >&2
  exit 1
fi
