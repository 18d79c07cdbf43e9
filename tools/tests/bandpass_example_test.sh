#!/usr/bin/env bash
# The bundled example file is what its generator script writes. Exits 77 (skipped) without
# python3. Usage: bandpass_example_test.sh SOURCE_DIR
set -euo pipefail
command -v python3 >/dev/null || { echo "python3 not installed"; exit 77; }
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
python3 "$1/tools/make_bandpass_s2p.py" "$work/bandpass_filter.s2p"
diff -u "$1/testdata/bandpass_filter.s2p" "$work/bandpass_filter.s2p"
