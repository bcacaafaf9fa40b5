#!/usr/bin/env bash
# The test suite: installs what it needs, builds, runs every test, then runs them again under
# AddressSanitizer and UndefinedBehaviorSanitizer.
set -euo pipefail
here=$(cd "$(dirname "$0")/.." && pwd)
bash "$here/scripts/deps.sh"
export QT_QPA_PLATFORM=offscreen
bash "$here/scripts/build.sh" "$here/build"
ctest --test-dir "$here/build" --output-on-failure
bash "$here/scripts/build.sh" "$here/build-asan" -DKG_SANITIZE=ON -DKG_BUILD_BENCH=OFF
# The gallery test runs the tool as a separate process; the code it runs is covered here by the
# component's own sanitized tests.
ASAN_OPTIONS=detect_leaks=1 UBSAN_OPTIONS=print_stacktrace=1:halt_on_error=1 \
  ctest --test-dir "$here/build-asan" --output-on-failure -E '^gallery$'
