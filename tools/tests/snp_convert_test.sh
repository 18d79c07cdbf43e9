#!/usr/bin/env bash
# Runs `lumenutil snp convert` and reads its output back: a file written in its own form and
# unit must give the reader the very same numbers, another form moves them by no more than
# that form's rounding, and a failed run leaves its target (and input) as they were.
# Usage: snp_convert_test.sh LUMENUTIL SOURCE_DIR
set -uo pipefail
source "$(dirname "$0")/tool_test_common.sh"
sha() { sha256sum <"$1"; }

# The example is a version 1 DB file in GHz: rewritten as it is and as version 2.0 it reads
# back bit for bit, and a second conversion gives the same text.
"$tool" snp convert "$example" "$work/same.s2p" 2>"$work/notes" || fail "convert failed"
[[ ! -s "$work/notes" ]] || fail "convert in the file's own form printed:"$'\n'"$(cat "$work/notes")"
grep -q '^# GHZ S DB R 50$' "$work/same.s2p" || fail "option line of same.s2p"
same_export "$example" "$work/same.s2p"
"$tool" snp convert "$example" "$work/v2.s2p" --version 2 || fail "convert --version 2 failed"
info=$("$tool" snp info "$work/v2.s2p")
expect_line "$info" '^version +2\.0$'
expect_line "$info" '^points +401$'
same_export "$example" "$work/v2.s2p"
"$tool" snp convert "$work/v2.s2p" "$work/v2again.s2p" 2>/dev/null
cmp -s <(grep -v '^!' "$work/v2.s2p") <(grep -v '^!' "$work/v2again.s2p") ||
  fail "a second conversion changed the text"
for keyword in '\[Version\] 2\.0' '\[Number of Ports\] 2' '\[Two-Port Data Order\] 21_12' \
               '\[Number of Frequencies\] 401' '\[Matrix Format\] Full' '\[Network Data\]' '\[End\]'; do
  grep -Eq "^$keyword\$" "$work/v2.s2p" || fail "v2.s2p lacks $keyword"
done

# RI in Hz holds every float; other forms and units move values by their rounding only, and
# the tool says how many moved.
"$tool" snp convert "$example" "$work/ri.s2p" --format ri --unit hz 2>"$work/notes"
[[ ! -s "$work/notes" ]] || fail "RI in Hz printed:"$'\n'"$(cat "$work/notes")"
same_export "$example" "$work/ri.s2p"
grep -q '^# HZ S RI R 50$' "$work/ri.s2p" || fail "option line of ri.s2p"
for form in ma db; do
  for unit in khz mhz ghz; do
    "$tool" snp convert "$work/ri.s2p" "$work/$form$unit.s2p" --format $form --unit $unit \
      2>"$work/notes" || fail "convert --format $form --unit $unit failed"
    upper=$(tr a-z A-Z <<<"$form $unit")
    grep -q "^# ${upper#* } S ${upper% *} R 50\$" "$work/$form$unit.s2p" || fail "option line of $form$unit"
    "$tool" snp diff "$work/ri.s2p" "$work/$form$unit.s2p" --tolerance-db 1e-5 --tolerance-deg 1e-4 \
      >/dev/null || fail "$form in $unit moved values beyond rounding"
  done
done
# The example's values came from DB text: DB holds them all again, MA not.
[[ ! -s "$work/notes" ]] || fail "DB in GHz printed:"$'\n'"$(cat "$work/notes")"
"$tool" snp convert "$work/ri.s2p" "$work/ma.s2p" --format ma 2>"$work/notes"
expect_line "$(cat "$work/notes")" '^lumenutil snp convert: note: [0-9]+ of 1604 values lie between the values MA can hold and were written to the nearest, moving by up to [0-9.e-]+ of their magnitude$'

# OUT = IN is allowed and goes through the temporary file.
cp "$example" "$work/dut.s2p"
"$tool" snp convert "$work/dut.s2p" "$work/dut.s2p" --version 2 --format ri || fail "convert onto IN failed"
grep -q '^\[Version\] 2\.0$' "$work/dut.s2p" || fail "dut.s2p was not rewritten"
same_export "$example" "$work/dut.s2p"

