#!/usr/bin/env bash
# Installs, with apt-get, whatever of the build and test dependencies this machine lacks.
set -euo pipefail
packages=(
    cmake make g++ pkg-config
    g++-mingw-w64-i686-posix g++-mingw-w64-x86-64-posix binutils-mingw-w64 mingw-w64-tools
    googletest libgtest-dev libbenchmark-dev libfreetype-dev
    wine wine64 xvfb xauth x11-utils imagemagick
    fonts-comic-neue fonts-dejavu-core fonts-noto-cjk fonts-thai-tlwg
)
missing=()
for package in "${packages[@]}"; do
    if ! dpkg-query -W -f='${Status}' "$package" 2>/dev/null | grep -q "install ok installed"; then
        missing+=("$package")
    fi
done
if [ ${#missing[@]} -eq 0 ]; then
    exit 0
fi
echo "Installing: ${missing[*]}"
SUDO=""
if [ "$(id -u)" -ne 0 ]; then SUDO=sudo; fi
export DEBIAN_FRONTEND=noninteractive
$SUDO apt-get update -q
$SUDO apt-get install -y -q --no-install-recommends "${missing[@]}"
