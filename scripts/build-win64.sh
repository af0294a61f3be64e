#!/usr/bin/env bash
# Installs what is missing, builds the Windows libraries once per machine, and builds
# everything for 64-bit Windows into the directory given ($1), the demo included.
set -euo pipefail

cd "$(dirname "${BASH_SOURCE[0]}")/.."
scripts/install-deps.sh
toolchain="$(scripts/win64-toolchain.sh)"
cmake -S . -B "$1" -DCMAKE_TOOLCHAIN_FILE="$toolchain" -DCMAKE_BUILD_TYPE=Release
cmake --build "$1" -j2
