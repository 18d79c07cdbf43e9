#!/usr/bin/env bash
# Runs `lumenutil snp info` and `snp export` on the bundled example and on small broken
# files, checking what an engineer would read. Usage: snp_commands_test.sh LUMENUTIL SOURCE_DIR
set -uo pipefail
source "$(dirname "$0")/tool_test_common.sh"

info=$("$tool" snp info "$example") || fail "info exited with $?"
expect_line "$info" '^version +1$'
expect_line "$info" '^ports +2$'
expect_line "$info" '^points +401$'
expect_line "$info" '^stimulus +1\.5 GHz to 3\.5 GHz'
expect_line "$info" '^parameters +S, dB-angle \(DB\)$'
expect_line "$info" '^reference +50 ohm$'
expect_line "$info" '^data order +11 21 12 22$'
expect_line "$info" '^traces +S11 S21 S12 S22$'

# The dB export must give back the file's own numbers for S21 at the first point.
table=$("$tool" snp export "$example" --params S21 --format db --limit 2) || fail "export failed"
[[ $(wc -l <<<"$table") -eq 3 ]] || fail "export --limit 2 gave:"$'\n'"$table"
expect_line "$table" '^frequency_Hz,S21_dB,S21_deg$'
file_row=$(grep -m1 '^1\.5000 ' "$example")
python3 - "$table" "$file_row" <<'PY' || fail "exported S21 differs from the file"
import sys
row = sys.argv[1].splitlines()[1].split(",")
file = sys.argv[2].split()
assert float(row[0]) == 1.5e9, row
assert abs(float(row[1]) - float(file[3])) < 1e-4 and abs(float(row[2]) - float(file[4])) < 1e-3
PY
# RI values are the stored floats, printed so that they read back exactly.
ri=$("$tool" snp export "$example" -p S11 -f ri -d ';' -n 1 | tail -n 1)
expect_line "$ri" '^1.5e\+09;-?[0-9.e-]+;-?[0-9.e-]+$'
for format in ma logmag phase uphase swr z y; do
  "$tool" snp export "$example" -f "$format" -n 3 >/dev/null || fail "export -f $format failed"
done

# Errors name the file and the line, and the exit status is not 0.
printf '# GHz S MA R 50\n1 0.5 0 0.1 90 0.2 zero 0.4 45\n' >"$work/bad.s2p"
message=$("$tool" snp info "$work/bad.s2p" 2>&1) && fail "a bad file was accepted"
expect_line "$message" "bad\.s2p: line 2: 'zero' is not a number"
message=$("$tool" snp export "$example" --params S31 2>&1) && fail "S31 of a two-port was accepted"
expect_line "$message" "'S31' is not a parameter of a 2-port network"
message=$("$tool" snp info "$work/missing.s2p" 2>&1) && fail "a missing file was accepted"
expect_line "$message" 'missing\.s2p: .*cannot open'
# Version 1 files take their port count from the extension, or from --ports.
printf '# Hz RI\n1 1 0\n2 0.5 0\n' >"$work/one.txt"
"$tool" snp info "$work/one.txt" >/dev/null 2>&1 && fail "a one-port file was read as two-port"
expect_line "$("$tool" snp info --ports 1 "$work/one.txt")" '^points +2$'

for command in info export plot resample; do
  "$tool" snp "$command" --help | grep -q "Usage" || fail "snp $command --help"
done
exit $((failures > 0))
