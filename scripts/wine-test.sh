#!/usr/bin/env bash
# CTest's way into Wine for the Windows test programs: runs one under `wine` and
# passes on its output and status. Now and then Wine ends a program before it has
# run (a failure status within milliseconds, not one line printed); such a start is
# reported with its status and made once more. A program that printed anything
# keeps its own status.
set -uo pipefail

out="$(mktemp)"
trap 'rm -f "$out"' EXIT
status=0
for attempt in 1 2; do
    wine "$@" 2>&1 | tee "$out"
    status=${PIPESTATUS[0]}
    if [ "$status" -eq 0 ] || [ -s "$out" ]; then
        exit "$status"
    fi
    echo "wine-test: wine ended with status $status before the program printed anything (start $attempt of 2)" >&2
done
exit "$status"
