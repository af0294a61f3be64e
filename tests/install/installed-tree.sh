#!/usr/bin/env bash
# Installs the build ($1) into a throw-away DESTDIR under a prefix with blanks and quotes,
# checks the tree, starts the launcher through its `veltrona` link, and opens a profile
# the way a file manager does. Needs an X display with a window manager.
set -euo pipefail
build="$1"
work="$(mktemp -d "${TMPDIR:-/tmp}/installed-tree.XXXXXX")"
# Ends whatever still runs from the installed tree (the launcher, its help viewer, modules).
end_installed() {
    local exe
    for exe in /proc/[0-9]*/exe; do
        [[ "$(readlink "$exe" 2>/dev/null)" != "$work/"* ]] || kill "${exe//[^0-9]/}" 2>/dev/null || true
    done
}
trap 'end_installed; rm -rf "$work"' EXIT
fail() { echo "FAIL: $*" >&2; exit 1; }

prefix="/opt/Veltrona \"suite\" it's"
root="$work/dest$prefix"
DESTDIR="$work/dest" cmake --install "$build" --prefix "$prefix" >/dev/null
app="$root/lib/veltrona"

# What the desktop needs (DebianPackages checks the files of the demo installation).
for file in applications/veltrona.desktop metainfo/veltrona.metainfo.xml man/man1/veltrona.1.gz \
    icons/hicolor/{16x16,24x24,32x32,48x48,64x64,128x128,256x256}/apps/veltrona.png \
    icons/hicolor/scalable/apps/veltrona.svg; do
    [ -f "$root/share/$file" ] || fail "not installed: share/$file"
done
[ "$(readlink "$root/bin/veltrona")" = ../lib/veltrona/Veltrona.exe ] || fail "bin/veltrona"
desktop-file-validate "$root/share/applications/veltrona.desktop"
! grep -q '&' "$root/share/applications/veltrona.desktop" || fail "a menu mnemonic in veltrona.desktop"
appstreamcli validate --no-net "$root/share/metainfo/veltrona.metainfo.xml" >/dev/null

# xdg-mime splits XDG_DATA_DIRS at blanks too, so the desktop sees share/ through a link.
ln -s "$root/share" "$work/share"
mkdir -m 700 "$work/run"
export XDG_RUNTIME_DIR="$work/run" XDG_CONFIG_HOME="$work/config" XDG_DATA_HOME="$work/data"
export XDG_DATA_DIRS="$work/share:/usr/share" PATH="$root/bin:$PATH"
export VELTRONA_STANDIN_LOG="$work/standins.log" VELTRONA_STANDIN_EXIT=1
# No session or accessibility bus: with none named, GIO would start one through dbus-launch
# and leave it on the display.
export DBUS_SESSION_BUS_ADDRESS=disabled: NO_AT_BRIDGE=1

# Runs "$@" until it succeeds, for at most 20 seconds.
wait_until() {
    local deadline=$((SECONDS + 20))
    until "$@"; do
        [ "$SECONDS" -lt "$deadline" ] || return 1
        sleep 0.1
    done
}
# Waits for the launcher's window; sets $window and $launcher, its process.
find_launcher() {
    window="$(timeout 30 xdotool search --sync --onlyvisible --name '^Veltrona$' | head -n 1)"
    [ -n "$window" ] || fail "no launcher window"
    launcher="$(xdotool getwindowpid "$window")"
}
close_launcher() {
    wmctrl -i -c "$window"
    timeout 20 tail --pid="$launcher" -f /dev/null || fail "the launcher did not close"
}
# Whether a stand-in record shows $1 started (with the argument $2, when given).
started() {
    awk -F '\t' -v arg="${2-}" '$1 == "exe" { exe = $2; hit = arg == "" }
        $1 == "arg" && $2 == arg { hit = 1 }
        $1 == "end" && hit { print exe }' "$VELTRONA_STANDIN_LOG" 2>/dev/null >"$work/started"
    grep -qxF "$app/$1" "$work/started"
}

# The launcher started through the link, from elsewhere, finds the modules and the help
# viewer beside it.
(cd / && exec veltrona) &
find_launcher
class="$(xprop -id "$window" WM_CLASS | sed -n 's/.*, "\(.*\)"$/\1/p')"
grep -qx "StartupWMClass=$class" "$root/share/applications/veltrona.desktop" ||
    fail "StartupWMClass is not the window class $class"
# The middle of the Printer button, below the menu bar.
timeout 20 xdotool windowactivate --sync "$window" mousemove --window "$window" 304 123 click 1 ||
    fail "the launcher's window did not become active"
wait_until started "Quenta Print Studio.exe" || fail "the Printer button started nothing"
xdotool key F1
wait_until started "Help/Veltrona Help.exe" || fail "F1 did not start the help viewer"
wmctrl -i -c "$(timeout 30 xdotool search --sync --onlyvisible --name '^Veltrona Help$' | head -n 1)"
close_launcher

# A profile opened the way a file manager opens it reaches the Inspect module whole.
update-desktop-database "$root/share/applications"
[ "$(timeout 20 xdg-mime query default application/vnd.iccprofile)" = veltrona.desktop ] ||
    fail "veltrona.desktop does not open colour profiles"
profile="$work/Proof \"A3\" it's.icc"
{ head -c 36 /dev/zero; printf acsp; head -c 88 /dev/zero; } >"$profile"
timeout 20 gio open "$profile" || fail "gio open $profile"
wait_until started "Quenta Inspect Studio.exe" "$profile" || fail "Inspect did not get $profile"
find_launcher
close_launcher
echo "installed tree: all checks passed"
