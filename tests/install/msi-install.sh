#!/usr/bin/env bash
# Installs the Windows Installer packages that msi-packages.sh made in $2 silently, in a
# Wine prefix and home of the test's own, and checks what they leave:
#   install          the installed launcher, run by the test program $3 (its window, a
#                    module started by a click, a profile opened with "Open with
#                    Veltrona", the shortcuts); the file types' own defaults untouched;
#                    the entry in Programs and Features
#   upgrade-remove   packages of an older number, made from the build $4 with the
#                    package settings $5, then the current ones: one entry each and the
#                    current files; then both removed: nothing of them left, the user's
#                    settings kept
# Runs on the caller's display; Wine's services for the prefix start and end here.
set -euo pipefail
root="$(cd "$(dirname "$0")/../.." && pwd)"
fail() { echo "FAIL: $*" >&2; exit 1; }

if [ -z "${MSI_TEST_WORK:-}" ]; then
    work="$(mktemp -d "${TMPDIR:-/tmp}/msi-install.XXXXXX")"
    trap 'rm -rf "$work"' EXIT
    # Wine links the user's desktop to $HOME, and its menu builder would write the Start
    # menu's entries into the home's desktop menus: a home of the test's own, no builder.
    mkdir "$work/home"
    MSI_TEST_WORK="$work" HOME="$work/home" WINEPREFIX="$work/wine" \
        WINEDLLOVERRIDES="winemenubuilder.exe=d" "$root/scripts/with-wine.sh" "$0" "$@"
    exit
fi
work="$MSI_TEST_WORK"
mode="$1"
packages="$2"
tests="$3"
# Wine's own services first, so that they do not hold the caller's output open.
wineboot </dev/null >/dev/null 2>&1

rc="$root/wxapplauncher/resources/Veltrona.rc"
version="$(sed -n 's/^ *VALUE "ProductVersion", "\([0-9.]*\)".*/\1/p' "$rc")"
launcher="$packages/Veltrona-$version-x64.msi"
standins="$packages/Veltrona-suite-standins-$version-x64.msi"
installed='C:\Program Files\Zelgrave\Veltrona'
folder="$WINEPREFIX/drive_c/Program Files/Zelgrave/Veltrona"

msiexec() {
    timeout 300 wine msiexec "$@" /qn </dev/null ||
        fail "msiexec $* ended with $? (124: still running after 300 s)"
}
# A registry value's data ("" for the default value), or failure when there is none.
value() {
    local output
    if [ -z "$2" ]; then
        output="$(wine reg query "$1" /ve 2>/dev/null)" || return 1
    else
        output="$(wine reg query "$1" /v "$2" 2>/dev/null)" || return 1
    fi
    tr -d '\r' <<<"$output" | awk -F'    ' -v name="${2:-(Default)}" '
        $2 == name && $4 != "(value not set)" { print $4; found = 1 }
        END { exit !found }'
}
# The entries in Programs and Features named $1, as "key|version|publisher|help|support".
entries() {
    wine reg query 'HKLM\Software\Microsoft\Windows\CurrentVersion\Uninstall' /s 2>/dev/null |
        tr -d '\r' | awk -F'    ' -v name="$1" '
            /^HKEY/ { if (shown == name) print key "|" v "|" p "|" h "|" s
                      key = $0; shown = v = p = h = s = "" }
            $2 == "DisplayName" { shown = $4 }
            $2 == "DisplayVersion" { v = $4 }
            $2 == "Publisher" { p = $4 }
            $2 == "HelpLink" { h = $4 }
            $2 == "URLInfoAbout" { s = $4 }
            END { if (shown == name) print key "|" v "|" p "|" h "|" s }'
}
# The files below a folder, with their checksums.
inventory() { (cd "$1" && find . -type f -print0 | sort -z | xargs -0 md5sum); }
# The installed folder holds exactly the files of the packages $@.
expect_files_of() {
    rm -rf "$work/extracted"
    for package in "$@"; do
        msiextract -C "$work/extracted" "$package" >/dev/null
    done
    diff -u <(inventory "$work/extracted/Zelgrave/Veltrona") <(inventory "$folder") ||
        fail "the installed files differ from the packages' $*"
}
run_tests() {
    VELTRONA_INSTALLED_DIR="$installed" wine "$tests" --gtest_filter="$1" ||
        fail "the installed launcher's tests $1"
}

# A profile type with a default of its own (as Windows has "icmfile"), and the user's
# updater settings: "Never" also keeps the scheduled updater from starting with the launcher.
wine reg add 'HKLM\Software\Classes\.icm' /ve /d icmfile /f >/dev/null
wine reg add 'HKCU\Software\Zelgrave\Zel Updater' /v 'Next Launch' /d Never /f >/dev/null
wine reg add 'HKCU\Software\Zelgrave\Zel Updater' /v Silent /t REG_DWORD /d 1 /f >/dev/null
wine reg add 'HKLM\Software\Zelgrave\Zel Updater' /v Silent /t REG_DWORD /d 0 /f >/dev/null

