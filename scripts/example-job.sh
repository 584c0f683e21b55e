#!/usr/bin/env bash
# The example job, the whole road: a printer of its own (a private CUPS
# scheduler whose queue prints into a pipe this script reads, one file a
# job), a hot folder made from examples/ and bound to that queue, the
# hot-folder service started, the example files dropped in, each one waited
# for until the scheduler says it is printed, every printed page rendered to
# a PNG with Ghostscript, the folder's status, and everything it started
# stopped again. Needs a built tree (scripts/build.sh) and the CUPS
# scheduler (scripts/setup.sh installs it); the machine-wide store goes into
# the scratch directory, so nothing outside it changes.
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
build=${BUILD_DIR:-$root/build}
host="$build/bin/hotfolder"
scratch=${EXAMPLE_DIR:-$root/out/example}
folder="$scratch/HotFolder"
printed="$scratch/printed"
queue=example-press

say() { echo "example-job: $*" >&2; }
for needed in "$host" /usr/sbin/cupsd /usr/sbin/lpadmin /usr/bin/ppdc /usr/bin/gs; do
  if [ ! -x "$needed" ]; then
    say "$needed is missing; run scripts/setup.sh and scripts/build.sh first"
    exit 1
  fi
done

status=0
# Start from a clean scratch directory each time.
rm -rf -- "$scratch"
mkdir -p -- "$scratch" "$printed"
export HOTFOLDER_WAREHOUSE_ROOT="$scratch/machine"

# The scheduler's own directory: its filters run as the print user, which
# must reach it, so it lives under /tmp rather than in a private home.
cups=$(mktemp -d /tmp/hotfolder-example-cups.XXXXXX)
chmod 755 "$cups"
cupsd_pid='' reader_pid='' service_pid=''
cleanup() {
  set +e
  [ -n "$service_pid" ] && kill "$service_pid" 2>/dev/null && wait "$service_pid" 2>/dev/null
  [ -n "$cupsd_pid" ] && kill "$cupsd_pid" 2>/dev/null && wait "$cupsd_pid" 2>/dev/null
  if [ -n "$reader_pid" ]; then
    kill "$reader_pid" 2>/dev/null && wait "$reader_pid" 2>/dev/null
    # Its last cat waits for a writer: one that opens and closes ends it.
    exec 3<>"$cups/device" && exec 3>&-
  fi
  rm -rf -- "$cups"
  return 0
}
trap cleanup EXIT
trap 'exit 130' INT TERM

# A free loopback port: one nobody answers on.
port=''
for candidate in $(seq 47631 47731); do
  if ! (exec 3<>"/dev/tcp/127.0.0.1/$candidate") 2>/dev/null; then
    port=$candidate
    break
  fi
done
[ -n "$port" ] || { say "no free loopback port for the scheduler"; exit 1; }
export CUPS_SERVER="127.0.0.1:$port"

mkdir -p "$cups"/{spool/tmp,cache,state,log,conf,ppd}
cat >"$cups/cupsd.conf" <<EOF
Listen 127.0.0.1:$port
LogLevel warn
DefaultAuthType None
WebInterface No
MaxJobs 0
Browsing Off
<Location />
  Order allow,deny
  Allow all
</Location>
<Location /admin>
  Order allow,deny
  Allow all
</Location>
<Policy default>
  <Limit All>
    Order deny,allow
  </Limit>
</Policy>
EOF
cat >"$cups/cups-files.conf" <<EOF
FileDevice Yes
Printcap
ServerRoot $cups/conf
RequestRoot $cups/spool
TempDir $cups/spool/tmp
CacheDir $cups/cache
StateDir $cups/state
ErrorLog $cups/log/error_log
AccessLog $cups/log/access_log
PageLog $cups/log/page_log
EOF

echo "== A printer of the example's own: CUPS at $CUPS_SERVER, queue $queue"
/usr/sbin/cupsd -f -c "$cups/cupsd.conf" -s "$cups/cups-files.conf" &
cupsd_pid=$!
for _ in $(seq 100); do
  (exec 3<>"/dev/tcp/127.0.0.1/$port") 2>/dev/null && break
  sleep 0.1
done
# The queue's device is a pipe read into one stream; the jobs in it are
# told apart afterwards by the first line each PostScript job starts with.
mkfifo -m 666 "$cups/device"
(while :; do cat "$cups/device"; done) >>"$scratch/printed.stream" &
reader_pid=$!
ppdc -d "$cups/ppd" /usr/share/cups/drv/sample.drv 2>/dev/null
/usr/sbin/lpadmin -h "$CUPS_SERVER" -p "$queue" -v "file://$cups/device" \
  -P "$cups/ppd/generic.ppd" -E 2>&1 | grep -v deprecated || true
