#!/usr/bin/env bash
# The main job on the shipped example: set-up, build, then the reference host.
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
"$root/scripts/setup.sh"
"$root/scripts/build.sh"
exec "$root/scripts/example-job.sh"
