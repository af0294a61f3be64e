#!/usr/bin/env bash
# The launcher view: a real click to a started module, and one hover repaint.
# Usage: bench/view/run.sh BUILD_DIR   (on an X display; bench/run.sh provides one)
set -euo pipefail
build="$1"
cmake --build "$build" --target view_bench demo >/dev/null
cd "$build/demo"
"$build/bench/view/view_bench"
