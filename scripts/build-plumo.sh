#!/usr/bin/env bash
# Builds the setup program, its starter, the sample product and the tools around them, and packs the products: what
# people get is build/Plumo-VERSION-install.exe; build/PlumoSetup.exe is the bare stamped setup program.
set -euo pipefail
cd "$(dirname "$0")/.."
export NINJA_STATUS='[%f/%t, %es] '

# build PRESET TARGET...
build() {
  local preset=$1
  shift
  [ -f "build/$preset/build.ninja" ] || cmake --preset "$preset" >/dev/null
  cmake --build --preset "$preset" --target "$@" | grep -v '^ninja: no work to do' || test "${PIPESTATUS[0]}" = 0
}

build windows setup bootstrap Plumo UnInstall ui headless
build release orbit
scripts/stage-plumo.sh
build/release/tools/orbit/orbit pack build/plumo --setup build/windows/src/starter/setup.exe \
  --output build/PlumoSetup.exe
for product in plumo gallery wizard97; do
  build/release/tools/orbit/orbit pack products/$product/product.toml
done
