#!/usr/bin/env bash
# Builds everything and runs every test on a fresh virtual display.
# Build directory: $BUILD_DIR (default "build"), relative to the repository.
set -euo pipefail

cd "$(dirname "${BASH_SOURCE[0]}")"
build="$(realpath -m "${BUILD_DIR:-build}")"

scripts/build.sh "$build"
scripts/with-xvfb.sh ctest --test-dir "$build" --output-on-failure --no-tests=error

# ---- Further test stages go below this line; each must exit non-zero on failure.

# ---- Instrument client under ThreadSanitizer (its own small build beside the main one).
tests/tsan/run.sh "$build-tsan"

# ---- The resource reader and the IPC server's peers under libFuzzer (clang, builds in "$build/fuzz"), briefly.
tests/fuzz/run-fuzz.sh "$build" "${FUZZ_SECONDS:-20}"
