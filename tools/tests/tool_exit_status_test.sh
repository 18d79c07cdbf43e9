#!/usr/bin/env bash
# Exit statuses of the tool as scripts see them: write errors on standard output, usage
# errors and closed pipes. Usage: tool_exit_status_test.sh LUMENUTIL SOURCE_DIR
set -uo pipefail
source "$(dirname "$0")/tool_test_common.sh"

# A full disk behind standard output is an error, not a success.
if [[ -w /dev/full ]]; then
  for command in "snp info $example" "hresult 5" "version"; do
    # shellcheck disable=SC2086
    message=$("$tool" $command 2>&1 >/dev/full) && fail "'$command' > /dev/full exited 0"
    expect_line "$message" '^lumenutil: cannot write to standard output: No space left on device$'
  done
fi

# Usage errors exit with 2; help is a success.
"$tool" snp export "$example" --no-such-option >/dev/null 2>&1
[[ $? -eq 2 ]] || fail "an unknown option did not exit with 2"
"$tool" >/dev/null 2>&1
[[ $? -eq 2 ]] || fail "a missing command did not exit with 2"
"$tool" snp export --help >/dev/null || fail "--help did not exit with 0"

# A reader that stops early ends the tool quietly.
"$tool" snp export "$example" 2>"$work/stderr" | head -n 1 >/dev/null
[[ ! -s "$work/stderr" ]] || fail "a closed pipe printed:"$'\n'"$(cat "$work/stderr")"

exit $((failures > 0))
