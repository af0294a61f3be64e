#!/usr/bin/env bash
# Builds the instrument client, its tests and the simulator under ThreadSanitizer
# and runs the tests on a fresh virtual display. Build directory: $1.
set -euo pipefail

root="$(cd "$(dirname "${BASH_SOURCE[0]}")/../.." && pwd)"
cmake -S "$root/tests/tsan" -B "$1" -DCMAKE_BUILD_TYPE=RelWithDebInfo >/dev/null
cmake --build "$1" -j2
export TSAN_OPTIONS="suppressions=$root/tests/tsan/toolkit.supp halt_on_error=1 second_deadlock_stack=1 exitcode=66"
"$root/scripts/with-xvfb.sh" ctest --test-dir "$1" --output-on-failure