# A set the writer refuses leaves the target, and an input named as output, untouched:
# version 1 cannot hold noise data that starts above the last network point.
cat >"$work/noise.s2p" <<'TS'
[Version] 2.0
# GHz S MA R 50
[Number of Ports] 2
[Number of Frequencies] 2
[Number of Noise Frequencies] 2
[Network Data]
1 0.5 0 0.1 90 0.2 0 0.4 45
2 0.6 10 0.3 80 0.2 5 0.5 40
[Noise Data]
3 2.5 0.5 45 0.2
4 3 0.4 50 0.25
[End]
TS
printf 'keep me\n' >"$work/target.s2p"
message=$("$tool" snp convert "$work/noise.s2p" "$work/target.s2p" --version 1 2>&1)
status=$?
[[ $status -eq 1 ]] || fail "a refused conversion exited with $status"
expect_line "$message" "^lumenutil: cannot write $work/target.s2p: version 1 noise data must start at or below the last network point \\(2 GHz\\) for a reader to tell it from network data, but it starts at 3 GHz; write version 2\$"
[[ $(cat "$work/target.s2p") == "keep me" ]] || fail "a refused conversion changed its target"
before=$(sha "$work/noise.s2p")
"$tool" snp convert "$work/noise.s2p" "$work/noise.s2p" --version 1 2>/dev/null && fail "refusal onto IN exited 0"
[[ $(sha "$work/noise.s2p") == "$before" ]] || fail "a refused conversion onto IN changed IN"
# A directory that cannot be written: a clear message, the target's directory unchanged.
message=$("$tool" snp convert "$example" "$work/missing/x.s2p" 2>&1) && fail "convert into a missing directory exited 0"
expect_line "$message" 'x\.s2p: cannot be written: No such file or directory$'

# A write that fails midway leaves the target as it was and no temporary file: a file size
# limit of 8 KiB stops the 50 KB output, by SIGXFSZ or, where that is ignored, by EFBIG.
printf 'keep me\n' >"$work/target.s2p"
status=$( { (ulimit -f 8; exec "$tool" snp convert "$example" "$work/target.s2p" --format ri); } 2>/dev/null
  echo $?)
[[ $status -eq $((128 + $(kill -l XFSZ))) ]] || fail "a convert beyond the size limit exited with $status"
[[ $(cat "$work/target.s2p") == "keep me" ]] || fail "a convert stopped by SIGXFSZ changed its target"
message=$(ulimit -f 8; trap '' XFSZ; "$tool" snp convert "$example" "$work/target.s2p" --format ri 2>&1)
status=$?
[[ $status -eq 1 ]] || fail "a convert that hit EFBIG exited with $status"
expect_line "$message" "^lumenutil: $work/target\\.s2p: writing the Touchstone file failed: File too large\$"
[[ $(cat "$work/target.s2p") == "keep me" ]] || fail "a convert that hit EFBIG changed its target"

# Noise data keeps its own frequencies through a conversion, in either version.
"$tool" snp convert "$work/noise.s2p" "$work/noise_ri.s2p" --format ri || fail "noise convert failed"
diff <("$tool" snp export "$work/noise.s2p" --noise) <("$tool" snp export "$work/noise_ri.s2p" --noise) ||
  fail "the noise records changed"
same_export "$work/noise.s2p" "$work/noise_ri.s2p"
sed -i 's/^3 2.5/1.5 2.5/' "$work/noise.s2p"
"$tool" snp convert "$work/noise.s2p" "$work/noise_v1.s2p" --version 1 || fail "version 1 noise convert failed"
grep -q '^! Noise Parameters$' "$work/noise_v1.s2p" || fail "no noise marker in noise_v1.s2p"
diff <("$tool" snp export "$work/noise.s2p" --noise) <("$tool" snp export "$work/noise_v1.s2p" --noise) ||
  fail "the noise records changed in version 1"

# Options that do not fit the file.
printf '# SEC S RI R 50\n1e-9 1 0\n2e-9 0.5 0\n' >"$work/time.s1p"
message=$("$tool" snp convert "$work/time.s1p" "$work/t.s1p" --unit ghz 2>&1) && fail "--unit on a time file exited 0"
expect_line "$message" "^lumenutil: --unit sets a frequency unit, but $work/time.s1p holds time values \\(SEC\\)\$"
"$tool" snp convert "$work/time.s1p" "$work/t.s1p" --version 2 || fail "converting a time file failed"
grep -q '^# SEC S RI R 50$' "$work/t.s1p" || fail "the time file lost its unit"
message=$("$tool" snp convert "$example" "$work/x.s4p" 2>&1) && fail "a two-port network went into .s4p"
expect_line "$message" 'x\.s4p names 4 ports, but the network has 2$'
"$tool" snp convert "$example" "$work/x.s2p" --version 3 >/dev/null 2>&1
[[ $? -eq 2 ]] || fail "--version 3 is not a usage error"

leftovers=$(find "$work" -name '.*.??????' | head -n 3)
[[ -z "$leftovers" ]] || fail "temporary files left behind: $leftovers"
exit $((failures > 0))
