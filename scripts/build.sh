#!/usr/bin/env bash
# Configures and builds the project into build/ (or $BUILD_DIR) from the
# CMake preset $HF_PRESET (default "default"; CI uses "ci", where warnings
# are errors). Extra configure options: $CMAKE_EXTRA_ARGS.
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
build=${BUILD_DIR:-$root/build}
# shellcheck disable=SC2086
cmake --preset "${HF_PRESET:-default}" -S "$root" -B "$build" ${CMAKE_EXTRA_ARGS:-} >/dev/null
cmake --build "$build" -j"$(nproc)"
