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
  if ! "$target" -max_total_time="$seconds" -rss_limit_mb=2048 -print_final_stats=1 \
      -artifact_prefix="$build/$name-" \
      "$corpus" "${seeds[@]}" 2>"$build/$name.log"; then
    echo "!! $name found a problem; see $build/$name.log"
    status=1
  fi
  tail -n 12 "$build/$name.log" | grep -E 'stat::number_of_executed_units|Done|ERROR' || true
done
exit $status
