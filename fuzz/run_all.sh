#!/usr/bin/env bash
# Builds every libFuzzer target with clang and runs each for the given number of seconds
# (default 60). Usage: fuzz/run_all.sh [SECONDS] [TARGET-NAME-FILTER]
set -euo pipefail
seconds=${1:-60}
filter=${2:-}
root=$(cd "$(dirname "$0")/.." && pwd)
build="$root/build-fuzz"
CC=clang CXX=clang++ cmake -S "$root" -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo \
  -DLUMEN_FUZZ=ON -DLUMEN_BUILD_TESTS=OFF -DLUMEN_BUILD_BENCH=OFF -DLUMEN_BUILD_TOOLS=OFF >/dev/null
cmake --build "$build" -j"$(nproc)"
status=0
for target in "$build"/fuzz/*_fuzz; do
  name=$(basename "$target")
  [[ -n "$filter" && "$name" != *"$filter"* ]] && continue
  corpus="$build/corpus/$name"
  mkdir -p "$corpus"
  seeds=("$root/fuzz/seeds/$name")
  [[ -d "${seeds[0]}" ]] || seeds=()
  echo "== $name for ${seconds}s"
  # -timeout makes an input that runs 10 s a finding (a hang), not just a slow run.
  if ! ASAN_OPTIONS=halt_on_error=1 UBSAN_OPTIONS=halt_on_error=1:print_stacktrace=1 \
      "$target" -max_total_time="$seconds" -timeout=10 -rss_limit_mb=2048 -print_final_stats=1 \
      -artifact_prefix="$build/$name-" \
      "$corpus" "${seeds[@]}" 2>"$build/$name.log"; then
    echo "!! $name found a problem; see $build/$name.log"
    status=1
  fi
  # A report that did not stop the run still counts as a finding.
  if grep -qE 'runtime error:|ERROR: (Address|Undefined|Leak)Sanitizer|ERROR: libFuzzer' \
      "$build/$name.log"; then
    echo "!! $name: sanitizer or libFuzzer report in $build/$name.log"
    status=1
  fi
  tail -n 12 "$build/$name.log" | grep -E 'stat::number_of_executed_units|Done|ERROR' || true
done
exit $status
