#!/usr/bin/env bash
# Builds and runs the whole test suite twice: with g++, then with clang under
# AddressSanitizer and UndefinedBehaviorSanitizer; then the phase tests, where two threads
# meet, once more under ThreadSanitizer.
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
cd "$root"
scripts/setup.sh
jobs=$(nproc)

echo "== Plain build (g++)"
CC=gcc CXX=g++ cmake -S . -B build -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo >/dev/null
cmake --build build -j"$jobs"
ctest --test-dir build --output-on-failure -j"$jobs"

echo "== Sanitized build (clang, ASan + UBSan)"
CC=clang CXX=clang++ cmake -S . -B build-asan -G Ninja -DCMAKE_BUILD_TYPE=Debug \
  -DLUMEN_SANITIZE=ON -DLUMEN_BUILD_BENCH=OFF >/dev/null
cmake --build build-asan -j"$jobs"
ASAN_OPTIONS=detect_leaks=1:abort_on_error=1 UBSAN_OPTIONS=print_stacktrace=1 \
  ctest --test-dir build-asan --output-on-failure -j"$jobs"

# The acquisition component is the one place where two threads meet: its tests run again
# under ThreadSanitizer, which a report fails.
echo "== Thread-sanitized phase tests (clang, TSan)"
CC=clang CXX=clang++ cmake -S . -B build-tsan -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo \
  -DCMAKE_CXX_FLAGS=-fsanitize=thread -DLUMEN_BUILD_BENCH=OFF -DLUMEN_BUILD_TOOLS=OFF >/dev/null
cmake --build build-tsan -j"$jobs" --target phase_tests
TSAN_OPTIONS=halt_on_error=1 build-tsan/phase/phase_tests
