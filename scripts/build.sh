#!/usr/bin/env bash
# Installs what is missing and builds everything into the directory given ($1).
set -euo pipefail

cd "$(dirname "${BASH_SOURCE[0]}")/.."
scripts/install-deps.sh
cmake -S . -B "$1" -DCMAKE_BUILD_TYPE=RelWithDebInfo
cmake --build "$1" -j2
