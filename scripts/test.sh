#!/usr/bin/env bash
# The whole test suite: set-up, build, then every test under ctest; then the
# same suite again built with AddressSanitizer, UndefinedBehaviorSanitizer and
# leak checking (scripts/sanitize.sh). Window tests get their own virtual X
# display. HF_SKIP_SANITIZERS=1 leaves the second pass out.
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
"$root/scripts/setup.sh"
"$root/scripts/build.sh"
build=${BUILD_DIR:-$root/build}

status=0
(cd "$build" && xvfb-run -a -s "-screen 0 1280x1024x24" \
  ctest --output-on-failure -j"$(nproc)" "$@") || status=$?
if [ "${HF_SKIP_SANITIZERS:-0}" != 1 ]; then
  echo "== the suite again under the sanitizers =="
  "$root/scripts/sanitize.sh" "$@" || status=$((status ? status : $?))
fi
echo "== size of the tests against the product =="
"$root/scripts/count-lines.sh"
exit "$status"
