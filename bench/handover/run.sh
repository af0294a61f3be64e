#!/usr/bin/env bash
# A second copy started with a file: from its exec to the Inspect stand-in's start
# record in the running copy, beside a second copy that only finds the lock and ends.
set -euo pipefail
build="$1"
"$build/bench/handover/bench_handover" "$build/demo"
