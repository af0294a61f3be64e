#!/usr/bin/env bash
# Builds the Windows Installer packages from the Windows build ($1) with CPack into $2,
# where the installer tests take them from, and checks them with msitools: each file of
# the demo installation in exactly one package, at its place in the suite's folder,
# stripped, the programs with their versions; the shortcuts, "Open with" for profiles
# beside the file types' own default, the entry in Programs and Features, the upgrade.
set -euo pipefail
build="$1"
out="$2"
source="$(cd "$(dirname "$0")/../.." && pwd)"
work="$(mktemp -d "${TMPDIR:-/tmp}/msi-packages.XXXXXX")"
trap 'rm -rf "$work"' EXIT
fail() { echo "FAIL: $*" >&2; exit 1; }

rm -rf "$out"
mkdir -p "$out"
cpack --config "$build/CPackConfig.cmake" -B "$out" >"$work/cpack.log" 2>&1 ||
    { cat "$work/cpack.log"; fail "cpack"; }
rc="$source/wxapplauncher/resources/Veltrona.rc"
version="$(sed -n 's/^ *VALUE "ProductVersion", "\([0-9.]*\)".*/\1/p' "$rc")"
fileVersion="$(sed -n 's/^FILEVERSION \([0-9]*\), *\([0-9]*\), *\([0-9]*\), *\([0-9]*\).*/\1.\2.\3.\4/p' "$rc")"
launcher="$out/Veltrona-$version-x64.msi"
standins="$out/Veltrona-suite-standins-$version-x64.msi"
[ -f "$launcher" ] && [ -f "$standins" ] || fail "no packages named by the version $version"

rows() { msiinfo export "$1" "$2" | tail -n +4 | tr -d '\r'; }
# The value of a row's column, found by its first column.
cell() { rows "$1" "$2" | awk -F'\t' -v key="$3" -v column="$4" '$1 == key { print $column }'; }

for package in "$launcher" "$standins"; do
    tables="$(msiinfo tables "$package")"
    for table in Property Directory Component File MsiFileHash Feature FeatureComponents Media \
        Upgrade Icon InstallExecuteSequence; do
        grep -qx "$table" <<<"$tables" || fail "$(basename "$package") has no $table table"
    done
    [[ "$(msiinfo suminfo "$package")" == *"Template: x64;1033"* ]] || fail "not an x64 package"
    for property in "ALLUSERS=1" "Manufacturer=Zelgrave" "ProductVersion=$version" \
        "ARPPRODUCTICON=Veltrona.ico"; do
        [ "$(cell "$package" Property "${property%%=*}" 2)" = "${property#*=}" ] ||
            fail "$(basename "$package"): $property"
    done
    # The links of the launcher's Help menu: the how-to guides as help, the forum as support.
    for link in ARPHELPLINK:kHowToPage ARPURLINFOABOUT:kUserForumPage; do
        page="$(sed -n "s/^const wxString ${link#*:} = \"\(.*\)\";/\1/p" \
            "$source/wxapplauncher/help/Documentation.cpp")"
        [ -n "$page" ] && [ "$(cell "$package" Property "${link%%:*}" 2)" = "$page" ] ||
            fail "$(basename "$package"): ${link%%:*}"
    done
    # A major upgrade: older products of the same upgrade code are found and removed.
    upgradeCode="$(cell "$package" Property UpgradeCode 2)"
    rows "$package" Upgrade | grep -q "^${upgradeCode^^}		$version		" ||
        fail "$(basename "$package") does not replace older versions"
    rows "$package" InstallExecuteSequence | grep -q "^RemoveExistingProducts	" ||
        fail "$(basename "$package") does not remove the older product"
    # Every component is a 64-bit one (its registry values land in the 64-bit view).
    rows "$package" Component | awk -F'\t' 'int($4 / 256) % 2 == 0 { exit 1 }' ||
        fail "$(basename "$package") has 32-bit components"
    # A file carries its version resource's file version, or a hash when it has none.
    while IFS=$'\t' read -r file _ name _ fileVer _; do
        hashed="$(cell "$package" MsiFileHash "$file" 1)"
        if [ -n "$fileVer" ] && [ -n "$hashed" ] || [ -z "$fileVer" ] && [ -z "$hashed" ]; then
            fail "$name: version '$fileVer', hash '$hashed'"
        fi
        echo "$name $fileVer" >>"$work/versions"
    done < <(rows "$package" File)
    msiextract -C "$work/$(basename "$package")" "$package" >/dev/null
