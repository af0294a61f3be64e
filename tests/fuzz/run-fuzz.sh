#!/usr/bin/env bash
# Builds the fuzz targets with clang and runs them briefly, sharing SECONDS between them: the
# resource reader, seeded with the real resource image, a small executable carrying it, the test
# build's executables with version resources and the hostile cases in seeds/resource/; and the IPC
# server's peers, seeded with the scripts in seeds/ipc/. Usage: run-fuzz.sh BUILD_DIR [SECONDS]
set -euo pipefail

src="$(cd "$(dirname "$0")/../.." && pwd)"
work="$(cd "$1" && pwd)/fuzz"
res="$(cd "$1" && pwd)/wxapplauncher/resources/Veltrona.res"
seconds="${2:-20}"
[ -f "$res" ] || { echo "run-fuzz: $res is missing; build the project first" >&2; exit 2; }
mkdir -p "$work/corpus" "$work/ipc-corpus" "$work/artifacts"

# The toolkit itself is not instrumented; what it is handed is.
build() {
    local target="$1"
    shift
    clang++ -std=c++17 -g -O1 -fsanitize=fuzzer,address,undefined -fno-sanitize-recover=all \
        $(wx-config --cxxflags) -I "$src/wxapplauncher" "$@" \
        $(wx-config --libs core,base) -o "$work/$target"
}
# Runs a target on its corpus for SECONDS.
fuzz() {
    "$work/$1" -max_total_time="$2" -rss_limit_mb=2048 -print_final_stats=1 \
        -artifact_prefix="$work/artifacts/$1-" "$work/$3"
}

build resource_fuzz "$src/tests/fuzz/ResourceFuzz.cpp" \
    "$src"/wxapplauncher/platform/{ResourceImage,IconResource,PeResource,VersionResource}.cpp \
    "$src"/wxapplauncher/platform/unix/{ElfResources,ResourceIcon}.cpp \
    "$src"/wxapplauncher/resources/{CatalogFormat,IconBundle}.cpp
build ipc_fuzz "$src/tests/fuzz/IpcFuzz.cpp" \
    "$src"/wxapplauncher/platform/PokeText.cpp \
    "$src"/wxapplauncher/platform/unix/{IpcPeer,Ipc,PrivateRuntimeDir}.cpp

cp "$res" "$work/corpus/Veltrona.res"
cp "$src"/tests/fuzz/seeds/resource/* "$work/corpus/"
cp "$(cd "$1" && pwd)"/tests/about/versions/{pe,elf}-[0-9]* "$work/corpus/"
echo 'int main(void) { return 0; }' | clang -x c - -o "$work/corpus/tiny-elf"
objcopy --add-section ".rsrc=$res" --set-section-flags .rsrc=noload,readonly "$work/corpus/tiny-elf"
cp "$src"/tests/fuzz/seeds/ipc/* "$work/ipc-corpus/"

# A time of 0 would mean no limit: each target gets a second at least.
fuzz resource_fuzz $((seconds > 1 ? seconds - seconds / 2 : 1)) corpus
fuzz ipc_fuzz $((seconds > 1 ? seconds / 2 : 1)) ipc-corpus
