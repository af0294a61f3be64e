#!/usr/bin/env bash
# Builds the resource reader's fuzz target with clang and runs it briefly, seeded with the real
# resource image, a small executable carrying it, the test build's executables with version
# resources and the hostile cases in seeds/. Usage: run-fuzz.sh BUILD_DIR [SECONDS]
set -euo pipefail

src="$(cd "$(dirname "$0")/../.." && pwd)"
work="$(cd "$1" && pwd)/fuzz"
res="$(cd "$1" && pwd)/wxapplauncher/resources/Veltrona.res"
[ -f "$res" ] || { echo "run-fuzz: $res is missing; build the project first" >&2; exit 2; }
mkdir -p "$work/corpus" "$work/artifacts"

# The toolkit itself is not instrumented; what it is handed is.
clang++ -std=c++17 -g -O1 -fsanitize=fuzzer,address,undefined -fno-sanitize-recover=all \
    $(wx-config --cxxflags) -I "$src/wxapplauncher" "$src/tests/fuzz/ResourceFuzz.cpp" \
    "$src"/wxapplauncher/platform/{ResourceImage,IconResource,PeResource,VersionResource}.cpp \
    "$src"/wxapplauncher/platform/unix/ElfResources.cpp \
    "$src"/wxapplauncher/resources/{CatalogFormat,IconBundle}.cpp \
    $(wx-config --libs core,base) -o "$work/resource_fuzz"
cp "$res" "$work/corpus/Veltrona.res"
cp "$src"/tests/fuzz/seeds/* "$work/corpus/"
cp "$(cd "$1" && pwd)"/tests/about/versions/{pe,elf}-[0-9]* "$work/corpus/"
echo 'int main(void) { return 0; }' | clang -x c - -o "$work/corpus/tiny-elf"
objcopy --add-section ".rsrc=$res" --set-section-flags .rsrc=noload,readonly "$work/corpus/tiny-elf"
"$work/resource_fuzz" -max_total_time="${2:-20}" -rss_limit_mb=2048 -print_final_stats=1 \
    -artifact_prefix="$work/artifacts/" "$work/corpus"
