#!/usr/bin/env bash
# Times dorvex and vpdload on generated installations of growing size, next to the floor of
# reading the same bytes with cat, and checks the performance targets.
#
#   bench/run_scale.sh [--scales "1 4 16 64"] [--runs N] [--wall] [--no-build] [--keep DIR]
#
# Builds Release in build-bench/ (BUILD_DIR overrides), generates one installation per
# scale (scale 64: 1024 switch chassis on one network, 4096 CECs with 8 SMA records each,
# 256 frames, about 8 MB of tables), and for each request prints the fastest wall time and
# the median CPU time of the request and of its floor (run alternately by time_pair.py),
# their ratio, the growth from the previous size and the peak memory. Takes about two
# minutes. Needs /usr/bin/time and python3.
#
# The targets are checked on CPU time (user + system of the process and its children, which
# is what a request costs whatever else the machine runs); --wall checks the fastest wall
# time instead, which is only meaningful on an otherwise idle machine.
set -euo pipefail

here=$(cd "$(dirname "$0")" && pwd)
repo=$(dirname "$here")
build=${BUILD_DIR:-$repo/build-bench}
scales=(1 4 16 64)
runs=21
import_runs=7
do_build=1
keep=""
judge=cpu

while [ $# -gt 0 ]; do
  case "$1" in
    --scales) read -r -a scales <<<"$2"; shift 2 ;;
    --runs) runs=$2; shift 2 ;;
    --no-build) do_build=0; shift ;;
    --wall) judge=wall; shift ;;
    --keep) keep=$2; shift 2 ;;
    -h|--help) sed -n '2,16p' "$0" | sed 's/^# \{0,1\}//'; exit 0 ;;
    *) echo "run_scale.sh: unknown argument $1" >&2; exit 2 ;;
  esac
done

for tool in /usr/bin/time python3; do
  command -v "$tool" >/dev/null || { echo "run_scale.sh: $tool is needed" >&2; exit 2; }
done

if [ "$do_build" = 1 ]; then
  cmake -S "$repo" -B "$build" -DDORVEX_BUILD_BENCH=ON -DCMAKE_BUILD_TYPE=Release >/dev/null
  cmake --build "$build" -j2 --target dorvex vpdload rackprobe nodebridge rackpower \
    gen_installation >/dev/null
fi
dorvex=$build/dorvex/dorvex
vpdload=$build/tools/vpdload/vpdload
rackprobe=$build/platform/rackprobe/rackprobe
gen=$build/bench/gen_installation

if [ -n "$keep" ]; then
  work=$keep
  mkdir -p "$work"
else
  work=$(mktemp -d "${TMPDIR:-/tmp}/run_scale.XXXXXX")
  trap 'rm -rf "$work"' EXIT
fi

# dorvex's traces (none are expected) stay out of syslog.
export CHRONICLE_LOG=/dev/null

results=$work/results.tsv
: >"$results"

# peak_kib CMD...: the largest resident set of the command, in KiB
peak_kib() {
  /usr/bin/time -v "$@" 2>&1 >/dev/null | awk -F': ' '/Maximum resident set size/ {print $2}'
}

# measure REQUEST SCALE TABLE_BYTES RUNS "FLOOR FILES" CMD...
measure() {
  local request=$1 scale=$2 table_bytes=$3 n=$4 floor_files=$5
  shift 5
  local times kib
  # shellcheck disable=SC2086  # the floor files are a list
  times=$("$here/time_pair.py" "$n" -- "$@" -- cat $floor_files) ||
    { echo "run_scale.sh: timing '$*' failed" >&2; exit 1; }
  kib=$(peak_kib "$@")
  printf '%s\t%s\t%s\t%s\t%s\n' "$request" "$scale" "$table_bytes" "$times" "$kib" >>"$results"
}

