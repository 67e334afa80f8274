#!/usr/bin/env bash
# The pane command as a user meets it: the README's tour on a saved sample house with a picture
# after each action, the undocked pane, and one-line errors that name the script's line.
set -u
pandex=$1
source_dir=$2
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
tour=$source_dir/samples/scripts/tour.pane
actions=$(grep -cvE '^[[:space:]]*(#|$)' "$tour")
"$pandex" sample "$work/house.pdx" >/dev/null
"$pandex" pane "$work/house.pdx" --script "$tour" --render "$work/renders" >"$work/tour.out" 2>&1
check tour 0 "^Wrote $((actions + 1)) pictures to $work/renders\$" -- cat "$work/tour.out"
check tour-tree 0 '^  \[x\] Garden$' -- cat "$work/tour.out"
check tour-saved-line 0 "^Saved the drawing to $work/house.pdx\$" -- cat "$work/tour.out"
check tour-saved 0 'Garden' -- "$pandex" info "$work/house.pdx"
check picture 0 'dock-caption' -- cat "$work/renders/000-start.svg"
if command -v rsvg-convert >/dev/null; then
  check picture-png 0 '' -- rsvg-convert "$work/renders/009-rename.svg" -o "$work/step.png"
fi
printf 'print\n' >"$work/print.pane"
check undocked 0 '^Cameras:$' -- "$pandex" pane --undocked --script "$work/print.pane"
printf 'tab cameras\n\nfly away\n' >"$work/unknown.pane"
check unknown-action 1 "^pandex: $work/unknown.pane: line 3: no action \"fly\"" -- "$pandex" pane --script "$work/unknown.pane"
printf 'tab plans\nselect Nowhere\n' >"$work/missing.pane"
check missing-item 1 "^pandex: $work/missing.pane: line 2: no tree item \"Nowhere\"" -- \
  "$pandex" pane --script "$work/missing.pane"
check missing-script 1 '^pandex: cannot read the script' -- "$pandex" pane --script "$work/none.pane"
exit $failures
