#!/usr/bin/env bash
# The whole test suite built with AddressSanitizer and UndefinedBehavior-
# Sanitizer (leak checking on) and run under ctest on a virtual display.
#
# Usage: scripts/sanitize.sh [CTEST ARGS...]     e.g. scripts/sanitize.sh -L store
# Environment: SANITIZE_BUILD_DIR (default <repo>/build-asan), SANITIZE_JOBS
# (build and test jobs, default 2), CMAKE_EXTRA_ARGS (more configure options).
#
# Leaks reported from the font configuration and session bus libraries are
# suppressed through tests/lsan.supp; everything else fails the test.
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
build=${SANITIZE_BUILD_DIR:-$root/build-asan}
jobs=${SANITIZE_JOBS:-2}

# shellcheck disable=SC2086
cmake --preset asan -S "$root" -B "$build" ${CMAKE_EXTRA_ARGS:-} >/dev/null
cmake --build "$build" -j"$jobs"

export ASAN_OPTIONS=${ASAN_OPTIONS:-detect_leaks=1}
export UBSAN_OPTIONS=${UBSAN_OPTIONS:-print_stacktrace=1:halt_on_error=1}
# GTK's accessibility bridge keeps a few strings from start-up to the end;
# no test needs it.
export NO_AT_BRIDGE=1
export LSAN_OPTIONS=${LSAN_OPTIONS:-suppressions=$root/tests/lsan.supp:print_suppressions=0}

cd "$build"
xvfb-run -a -s "-screen 0 1280x1024x24" ctest --output-on-failure -j"$jobs" "$@"
