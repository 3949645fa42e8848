#!/usr/bin/env bash
# Builds the extraction benchmark for Windows and runs it under Wine in a prefix of its own. Arguments are the
# benchmark's own (bench/README.md). Fails when the ratio is above the bound.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/install-tools.sh
[ -f build/windows/build.ninja ] || cmake --preset windows >/dev/null
cmake --build --preset windows --target extract_bench

scratch=$(mktemp -d "${TMPDIR:-/tmp}/orbit-bench.XXXXXX")
export WINEARCH=win32 WINEPREFIX="$scratch/prefix" WINEDEBUG=-all WINEDLLOVERRIDES="mscoree,mshtml="
cleanup() {
  wineserver -k 2>/dev/null || true
  rm -rf "$scratch"
}
trap cleanup EXIT
echo "making a fresh Wine prefix ..."
env -u DISPLAY wineboot -i >/dev/null 2>&1
wineserver -w

program=$PWD/build/windows/bench/extract_bench.exe
cd "$scratch"
env -u DISPLAY wine "$program" "$@"
