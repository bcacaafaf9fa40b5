#!/usr/bin/env bash
# The test suite: installs what it needs, builds with gcc and runs every test, then builds again
# with clang under AddressSanitizer (leak checking included) and UndefinedBehaviorSanitizer and
# runs the suite once more, with the fuzz targets built in that pass and run as short, bounded
# tests (label "fuzz").
set -euo pipefail
here=$(cd "$(dirname "$0")/.." && pwd)
bash "$here/scripts/deps.sh"
export QT_QPA_PLATFORM=offscreen

# Line tables (-g1) are all a failure's trace needs; full debug information took a third of the
# build time.
bash "$here/scripts/build.sh" "$here/build" -DCMAKE_CXX_FLAGS_RELWITHDEBINFO="-O2 -g1 -DNDEBUG"
ctest --test-dir "$here/build" --output-on-failure

asan="$here/build-asan"
# The sanitizer build is clang's (libFuzzer comes with it, and it builds sanitized code in half
# gcc's time): a folder configured by another compiler is made afresh, as CMake keeps the
# compiler it first found.
if [ -f "$asan/CMakeCache.txt" ] && ! grep -q '^CMAKE_CXX_COMPILER:.*clang' "$asan/CMakeCache.txt"; then
  rm -rf "$asan"
fi
CC=clang CXX=clang++ bash "$here/scripts/build.sh" "$asan" -DKG_SANITIZE=ON -DKG_FUZZ=ON -DKG_BUILD_BENCH=OFF \
  -DCMAKE_CXX_FLAGS_RELWITHDEBINFO="-O1 -g1 -DNDEBUG"
# The gallery test runs the tool as a separate process; the code it runs is covered here by the
# component's own sanitized tests.
ASAN_OPTIONS=detect_leaks=1 LSAN_OPTIONS=suppressions="$here/tests/lsan.supp":print_suppressions=0 \
UBSAN_OPTIONS=print_stacktrace=1:halt_on_error=1 \
  ctest --test-dir "$asan" --output-on-failure -E '^gallery$'
