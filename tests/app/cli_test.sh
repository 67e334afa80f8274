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
check no-command 2 '^pandex: .*subcommand.*\(see pandex --help\)$' -- "$pandex"
check builtin-sample 0 '^Drawing: sample' -- "$pandex" info
check write-sample 0 'Wrote the sample drawing' -- "$pandex" sample "$work/sample.pdx"
check info-saved 0 '^Drawing: sample' -- "$pandex" info "$work/sample.pdx"
check missing-file 1 '^pandex: .+' -- "$pandex" info "$work/none.pdx"
printf 'not a drawing at all\n' >"$work/foreign.pdx"
check foreign-file 1 '^pandex: .+' -- "$pandex" info "$work/foreign.pdx"
check unwritable 1 '^pandex: .+' -- "$pandex" sample "$work/no/such/folder/x.pdx"
check sample-keeps-existing 1 '^pandex: .*sample\.pdx exists; add --force to replace it$' -- "$pandex" sample "$work/sample.pdx"
check sample-force 0 'Wrote the sample drawing' -- "$pandex" sample "$work/sample.pdx" --force
check sample-force-backup 0 '^backup$' -- bash -c "[ -f '$work/sample.pdx.bak' ] && echo backup"
# 2D output: the sample's batch into a scratch folder, ticks, a new camera, and refusals.
count_dxf() { find "$1" -maxdepth 1 -name '*.dxf' | wc -l; }
absent() { [ ! -e "$1" ] && echo absent; }
check build-2d-help 0 '--mode' -- "$pandex" build-2d --help
check build-2d-sample 0 '^6 of 6 views saved to .*/out/2D_$' -- "$pandex" build-2d --output-dir "$work/out"
check build-2d-files 0 '^6$' -- count_dxf "$work/out/2D_"
check build-2d-progress 0 '^File 6 of 6: Ground floor_Default' -- "$pandex" build-2d --output-dir "$work/out"
"$pandex" sample "$work/views.pdx" >/dev/null
check untick 0 'Unticked 2 views' -- "$pandex" untick "$work/views.pdx" "Street perspective" "A/Default"
check build-2d-unticked 0 '^4 of 4 views saved' -- "$pandex" build-2d "$work/views.pdx"
check build-2d-no-unticked-file 0 '^absent$' -- absent "$work/2D_/views_Street perspective.dxf"
check tick 0 'Ticked 1 views' -- "$pandex" tick "$work/views.pdx" "A/Default"
check build-2d-sections 0 '^2 of 2 views saved' -- "$pandex" build-2d "$work/views.pdx" --mode sections
check add-camera 0 'Added camera "North"' -- "$pandex" add-camera "$work/views.pdx" North --eye 5 30 5 --target 5 4 2
check build-2d-cameras 0 'North: .*/2D_/views_North\.dxf, \.svg \(saved\)' -- \
  "$pandex" build-2d "$work/views.pdx" --mode cameras
check add-camera-unticked 0 'Added camera' -- \
  "$pandex" add-camera "$work/views.pdx" South --eye 5 -30 5 --target 5 4 2 --no-tick --perspective
check build-2d-skips-unticked 0 '^3 of 3 views saved' -- "$pandex" build-2d "$work/views.pdx" --mode cameras
check untick-unknown 1 '^pandex: no view named "Nope"' -- "$pandex" untick "$work/views.pdx" North Nope
check untick-keeps-all 0 '^3 of 3 views saved' -- "$pandex" build-2d "$work/views.pdx" --mode cameras
check add-camera-no-direction 1 '^pandex: the eye and the target must differ' -- \
  "$pandex" add-camera "$work/views.pdx" Flat --eye 1 1 1 --target 1 1 1
check add-camera-not-a-number 1 '^pandex: the eye and the target must be numbers' -- \
  "$pandex" add-camera "$work/views.pdx" Odd --eye nan 1 1 --target 1 1 1
