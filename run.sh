#!/usr/bin/env bash
# Builds the launcher and starts it from the demo installation. Without a
# display it runs once on a virtual one, saves a screenshot and closes it.
# Build directory: $BUILD_DIR (default "build"), relative to the repository.
# With --windows: the 64-bit Windows build in "$BUILD_DIR-win64", run under Wine.
set -euo pipefail

cd "$(dirname "${BASH_SOURCE[0]}")"
build="$(realpath -m "${BUILD_DIR:-build}")"

session=() # what the launcher runs inside: Wine's server for the Windows build
start=""   # what starts the launcher
if [ "${1:-}" = "--windows" ]; then
    shift
    build="$build-win64"
    scripts/build-win64.sh "$build"
    export WINEPREFIX="${WINEPREFIX:-$build/wine}"
    session=(scripts/with-wine.sh)
    start=wine
else
    scripts/build.sh "$build"
fi

launcher="$build/demo/Veltrona.exe"
if [ -n "${DISPLAY:-}" ]; then
    exec "${session[@]}" $start "$launcher" "$@"
fi

screenshot="$build/screenshot.png"
export VELTRONA_START="$start" VELTRONA_LAUNCHER="$launcher" VELTRONA_SCREENSHOT="$screenshot"
scripts/with-xvfb.sh "${session[@]}" bash -c '
    set -euo pipefail
    $VELTRONA_START "$VELTRONA_LAUNCHER" "$@" &
    pid=$!
    trap "kill $pid 2>/dev/null || true" EXIT
    if ! timeout 60 xdotool search --sync --onlyvisible --name "^Veltrona\$" >/dev/null; then
        echo "run.sh: the launcher window did not appear" >&2
        exit 1
    fi
    import -window root "$VELTRONA_SCREENSHOT"
    wmctrl -F -c Veltrona
    if ! timeout 10 tail --pid="$pid" -f /dev/null; then
        echo "run.sh: the launcher did not close when asked" >&2
        exit 1
    fi
    wait "$pid" || true
    trap - EXIT
' run.sh "$@"
echo "Screenshot: $screenshot"
