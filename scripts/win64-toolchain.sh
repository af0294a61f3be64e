#!/usr/bin/env bash
# Builds the static 64-bit Windows libraries the Windows build links against
# (wxWidgets 3.2 for MSW with libpng and expat, all from Debian's own source
# packages, zlib from libz-mingw-w64-dev, GoogleTest from Debian's sources),
# once per machine, into a cache keyed by this script's content.
# Prints the CMake toolchain file to use. Needs scripts/install-deps.sh first.
set -euo pipefail

here="$(cd "$(dirname "${BASH_SOURCE[0]}")" && pwd)"
key="$(sha256sum "${BASH_SOURCE[0]}" | cut -c1-16)"
cache="${XDG_CACHE_HOME:-$HOME/.cache}/veltrona/win64-$key"
prefix="$cache/prefix"
toolchain="$cache/mingw64.cmake"

if [ -f "$cache/done" ]; then
    echo "$toolchain"
    exit 0
fi

host=x86_64-w64-mingw32
jobs="$(nproc)"
work="$(mktemp -d "${TMPDIR:-/tmp}/veltrona-win64.XXXXXX")"
trap 'rm -rf "$work"' EXIT
rm -rf "$cache"
mkdir -p "$prefix"

# Source packages need a deb-src entry for the configured suite.
if ! apt-get source --print-uris wxwidgets3.2 >/dev/null 2>&1; then
    if [ "$(id -u)" -ne 0 ]; then
        echo "win64-toolchain: add a deb-src entry for Debian (as root) and run again" >&2
        exit 1
    fi
    cat >/etc/apt/sources.list.d/veltrona-deb-src.sources <<'EOF'
Types: deb-src
URIs: http://deb.debian.org/debian
Suites: bookworm bookworm-updates
Components: main
Signed-By: /usr/share/keyrings/debian-archive-keyring.gpg
EOF
    apt-get update >&2
fi
(cd "$work" && apt-get source wxwidgets3.2 libpng1.6 expat >&2)

cat >"$toolchain" <<EOF
set(CMAKE_SYSTEM_NAME Windows)
set(CMAKE_SYSTEM_PROCESSOR x86_64)
set(CMAKE_C_COMPILER $host-gcc-posix)
set(CMAKE_CXX_COMPILER $host-g++-posix)
set(CMAKE_RC_COMPILER $host-windres)
set(CMAKE_FIND_ROOT_PATH /usr/$host $prefix)
set(CMAKE_FIND_ROOT_PATH_MODE_PROGRAM NEVER)
set(CMAKE_FIND_ROOT_PATH_MODE_LIBRARY ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_INCLUDE ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_PACKAGE ONLY)
set(wxWidgets_CONFIG_EXECUTABLE $prefix/bin/wx-config)
set(VELTRONA_WIN64_PREFIX $prefix)
EOF

cmake_static=(-DCMAKE_TOOLCHAIN_FILE="$toolchain" -DCMAKE_BUILD_TYPE=Release
              -DCMAKE_INSTALL_PREFIX="$prefix" -DBUILD_SHARED_LIBS=OFF)

# libpng
cmake -S "$work"/libpng1.6-*/ -B "$work/png" "${cmake_static[@]}" \
    -DPNG_SHARED=OFF -DPNG_STATIC=ON -DPNG_TESTS=OFF -DPNG_EXECUTABLES=OFF >&2
cmake --build "$work/png" -j"$jobs" --target install >&2

# expat: its CMake template leaves XML_DTD undefined unless the line carries a value.
expat_src="$(echo "$work"/expat-*/expat)"
sed -i 's/^#cmakedefine XML_DTD$/#cmakedefine XML_DTD 1/' "$expat_src/expat_config.h.cmake"
cmake -S "$expat_src" -B "$work/expat" "${cmake_static[@]}" -DEXPAT_SHARED_LIBS=OFF \
    -DEXPAT_BUILD_TOOLS=OFF -DEXPAT_BUILD_EXAMPLES=OFF -DEXPAT_BUILD_TESTS=OFF \
    -DEXPAT_BUILD_DOCS=OFF >&2
cmake --build "$work/expat" -j"$jobs" --target install >&2

# GoogleTest, from the googletest package's sources.
cmake -S /usr/src/googletest -B "$work/gtest" "${cmake_static[@]}" -Dgtest_disable_pthreads=OFF >&2
cmake --build "$work/gtest" -j"$jobs" --target install >&2

# wxWidgets for MSW, static, with accessibility for the buttons' screen-reader answers.
mkdir -p "$work/wx"
(cd "$work/wx" && "$(echo "$work"/wxwidgets3.2-*)"/configure \
    --host=$host --build="$(gcc -dumpmachine)" --prefix="$prefix" \
    --with-msw --disable-shared --enable-unicode --enable-accessibility \
    --with-libpng=sys --with-zlib=sys --with-expat=sys --with-regex=builtin \
    --without-libjpeg --without-libtiff --without-liblzma --without-opengl \
    --disable-webview --disable-mediactrl --disable-stc --disable-richtext \
    --disable-ribbon --disable-propgrid --disable-aui \
    CC=$host-gcc-posix CXX=$host-g++-posix \
    CPPFLAGS="-I$prefix/include" LDFLAGS="-L$prefix/lib" >&2)
make -C "$work/wx" -j"$jobs" >&2
make -C "$work/wx" install >&2

touch "$cache/done"
echo "$toolchain"
