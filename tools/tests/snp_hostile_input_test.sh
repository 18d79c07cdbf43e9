#!/usr/bin/env bash
# Hostile and odd inputs: bounded plots, values beyond their range, truncated or disordered
# data, unusable reference resistances, ignored options, old Mac line ends and unprintable
# bytes each give a clear message (or a warning) and the right exit status, never nonsense
# with status 0. Usage: snp_hostile_input_test.sh LUMENUTIL SOURCE_DIR
set -uo pipefail
source "$(dirname "$0")/tool_test_common.sh"

# run ARGS...: sets $out (stdout and stderr) and $status.
run() { out=$("$tool" "$@" 2>&1); status=$?; }
expect_failure() {  # expect_failure REGEX ARGS...
  local regex=$1
  shift
  run "$@"
  [[ $status -eq 1 ]] || fail "'$*' exited $status, not 1:"$'\n'"$out"
  expect_line "$out" "$regex"
}

# Plots: a 100,001-point trace draws about two vertices per px column, not 100,001.
python3 - "$work/long.s2p" <<'PY'
import math, sys
with open(sys.argv[1], "w") as f:
    f.write("# Hz S RI R 50\n")
    for i in range(100001):
        a = 0.5 + 0.4 * math.sin(i / 50.0)
        f.write(f"{1e6 + i * 1e4:.0f} {a:.6f} 0 0.5 0 0.5 0 {a:.6f} 0.1\n")
PY
run snp plot "$work/long.s2p" -o "$work/long.svg"
[[ $status -eq 0 ]] || fail "plot of 100,001 points failed: $out"
vertices=$(grep -o '<polyline[^>]*points="[^"]*"' "$work/long.svg" | grep -o '[0-9.]*,[0-9.]*' |
  wc -l)
((vertices > 0 && vertices <= 4 * 2 * 700)) || fail "4 traces drew $vertices vertices"
((vertices > 4 * 690)) || fail "the reduced plot kept only $vertices vertices"
run snp plot "$work/long.s2p" --format smith -o "$work/smith.svg"
[[ $status -eq 0 ]] || fail "smith plot of 100,001 points failed: $out"
(($(stat -c %s "$work/smith.svg") < 400000)) || fail "the Smith chart is $(stat -c %s "$work/smith.svg") bytes"

# More than 64 traces are refused, saying how to choose.
{
  echo "[Version] 2.0"; echo "# Hz S RI R 50"; echo "[Number of Ports] 9"; echo "[Network Data]"
  printf '1'; for _ in $(seq 81); do printf ' 0.1 0'; done; echo
} >"$work/nine.s9p"
expect_failure '81 traces are too many for one plot \(at most 64\); choose the traces with --params' \
  snp plot "$work/nine.s9p" -o "$work/nine.svg"
[[ ! -e "$work/nine.svg" ]] || fail "a refused plot wrote its output"
run snp plot "$work/nine.s9p" --params S11,S21 -o "$work/nine.svg"
[[ $status -eq 0 ]] || fail "a plot of two chosen traces of nine ports failed: $out"

# Values beyond their range fail with the line instead of turning into nan rows.
printf '# GHz S RI R 50\n1 0.5 0 0 0 0 0 0 0\n1e300 0.5 0 0 0 0 0 0 0\n' >"$work/inf.s2p"
expect_failure "inf\.s2p: line 3: '1e300' GHz is beyond the range of a stimulus value" \
  snp resample "$work/inf.s2p" --start 1G --stop 2G --points 3 -o "$work/out.s2p"
printf '# GHz S RI R 50\n1 0.5 0 1e39 0 0 0 0 0\n' >"$work/big.s2p"
expect_failure "line 2: '1e39' is beyond the range of a single-precision value" \
  snp info "$work/big.s2p"

# A version 2 file with fewer points than it declares is truncated.
printf '[Version] 2.0\n# Hz S RI R 50\n[Number of Ports] 1\n[Number of Frequencies] 5\n[Network Data]\n1 1 0\n2 1 0\n' \
  >"$work/short.s1p"
expect_failure 'declares 5 points, but the network data holds 2: the file is truncated' \
  snp export "$work/short.s1p"
sed 's/\] 5$/] 1/' "$work/short.s1p" >"$work/long.s1p"
run snp info "$work/long.s1p"
expect_line "$out" '^points +1 \(as \[Number of Frequencies\] declares; the points after them were ignored\)$'

# Frequencies that do not ascend are read, but not resampled.
printf '# Hz S RI R 50\n1 1 0\n3 1 0\n2 1 0\n' >"$work/disorder.s1p"
run snp info "$work/disorder.s1p"
[[ $status -eq 0 ]] || fail "info refused a file with disordered frequencies"
expect_failure "disorder\.s1p: line 4: 2 Hz does not ascend from 3 Hz before it; interpolating needs strictly ascending frequencies" \
  snp resample "$work/disorder.s1p" --start 1 --stop 2 --points 2 -o "$work/out.s1p"

