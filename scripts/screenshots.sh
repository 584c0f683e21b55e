#!/usr/bin/env bash
# Renders the settings panel (English and German) and the custom page size
# dialog, and the manager's window and folder dialog, into docs/ under a
# virtual display.
# Usage: scripts/screenshots.sh [build-directory]
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
build="${1:-$root/build}"
cmake --preset default -S "$root" -B "$build" >/dev/null
cmake --build "$build" --target ui_panel_screenshots manager_screenshots hf_catalogues -j2
for language in en de; do
  xvfb-run -a -s "-screen 0 1280x1024x24" "$build/bin/ui_panel_screenshots" "$root/docs" "$language"
  # The manager as a desktop of that language runs it: the toolkit's own
  # buttons come translated from the system's catalogues.
  locale=C.UTF-8
  [ "$language" = de ] && locale=de_DE.UTF-8
  LC_ALL=$locale xvfb-run -a -s "-screen 0 2560x1200x24" \
    "$build/bin/manager_screenshots" "$root/docs" "$language"
done
ls -1 "$root"/docs/settings-panel-*.png "$root"/docs/custom-page-size-*.png "$root"/docs/manager-*.png
