#!/usr/bin/env bash
# The Debian packages as a downstream project meets them: builds them from BUILD_DIR with
# cpack, checks what each holds and depends on, unpacks all three into a scratch root
# (dpkg-deb -x; nothing is installed on the machine), then configures, builds and runs a small
# consumer against that root twice, finding the library with find_package and with
# pkg-config. The consumer reads the bundled Touchstone file and prints S21 at 2.4 GHz, which
# must match the file's own row. The scratch root is removed afterwards.
# Usage: packaging/downstream_test.sh BUILD_DIR
set -euo pipefail
here=$(cd "$(dirname "$0")" && pwd)
source_dir=$(cd "$here/.." && pwd)
build=$(cd "$1" && pwd)

fail() {
  echo "downstream test: $*" >&2
  exit 1
}

# Packages of this very build.
rm -rf "$build/packages"
(cd "$build" && cpack -G DEB >"$build/cpack.log" 2>&1) ||
  { cat "$build/cpack.log" >&2; fail "cpack -G DEB failed in $build"; }
version=$(sed -n 's/^set(CPACK_PACKAGE_VERSION "\(.*\)")$/\1/p' "$build/CPackConfig.cmake")
arch=$(dpkg --print-architecture)
lib_deb="$build/packages/liblumenutility1_${version}_${arch}.deb"
dev_deb="$build/packages/liblumenutility-dev_${version}_${arch}.deb"
tool_deb="$build/packages/lumenutil_${version}_${arch}.deb"
for deb in "$lib_deb" "$dev_deb" "$tool_deb"; do
  [[ -f $deb ]] || fail "cpack did not write $(basename "$deb"); it wrote: $(ls "$build/packages")"
done
count=$(find "$build/packages" -maxdepth 1 -name '*.deb' | wc -l)
((count == 3)) || fail "cpack wrote $count packages, not 3: $(ls "$build/packages")"

# What each package holds: the expected files, and nothing a test, benchmark or fuzz target
# or the simulated phase reference driver left in the install tree.
contents() {  # the paths, without the targets of links
  dpkg-deb -c "$1" | sed -E 's/ -> .*//' | awk '{$1 = $2 = $3 = $4 = $5 = ""; sub(/^ +/, ""); print}' |
    sed 's|^\./|/|'
}
expect() {  # DEB PATTERN WHAT
  contents "$1" | grep -Eq "$2" || fail "$(basename "$1") lacks $3"
}
for deb in "$lib_deb" "$dev_deb" "$tool_deb"; do
  if leaked=$(contents "$deb" | grep -Ei '_tests?$|_test\.|bench|fuzz|Ferrule|gtest|gmock'); then
    fail "$(basename "$deb") holds test-only files: $leaked"
  fi
  expect "$deb" '^/usr/share/doc/[^/]+/copyright$' "a copyright file"
done
expect "$lib_deb" '^/usr/lib/([^/]+/)?liblumenutility\.so\.1$' "liblumenutility.so.1"
if contents "$lib_deb" | grep -Eq '\.so$|/include/|\.pc$|\.cmake$'; then
  fail "$(basename "$lib_deb") holds development files"
fi
expect "$dev_deb" '^/usr/lib/([^/]+/)?liblumenutility\.so$' "the link liblumenutility.so"
expect "$dev_deb" '^/usr/include/lumen/core\.h$' "the headers"
expect "$dev_deb" '/pkgconfig/lumenutility\.pc$' "the pkg-config file"
expect "$dev_deb" '/cmake/LumenUtility/LumenUtilityConfig\.cmake$' "the CMake package"
expect "$tool_deb" '^/usr/bin/lumenutil$' "the tool"
expect "$tool_deb" '^/usr/share/man/man1/lumenutil\.1\.gz$' "the manual page"

depends() { dpkg-deb -f "$1" Depends; }
depends "$dev_deb" | grep -Fq "liblumenutility1 (= $version)" ||
  fail "liblumenutility-dev does not depend on liblumenutility1 (= $version): $(depends "$dev_deb")"
depends "$dev_deb" | grep -Eq '(^|, )libboost-dev( |,|$)' ||
  fail "liblumenutility-dev does not depend on libboost-dev: $(depends "$dev_deb")"
depends "$tool_deb" | grep -Fq "liblumenutility1 (= $version)" ||
  fail "lumenutil does not depend on liblumenutility1 (= $version): $(depends "$tool_deb")"
