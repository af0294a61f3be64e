#!/usr/bin/env bash
# Runs a command (a Windows program, or anything that starts one) under Wine in a
# private prefix: created on first use, served by one wineserver for the whole run
# and shut down again at the end whatever the command does. Runs sharing a prefix
# share that server; the last one to end shuts it down.
# Usage: scripts/with-wine.sh COMMAND [ARG...]
# The prefix: $WINEPREFIX, else "wine" below $BUILD_DIR (default "build-win64").
set -euo pipefail

if [ $# -eq 0 ]; then
    echo "usage: $0 COMMAND [ARG...]" >&2
    exit 2
fi

root="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
if [ -z "${WINEPREFIX:-}" ]; then
    build="${BUILD_DIR:-build-win64}"
    case "$build" in /*) ;; *) build="$root/$build" ;; esac
    WINEPREFIX="$build/wine"
fi
export WINEPREFIX
export WINEARCH=win64
export WINEDEBUG="${WINEDEBUG:--all}"
# No prompts to install Mono or Gecko: nothing here needs .NET or an HTML engine.
export WINEDLLOVERRIDES="mscoree,mshtml=${WINEDLLOVERRIDES:+;$WINEDLLOVERRIDES}"

mkdir -p "$WINEPREFIX"
exec 9>"$WINEPREFIX.lock"

stop() {
    # Whoever still holds the shared lock is still running: the last one out stops the server.
    flock -u 9
    if flock -x -n 9; then
        wineserver -k 2>/dev/null || true
        wineserver -w 2>/dev/null || true
    fi
}

flock -x 9
trap stop EXIT
trap 'exit 130' INT
trap 'exit 143' TERM
if [ ! -f "$WINEPREFIX/.initialised" ]; then
    echo "with-wine: creating the Wine prefix $WINEPREFIX" >&2
    wineboot -i >/dev/null 2>&1 9>&-
    wineserver -w 9>&-
    touch "$WINEPREFIX/.initialised"
fi
# Persistent, so that each program started does not bring up a server of its own.
wineserver -p 2>/dev/null 9>&- || true
flock -s 9

status=0
"$@" 9>&- || status=$?
exit "$status"
