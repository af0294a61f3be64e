#!/usr/bin/env bash
# Builds the instrument client with its tests and the simulator library under
# ThreadSanitizer, and runs the tests (each in its own process) on a fresh
# virtual display. Build directory: $1, else "${BUILD_DIR:-build}-tsan".
set -euo pipefail

root="$(cd "$(dirname "${BASH_SOURCE[0]}")/../.." && pwd)"
build="${1:-$root/${BUILD_DIR:-build}-tsan}"

cmake -S "$root/tests/tsan" -B "$build" -DCMAKE_BUILD_TYPE=RelWithDebInfo >/dev/null
cmake --build "$build" -j2

export TSAN_OPTIONS="suppressions=$root/tests/tsan/toolkit.supp halt_on_error=1 second_deadlock_stack=1 exitcode=66"
"$root/scripts/with-xvfb.sh" ctest --test-dir "$build" --output-on-failure
