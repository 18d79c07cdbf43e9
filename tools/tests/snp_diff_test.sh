#!/usr/bin/env bash
# Runs `lumenutil snp diff` as a regression check would: the largest differences and where
# they occur, and the exit status (0 within the tolerances, 1 outside, 2 on an error).
# Usage: snp_diff_test.sh LUMENUTIL SOURCE_DIR
set -uo pipefail
source "$(dirname "$0")/tool_test_common.sh"
run() {  # run EXPECTED_STATUS ARGS...: the output (stdout and stderr) of lumenutil snp diff
  local expected=$1
  shift
  out=$("$tool" snp diff "$@" 2>&1)
  local status=$?
  [[ $status -eq $expected ]] || fail "snp diff $* exited with $status, not $expected:"$'\n'"$out"
}

# Identical files: every difference 0, exit 0.
cp "$example" "$work/copy.s2p"
run 0 "$example" "$work/copy.s2p"
expect_line "$out" '^B +.*copy\.s2p: 401 points, 1\.5 GHz to 3\.5 GHz, the points of A$'
expect_line "$out" '^S21 +0 +1\.5 GHz +0 +1\.5 GHz$'
expect_line "$out" '^result +within 0 dB and 0 degrees$'

# A 0.1 dB change of S21 at 2.4 GHz is found there, and only there (its phase moves by the
# rounding of the new float parts, some 1e-7 degrees).
awk '$1 == "2.4000" { $4 = sprintf("%.5f", $4 + 0.1) } { print }' "$example" >"$work/changed.s2p"
run 1 "$example" "$work/changed.s2p" --tolerance-deg 1e-5
expect_line "$out" '^S21 +0\.1 +2\.4 GHz +[0-9.e-]+ +(1\.5|2\.4) GHz$'
expect_line "$out" '^S11 +0 +1\.5 GHz +0 +1\.5 GHz$'
expect_line "$out" '^result +outside 0 dB and 1e-05 degrees: S21 by 0\.1 dB at 2\.4 GHz$'
run 0 "$example" "$work/changed.s2p" --tolerance-db 0.11 --tolerance-deg 1e-5
expect_line "$out" '^result +within 0\.11 dB and 1e-05 degrees$'
run 1 "$example" "$work/changed.s2p" --tolerance-db 0.11
run 0 "$example" "$work/changed.s2p" --params S11,S22
[[ $(grep -c '^S' <<<"$out") -eq 2 ]] || fail "--params S11,S22 gave:"$'\n'"$out"
# The per-point differences as CSV: one row per point of A, the change in its row.
run 1 "$example" "$work/changed.s2p" --format csv --params S21
expect_line "$out" '^frequency_Hz,S21_dB,S21_deg$'
[[ $(wc -l <<<"$out") -eq 402 ]] || fail "the CSV has $(wc -l <<<"$out") lines"
expect_line "$out" '^2\.4e\+09,0\.(0999|1000)[0-9]*,[0-9.e-]+$'
[[ $(grep -vc ',0,0$' <<<"$out") -eq 2 ]] || fail "more than one point differs:"$'\n'"$(grep -v ',0,0$' <<<"$out" | head)"

# Different grids: B is carried onto A's points by circular interpolation.
"$tool" snp resample "$example" --start 1.5G --stop 3.5G --points 1601 -o "$work/fine.s2p"
run 0 "$example" "$work/fine.s2p" --tolerance-db 1e-4 --tolerance-deg 1e-3
expect_line "$out" '^B +.*fine\.s2p: 1601 points, 1\.5 GHz to 3\.5 GHz, carried onto the points of A by circular interpolation$'
# The other way round B is interpolated exactly as the resampling did.
run 0 "$work/fine.s2p" "$example"
run 1 "$work/fine.s2p" "$work/changed.s2p" --tolerance-db 0.05 --tolerance-deg 1
expect_line "$out" '^S21 +0\.1 +2\.4 GHz '
# Where B does not cover A the comparison is refused, unless B's end values are held.
"$tool" snp resample "$example" --start 2G --stop 3G --points 201 -o "$work/narrow.s2p"
run 2 "$example" "$work/narrow.s2p"
expect_line "$out" "^lumenutil: $work/narrow\\.s2p covers 2 GHz to 3 GHz, not all of 1\\.5 GHz to 3\\.5 GHz of $example; --hold-ends extends its traces with their end values\$"
run 1 "$example" "$work/narrow.s2p" --hold-ends
expect_line "$out" 'carried onto the points of A by circular interpolation, end values held$'
run 0 "$work/narrow.s2p" "$example" --tolerance-db 1e-4 --tolerance-deg 1e-3

# Errors exit with 2: port counts, stimulus that does not ascend, unreadable files, usage.
printf '# GHz S RI R 50\n1 0.5 0\n2 0.4 0\n' >"$work/one.s1p"
run 2 "$example" "$work/one.s1p"
expect_line "$out" "^lumenutil: $example has 2 ports and $work/one\\.s1p 1; only networks of one size compare\$"
printf '# GHz S RI R 50\n1 0.5 0\n2 0.4 0\n1.5 0.3 0\n3 0.2 0\n' >"$work/back.s1p"
run 2 "$work/back.s1p" "$work/one.s1p"
expect_line "$out" "^lumenutil: $work/back\\.s1p: the frequency must ascend strictly, but point 3 \\(1\\.5 GHz\\) does not lie above point 2 \\(2 GHz\\)\$"
printf '# GHz S RI R 50\n1 0.5 0\n1 0.4 0\n' >"$work/twice.s1p"
run 2 "$work/one.s1p" "$work/twice.s1p"
expect_line "$out" 'twice\.s1p: the frequency must ascend strictly, but point 2 \(1 GHz\) does not lie above point 1 \(1 GHz\)$'
printf '# SEC S RI R 50\n1e-9 0.5 0\n2e-9 0.4 0\n' >"$work/time.s1p"
run 2 "$work/one.s1p" "$work/time.s1p"
expect_line "$out" 'one\.s1p holds frequency values and .*time\.s1p time values$'
run 2 "$example" "$work/missing.s2p"
run 2 "$example" "$work/copy.s2p" --params S31
run 2 "$example" "$work/copy.s2p" --tolerance-db -1
run 2 "$example"
exit $((failures > 0))