lpstat -h "$CUPS_SERVER" -l -p "$queue" | sed -n '1,3p'

echo
echo "== The filter module"
"$host" info | sed -n '1,7p'

echo
echo "== A hot folder bound to the queue, converting to PostScript on Letter"
"$host" init "$folder" --printer "$queue" --name "Example"
"$host" settings "$folder" --set OUTPUTFILETYPEEPS=0 OUTPUTFILETYPEPS=1 \
  DEFAULTPAGESIZE=Letter "IMAGEPOSITION=Center"

echo
echo "== The hot-folder service, and the example files dropped in"
"$host" serve --settle 200 2>"$scratch/service.log" &
service_pid=$!
for _ in $(seq 100); do
  grep -q "serving $folder" "$scratch/service.log" && break
  sleep 0.1
done
cp -- "$root"/examples/eps/*.eps "$folder/"
ls -1 "$root"/examples/eps/

# Printed once each: the files the filter takes (not-really.eps it refuses)
# are each one completed job in the folder's printed-jobs log.
log="$folder/[_Orv_HotFolder_]/printed-jobs.log"
expected=$(ls "$root"/examples/eps/*.eps | grep -vc not-really)
for _ in $(seq 600); do
  done_jobs=$(grep -c $'\tcompleted\t' "$log" 2>/dev/null || true)
  [ "${done_jobs:-0}" -ge "$expected" ] && break
  sleep 0.1
done
"$host" stop >/dev/null || true
wait "$service_pid" || true
service_pid=''
sed 's/^<[0-9]>//' "$scratch/service.log"

echo
echo "== Printed pages, rendered"
# printed-jobs.log: time, verdict, queue, job id, name, work id, reason.
completed=$(awk -F'\t' '$2 == "completed"' "$log" | sort -t $'\t' -k4,4n)
# Each job the queue printed starts with a line "%!PS-Adobe-3.0" (an embedded
# EPS's first line goes on with " EPSF-3.0"), after the end-of-job ^D of the
# job before, and names its original in its first %%Title line.
pieces=$(mktemp -d "$scratch/.pieces.XXXXXX")
for _ in $(seq 50); do
  rm -f "$pieces"/*
  csplit -s -z -f "$pieces/job-" -n 3 "$scratch/printed.stream" \
    "/^"$'\x04'"\{0,1\}%!PS-Adobe-3\.0"$'\r'"\{0,1\}\$/" '{*}' 2>/dev/null || true
  [ "$(ls "$pieces" | wc -l)" -ge "$expected" ] && break
  sleep 0.1
done
for piece in "$pieces"/job-*; do
  [ -e "$piece" ] || continue
  title=$(grep -a -m1 '^%%Title: ' "$piece" | tr -d '\r')
  name=${title#%%Title: /}
  page="$printed/${name%.*}.ps"
  sed '1s/^\x04//' "$piece" >"$page"
  rm -f -- "$piece"
  gs -q -dSAFER -dBATCH -dNOPAUSE -sDEVICE=png16m -r40 -sOutputFile="${page%.ps}.png" "$page" ||
    { say "Ghostscript cannot render $page"; status=1; }
  job=$(awk -F'\t' -v name="$name" '$5 == name { print $4 }' <<<"$completed" | tr '\n' ' ')
  echo "CUPS job ${job% }, $name: $page ($(wc -c <"$page") bytes), ${page%.ps}.png"
done
rmdir -- "$pieces" 2>/dev/null || true
printed_count=$(ls "$printed"/*.ps 2>/dev/null | wc -l)
twice=$(cut -f5 <<<"$completed" | sort | uniq -d | tr '\n' ' ')
if [ "$(grep -c . <<<"$completed")" -ne "$expected" ] || [ "$printed_count" -ne "$expected" ] ||
  [ -n "$twice" ]; then
  say "expected $expected files printed once each; the scheduler completed" \
    "$(grep -c . <<<"$completed") job(s), $printed_count came out${twice:+, twice: $twice}"
  status=1
fi

echo
echo "== Status"
"$host" status | sed -n '1,40p'

echo
echo "== Where things are"
echo "Printed files and their pictures: $printed"
echo "PostScript files and their job tickets: $folder/Output"
echo "Originals kept: $folder/[_Orv_HotFolder_]/[MoveFolder]"
echo "Left in the folder (refused): $(cd "$folder" && ls -p | grep -v / | tr '\n' ' ')"
echo "The service's messages: $scratch/service.log"
exit "$status"
