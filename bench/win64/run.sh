#!/usr/bin/env bash
# The Windows demo's programs: their size and the DLLs they import. Each must stand
# alone beside Windows' own DLLs, so an import of any other DLL (the toolkit's, the
# C++ runtime's, libgcc's, winpthread's) is flagged and fails the benchmark.
# Usage: bench/win64/run.sh BUILD_DIR   (the Windows build is "BUILD_DIR-win64")
set -euo pipefail

cd "$(dirname "${BASH_SOURCE[0]}")/../.."
build="$1-win64"
scripts/build-win64.sh "$build" >/dev/null

# The DLLs of Windows itself that a toolkit program may use; the universal C runtime's
# api-ms-win-* sets are Windows' own as well.
declare -A system_dll
for dll in advapi32.dll bcrypt.dll comctl32.dll comdlg32.dll crypt32.dll dwmapi.dll gdi32.dll \
    gdiplus.dll imm32.dll kernel32.dll msimg32.dll msvcrt.dll ntdll.dll ole32.dll oleacc.dll \
    oleaut32.dll rpcrt4.dll setupapi.dll shell32.dll shlwapi.dll ucrtbase.dll user32.dll \
    usp10.dll uxtheme.dll version.dll winhttp.dll winmm.dll winspool.drv ws2_32.dll wsock32.dll; do
    system_dll[$dll]=1
done

foreign=0
while IFS= read -r -d '' program; do
    name="${program#"$build/demo/"}"
    printf '%-34s %9d bytes\n' "$name" "$(stat -c %s "$program")"
    while read -r dll; do
        lower="${dll,,}"
        if [[ -n "${system_dll[$lower]:-}" || "$lower" == api-ms-win-* ]]; then
            printf '    %s\n' "$dll"
        else
            printf '    %s   <- not a Windows DLL\n' "$dll"
            foreign=$((foreign + 1))
        fi
    done < <(x86_64-w64-mingw32-objdump -p "$program" | sed -n 's/^[[:space:]]*DLL Name: //p')
done < <(find "$build/demo" -type f \( -name '*.exe' -o -name '*.dll' \) -print0 | sort -z)

if [ "$foreign" -gt 0 ]; then
    echo "win64: $foreign import(s) of DLLs that Windows does not have" >&2
    exit 1
fi
