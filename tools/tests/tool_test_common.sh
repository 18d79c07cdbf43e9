# Sourced by the scripts that run the built tool, called as SCRIPT LUMENUTIL SOURCE_DIR.
# Sets $tool, $example (the bundled two-port file) and $work (a scratch folder removed on
# exit), and gives scripts that report every failure before exiting fail() and expect_line();
# such a script ends with `exit $((failures > 0))`.
tool=$1
example=$2/testdata/bandpass_filter.s2p
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
failures=0
fail() { echo "FAIL: $*"; failures=$((failures + 1)); }
expect_line() {  # expect_line TEXT REGEX
  grep -Eq -- "$2" <<<"$1" || fail "no line matching '$2' in:"$'\n'"$1"
}
