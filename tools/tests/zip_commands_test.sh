#!/usr/bin/env bash
# `lumenutil zip` and `lumenutil unzip` on small trees, checked against the system's zip tools
# where they are installed. Usage: zip_commands_test.sh LUMENUTIL SOURCE_DIR
set -uo pipefail
source "$(dirname "$0")/tool_test_common.sh"

mkdir -p "$work/in/sub dir"
printf 'alpha\n' >"$work/in/a.txt"
seq 1 20000 >"$work/in/sub dir/numbers.txt"
: >"$work/in/empty"

# Pack relative to -C, unpack elsewhere: the same bytes come back, and the names are listed.
"$tool" zip "$work/out.zip" -C "$work/in" a.txt "sub dir/numbers.txt" empty \
  || fail "zip exited $?"
listed=$("$tool" unzip "$work/out.zip" -d "$work/x") || fail "unzip exited $?"
[[ "$listed" == $'a.txt\nsub dir/numbers.txt\nempty' ]] || fail "unzip listed:"$'\n'"$listed"
for f in a.txt "sub dir/numbers.txt" empty; do
  cmp -s "$work/in/$f" "$work/x/$f" || fail "$f differs after the round trip"
done
if command -v unzip >/dev/null; then
  unzip -tq "$work/out.zip" >/dev/null || fail "unzip -t rejects the archive"
fi
if command -v zip >/dev/null; then
  (cd "$work/in" && zip -qr "$work/by_zip.zip" a.txt "sub dir")
  "$tool" unzip "$work/by_zip.zip" -d "$work/y" >/dev/null || fail "an archive of zip did not unpack"
  cmp -s "$work/in/sub dir/numbers.txt" "$work/y/sub dir/numbers.txt" || fail "zip's entry differs"
fi

# A missing input is named and no archive appears; an existing archive stays as it was.
message=$("$tool" zip "$work/new.zip" -C "$work/in" a.txt missing.txt 2>&1) && fail "a missing input exited 0"
expect_line "$message" "^lumenutil: $work/in/missing.txt: no such file$"
[[ ! -e "$work/new.zip" ]] || fail "an archive was written despite the missing input"
cp "$work/out.zip" "$work/before.zip"
touch "$work/escape"
message=$("$tool" zip "$work/out.zip" -C "$work/in" a.txt ../escape 2>&1) && fail "../escape exited 0"
expect_line "$message" "not written"
cmp -s "$work/out.zip" "$work/before.zip" || fail "a failed zip changed the existing archive"

# An archive whose entry climbs out of the destination writes nothing outside it.
if command -v python3 >/dev/null; then
  python3 - "$work/evil.zip" <<'PY'
import sys, zipfile
with zipfile.ZipFile(sys.argv[1], "w") as z:
    z.writestr("fine.txt", "fine")
    z.writestr("../escaped.txt", "escaped")
PY
  message=$("$tool" unzip "$work/evil.zip" -d "$work/dest" 2>&1) && fail "a climbing entry exited 0"
  expect_line "$message" "^fine.txt$"
  expect_line "$message" "extraction stopped after 1 entries"
  [[ ! -e "$work/escaped.txt" ]] || fail "an entry was written outside the destination"
fi

"$tool" unzip "$work/no-such.zip" -d "$work/d" >/dev/null 2>&1
[[ $? -eq 2 ]] || fail "a missing archive is not a usage error"
exit $((failures > 0))
