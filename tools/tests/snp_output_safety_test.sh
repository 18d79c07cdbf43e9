#!/usr/bin/env bash
# Output files are whole or untouched: the input survives every command, a failed run leaves
# the target as it was and no temporary file behind. Usage: snp_output_safety_test.sh
# LUMENUTIL SOURCE_DIR
set -uo pipefail
source "$(dirname "$0")/tool_test_common.sh"

cp "$example" "$work/dut.s2p"
before=$(sha256sum <"$work/dut.s2p")
unchanged() { [[ $(sha256sum <"$work/dut.s2p") == "$before" ]] || fail "$1 changed dut.s2p"; }

# export and plot write another format: naming the input as output is refused, by any
# spelling of its path.
for command in "export" "plot"; do
  message=$("$tool" snp $command "$work/dut.s2p" -o "$work/./dut.s2p" 2>&1) &&
    fail "$command over its input exited 0"
  expect_line "$message" 'dut\.s2p: is the input file; choose another output$'
  unchanged "$command -o input"
done

# resample may replace its input, through the temporary file.
"$tool" snp resample "$work/dut.s2p" --start 2.3G --stop 2.5G --points 5 -o "$work/dut.s2p" ||
  fail "resample over its input failed"
[[ $(grep -cv '^[!#]' "$work/dut.s2p") -eq 5 ]] || fail "resample over its input wrote:"$'\n'"$(cat "$work/dut.s2p")"
cp "$example" "$work/dut.s2p"

# A failing run leaves the existing target exactly as it was: here resample refuses a sweep
# beyond the file after the target exists.
printf 'keep me\n' >"$work/target.s2p"
chmod 640 "$work/target.s2p"
"$tool" snp resample "$work/dut.s2p" --start 1G --stop 9G --points 5 -o "$work/target.s2p" \
  2>/dev/null && fail "a sweep beyond the file was accepted"
[[ $(cat "$work/target.s2p") == "keep me" ]] || fail "a failed resample changed its target"
# A successful one replaces it and keeps its mode.
"$tool" snp export "$work/dut.s2p" -n 2 -o "$work/target.s2p" || fail "export failed"
[[ $(stat -c %a "$work/target.s2p") == 640 ]] || fail "the target lost its mode"
unchanged "export"

# A run stopped by a signal leaves the target as it was and no temporary file.
printf 'keep me\n' >"$work/big.s2p"
"$tool" snp resample "$work/dut.s2p" --start 1.6G --stop 3.4G --points 3000000 \
  -o "$work/big.s2p" 2>/dev/null &
sleep 0.5
kill -TERM $! 2>/dev/null
wait $!
status=$?
if [[ $status -ne 0 ]]; then
  [[ $status -eq 143 ]] || fail "a stopped resample exited with $status"
  [[ $(cat "$work/big.s2p") == "keep me" ]] || fail "a stopped resample changed its target"
fi

# Nothing is left beside the targets.
leftovers=$(find "$work" -name '.*.??????' | head -n 3)
[[ -z "$leftovers" ]] || fail "temporary files left behind: $leftovers"

# A directory that cannot be written gives a clear message and no file.
if [[ $(id -u) -ne 0 ]]; then
  mkdir "$work/locked" && chmod 555 "$work/locked"
  message=$("$tool" snp export "$work/dut.s2p" -o "$work/locked/x.csv" 2>&1) &&
    fail "export into a read-only directory exited 0"
  expect_line "$message" 'x\.csv: cannot be written: Permission denied$'
fi
message=$("$tool" snp export "$work/dut.s2p" -o "$work/missing/x.csv" 2>&1) &&
  fail "export into a missing directory exited 0"
expect_line "$message" 'x\.csv: cannot be written: No such file or directory$'

# Devices are written in place, never replaced.
"$tool" snp export "$work/dut.s2p" -n 1 -o /dev/null || fail "export to /dev/null failed"
[[ -c /dev/null ]] || fail "/dev/null is no longer a device"

exit $((failures > 0))
