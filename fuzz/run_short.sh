#!/usr/bin/env bash
# Builds the fuzz preset and runs the drawing-file fuzzer for about a minute (FUZZ_SECONDS), from
# a seed corpus of real drawing files it writes first, then the pane-script reader for a quarter
# of a minute. Exits non-zero when a fuzzer finds a crash, a sanitizer report or a hang; the
# input that did it is left in build/fuzz/drawing_file/ or build/fuzz/pane_script/.
set -euo pipefail
cd "$(dirname "$0")/.."
cmake --preset fuzz
cmake --build --preset fuzz --target drawing_file_fuzzer drawing_file_seeds

work=build/fuzz/drawing_file
rm -rf "$work/seeds"
mkdir -p "$work/seeds" "$work/corpus" "$work/findings"
build/fuzz/fuzz/drawing_file_seeds "$work/seeds"

# Every accepted input is saved again, with its syncs; memory-backed files keep that quick.
if [ -z "${TMPDIR:-}" ] && [ -d /dev/shm ] && [ -w /dev/shm ]; then export TMPDIR=/dev/shm; fi
build/fuzz/fuzz/drawing_file_fuzzer -max_total_time="${FUZZ_SECONDS:-60}" -timeout=10 -rss_limit_mb=2048 \
  -print_final_stats=1 -artifact_prefix="$work/findings/" "$work/corpus" "$work/seeds"

# Pane scripts, from the sample scripts, for a quarter of that time (PANE_FUZZ_SECONDS).
cmake --build --preset fuzz --target pane_script_fuzzer
pane=build/fuzz/pane_script
mkdir -p "$pane/corpus" "$pane/findings"
build/fuzz/fuzz/pane_script_fuzzer -max_total_time="${PANE_FUZZ_SECONDS:-15}" -timeout=10 -rss_limit_mb=2048 \
  -max_len=8192 -print_final_stats=1 -artifact_prefix="$pane/findings/" "$pane/corpus" samples/scripts