for scale in "${scales[@]}"; do
  root=$work/scale$scale
  rm -rf "$root"
  "$gen" --scale "$scale" "$root" >/dev/null
  mkdir -p "$root/bin"
  ln -s "$rackprobe" "$root/bin/rackprobe"
  export OLV_ROOT=$root
  data=$root/data
  tables="$data/chassis_vpd.db $data/bpa_vpd.db $data/sma_vpd.db"
  # shellcheck disable=SC2086
  table_bytes=$(stat -c %s $tables | awk '{s += $1} END {print s}')

  # The last switch chassis and the last CEC that the dump lists.
  read -r sw_frame sw_cage < <(awk '$3 == "SW_CHIP" {f = $1; c = $2} END {print f, c}' "$root/etc/rackprobe.dump")
  read -r cec_frame cec_cage < <(awk '$3 == "SMA" {f = $1; c = $2} END {print f, c}' "$root/etc/rackprobe.dump")

  declare -A cmd=(
    [netvpd]="-y netvpd -n 1"
    [part]="-y switch -f $sw_frame -c $sw_cage -r dca -h 1"
    [location]="-y cec -f $cec_frame -c $cec_cage"
    [poll]="-y cec -t 0"
    [dump]="-y all"
  )
  declare -A floor=(
    [netvpd]="$tables $work/netvpd.out"
    [part]="$data/chassis_vpd.db"
    [location]="$data/sma_vpd.db"
    [poll]="$data/sma_vpd.db $work/poll.out"
    [dump]="$tables $work/dump.out"
  )
  for request in netvpd part location poll dump; do
    # shellcheck disable=SC2086  # the options are words
    if ! "$dorvex" ${cmd[$request]} >"$work/$request.out"; then
      echo "run_scale.sh: dorvex ${cmd[$request]} failed at scale $scale" >&2
      exit 1
    fi
    # shellcheck disable=SC2086
    measure "$request" "$scale" "$table_bytes" "$runs" "${floor[$request]}" "$dorvex" ${cmd[$request]}
  done

  # vpdload: export once, then time the import of that inventory into a data folder of its own.
  "$vpdload" export "$work/inventory.json"
  import_dir=$work/import$scale
  mkdir -p "$import_dir"
  measure import "$scale" "$table_bytes" "$import_runs" "$work/inventory.json $tables" \
    "$vpdload" --data "$import_dir" import "$work/inventory.json"
  for t in chassis_vpd.db bpa_vpd.db sma_vpd.db; do
    cmp -s "$data/$t" "$import_dir/$t" || { echo "run_scale.sh: import changed $t" >&2; exit 1; }
  done
  rm -rf "$root" "$import_dir"
  unset cmd floor
done

echo "Machine: $(nproc) cores, $(awk '/MemTotal/ {printf "%.0f GiB", $2 / 1048576}' /proc/meminfo)," \
  "$(lscpu | awk -F': *' '/Model name/ {print $2}'), load average $(cut -d' ' -f1-3 /proc/loadavg)"
echo
python3 - "$results" "${scales[-1]}" "$judge" <<'EOF'
import sys

rows = [line.rstrip("\n").split("\t") for line in open(sys.argv[1])]
largest = sys.argv[2]
by_cpu = sys.argv[3] == "cpu"
print("Targets checked on %s time." % ("CPU" if by_cpu else "wall"))
print()
MIB = 1024 * 1024
print("| request | scale | tables | wall ms | floor wall ms | CPU ms | floor CPU ms | ratio | growth | peak RSS | check |")
print("|---|---:|---:|---:|---:|---:|---:|---:|---:|---:|---|")
previous = {}
failures = 0
for request, scale, table_bytes, t, cpu, f, fcpu, kib in rows:
    table_bytes, t, cpu, f, fcpu = int(table_bytes), float(t), float(cpu), float(f), float(fcpu)
    rss = int(kib) * 1024
    judged, judged_floor = (cpu, fcpu) if by_cpu else (t, f)
    ratio = judged / judged_floor
    growth = judged / previous[request] if request in previous else None
    previous[request] = judged
    failed = []
    if request == "netvpd" and scale == largest and ratio > 3:
        failed.append("ratio > 3")
    if request in ("part", "location") and ratio > 2:
        failed.append("ratio > 2")
    if growth is not None and growth > 4.5:
        failed.append("growth > 4.5")
    if request != "import" and rss > table_bytes + 32 * MIB:
        failed.append("memory > tables + 32 MiB")
    failures += bool(failed)
    print("| %s | %s | %.2f MB | %.2f | %.2f | %.2f | %.2f | %.2f | %s | %.1f MiB | %s |" % (
        request, scale, table_bytes / 1e6, t, f, cpu, fcpu, ratio,
        "%.2f" % growth if growth is not None else "-", rss / MIB,
        "FAIL: " + ", ".join(failed) if failed else "PASS"))
print()
print("%d of %d rows failed" % (failures, len(rows)) if failures else "all %d rows pass" % len(rows))
EOF