check add-camera-no-target 2 '^pandex: .*target is required' -- "$pandex" add-camera "$work/views.pdx" N --eye 1 2 3
check build-2d-bad-mode 2 '^pandex: .*bogus not in' -- "$pandex" build-2d --mode bogus
check build-2d-missing 1 '^pandex: .+none\.pdx' -- "$pandex" build-2d "$work/none.pdx"
check build-2d-empty-name 2 '^pandex: .*empty name' -- "$pandex" build-2d ""
check build-2d-output-dir 0 '^3 of 3 views saved to .*/elsewhere/2D_$' -- \
  "$pandex" build-2d "$work/views.pdx" --mode cameras --output-dir "$work/elsewhere"
check build-2d-output-dir-files 0 '^3$' -- count_dxf "$work/elsewhere/2D_"
check build-2d-no-deep-tree 1 '^pandex: the output folder .*/not/there cannot be made: .*/not does not exist$' -- \
  "$pandex" build-2d --output-dir "$work/not/there"
check build-2d-no-deep-tree-made 0 '^absent$' -- absent "$work/not"
# A new run sweeps away what killed writes of earlier runs left in the 2D folder.
: >"$work/2D_/.views_North.dxf.0123456789abcdef.tmp"
"$pandex" build-2d "$work/views.pdx" --mode plans >/dev/null
check build-2d-sweeps-leftovers 0 '^absent$' -- absent "$work/2D_/.views_North.dxf.0123456789abcdef.tmp"
# Views whose files would collide are written apart, with a warning.
"$pandex" add-camera "$work/views.pdx" "a/b" --eye 5 30 5 --target 5 4 2 >/dev/null
"$pandex" add-camera "$work/views.pdx" "a_b" --eye 5 -30 5 --target 5 4 2 >/dev/null
check build-2d-collision 0 '^pandex: warning: a_b: its file views_a_b is also the file of "a/b"; written as views_a_b~2' \
  -- "$pandex" build-2d "$work/views.pdx" --mode cameras
check build-2d-collision-files 0 'a_b: .*/2D_/views_a_b~2\.dxf, \.svg \(saved\)' -- \
  "$pandex" build-2d "$work/views.pdx" --mode cameras
# Editing through a link changes the drawing it leads to and leaves the link.
mkdir "$work/real" && "$pandex" sample "$work/real/linked.pdx" >/dev/null && ln -s real/linked.pdx "$work/link.pdx"
"$pandex" add-camera "$work/link.pdx" Linked --eye 1 2 3 --target 0 0 0 >/dev/null
check edit-through-link 0 '\[x\] Linked ' -- "$pandex" info "$work/real/linked.pdx"
check link-kept 0 '^link$' -- bash -c "[ -L '$work/link.pdx' ] && echo link"
# Two editors at once: each waits for the other, and both cameras are kept.
"$pandex" sample "$work/busy.pdx" >/dev/null
for pair in 1 2 3 4 5 6 7 8; do
  "$pandex" add-camera "$work/busy.pdx" "P$pair" --eye 1 2 3 --target 0 0 0 >/dev/null &
  "$pandex" add-camera "$work/busy.pdx" "Q$pair" --eye 1 2 3 --target 0 0 0 >/dev/null &
  wait
done
added_cameras() { "$pandex" info "$1" | grep -cE '^  \[x\] [PQ][1-8] '; }
check concurrent-edits-keep-both 0 '^16$' -- added_cameras "$work/busy.pdx"
mkdir "$work/blocked" && cp "$work/views.pdx" "$work/blocked/views.pdx" && : >"$work/blocked/2D_"
check build-2d-no-folder 1 '^pandex: Cannot create 2D folder\. \(.*/blocked/2D_\)' -- \
  "$pandex" build-2d "$work/blocked/views.pdx"
# The pane command: the README's tour on a saved sample house with a picture after each action,
# the undocked pane, and one-line errors that name the script's line.
source_dir=$(cd "$(dirname "$0")/../.." && pwd)
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
check pane-empty-drawing 2 '^pandex: .*empty name' -- "$pandex" pane "" --script "$work/print.pane"
[ "$failures" -eq 0 ]
