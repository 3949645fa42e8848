#!/usr/bin/env bash
# Builds the setup program, its starter, the sample product and the tools around them, and packs the products: what
# people get is build/Plumo-VERSION-install.exe; build/PlumoSetup.exe is the bare stamped setup program.
#   build-plumo.sh [PRESET]    packed by the orbit of that preset: release, or host (the tests', under sanitizers)
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
preset=${1:-release}
orbit=build/$preset/tools/orbit/orbit
build "$preset" orbit
scripts/stage-plumo.sh
"$orbit" pack build/plumo --setup build/windows/src/starter/setup.exe \
  --output build/PlumoSetup.exe
for product in plumo gallery wizard97; do
  "$orbit" pack products/$product/product.toml
done
