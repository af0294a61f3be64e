#!/usr/bin/env bash
# Builds both Debian packages from the build ($1) into a throw-away directory and checks
# their fields and contents with dpkg-deb, and the packages themselves with lintian.
set -euo pipefail
build="$1"
work="$(mktemp -d "${TMPDIR:-/tmp}/debian-packages.XXXXXX")"
trap 'rm -rf "$work"' EXIT
fail() { echo "FAIL: $*" >&2; exit 1; }

cpack --config "$build/CPackConfig.cmake" -B "$work" >"$work/cpack.log" 2>&1 ||
    { cat "$work/cpack.log"; fail "cpack"; }
version="$(sed -n 's/^PRODUCTVERSION \([0-9]*\),\([0-9]*\),\([0-9]*\),\([0-9]*\).*/\1.\2.\3.\4/p' \
    "$(dirname "$0")/../../wxapplauncher/resources/Veltrona.rc")"
launcher="$work/veltrona_${version}_amd64.deb"
standins="$work/veltrona-suite-standins_${version}_amd64.deb"

# Dependencies found by dpkg-shlibdeps; the stand-ins need this very launcher.
[[ "$(dpkg-deb --field "$launcher" Depends)" == *"libwxgtk3.2-1 (>="* ]] || fail "launcher Depends"
[[ "$(dpkg-deb --field "$standins" Depends)" == "veltrona (= $version),"*libx11-6* ]] ||
    fail "stand-ins Depends"

# Each file of the demo installation is in exactly one package; the launcher's package
# has the desktop files.
dpkg-deb --contents "$launcher" | sed 's/^.* \.\///' >"$work/launcher.list"
dpkg-deb --contents "$standins" | sed 's/^.* \.\///' >"$work/standins.list"
while read -r file; do
    if [ "$file" = Veltrona.exe ]; then owner="$work/launcher.list"; else owner="$work/standins.list"; fi
    grep -qxF "usr/lib/veltrona/$file" "$owner" || fail "$file is not in $(basename "$owner")"
done < <(cd "$build/demo" && find . -type f -printf '%P\n')
for file in "usr/bin/veltrona -> ../lib/veltrona/Veltrona.exe" usr/share/applications/veltrona.desktop \
    usr/share/metainfo/veltrona.metainfo.xml usr/share/icons/hicolor/48x48/apps/veltrona.png; do
    grep -qxF "$file" "$work/launcher.list" || fail "$file is not in the launcher's package"
done

# Stripping keeps the resources that the launcher reads from its own file.
dpkg-deb --extract "$launcher" "$work/root"
objdump -h "$work/root/usr/lib/veltrona/Veltrona.exe" >"$work/sections"
grep -q ' \.rsrc ' "$work/sections" || fail "the packed launcher lost its resources"
! grep -q ' \.debug_info ' "$work/sections" || fail "the packed launcher is not stripped"

lintian --fail-on error "$launcher" "$standins" || fail "lintian found errors"
echo "Debian packages: all checks passed"
