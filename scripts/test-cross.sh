#!/usr/bin/env bash
# Builds the 32-bit targets and runs their tests: every suite on 32-bit Linux, then Pandex.dll
# loaded by the Windows journey program under wine. Prints the host records' layout of each.
set -euo pipefail
cd "$(dirname "$0")/.."
cmake --preset m32
cmake --build --preset m32
build/m32/tests/print_record_layout
ctest --preset m32
cmake --preset windows
cmake --build --preset windows
ctest --preset windows
