#!/usr/bin/env bash
# pandex ui-gallery: one well-formed picture per control sheet and per dialog template, listed
# on the index page, and each one convertible to PNG; a folder it cannot write is refused.
set -u
pandex=$1
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
failures=0
fail() { echo "FAIL $*"; failures=$((failures + 1)); }

"$pandex" ui-gallery "$work/gallery" >"$work/out.txt" 2>&1 || fail "ui-gallery exited $?: $(cat "$work/out.txt")"
for name in buttons edits combo_boxes combo_dropped combo_owner_drawn_dropped combo_ex_dropped report_list \
            report_list_editing tree_and_tabs progress_bars menu_with_bitmaps image_menu icons_and_bitmaps \
            dialog_5000 dialog_5012 dialog_5038 dialog_5046 dialog_5054 dialog_5055 dialog_5062; do
  file="$work/gallery/$name.svg"
  [ -s "$file" ] || { fail "no $name.svg"; continue; }
  /usr/bin/python3 -c 'import sys, xml.dom.minidom; xml.dom.minidom.parse(sys.argv[1])' "$file" || fail "$name.svg is not well-formed"
  grep -q "src=\"$name.svg\"" "$work/gallery/index.html" || fail "index.html does not show $name"
  grep -q "/$name.svg\$" "$work/out.txt" || fail "the command does not list $name.svg"
done
# Every numbered icon and bitmap is on the sheet of pictures.
for id in 5002 5003 5005 5006 5007 5008 5010 5014 5015 5016 5017 5027 5039 5040 5042 5043 5045 5048 5049 5050 5052 \
          5056 5057 5058 5059 5060 5061 5062 5064 5066 5067; do
  grep -q "data-icon=\"$id\"" "$work/gallery/icons_and_bitmaps.svg" || fail "picture $id missing"
done
rsvg-convert -z 2 "$work/gallery/dialog_5012.svg" -o "$work/dialog_5012.png" || fail "rsvg-convert refused dialog_5012.svg"
grep -q 'rsvg-convert' "$work/out.txt" || fail "the command does not say how to make PNGs"
touch "$work/file"
"$pandex" ui-gallery "$work/file/gallery" >/dev/null 2>"$work/err.txt" && fail "a folder inside a file was accepted"
grep -q '^pandex: ' "$work/err.txt" || fail "no one-line error: $(cat "$work/err.txt")"
[ "$failures" -eq 0 ] && echo "ui-gallery: all checks passed"
exit "$failures"
