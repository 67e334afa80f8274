#!/usr/bin/env bash
# The pandex command line as a user meets it: help, the sample, info on a saved drawing and
# one-line errors with a non-zero exit.
set -u
pandex=$1
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
failures=0
check() {  # check NAME EXPECTED_EXIT PATTERN -- COMMAND...
  local name=$1 expected=$2 pattern=$3; shift 4
  local output status
  output=$("$@" 2>&1); status=$?
  if [ "$status" -ne "$expected" ] || ! grep -qE -- "$pattern" <<<"$output"; then
    echo "FAIL $name: exit $status (wanted $expected), output:"; echo "$output"; failures=$((failures + 1))
  else
    echo "ok   $name"
  fi
}
check help 0 'info' -- "$pandex" --help
check info-help 0 'DRAWING' -- "$pandex" info --help
check sample-help 0 'OUTPUT' -- "$pandex" sample --help
check no-command 106 'subcommand' -- "$pandex"
check builtin-sample 0 '^Drawing: sample' -- "$pandex" info
check write-sample 0 'Wrote the sample drawing' -- "$pandex" sample "$work/sample.pdx"
check info-saved 0 '^Drawing: sample' -- "$pandex" info "$work/sample.pdx"
check missing-file 1 '^pandex: .+' -- "$pandex" info "$work/none.pdx"
printf 'not a drawing at all\n' >"$work/foreign.pdx"
check foreign-file 1 '^pandex: .+' -- "$pandex" info "$work/foreign.pdx"
check unwritable 1 '^pandex: .+' -- "$pandex" sample "$work/no/such/folder/x.pdx"
[ "$failures" -eq 0 ]
