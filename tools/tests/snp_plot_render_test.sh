#!/usr/bin/env bash
# Draws the bundled example in every plot format and checks that a real SVG renderer
# (rsvg-convert) turns each picture into a PNG of the stated size. Exits 77 (skipped) when
# rsvg-convert is not installed. Usage: snp_plot_render_test.sh LUMENUTIL SOURCE_DIR
set -euo pipefail
command -v rsvg-convert >/dev/null || { echo "rsvg-convert not installed"; exit 77; }
source "$(dirname "$0")/tool_test_common.sh"
for format in logmag phase smith; do
  "$tool" snp plot "$example" --format "$format" -o "$work/$format.svg"
  grep -q '<polyline' "$work/$format.svg"
  rsvg-convert "$work/$format.svg" -o "$work/$format.png"
  # A PNG starts with its signature; its width sits in bytes 16-19 of the header.
  [[ $(head -c 8 "$work/$format.png" | od -An -tx1 | tr -d ' \n') == 89504e470d0a1a0a ]]
  width=$(od -An -tu1 -j16 -N4 "$work/$format.png" | awk '{print $1*16777216+$2*65536+$3*256+$4}')
  ((width >= 800)) || { echo "$format rendered $width px wide"; exit 1; }
done
grep -q '>S21<' "$work/logmag.svg"
grep -q '>2.5 GHz<' "$work/logmag.svg"
