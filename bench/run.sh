#!/usr/bin/env bash
# Builds what the benchmarks need and runs each of them on a fresh virtual display.
# Every figure is printed beside its anchor, measured in the same run: compare the
# two, never one absolute time. Run by hand; ./test.sh does not run it.
# Usage: bench/run.sh [NAME...]   (default: every bench/*/run.sh, in name order)
set -euo pipefail

cd "$(dirname "${BASH_SOURCE[0]}")/.."
build="$(realpath -m "${BUILD_DIR:-build}")"
scripts/build.sh "$build" >/dev/null

if [ $# -gt 0 ]; then
    benches=()
    for name in "$@"; do benches+=("bench/$name/run.sh"); done
else
    benches=(bench/*/run.sh)
fi

for bench in "${benches[@]}"; do
    [ -f "$bench" ] || continue
    echo "== $(basename "$(dirname "$bench")")"
    scripts/with-xvfb.sh bash "$bench" "$build"
done
