#!/usr/bin/env bash
# Builds dorvex, installs the example installation under demo-root/ and asks dorvex a few
# questions about it. Safe to run again: demo-root/ is rebuilt every time.
#   ./demo.sh
set -euo pipefail
cd "$(dirname "$0")"
here=$PWD

./scripts/install-deps.sh
# The flags of ./test.sh, so that the two share build/.
cmake -S . -B build -DDORVEX_WERROR=ON >/dev/null
cmake --build build -j2 --target dorvex vpdload rackprobe

root=$here/demo-root
rm -rf "$root"
mkdir -p "$root/data" "$root/etc" "$root/bin"
export OLV_ROOT=$root
# The database's traces go to a file instead of the system log.
export CHRONICLE_LOG=$root/trace.log

build/tools/vpdload/vpdload import examples/installation.json
cp examples/hwserver.json examples/rackprobe.dump "$root/etc/"
cp build/platform/rackprobe/rackprobe "$root/bin/rackprobe"
echo "Example installation ready in demo-root/ (traces in demo-root/trace.log)."

# Prints the command, its output (at most `limit` lines) and its exit status.
limit=0
ask() {
  local out status=0
  echo
  echo "\$ dorvex $*"
  out=$(build/dorvex/dorvex "$@") || status=$?
  if [ -n "$out" ]; then
    local -a lines
    mapfile -t lines <<<"$out"
    if [ "$limit" -gt 0 ] && [ "${#lines[@]}" -gt "$limit" ]; then
      printf '%s\n' "${lines[@]:0:limit}"
      echo "... ($((${#lines[@]} - limit)) more lines)"
    else
      printf '%s\n' "$out"
    fi
  fi
  echo "(exit status $status)"
}

echo
echo "A part request: the first DCA of the switch chassis in frame 2, cage 3."
ask -y switch -f 2 -c 3 -r dca -h 1
echo
echo "A FRU request: the controller of side 2 of frame 1's BPA (cage 255)."
ask -y bpa -f 1 -c 255 -r bpc -a 2
echo
echo "A location request: the CEC in frame 2, cage 6."
ask -y cec -f 2 -c 6
echo
echo "An MTMS request: where is the BPA 9458-100*02B7E20?"
ask -y bpa -m '9458-100*02B7E20'
echo
echo "The change poll: the SMA table's time, then one line per CEC ..."
ask -y cec -t 0
poll=$(build/dorvex/dorvex -y cec -t 0)
stamp=${poll%%$'\n'*}
echo
echo "... and asked again with that time: nothing has changed."
ask -y cec -t "$stamp"
echo
echo "The switch chassis of network 2."
ask -y switch -n 2
echo
echo "The network VPD of network 1: every switch chassis with its cables, then the BPAs."
limit=43
ask -y netvpd -n 1
limit=0
echo
echo "Data that is not there: frame 3 has no switch chassis."
ask -y switch -f 3 -c 3 -r planar
echo
echo "Try more: OLV_ROOT=$root build/dorvex/dorvex -y all   (see examples/README.md)"
