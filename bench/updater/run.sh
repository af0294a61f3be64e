#!/usr/bin/env bash
# The updater's share of the deferred start-up, beside the toolkit calls it rests on.
set -euo pipefail
"$1/bench/updater/bench_updater"
