#!/usr/bin/env bash
# Runs `lumenutil snp resample` and reads its output back: the version 1 writer must give the
# reader the very numbers it started from. Usage: snp_resample_test.sh LUMENUTIL SOURCE_DIR
set -uo pipefail
source "$(dirname "$0")/tool_test_common.sh"

# Three ports (rows of pairs over several lines) and awkward values survive the round trip.
cat >"$work/three.ts" <<'TS'
[Version] 2.0
# GHz S RI R 75
[Number of Ports] 3
[Network Data]
1 0.1 -0.2 1e-7 3.3333333 -0.999999 0 4 5 6 7 8 9 10 11 12 13 14 0.7
2 1 2 3 4 5 6 7 8 9 10 11 12 13 14 15 16 17 18
3 -1 -2 -3 -4 -5 -6 -7 -8 -9 -10 -11 -12 -13 -14 -15 -16 -17 1.17549435e-38
TS
"$tool" snp resample "$work/three.ts" --start 1G --stop 3GHz --points 3 -o "$work/three.s3p" ||
  fail "resampling the three-port file failed"
same_export "$work/three.ts" "$work/three.s3p"
grep -q '^# HZ S RI R 75$' "$work/three.s3p" || fail "option line of three.s3p"

# A two-port file in 11 12 21 22 order comes back in version 1 order with the same traces.
cat >"$work/order.ts" <<'TS'
[Version] 2.0
# MHz S MA R 50
[Number of Ports] 2
[Two-Port Data Order] 12_21
[Network Data]
100 0.5 0 0.2 10 0.1 90 0.4 45
200 0.6 10 0.2 5 0.3 80 0.5 40
300 0.7 20 0.2 0 0.5 70 0.6 35
TS
"$tool" snp resample "$work/order.ts" --start 100M --stop 300M --points 3 -o "$work/order.s2p"
same_export "$work/order.ts" "$work/order.s2p" --params S11,S12,S21,S22
"$tool" snp info "$work/order.s2p" | grep -Eq '^data order +11 21 12 22$' || fail "order.s2p order"

# Onto twice as many points: every other new point is an old one and keeps its value (to a
# float's last digits: the phase fit may move a point that sits a fraction of a hertz off).
"$tool" snp resample "$example" --start 1.5G --stop 3.5G --points 801 -o "$work/fine.s2p" ||
  fail "resampling the example failed"
"$tool" snp export "$example" -f ri | cut -d, -f2- >"$work/coarse.csv"
"$tool" snp export "$work/fine.s2p" -f ri | cut -d, -f2- | awk 'NR == 1 || NR % 2 == 0' >"$work/even.csv"
python3 - "$work/coarse.csv" "$work/even.csv" <<'PY' || fail "old points changed in fine.s2p"
import sys
a, b = (open(p).read().splitlines() for p in sys.argv[1:])
assert len(a) == len(b) == 402 and a[0] == b[0], (len(a), len(b))
worst = max(abs(float(x) - float(y)) for ra, rb in zip(a[1:], b[1:])
            for x, y in zip(ra.split(","), rb.split(",")))
assert worst < 1e-6, worst
PY
"$tool" snp info "$work/fine.s2p" | grep -Eq '^points +801$' || fail "fine.s2p point count"
"$tool" snp resample "$example" --start 1.6G --stop 3.4G --points 50 --log -o "$work/log.s2p" ||
  fail "logarithmic resampling failed"

# Beyond the file's range only with --hold-ends, which holds the end values.
message=$("$tool" snp resample "$example" --start 1G --stop 3.5G --points 11 -o "$work/wide.s2p" 2>&1) &&
  fail "a sweep beyond the file was accepted"
grep -q -- '--hold-ends' <<<"$message" || fail "no hint at --hold-ends in: $message"
"$tool" snp resample "$example" --start 1G --stop 3.5G --points 11 --hold-ends -o "$work/wide.s2p" ||
  fail "--hold-ends failed"
held=$("$tool" snp export "$work/wide.s2p" -f ri -n 1 | tail -n 1 | cut -d, -f2-)
first=$("$tool" snp export "$example" -f ri -n 1 | tail -n 1 | cut -d, -f2-)
[[ $held == "$first" ]] || fail "1 GHz does not hold the 1.5 GHz values: $held vs $first"

# Noise data goes along.
printf '# GHz S MA R 50\n! Noise Parameters\n1 0.5 0 0.1 90 0.2 0 0.4 45\n2 0.6 10 0.3 80 0.2 5 0.5 40\n1 3 0.5 45 0.2\n2 4 0.25 30 0.3\n' >"$work/noise.s2p"
"$tool" snp resample "$work/noise.s2p" --start 1G --stop 2G --points 2 -o "$work/noise_out.s2p"
"$tool" snp info "$work/noise_out.s2p" | grep -Eq '^noise data +2 points' || fail "noise data lost"
same_export "$work/noise.s2p" "$work/noise_out.s2p"

for args in "--start x --stop 2G --points 3" "--start 0 --stop 2G --points 3 --log" \
            "--start 1G --stop 2G --points 0" "--start 1G --stop 2G --points 10000001"; do
  # shellcheck disable=SC2086
  "$tool" snp resample "$work/noise.s2p" $args -o "$work/bad.s2p" 2>/dev/null &&
    fail "accepted: $args"
done
# The sweep written must ascend; one point at a single frequency is a sweep.
message=$("$tool" snp resample "$example" --start 3G --stop 2G --points 3 -o "$work/d.s2p" 2>&1) &&
  fail "a descending sweep was accepted"
expect_line "$message" '^lumenutil: --start 3G is above --stop 2G: the new sweep must ascend$'
message=$("$tool" snp resample "$example" --start 2G --stop 2G --points 3 -o "$work/e.s2p" 2>&1) &&
  fail "three points at one frequency were accepted"
expect_line "$message" '^lumenutil: --start and --stop are equal: 3 points need --stop above --start$'
"$tool" snp resample "$example" --start 2G --stop 2G --points 1 -o "$work/one.s2p" ||
  fail "one point at one frequency was refused"
"$tool" snp resample --help | grep -q '1 to 10000000' || fail "--help does not state the point limit"
"$tool" snp resample "$example" --start 2G --stop 3G --points 3 -o "$work/x.s4p" 2>/dev/null &&
  fail "a two-port network was written to a .s4p file"

# Stimulus steps far below one unit (a time-domain file in seconds, 1 ns apart) are
# interpolated, not copied from a neighbour within 0.1 s: the unit circle at 0, 90 and 180
# degrees gives 45 degrees halfway between the first two points.
printf '# SEC S RI R 50
0 1 0
1e-9 0 1
2e-9 -1 0
' >"$work/time.s1p"
"$tool" snp resample "$work/time.s1p" --start 0.5e-9 --stop 1.5e-9 --points 2 -o "$work/time_out.s1p" ||
  fail "resampling a time-domain file failed"
halfway=$("$tool" snp export "$work/time_out.s1p" -f ma -n 1 | tail -n 1)
[[ $halfway =~ ^5e-10,(0\.99999|1)[0-9]*,(44\.9999|45)[0-9.]*$ ]] ||
  fail "halfway in a time-domain file reads $halfway, not magnitude 1 at 45 degrees"
exit $((failures > 0))
