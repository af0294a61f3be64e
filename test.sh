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

# ---- The Windows build's tests under Wine on a fresh virtual display, in a private Wine
# prefix of that build (the toolkit for Windows is built once per machine first).
# VELTRONA_WINDOWS=0 leaves this stage out.
if [ "${VELTRONA_WINDOWS:-1}" != 0 ]; then
    scripts/build-win64.sh "$build-win64"
    # Wine's own services (started by the first program) would keep the output pipes of
    # the test that started them open, and CTest would wait for them: wineboot starts
    # them first, on this script's own output.
    WINEPREFIX="$build-win64/wine" scripts/with-xvfb.sh scripts/with-wine.sh bash -c '
        wineboot </dev/null >/dev/null 2>&1
        ctest --test-dir "$1" --output-on-failure --no-tests=error' windows-tests "$build-win64"
fi
