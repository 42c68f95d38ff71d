#!/usr/bin/env bash
# Installs what the build and the tests need on a Debian machine (run as root, or with sudo).
# Safe to run again: it only installs what is missing.
set -euo pipefail

packages=(
  cmake make g++ clang libclang-rt-14-dev
  libgtest-dev libsndfile1-dev libasound2-dev pkg-config
  libcairo2-dev libfreetype-dev libx11-dev libpng-dev libimagequant-dev fonts-dejavu-core
  g++-mingw-w64-i686 g++-mingw-w64-x86-64 binutils-mingw-w64-i686 binutils-mingw-w64-x86-64
  wine wine64 wine32:i386 xvfb xauth libx11-dev libxtst-dev libpng-dev x11-utils
  ardour lsp-plugins-vst
)

missing=()
for p in "${packages[@]}"; do
  dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed" || missing+=("$p")
done
[ ${#missing[@]} -eq 0 ] && exit 0

SUDO=""
[ "$(id -u)" -ne 0 ] && SUDO="sudo"
if ! dpkg --print-foreign-architectures | grep -qx i386; then
  $SUDO dpkg --add-architecture i386
fi
$SUDO apt-get update -qq
DEBIAN_FRONTEND=noninteractive $SUDO apt-get install -y -qq --no-install-recommends "${missing[@]}"
