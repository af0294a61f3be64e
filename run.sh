#!/usr/bin/env bash
# Builds the launcher and starts it from the demo installation. Without a
# display it runs once on a virtual one, saves a screenshot and closes it.
# Build directory: $BUILD_DIR (default "build"), relative to the repository.
set -euo pipefail

cd "$(dirname "${BASH_SOURCE[0]}")"
build="$(realpath -m "${BUILD_DIR:-build}")"

scripts/build.sh "$build"

launcher="$build/demo/Veltrona.exe"
if [ -n "${DISPLAY:-}" ]; then
    exec "$launcher" "$@"
fi

screenshot="$build/screenshot.png"
export VELTRONA_LAUNCHER="$launcher" VELTRONA_SCREENSHOT="$screenshot"
scripts/with-xvfb.sh bash -c '
    set -euo pipefail
    "$VELTRONA_LAUNCHER" "$@" &
    pid=$!
    trap "kill $pid 2>/dev/null || true" EXIT
    if ! timeout 30 xdotool search --sync --onlyvisible --name "^Veltrona\$" >/dev/null; then
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