# Unusable reference resistances: info says so; z and y are refused.
for r in 0 -50; do
  printf '# Hz S RI R %s\n1 0.5 0\n2 0.5 0\n' "$r" >"$work/r.s1p"
  run snp info "$work/r.s1p"
  expect_line "$out" "^reference +$r ohm, not usable: impedances and admittances need a resistance above 0$"
  for format in z y; do
    expect_failure "the reference resistance of port 1 is $r ohm, which is not usable" \
      snp export "$work/r.s1p" --format $format
  done
  run snp export "$work/r.s1p" --format db
  [[ $status -eq 0 ]] || fail "db export refused a file with R $r"
done
printf '[Version] 2.0\n# Hz S RI R 50\n[Number of Ports] 2\n[Reference] 50 0\n[Network Data]\n1 0 0 0 0 0 0 0 0\n' >"$work/ref.s2p"
expect_failure "port 2 is 0 ohm" snp export "$work/ref.s2p" --format z --params S22
run snp export "$work/ref.s2p" --format z --params S11
[[ $status -eq 0 ]] || fail "z of port 1 with a usable reference was refused: $out"

# Ignored option tokens: one warning each, naming what the file is read as.
printf '# THz S RI R 50\n1 0.5 0\n' >"$work/thz.s1p"
run snp info "$work/thz.s1p"
[[ $status -eq 0 ]] || fail "info refused an ignored unit"
expect_line "$out" "^lumenutil: warning: .*thz\.s1p: option 'THZ' ignored; frequencies read in GHz$"
printf '# MHz Q RI\n1 0.5 0\n' >"$work/q.s1p"
run snp export "$work/q.s1p"
expect_line "$out" "option 'Q' ignored; the file is read as MHz, S-parameters, RI, R 50$"
run snp info "$work/q.s1p"
expect_line "$out" '^reference +50 ohm \(the file names no reference resistance\)$'

# Old Mac text: a lone CR ends a line.
printf '# GHz S RI R 50\r1 0.5 0\r2 0.25 0\r' >"$work/mac.s1p"
run snp export "$work/mac.s1p"
[[ $status -eq 0 ]] || fail "lone CR line ends refused: $out"
expect_line "$out" '^2e\+09,0\.25,0$'

# Unprintable bytes are quoted, and a NUL does not cut the message short.
printf '# GHz S RI R 50\n1 0.5 x\0y\033z\n' >"$work/nul.s1p"
expect_failure "line 2: 'x.x00y.x1Bz' is not a number \(in the data point that starts at line 2\)$" \
  snp info "$work/nul.s1p"

# A two-port file failing after a frequency drop hints at the noise marker.
printf '# GHz S RI R 50\n1 0 0 0 0 0 0 0 0\n2 0 0 0 0 0 0 0 0\n1 2 0.5 45 0.2\n' >"$work/noise.s2p"
expect_failure "the frequency drops at line 4; noise data there needs a '! Noise Parameters' comment before it\)$" \
  snp info "$work/noise.s2p"

# Input that is not Touchstone is refused at its first lines, whatever its size, and memory
# stays bounded: under a 512 MB limit a 2 GB file, and /dev/zero without end, fail at once.
# (A sanitized build reserves terabytes of shadow memory, so it runs without the limit.)
memory_limit=524288
grep -qa AddressSanitizer "$tool" && memory_limit=unlimited
truncate -s 2G "$work/zeros.s2p"
for input in "$work/zeros.s2p" /dev/zero; do
  out=$(ulimit -v $memory_limit; timeout 20 "$tool" snp info "$input" 2>&1)
  status=$?
  [[ $status -eq 1 ]] || fail "info $input exited $status: $out"
  expect_line "$out" "line 1: the option line \(starting with '#'\) is missing$"
done

# "-" reads standard input in every command.
run snp info - <"$example"
expect_line "$out" '^ports +2$'
"$tool" snp export - --params S21 <"$example" | head -n 2 >"$work/stdin.csv"
expect_line "$(cat "$work/stdin.csv")" '^frequency_Hz,S21_re,S21_im$'
cat "$example" | "$tool" snp resample - --start 2.3G --stop 2.5G --points 3 -o "$work/stdin.s2p" ||
  fail "resample from a pipe failed"
[[ $(grep -cv '^[!#]' "$work/stdin.s2p") -eq 3 ]] || fail "resample from a pipe wrote the wrong points"
out=$(printf '# Hz RI\n1 x\n' | "$tool" snp info - 2>&1) && fail "bad standard input exited 0"
expect_line "$out" "^lumenutil: standard input: line 2: 'x' is not a number"

exit $((failures > 0))