done
[ "$(cell "$launcher" Property UpgradeCode 2)" != "$(cell "$standins" Property UpgradeCode 2)" ] ||
    fail "both packages share an upgrade code"
grep -qxF "Veltrona.exe $fileVersion" "$work/versions" || fail "Veltrona.exe lacks its version"
grep -qxF "Quenta Print Studio.exe 3.1.0.1207" "$work/versions" || fail "a module lacks its version"

# Each file of the demo installation in exactly one package, at its path in the suite's
# folder; nothing else.
launcherTree="$work/$(basename "$launcher")/Zelgrave/Veltrona"
standinsTree="$work/$(basename "$standins")/Zelgrave/Veltrona"
(cd "$build/demo" && find . -type f | sort) >"$work/demo.list"
(cd "$launcherTree" && find . -type f; cd "$standinsTree" && find . -type f) | sort >"$work/packed.list"
diff -u "$work/demo.list" "$work/packed.list" || fail "the packages' files differ from the demo"
[ "$(cd "$launcherTree" && find . -type f)" = ./Veltrona.exe ] || fail "the launcher's package"
# Stripped, with the resources that the launcher and the modules read from their files.
while IFS= read -r -d '' program; do
    x86_64-w64-mingw32-objdump -h "$program" >"$work/sections"
    ! grep -q ' \.debug_info ' "$work/sections" || fail "$program is not stripped"
done < <(find "$launcherTree" "$standinsTree" -name '*.exe' -print0 -o -name '*.dll' -print0)
grep -q ' \.rsrc ' <(x86_64-w64-mingw32-objdump -h "$launcherTree/Veltrona.exe") ||
    fail "the packed launcher lost its resources"

# Start menu shortcut always, desktop shortcut only with DESKTOPSHORTCUT=1, both with the
# launcher's icon.
rows "$launcher" Shortcut | awk -F'\t' '{ print $2, $3, $5, $9 }' | sort >"$work/shortcuts"
printf '%s\n' "DesktopFolder Veltrona [#f_Veltrona_exe] Veltrona.ico" \
    "ProgramMenuFolder Veltrona [#f_Veltrona_exe] Veltrona.ico" | diff -u - "$work/shortcuts" ||
    fail "the shortcuts"
desktopComponent="$(rows "$launcher" Shortcut | awk -F'\t' '$2 == "DesktopFolder" { print $4 }')"
[ "$(cell "$launcher" Component "$desktopComponent" 5)" = 'DESKTOPSHORTCUT=1 OR REMOVE~="ALL"' ] ||
    fail "the desktop shortcut is not optional"

# "Open with Veltrona": a ProgId whose command hands the file to the launcher, listed in
# both file types' OpenWithProgids; their own default value is never written.
rows "$launcher" Registry | awk -F'\t' '{ print $2 "|" $3 "|" $4 "|" $5 }' | sort >"$work/registry"
for row in '0|.icc\OpenWithProgids|Zelgrave.Veltrona.Profile|' \
    '0|.icm\OpenWithProgids|Zelgrave.Veltrona.Profile|' \
    '0|Zelgrave.Veltrona.Profile\shell\open||Open with Veltrona' \
    '0|Zelgrave.Veltrona.Profile\shell\open\command||"[#f_Veltrona_exe]" "%1"'; do
    grep -qxF "$row" "$work/registry" || fail "no registry row $row"
done
! grep -qE '^[0-9]+\|\.ic[cm]\|' "$work/registry" || fail "the package writes a file type's default"
echo "Windows Installer packages: all checks passed"
