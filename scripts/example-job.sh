#!/usr/bin/env bash
# The example job: makes a hot folder from examples/ in a scratch directory,
# runs it once with the reference host and says where the PostScript went.
# Needs a built tree (scripts/build.sh); no root rights: the machine-wide
# store goes into the scratch directory too.
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
build=${BUILD_DIR:-$root/build}
host="$build/bin/hotfolder"
scratch=${EXAMPLE_DIR:-$root/out/example}
folder="$scratch/HotFolder"

if [ ! -x "$host" ]; then
  echo "example-job: $host is missing; build first (scripts/build.sh)" >&2
  exit 1
fi

# Start from a clean scratch directory each time.
rm -rf -- "$scratch"
mkdir -p -- "$scratch"
export HOTFOLDER_WAREHOUSE_ROOT="$scratch/machine"

echo "== The filter module"
"$host" info | sed -n '1,7p'

echo
echo "== A hot folder bound to the example server, converting to PostScript on Letter"
"$host" init "$folder" --server "$root/examples/server-description.xml" --name "Example"
"$host" settings "$folder" --set OUTPUTFILETYPEEPS=0 OUTPUTFILETYPEPS=1 \
  DEFAULTPAGESIZE=Letter "IMAGEPOSITION=Center"

echo
echo "== Dropping the example files in and running the folder"
cp -- "$root"/examples/eps/*.eps "$folder/"
status=0
"$host" run "$folder" --stats || status=$?

echo
echo "== Results"
echo "PostScript files and their job tickets: $folder/Output"
ls -1 "$folder/Output"
echo "Originals kept:   $folder/[_Orv_HotFolder_]/[MoveFolder]"
echo "Left in the folder (refused): $(cd "$folder" && ls -p | grep -v / | tr '\n' ' ')"
exit "$status"