depends "$lib_deb" | grep -Eq '(^|, )libc6 ' ||
  fail "liblumenutility1 has no dependencies computed from its binary: $(depends "$lib_deb")"

# The scratch root and the consumer's builds.
scratch=$(mktemp -d "${TMPDIR:-/tmp}/lumen-downstream.XXXXXX")
trap 'rm -rf "$scratch"' EXIT
root="$scratch/root"
for deb in "$lib_deb" "$dev_deb" "$tool_deb"; do
  dpkg-deb -x "$deb" "$root"
done
libdir=$(dirname "$(find "$root/usr/lib" -name 'liblumenutility.so.1' | head -n 1)")
pcdir=$(dirname "$(find "$root/usr/lib" -name 'lumenutility.pc' | head -n 1)")

# S21 of the file's 2.4 GHz row: -1.23498 dB, -7.8422 degrees.
expected_output="S21 at 2.4e+09 Hz: -1.2350 dB, -7.842 deg"
run_consumer() {  # HOW BUILD_DIR
  local output
  output=$(LD_LIBRARY_PATH="$libdir" "$2/consumer" "$source_dir/testdata/bandpass_filter.s2p" 2.4e9) ||
    fail "the consumer built with $1 failed"
  [[ $output == "$expected_output" ]] ||
    fail "the consumer built with $1 printed '$output', not '$expected_output'"
  # The library it ran with is the unpacked one.
  LD_LIBRARY_PATH="$libdir" ldd "$2/consumer" | grep -q "liblumenutility.so.1 => $libdir/" ||
    fail "the consumer built with $1 does not load the unpacked library"
  echo "$1: $output"
}

# find_package, through the prefix path alone: the CMake package files locate everything
# relative to their own place.
cmake -S "$here/downstream" -B "$scratch/cmake" -G Ninja -DLUMEN_FIND=cmake \
  -DCMAKE_PREFIX_PATH="$root/usr" >"$scratch/cmake.log" 2>&1 ||
  { cat "$scratch/cmake.log" >&2; fail "configuring with find_package failed"; }
found=$(sed -n 's/^LumenUtility_DIR:PATH=//p' "$scratch/cmake/CMakeCache.txt")
[[ $found == "$root/"* ]] || fail "find_package found LumenUtility in '$found', not in the root"
cmake --build "$scratch/cmake" >"$scratch/cmake-build.log" 2>&1 ||
  { cat "$scratch/cmake-build.log" >&2; fail "building with find_package failed"; }
run_consumer find_package "$scratch/cmake"

# pkg-config, searching the root only; the file names /usr, which the sysroot maps into it.
export PKG_CONFIG_LIBDIR="$pcdir" PKG_CONFIG_PATH="" PKG_CONFIG_SYSROOT_DIR="$root"
flags=$(pkg-config --cflags --libs lumenutility)
[[ $flags == *"-I$root/usr/include"* && $flags == *"-L$libdir"* ]] ||
  fail "pkg-config gives '$flags', not paths into the root"
cmake -S "$here/downstream" -B "$scratch/pkg-config" -G Ninja -DLUMEN_FIND=pkg-config \
  >"$scratch/pkg-config.log" 2>&1 ||
  { cat "$scratch/pkg-config.log" >&2; fail "configuring with pkg-config failed"; }
cmake --build "$scratch/pkg-config" >"$scratch/pkg-config-build.log" 2>&1 ||
  { cat "$scratch/pkg-config-build.log" >&2; fail "building with pkg-config failed"; }
run_consumer pkg-config "$scratch/pkg-config"

# The packaged tool runs on the packaged library, and its packaged manual page renders.
tool_version=$(LD_LIBRARY_PATH="$libdir" "$root/usr/bin/lumenutil" version) ||
  fail "the packaged lumenutil does not run"
[[ $tool_version == "lumenutil $version" ]] ||
  fail "the packaged lumenutil says '$tool_version', not 'lumenutil $version'"
man_warnings=$(MANWIDTH=80 man --warnings -l "$root/usr/share/man/man1/lumenutil.1.gz" 2>&1 >/dev/null)
[[ -z $man_warnings ]] || fail "the packaged manual page does not render cleanly: $man_warnings"
echo "packaged tool: $tool_version, manual page renders"

echo "downstream test passed: $(cd "$build/packages" && ls ./*.deb | tr '\n' ' ')"
