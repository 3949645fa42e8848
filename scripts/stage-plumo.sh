#!/usr/bin/env bash
# Puts together what the sample product's setup installs: build/plumo, from products/plumo/files and the built programs.
# usage: scripts/stage-plumo.sh [TARGET-FOLDER]
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
target=${1:-$root/build/plumo}
programs=$root/build/windows/products/plumo

rm -rf "$target"
mkdir -p "$target"
cp -r "$root/products/plumo/files/." "$target/"
cp "$programs/Plumo.exe" "$programs/UnInstall.exe" "$programs/UnInstall01.exe" "$target/"

# The repository keeps neither times nor the read-only attribute. Times far apart, so that a lost one is noticed.
find "$target" -type f -exec touch -d '2026-03-01 12:00:00 UTC' {} +
touch -d '2004-05-17 08:30:00 UTC' "$target/Licence.txt"
touch -d '1999-12-31 23:59:58 UTC' "$target/Texts/empty.txt"
chmod 0444 "$target/Licence.txt"
