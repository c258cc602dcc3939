#!/usr/bin/env bash
# Builds the libFuzzer targets with clang (AddressSanitizer + UndefinedBehaviorSanitizer) in
# build-fuzz/ and runs each for SECONDS on a copy of its committed corpus. Fails when a
# target crashes, leaks, times out, runs out of memory or a sanitizer reports anything.
#   tests/fuzz/run_fuzzers.sh SECONDS [TARGET...]      (default: every target)
# The committed corpus is not changed. The work folder (new inputs, logs, crash inputs) is
# kept when a target fails and removed otherwise.
set -euo pipefail
seconds=${1:?usage: run_fuzzers.sh SECONDS [TARGET...]}
shift
root=$(cd "$(dirname "$0")/../.." && pwd)
cd "$root"
targets=("$@")
if [ ${#targets[@]} -eq 0 ]; then
  targets=(tables chiplist hwserver inventory args)
fi

cmake -S . -B build-fuzz -DCMAKE_CXX_COMPILER=clang++ -DCMAKE_C_COMPILER=clang \
  -DDORVEX_FUZZ=ON -DDORVEX_BUILD_TESTS=ON >/dev/null
cmake --build build-fuzz -j2 --target "${targets[@]/#/fuzz_}"

work=$(mktemp -d "${TMPDIR:-/tmp}/fuzz-run.XXXXXX")
failed=()
for t in "${targets[@]}"; do
  mkdir -p "$work/$t/corpus" "$work/$t/artifacts"
  cp tests/fuzz/corpus/"$t"/* "$work/$t/corpus/"
  log="$work/$t/fuzz.log"
  echo "== fuzz_$t for ${seconds}s"
  status=0
  build-fuzz/tests/fuzz/fuzz_"$t" -max_total_time="$seconds" -rss_limit_mb=2048 -timeout=10 \
    -print_final_stats=1 -artifact_prefix="$work/$t/artifacts/" "$work/$t/corpus" \
    >"$log" 2>&1 || status=$?
  # The exit status covers crashes, leaks, timeouts and out-of-memory; the log check catches
  # a sanitizer report that did not end the run.
  if [ "$status" -ne 0 ] || grep -qE 'ERROR: (AddressSanitizer|LeakSanitizer|libFuzzer)|runtime error:' "$log"; then
    echo "fuzz_$t FAILED (status $status); log and inputs in $work/$t:"
    grep -E -A25 'ERROR|runtime error:|check failed' "$log" | head -60 || tail -30 "$log"
    failed+=("$t")
  else
    grep -E '^#[0-9]+.*DONE' "$log" | tail -1 || true
    grep -E 'stat::(number_of_executed_units|average_exec_per_sec)' "$log" || true
  fi
done
if [ ${#failed[@]} -ne 0 ]; then
  echo "failed: ${failed[*]}; logs and inputs in $work"
  exit 1
fi
rm -rf "$work"
echo "all fuzz targets ran ${seconds}s without a finding"
