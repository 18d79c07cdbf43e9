#!/usr/bin/env bash
# Installs the built library into a scratch prefix and builds and runs a downstream program
# against it through find_package and through pkg-config.
# Usage: check_install.sh BUILD_DIR SCRATCH_DIR
set -euo pipefail
build=$1
scratch=$2
here=$(cd "$(dirname "$0")" && pwd)
rm -rf "$scratch"
cmake --install "$build" --prefix "$scratch/prefix" >/dev/null
# Simulated drivers are for tests and development machines, never part of the package.
if find "$scratch/prefix" -name 'libFerrule*' | grep -q .; then
  echo "a simulated driver was installed" >&2
  exit 1
fi
export PKG_CONFIG_PATH="$scratch/prefix/lib/pkgconfig:$scratch/prefix/lib/x86_64-linux-gnu/pkgconfig"
cmake -S "$here" -B "$scratch/build" -G Ninja -DCMAKE_PREFIX_PATH="$scratch/prefix" >/dev/null
cmake --build "$scratch/build" >/dev/null
libdir=$(dirname "$(find "$scratch/prefix" -name 'liblumenutility.so' | head -n 1)")
LD_LIBRARY_PATH="$libdir" "$scratch/build/consumer_cmake"
LD_LIBRARY_PATH="$libdir" "$scratch/build/consumer_pkgconfig"