case "$mode" in
install)
    msiexec /i "$(winepath -w "$launcher")"
    msiexec /i "$(winepath -w "$standins")"
    expect_files_of "$launcher" "$standins"
    value 'HKCR\.icc\OpenWithProgids' Zelgrave.Veltrona.Profile >/dev/null ||
        fail ".icc files have no \"Open with Veltrona\""
    value 'HKCR\.icm\OpenWithProgids' Zelgrave.Veltrona.Profile >/dev/null ||
        fail ".icm files have no \"Open with Veltrona\""
    [ "$(value 'HKCR\.icm' '')" = icmfile ] || fail "the .icm files' default was taken over"
    ! value 'HKCR\.icc' '' >/dev/null || fail "the package made itself the .icc files' default"

    help="$(msiinfo export "$launcher" Property | tr -d '\r' | awk -F'\t' '$1 == "ARPHELPLINK" { print $2 }')"
    support="$(msiinfo export "$launcher" Property | tr -d '\r' | awk -F'\t' '$1 == "ARPURLINFOABOUT" { print $2 }')"
    for product in Veltrona "Veltrona suite stand-ins"; do
        [ "$(entries "$product" | cut -d'|' -f2-)" = "$version|Zelgrave|$help|$support" ] ||
            fail "the entry of $product in Programs and Features: $(entries "$product")"
    done
    # The entry's icon: the package's, kept by the installer with the product.
    icon="$(wine reg query 'HKLM\Software\Classes\Installer\Products' /s | tr -d '\r' |
        awk -F'    ' '/^HKEY/ { name = icon = "" } $2 == "ProductName" { name = $4 }
                      $2 == "ProductIcon" { icon = $4 } name == "Veltrona" && icon != "" { print icon; exit }')"
    [ -n "$icon" ] && [ -f "$(winepath -u "$icon")" ] || fail "the entry's icon '$icon'"

    VELTRONA_DESKTOP_SHORTCUT=0 run_tests 'InstalledLauncherTest.*'
    ;;
upgrade-remove)
    build="$4"
    settings="$5"
    # The packages of an older number: the same install components, with another program
    # as the launcher and an older page.
    old="$(awk -F. '{ printf "%d.%d.%d.%s", $1, $2, $3 - 1, $4 }' <<<"$version")"
    for component in launcher standins; do
        cmake --install "$build" --component $component --prefix "$work/old/$component" --strip \
            >/dev/null
    done
    cp "$work/old/standins/Quenta Updater.exe" "$work/old/launcher/Veltrona.exe"
    echo "<p>old</p>" >"$work/old/standins/Documentation/en/Help/Launcher.html"
    for component in launcher standins; do
        cmake -DPACKAGE=$component -DSTAGED="$work/old/$component" -DVERSION="$old" \
            -DOUTPUT="$work/old/$component.msi" -DSETTINGS="$settings" \
            -P "$root/packaging/msw/BuildMsi.cmake"
    done
    msiexec /i "$(winepath -w "$work/old/launcher.msi")"
    msiexec /i "$(winepath -w "$work/old/standins.msi")"
    expect_files_of "$work/old/launcher.msi" "$work/old/standins.msi"
    [ "$(entries Veltrona | cut -d'|' -f2)" = "$old" ] || fail "the older launcher's entry"

    msiexec /i "$(winepath -w "$launcher")" DESKTOPSHORTCUT=1
    msiexec /i "$(winepath -w "$standins")"
    for product in Veltrona "Veltrona suite stand-ins"; do
        [ "$(entries "$product" | cut -d'|' -f2)" = "$version" ] ||
            fail "after the upgrade, $product has the entries: $(entries "$product")"
    done
    expect_files_of "$launcher" "$standins"
    VELTRONA_DESKTOP_SHORTCUT=1 run_tests 'InstalledLauncherTest.Shortcuts*'

    msiexec /x "$(winepath -w "$launcher")"
    msiexec /x "$(winepath -w "$standins")"
    # Nothing of the packages: no file or folder, shortcut, key or value.
    left="$(find "$WINEPREFIX/drive_c" "$HOME" -iname '*veltrona*' -o -iname '*zelgrave*')"
    [ -z "$left" ] || fail "left after removal: $left"
    [ -z "$(entries Veltrona)$(entries "Veltrona suite stand-ins")" ] || fail "entries left"
    for hive in HKLM HKCU; do
        wine reg export $hive "$work/$hive.reg" /y >/dev/null
        iconv -f UTF-16 -t UTF-8 "$work/$hive.reg" | tr -d "\r" >"$work/$hive.txt"
        grep -qi 'zel updater' "$work/$hive.txt" || fail "$hive: no readable export"
        ! grep -i -B3 veltrona "$work/$hive.txt" || fail "$hive keeps the packages' keys"
    done
    ! wine reg query 'HKCR\.icc' >/dev/null 2>&1 || fail "the .icc key is left"
    ! wine reg query 'HKCR\.icm\OpenWithProgids' >/dev/null 2>&1 || fail "the .icm list is left"
    [ "$(value 'HKCR\.icm' '')" = icmfile ] || fail "the .icm files' default is gone"
    # The user's own settings stay.
    [ "$(value 'HKCU\Software\Zelgrave\Zel Updater' 'Next Launch')" = Never ] &&
        [ "$(value 'HKCU\Software\Zelgrave\Zel Updater' Silent)" = 0x1 ] &&
        [ "$(value 'HKLM\Software\Zelgrave\Zel Updater' Silent)" = 0x0 ] ||
        fail "the user's updater settings were touched"
    ;;
*)
    fail "unknown mode $mode"
    ;;
esac
echo "Windows Installer packages, $mode: all checks passed"
