#!/usr/bin/env bash
# Builds the Debian packages liblumenutility1, liblumenutility-dev and lumenutil: a Release
# build with Debian's hardening flags in build-package/ (tests, benchmarks and fuzz targets
# are not built), `cpack -G DEB`, then lintian on the three packages, which fails on errors.
# The packages are written to build-package/packages/.
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
cd "$root"
scripts/setup.sh
build=build-package

# The compiler and linker flags Debian builds its own packages with (stack protector,
# fortified sources, read-only relocations, immediate binding), file names relative to the
# source tree so that the binaries do not record where they were built.
export DEB_BUILD_MAINT_OPTIONS=hardening=+all
CXXFLAGS="$(dpkg-buildflags --get CPPFLAGS) $(dpkg-buildflags --get CXXFLAGS)"
LDFLAGS=$(dpkg-buildflags --get LDFLAGS)
export CXXFLAGS LDFLAGS

echo "== Release build in $build"
CC=gcc CXX=g++ cmake -S . -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=Release \
  -DCMAKE_INSTALL_PREFIX=/usr -DLUMEN_BUILD_TESTS=OFF -DLUMEN_BUILD_BENCH=OFF >/dev/null
cmake --build "$build" -j"$(nproc)"

echo "== cpack -G DEB"
rm -rf "$build/packages"
(cd "$build" && cpack -G DEB)

echo "== lintian"
lintian --info --display-info "$build"/packages/*.deb
echo "lintian: no errors"
ls -l "$build"/packages/*.deb
