# Sourced by the scripts that run the built tool, called as SCRIPT LUMENUTIL SOURCE_DIR.
# Sets $tool, $example (the bundled two-port file) and $work (a scratch folder removed on
# exit), and gives scripts that report every failure before exiting fail(), expect_line() and
# same_export(); such a script ends with `exit $((failures > 0))`.
tool=$1
example=$2/testdata/bandpass_filter.s2p
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
failures=0
fail() { echo "FAIL: $*"; failures=$((failures + 1)); }
expect_line() {  # expect_line TEXT REGEX
  grep -Eq -- "$2" <<<"$1" || fail "no line matching '$2' in:"$'\n'"$1"
}
same_export() {  # same_export A B [export options...]: identical RI tables
  local a=$1 b=$2
  shift 2
  diff <("$tool" snp export "$a" -f ri "$@") <("$tool" snp export "$b" -f ri "$@") >"$work/diff" ||
    fail "$a and $b differ:"$'\n'"$(head -n 5 "$work/diff")"
}
