#!/usr/bin/env bash
# Checks the manual page of lumenutil: it renders the way man(1) shows it without any warning
# of groff or man (unknown macros, bad escapes, lines that do not fit), it names the build's
# version, and, given the built tool, it has a section for every command the tool's --help
# lists and mentions every option of each.
# Usage: check_man_page.sh PAGE VERSION [LUMENUTIL]
set -euo pipefail
page=$1
version=$2
tool=${3:-}
status=0

if ! grep -q "^\.TH .*\"lumen-utility $version\"" "$page"; then
  echo "$page: the .TH line does not name lumen-utility $version:" >&2
  grep '^\.TH' "$page" >&2
  status=1
fi

warnings=$(MANWIDTH=80 LC_ALL=C.UTF-8 man --warnings -l "$page" 2>&1 >/dev/null)
if [[ -n $warnings ]]; then
  echo "man --warnings -l $page:" >&2
  echo "$warnings" >&2
  status=1
fi

# Sub-commands and options as CLI11 lists them: two blanks, then the name.
help_list() {  # SECTION COMMAND...
  local section=$1
  shift
  "$tool" "$@" --help | awk -v s="$section:" '$0 == s {on = 1; next} /^$/ {on = 0}
    on && /^  [^ ]/ {print $1}'
}
check_command() {  # COMMAND...
  local path="$*" option name
  if [[ -n $path ]] && ! grep -Eq "^\.SS \"?$path( |\"|$)" "$page"; then
    echo "$page: no section for the command '$path'" >&2
    status=1
  fi
  for option in $(help_list Options "$@" | tr ',' ' '); do
    [[ $option == -h || $option == --help ]] && continue
    if ! grep -qF -- "${option//-/\\-}" "$page"; then
      echo "$page: the option $option of '${path:-lumenutil}' is not described" >&2
      status=1
    fi
  done
  for name in $(help_list Subcommands "$@"); do
    check_command "$@" "$name"
  done
}
if [[ -n $tool ]]; then
  check_command
fi

((status == 0)) && echo "$page renders without warnings and covers every command and option"
exit $status
