#!/usr/bin/env bash
# Installs the Debian packages that the build, the demo and the tests need.
# Add new needs to the one list below.
set -euo pipefail

packages=(
    cmake
    g++
    make
    pkg-config
    libwxgtk3.2-dev
    libgtk-3-dev
    libgtest-dev
    googletest
    libx11-dev
    libxtst-dev
    xvfb
    xauth
    openbox
    weston
    xwayland
    xdotool
    xclip
    adwaita-icon-theme
    x11-utils
    wmctrl
    imagemagick
    locales-all
    gettext
    librsvg2-bin
    binutils-mingw-w64-x86-64
    g++-mingw-w64-x86-64-posix
    mingw-w64-tools
    libz-mingw-w64-dev
    wine
    wine64
    clang
    libclang-rt-14-dev
    libtsan2
    dpkg-dev
    file
    fonts-wqy-microhei
    at-spi2-core
    libatspi2.0-dev
    dbus
    dbus-bin
    dbus-x11
    lintian
    wixl
    msitools
    desktop-file-utils
    appstream
    xdg-utils
    libglib2.0-bin
    shared-mime-info
    xdg-utils
    file
)

missing=()
for package in "${packages[@]}"; do
    status="$(dpkg-query -W -f='${db:Status-Status}' "$package" 2>/dev/null || true)"
    if [ "$status" != "installed" ]; then
        missing+=("$package")
    fi
done

if [ ${#missing[@]} -eq 0 ]; then
    exit 0
fi

if [ "$(id -u)" -ne 0 ]; then
    echo "Missing packages. Install them with:" >&2
    echo "  sudo apt-get install --no-install-recommends ${missing[*]}" >&2
    exit 1
fi

echo "Installing: ${missing[*]}"
apt-get update
DEBIAN_FRONTEND=noninteractive apt-get install -y --no-install-recommends "${missing[@]}"
