#!/usr/bin/env bash
# Runs a command on a fresh virtual X display with the openbox window manager,
# and takes both down again whatever the command does.
# Usage: scripts/with-xvfb.sh COMMAND [ARG...]   (screen size: XVFB_SCREEN)
set -euo pipefail

if [ $# -eq 0 ]; then
    echo "usage: $0 COMMAND [ARG...]" >&2
    exit 2
fi

screen="${XVFB_SCREEN:-1280x1024x24}"
workdir="$(mktemp -d "${TMPDIR:-/tmp}/with-xvfb.XXXXXX")"
xvfb_pid=""
wm_pid=""

stop() {
    local pid="$1"
    [ -n "$pid" ] || return 0
    kill "$pid" 2>/dev/null || return 0
    wait "$pid" 2>/dev/null || true
}

cleanup() {
    stop "$wm_pid"
    stop "$xvfb_pid"
    rm -rf "$workdir"
}
trap cleanup EXIT
trap 'exit 130' INT
trap 'exit 143' TERM

# Xvfb picks a free display number itself and writes it to the pipe when ready.
mkfifo "$workdir/displayfd"
Xvfb -displayfd 3 -screen 0 "$screen" -nolisten tcp 3>"$workdir/displayfd" \
    >"$workdir/xvfb.log" 2>&1 &
xvfb_pid=$!
display=""
if ! read -r -t 30 display <"$workdir/displayfd" || [ -z "$display" ]; then
    echo "with-xvfb: Xvfb did not start" >&2
    cat "$workdir/xvfb.log" >&2 || true
    exit 1
fi
export DISPLAY=":$display"
# No session bus, nor an accessibility bridge that asks for one: with none named, GIO starts
# a bus through dbus-launch and leaves it on the display for every later program.
export DBUS_SESSION_BUS_ADDRESS=disabled: NO_AT_BRIDGE=1

openbox --sm-disable >"$workdir/openbox.log" 2>&1 &
wm_pid=$!
deadline=$((SECONDS + 30))
until xprop -root _NET_SUPPORTING_WM_CHECK 2>/dev/null | grep -q 'window id'; do
    if [ "$SECONDS" -ge "$deadline" ] || ! kill -0 "$wm_pid" 2>/dev/null; then
        echo "with-xvfb: the window manager did not come up" >&2
        cat "$workdir/openbox.log" >&2 || true
        exit 1
    fi
    sleep 0.1
done

status=0
"$@" || status=$?
exit "$status"
