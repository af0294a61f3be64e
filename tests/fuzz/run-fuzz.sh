#!/usr/bin/env bash
# Builds the resource reader's fuzz target with clang and runs it briefly on a seed
# corpus made from the real resource image and a small executable that carries it.
# Usage: tests/fuzz/run-fuzz.sh BUILD_DIR [SECONDS]   (BUILD_DIR holds the built project)
set -euo pipefail

build="$(cd "$1" && pwd)"
seconds="${2:-20}"
src="$(cd "$(dirname "$0")/../.." && pwd)"
res="$build/wxapplauncher/resources/Veltrona.res"
work="$build/fuzz"

if [ ! -f "$res" ]; then
    echo "run-fuzz: $res is missing; build the project first" >&2
    exit 2
fi
mkdir -p "$work/corpus" "$work/artifacts"

clang++ -std=c++17 -g -O1 -fsanitize=fuzzer,address,undefined -fno-sanitize-recover=all \
    -I "$src/wxapplauncher" \
    "$src/tests/fuzz/ResourceFuzz.cpp" \
    "$src/wxapplauncher/platform/ResourceImage.cpp" \
    "$src/wxapplauncher/platform/IconResource.cpp" \
    "$src/wxapplauncher/resources/CatalogFormat.cpp" \
    -o "$work/resource_fuzz"

cp "$res" "$work/corpus/Veltrona.res"
printf 'int main(void) { return 0; }\n' >"$work/tiny.c"
clang -o "$work/corpus/tiny-elf" "$work/tiny.c"
objcopy --add-section ".rsrc=$res" --set-section-flags .rsrc=noload,readonly "$work/corpus/tiny-elf"

"$work/resource_fuzz" -max_total_time="$seconds" -rss_limit_mb=2048 -print_final_stats=1 \
    -artifact_prefix="$work/artifacts/" "$work/corpus"
