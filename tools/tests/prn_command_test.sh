#!/usr/bin/env bash
# `lumenutil prn` on small PRN files it writes itself. Usage: prn_command_test.sh LUMENUTIL SOURCE_DIR
set -uo pipefail
source "$(dirname "$0")/tool_test_common.sh"

# As read: header and zero-frequency lines skipped, empty pieces and trailing pieces ignored.
printf 'Frequency,Phase\n0,45\n1e9, 90\n2e9,,-180,x\n3e9,abc\n' >"$work/cal.prn"
out=$("$tool" prn "$work/cal.prn") || fail "prn exited $?"
[[ "$out" == $'Frequency (Hz),Phase (deg)\n1e+09,90.0000\n2e+09,-180.0000' ]] ||
  fail "as read:"$'\n'"$out"

# The output is a PRN file itself and reads back to the same lines.
printf '%s\n' "$out" >"$work/again.prn"
[[ "$("$tool" prn "$work/again.prn")" == "$out" ]] || fail "the output does not read back"

# A delay of 36 degrees per GHz, resampled inside its range.
for k in 1 2 3 4 5; do echo "${k}e9,$((-36 * k))"; done >"$work/delay.prn"
out=$("$tool" prn "$work/delay.prn" --start 1.5G --stop 4.5GHz --points 4) || fail "sweep exited $?"
[[ "$out" == $'Frequency (Hz),Phase (deg)\n1.5e+09,-54.0000\n2.5e+09,-90.0000\n3.5e+09,-126.0000\n4.5e+09,-162.0000' ]] ||
  fail "sweep:"$'\n'"$out"

# Outside the calibration, and an empty file: errors naming the file, status 1.
message=$("$tool" prn "$work/delay.prn" --start 0.5G --stop 4G --points 3 2>&1)
[[ $? -eq 1 ]] || fail "a sweep outside the file did not exit with 1"
expect_line "$message" "^lumenutil: $work/delay.prn: the sweep 5e\+08 to 4e\+09 Hz reaches outside the calibration, 1e\+09 to 5e\+09 Hz$"
: >"$work/empty.prn"
message=$("$tool" prn "$work/empty.prn" 2>&1)
[[ $? -eq 1 ]] || fail "an empty file did not exit with 1"
expect_line "$message" "^lumenutil: $work/empty.prn: no calibration points$"

# Usage errors exit with 2 and name the problem in one line.
check_usage() {  # check_usage REGEX ARGS...
  local regex=$1
  shift
  message=$("$tool" prn "$@" 2>&1)
  [[ $? -eq 2 ]] || fail "'prn $*' did not exit with 2"
  expect_line "$message" "$regex"
}
check_usage '^--start requires --stop$' "$work/delay.prn" --start 1G
check_usage "^--start: 'x' is not a frequency" "$work/delay.prn" --start x --stop 2G --points 3
check_usage '^--points: Value 0 not in range' "$work/delay.prn" --start 1G --stop 2G --points 0
check_usage '^--start and --stop are equal: 3 points' "$work/delay.prn" --start 2G --stop 2G --points 3
check_usage 'File does not exist' "$work/none.prn"
"$tool" prn --help >/dev/null || fail "--help did not exit with 0"
exit $((failures > 0))
