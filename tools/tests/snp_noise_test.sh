#!/usr/bin/env bash
# The noise data of a two-port file in the tool: `snp info` lists the records, `snp export
# --noise` prints them and `snp plot --format nf` draws NFmin. Usage: snp_noise_test.sh
# LUMENUTIL SOURCE_DIR
set -uo pipefail
source "$(dirname "$0")/tool_test_common.sh"

# Three noise records at their own frequencies, between and beside the network points.
cat >"$work/amp.s2p" <<'TS'
# GHz S MA R 50
1 0.5 0 3.1 90 0.02 0 0.4 45
2 0.6 10 3.2 80 0.02 5 0.5 40
3 0.6 20 3.0 70 0.02 9 0.5 35
! Noise Parameters
1.5 0.8 0.5 45 0.2
2.5 1.1 0.25 -30 0.3
3.5 1.6 0 0 0.5
TS
info=$("$tool" snp info "$work/amp.s2p") || fail "info failed"
expect_line "$info" '^noise data +3 points \(NFmin, GammaOpt, Rn\)$'
expect_line "$info" '^ +frequency +NFmin \(dB\) +\|GammaOpt\| +angle \(deg\) +Rn \(ohm\)$'
expect_line "$info" '^ +1\.5 GHz +0\.8 +0\.5 +45 +10$'
expect_line "$info" '^ +2\.5 GHz +1\.1 +0\.25 +-30 +15$'
expect_line "$info" '^ +3\.5 GHz +1\.6 +0 +0 +25$'

table=$("$tool" snp export "$work/amp.s2p" --noise) || fail "export --noise failed"
[[ $(wc -l <<<"$table") -eq 4 ]] || fail "export --noise gave:"$'\n'"$table"
expect_line "$table" '^frequency_Hz,NFmin_dB,GammaOpt_mag,GammaOpt_deg,Rn_ohm$'
python3 - "$table" <<'PY' || fail "exported noise records differ from the file"
import sys
rows = [list(map(float, r.split(","))) for r in sys.argv[1].splitlines()[1:]]
want = [(1.5e9, 0.8, 0.5, 45, 10), (2.5e9, 1.1, 0.25, -30, 15), (3.5e9, 1.6, 0, 0, 25)]
for got, w in zip(rows, want):
    assert got[0] == w[0], got
    assert all(abs(g - x) < 1e-5 * max(1, abs(x)) for g, x in zip(got[1:], w[1:])), (got, w)
PY
# NFmin is kept as a float noise factor: its dB come back to a float's digits.
expect_line "$("$tool" snp export "$work/amp.s2p" --noise -d ';' -n 1)" '^1\.5e\+09;0\.(8|7999[0-9]*);0\.5;45;10$'
message=$("$tool" snp export "$example" --noise 2>&1) && fail "export --noise of a file without noise exited 0"
expect_line "$message" 'bandpass_filter\.s2p: holds no noise data$'
"$tool" snp export "$work/amp.s2p" --noise --format db >/dev/null 2>&1
[[ $? -eq 2 ]] || fail "--noise with --format is not a usage error"

"$tool" snp plot "$work/amp.s2p" --format nf -o "$work/nf.svg" || fail "plot --format nf failed"
grep -q 'amp\.s2p: minimum noise figure' "$work/nf.svg" || fail "no title in nf.svg"
grep -q 'NFmin (dB)' "$work/nf.svg" || fail "no axis label in nf.svg"
grep -q '<polyline' "$work/nf.svg" || fail "no curve in nf.svg"
message=$("$tool" snp plot "$example" --format nf -o "$work/none.svg" 2>&1) && fail "plot nf without noise exited 0"
expect_line "$message" 'holds no noise data$'
[[ ! -e "$work/none.svg" ]] || fail "a refused plot left a file"
# resample writes version 1 unless told otherwise; noise data that version 1 cannot hold
# (here: starting above the new sweep's last point) is left out with a warning, and kept in
# version 2.
message=$("$tool" snp resample "$work/amp.s2p" --start 1G --stop 1.2G --points 3 -o "$work/low.s2p" 2>&1) ||
  fail "resample below the noise data failed"
expect_line "$message" '^lumenutil snp resample: warning: noise data not written: version 1 noise data must start at or below the last network point \(1\.2 GHz\) for a reader to tell it from network data, but it starts at 1\.5 GHz; write version 2$'
expect_line "$("$tool" snp info "$work/low.s2p")" '^noise data +none$'
"$tool" snp resample "$work/amp.s2p" --start 1G --stop 1.2G --points 3 --version 2 -o "$work/low2.s2p" ||
  fail "resample --version 2 failed"
diff <("$tool" snp export "$work/amp.s2p" --noise) <("$tool" snp export "$work/low2.s2p" --noise) ||
  fail "resample --version 2 changed the noise records"
exit $((failures > 0))
