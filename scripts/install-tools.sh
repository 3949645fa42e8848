#!/usr/bin/env bash
# Installs everything that building, running and testing Orbit Setup needs on a bare Debian 12 (as root).
# Does nothing, in well under a second, when everything is there already.
set -euo pipefail

build_packages=(
  g++ cmake ninja-build python3 clang-format-14 clang-tidy-14
  g++-mingw-w64-i686-posix libz-mingw-w64-dev zlib1g-dev googletest libcli11-dev
  libtomlplusplus-dev libdeflate-dev
)
desktop_packages=(
  wine wine32:i386 xvfb x11-utils imagemagick fonts-liberation fonts-wine openssl osslsigncode
)

installed() { dpkg-query -W -f '${db:Status-Abbrev}' "$1" 2>/dev/null | grep -q '^ii'; }

missing=()
for package in "${build_packages[@]}" "${desktop_packages[@]}"; do
  installed "$package" || missing+=("$package")
done
[ ${#missing[@]} -eq 0 ] && exit 0

echo "Installing: ${missing[*]}"
export DEBIAN_FRONTEND=noninteractive
dpkg --print-foreign-architectures | grep -qx i386 || dpkg --add-architecture i386
# One stale index must not stop the installation: what is really missing fails below, by name.
apt-get update -q || echo "apt-get update reported an error; going on with the indexes that are there" >&2
install=(apt-get install -y -q --no-install-recommends)
"${install[@]}" "${missing[@]}" || "${install[@]}" -t bookworm "${missing[@]}"
