#!/usr/bin/env bash
# Builds and runs the whole test suite twice: with g++ (then the API reference, which fails on
# an undocumented public member, and the Debian packages of that build with a downstream program
# built against them), then with clang under AddressSanitizer and UndefinedBehaviorSanitizer;
# then the tests of the code two threads meet (acquisition component, property bags,
# shared-memory names, debug print, beeper and tracing) under ThreadSanitizer.
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
cd "$root"
scripts/setup.sh
jobs=$(nproc)

echo "== Plain build (g++)"
# Installed under /usr, as the Debian packages are: the library goes to lib/<arch>.
CC=gcc CXX=g++ cmake -S . -B build -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo \
  -DCMAKE_INSTALL_PREFIX=/usr >/dev/null
cmake --build build -j"$jobs"
ctest --test-dir build --output-on-failure -j"$jobs"

# The API reference: a public class or function without a comment fails the build.
echo "== API reference (Doxygen)"
cmake --build build --target docs

echo "== Debian packages of the plain build, unpacked and used downstream"
packaging/downstream_test.sh build

echo "== Sanitized build (clang, ASan + UBSan)"
CC=clang CXX=clang++ cmake -S . -B build-asan -G Ninja -DCMAKE_BUILD_TYPE=Debug \
  -DLUMEN_SANITIZE=ON -DLUMEN_BUILD_BENCH=OFF >/dev/null
cmake --build build-asan -j"$jobs"
ASAN_OPTIONS=detect_leaks=1:abort_on_error=1 UBSAN_OPTIONS=print_stacktrace=1 \
  ctest --test-dir build-asan --output-on-failure -j"$jobs"

# Where two threads meet, the tests run again under ThreadSanitizer, which a report fails.
echo "== Thread-sanitized tests (clang, TSan)"
CC=clang CXX=clang++ cmake -S . -B build-tsan -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo \
  -DCMAKE_CXX_FLAGS=-fsanitize=thread -DLUMEN_BUILD_BENCH=OFF -DLUMEN_BUILD_TOOLS=OFF >/dev/null
cmake --build build-tsan -j"$jobs" --target phase_tests propertybag_tests capture_tests \
  diagnostics_tests platform_tests
export TSAN_OPTIONS=halt_on_error=1
build-tsan/phase/phase_tests
build-tsan/propertybag/propertybag_tests
build-tsan/diagnostics/diagnostics_tests
build-tsan/platform/platform_tests \
  --gtest_filter='TraceSession.*:AutoResetEvent.*:WorkerThread.*:JsonTraceFileSink.*'
# The capture tests also fork, which ThreadSanitizer does not follow; its thread test runs.
build-tsan/capture/capture_tests --gtest_filter='SharedMemoryRegistry.*'

