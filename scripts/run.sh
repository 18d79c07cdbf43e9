#!/usr/bin/env bash
# The main job: builds the library, its example program and the lumenutil tool, runs the
# example, then shows lumenutil at work on the bundled Touchstone file (a band-pass filter
# written by tools/make_bandpass_s2p.py): its description, the first rows of an export, the
# passband resampled onto five points, and SVG plots in build/example/.
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
cd "$root"
scripts/setup.sh
CC=gcc CXX=g++ cmake -S . -B build -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo >/dev/null
cmake --build build -j"$(nproc)" --target lumen_example lumenutil
build/tools/lumen_example

tool=build/tools/lumenutil
example=testdata/bandpass_filter.s2p
mkdir -p build/example
run() {
  echo
  echo "\$ lumenutil $*"
  "$tool" "$@"
}
run snp info "$example"
run snp export "$example" --params S21,S11 --format db --limit 5
run snp resample "$example" --start 2.3G --stop 2.5G --points 5 -o build/example/passband.s2p
run snp export build/example/passband.s2p --params S21,S11 --format db
run snp plot "$example" --params S21,S11,S22 -o build/example/bandpass_filter.svg
run snp plot "$example" --format smith -o build/example/bandpass_filter_smith.svg
echo
echo "Plots written to build/example/bandpass_filter.svg and build/example/bandpass_filter_smith.svg"
