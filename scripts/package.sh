#!/usr/bin/env bash
# Builds the Linux and the Windows trees, then makes their packages with CPack into one
# folder: the Debian packages veltrona and veltrona-suite-standins, and the Windows
# Installer packages Veltrona-<version>-x64.msi and Veltrona-suite-standins-<version>-x64.msi.
# Usage: scripts/package.sh [DIR]   (default: packages/ in the build directory)
# Build directories: $BUILD_DIR (default "build") and "$BUILD_DIR-win64".
set -euo pipefail

cd "$(dirname "${BASH_SOURCE[0]}")/.."
build="$(realpath -m "${BUILD_DIR:-build}")"
out="$(realpath -m "${1:-$build/packages}")"

scripts/build.sh "$build"
scripts/build-win64.sh "$build-win64"
mkdir -p "$out"
for tree in "$build" "$build-win64"; do
    rm -rf "$tree/cpack"
    cpack --config "$tree/CPackConfig.cmake" -B "$tree/cpack"
done
cp "$build"/cpack/*.deb "$build-win64"/cpack/*.msi "$out/"
echo "Packages in $out:"
ls -1 "$out"
