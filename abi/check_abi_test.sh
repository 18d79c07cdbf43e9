#!/usr/bin/env bash
# Tests of check_abi.py on made-up symbol tables (a stand-in nm prints them): a symbol added
# to or gone from the library is named with the update command, and exports that the public
# headers do not declare are caught while declared ones pass.
# Usage: check_abi_test.sh PYTHON SOURCE_DIR
set -euo pipefail
python=$1
source_dir=$2
scratch=$(mktemp -d "${TMPDIR:-/tmp}/check-abi-test.XXXXXX")
trap 'rm -rf "$scratch"' EXIT
failures=0

# nm -D --defined-only -C output: address, type letter, demangled name.
fake_nm() {  # NAME...
  local name
  {
    echo '#!/bin/sh'
    echo "cat <<'SYMBOLS'"
    for name in "$@"; do echo "0000000000001000 T $name"; done
    echo 'SYMBOLS'
  } >"$scratch/nm"
  chmod +x "$scratch/nm"
}
check() {  # MODE LIST_FILE
  "$python" "$source_dir/abi/check_abi.py" --nm "$scratch/nm" --library liblumenutility.so \
    --symbols "$2" --include "$source_dir/include" --check "$1" \
    --update-command "cmake --build BUILD --target abi-update" >"$scratch/out" 2>&1
}
expect_status() {  # TEST STATUS MODE LIST_FILE
  local status=0
  check "$3" "$4" || status=$?
  if ((status != $2)); then
    echo "FAIL $1: exit status $status, not $2"
    cat "$scratch/out"
    failures=$((failures + 1))
  fi
}
expect_output() {  # TEST TEXT
  if ! grep -qF -- "$2" "$scratch/out"; then
    echo "FAIL $1: the output lacks '$2'"
    cat "$scratch/out"
    failures=$((failures + 1))
  fi
}
expect_no_output() {  # TEST TEXT
  if grep -qF -- "$2" "$scratch/out"; then
    echo "FAIL $1: the output names '$2'"
    cat "$scratch/out"
    failures=$((failures + 1))
  fi
}

printf '%s\n' '# comment lines are not symbols' 'LumenUtility::InputArray::size() const' \
  'LumenUtility::InputArray::clear()' >"$scratch/list"

test=ListedSymbolsPass
fake_nm 'LumenUtility::InputArray::clear()' 'LumenUtility::InputArray::size() const'
expect_status $test 0 list "$scratch/list"

test=AddedAndGoneSymbolsAreNamedWithTheUpdateCommand
fake_nm 'LumenUtility::InputArray::size() const' 'LumenUtility::InputArray::front() const'
expect_status $test 1 list "$scratch/list"
expect_output $test '+ LumenUtility::InputArray::front() const'
expect_output $test '- LumenUtility::InputArray::clear()'
expect_output $test 'cmake --build BUILD --target abi-update'
expect_no_output $test 'size() const'

test=DeclaredSymbolsArePublic
fake_nm 'LumenUtility::InputArray::size() const' 'vtable for LumenException' \
  'typeinfo for vna_interprocess::VNAMessageText' 'LumenUtility::TsComplex::m_minus200dB' \
  'dprint(int, wchar_t const*, ...)' 'gDebugPrint' \
  'LumenUtility::operator<<(std::basic_ostream<wchar_t, std::char_traits<wchar_t> >&, LumenUtility::Segment const&)' \
  'GlobalState::GetExternalReference[abi:cxx11]()'
expect_status $test 0 public "$scratch/list"

test=UndeclaredExportsAreLeaks
fake_nm 'LumenUtility::InputArray::size() const' \
  'std::vector<int, std::allocator<int> >::_M_default_append(unsigned long)' \
  'void std::__detail::__to_chars_10_impl<unsigned int>(char*, unsigned int, unsigned int)' \
  'vtable for boost::detail::sp_counted_impl_p<Factory>' \
  'LumenUtility::TouchstoneParser::Parse()' 'LumenUtility::NotInAnyHeader(int)' \
  'UnknownScope::Helper::Run()'
expect_status $test 1 public "$scratch/list"
for name in _M_default_append __to_chars_10_impl sp_counted_impl_p TouchstoneParser::Parse \
  NotInAnyHeader UnknownScope::Helper; do
  expect_output $test "$name"
done
expect_no_output $test 'InputArray::size'

test=UpdateRefusesToRecordLeaks
fake_nm 'LumenUtility::InputArray::size() const' 'LumenUtility::NotInAnyHeader(int)'
cp "$scratch/list" "$scratch/list.before"
status=0
"$python" "$source_dir/abi/check_abi.py" --nm "$scratch/nm" --library liblumenutility.so \
  --symbols "$scratch/list" --include "$source_dir/include" --update >"$scratch/out" 2>&1 ||
  status=$?
if ((status != 1)) || ! cmp -s "$scratch/list" "$scratch/list.before"; then
  echo "FAIL $test: status $status, or the list was rewritten"
  failures=$((failures + 1))
fi

test=UpdateWritesTheSortedList
fake_nm 'LumenUtility::InputArray::size() const' 'LumenUtility::InputArray::clear()'
"$python" "$source_dir/abi/check_abi.py" --nm "$scratch/nm" --library liblumenutility.so \
  --symbols "$scratch/new" --include "$source_dir/include" --update >/dev/null
if [[ $(grep -v '^#' "$scratch/new") != $'LumenUtility::InputArray::clear()\nLumenUtility::InputArray::size() const' ]]; then
  echo "FAIL $test:"
  cat "$scratch/new"
  failures=$((failures + 1))
fi
expect_status $test 0 list "$scratch/new"

((failures == 0)) && echo "check_abi.py: all cases pass"
exit $((failures > 0))
