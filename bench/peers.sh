#!/usr/bin/env bash
# Compares what orbit packs with what NSIS and wixl make of the same folder: packed size, silent installation, memory,
# first window. Prints the table, and fails when a bound is missed.
#
#   bench/peers.sh [--rounds N] [--write]    --write puts the table into docs/performance.md
set -euo pipefail
cd "$(dirname "$0")/.."
ORBIT_ROOT=$PWD
. scripts/wine-env.sh

rounds=5 document='' command="bench/peers.sh${*:+ $*}"
while [ $# -gt 0 ]; do
  case $1 in
    --rounds) rounds=$2; shift 2 ;;
    --write) document=docs/performance.md; shift ;;
    *) echo "usage: bench/peers.sh [--rounds N] [--write]" >&2; exit 2 ;;
  esac
done

# ---- programs

peers=(nsis wixl)
dpkg-query -W "${peers[@]}" >/dev/null 2>&1 || apt-get install -y -q --no-install-recommends "${peers[@]}"
scripts/install-tools.sh
for preset in windows release; do [ -f build/$preset/build.ninja ] || cmake --preset $preset >/dev/null; done
export NINJA_STATUS='[%f/%t, %es] '
cmake --build --preset windows --target setup bootstrap UnInstall | tail -1
cmake --build --preset release --target orbit sample_tree | tail -1
template_make

# ---- the work folder: in memory, when there is room, so that no disk's caches and clean-ups are measured

place=build
[ "$(stat -f -c %T /dev/shm)" = tmpfs ] && [ "$(df --output=avail -m /dev/shm | tail -1)" -gt 3000 ] && place=/dev/shm
wine_begin "$place/orbit-peers"
cleanup() { wine_end; rm -rf "$ORBIT_WORK"; }
trap cleanup EXIT
results=$ORBIT_WORK/results
measure() { python3 bench/peers.py "$@"; }

# ---- packing

tree=$ORBIT_WORK/tree
build/release/bench/sample_tree "$tree"
program=$(cd "$tree" && find . -name '*.exe' | sort | sed -n 1p)
program=${program#./}

pack_orbit() {
  mkdir -p "$ORBIT_WORK/product"
  cp -r "$tree" "$ORBIT_WORK/product/files"
  cp build/windows/products/plumo/UnInstall.exe "$ORBIT_WORK/product/files"
  cat >"$ORBIT_WORK/product/product.toml" <<END
name = "Sample"
version = "1.0"
publisher = "Sample"
files = "files"
[variables]
program_file = '${program//\//\\}'
desktop_shortcut = false
quick_launch = false
END
  build/release/tools/orbit/orbit pack "$ORBIT_WORK/product/product.toml" --output "$ORBIT_WORK/orbit.exe"
}

pack_nsis() { makensis -V1 "-DOUTPUT=$ORBIT_WORK/nsis.exe" "-DTREE=$tree" "-DPROGRAM=${program//\//\\}" bench/peers.nsi; }

# wixl takes relative paths only.
pack_msi() {
  local product=$PWD/bench/peers.wxs
  (
    cd "$ORBIT_WORK"
    find tree -type f | sort |
      wixl-heat -p tree/ --directory-ref INSTALLDIR --component-group Files --var var.Tree >files.wxs
    wixl -D Tree=tree -D "Program=${program//\//\\}" -o msi.msi "$product" files.wxs
  )
}

# What a product without content weighs.
pack_empty() {
  mkdir -p "$ORBIT_WORK/empty/files"
  : >"$ORBIT_WORK/empty/files/empty"
  printf 'name = "Empty"\nversion = "1.0"\nfiles = "files"\n' >"$ORBIT_WORK/empty/product.toml"
  build/release/tools/orbit/orbit pack "$ORBIT_WORK/empty/product.toml" --output "$ORBIT_WORK/empty.exe"
}

echo "packing ..."
for pack in pack_orbit pack_nsis pack_msi pack_empty; do
  $pack >"$ORBIT_WORK/pack.log" 2>&1 || { cat "$ORBIT_WORK/pack.log" >&2; exit 1; }
done
{
  echo "orbit size $(stat -c %s "$ORBIT_WORK/orbit.exe")"
  echo "nsis size $(stat -c %s "$ORBIT_WORK/nsis.exe")"
  echo "msi size $(stat -c %s "$ORBIT_WORK/msi.msi")"
  echo "orbit empty $(stat -c %s "$ORBIT_WORK/empty.exe")"
} >"$results"

# ---- installing

folder='C:\Peers\Sample'
work=$(win_path "$ORBIT_WORK")
uninstalled() { timeout 60 wine "$@" >/dev/null 2>&1 || true; }

install_orbit=("$work\\orbit.exe" /S "/DIR=$folder")
install_nsis=("$work\\nsis.exe" /S "/D=$folder")
install_msi=(msiexec /i "$work\\msi.msi" /qn "INSTALLDIR=$folder")
attended_orbit=("$work\\orbit.exe")
attended_nsis=("$work\\nsis.exe")
remove_orbit() { uninstalled "$folder\\UnInstall.exe" /S; }
remove_nsis() { uninstalled "$folder\\uninstall.exe" /S "_?=$folder"; }
remove_msi() { uninstalled msiexec /x "$work\\msi.msi" /qn; }

# Byte for byte what was packed. What a program adds of its own may be there, too.
check_installed() {
  diff -rq "$tree" "$installed" | grep -v "^Only in $installed: " && { echo "$1 has not installed the tree" >&2; exit 1; }
  return 0
}

# run PROGRAM MEASURE: installs, notes the number, and removes all again.
run() {
  local -n how=install_$1
  echo "$1 $2 $(measure "$2" wine "${how[@]}")" | tee -a "$results"
  check_installed "$1"
  "remove_$1"
  rm -rf "$installed"
}

cp -a "$ORBIT_TEMPLATE/prefix" "$ORBIT_WORK/prefix"
export WINEPREFIX=$ORBIT_WORK/prefix
wine_prefixes+=("$WINEPREFIX")
installed=$WINEPREFIX/drive_c/Peers/Sample
display_start
wineserver -p
# A desktop that is there before and after, as everywhere; programs open their windows on it.
wine reg add 'HKCU\Software\Wine\Explorer' /v Desktop /d peers >/dev/null 2>&1
wine explorer '/desktop=peers,1024x768' >/dev/null 2>&1 &
sleep 3

for _ in $(seq "$rounds"); do
  for program in orbit nsis msi; do run $program time; done
done
for _ in $(seq "$rounds"); do
  for program in orbit nsis msi; do run $program memory; done
done
for _ in $(seq "$rounds"); do
  for program in orbit nsis; do
    declare -n how=attended_$program
    echo "$program window $(measure window "$ORBIT_WORK/screen/Xvfb_screen0" wine "${how[@]}")" | tee -a "$results"
  done
done

{
  echo "about $(date +%Y-%m-%d), \`$command\`, medians of $rounds rounds"
  echo "about $(nproc) processors ($(lscpu | awk -F': *' '/^Model name/ && !n++ {print $2}')), $(free -g | awk '/^Mem/ {print $2}') GB," \
    "$(. /etc/os-release && echo "$PRETTY_NAME"), $(wine --version), work folder in $(stat -f -c %T "$ORBIT_WORK")"
  echo "about $(find "$tree" -type f | wc -l) files, $(find "$tree" -type f -printf '%s\n' | awk '{s += $1} END {printf "%d", s}') bytes;" \
    "$(makensis -VERSION | sed 's/^/NSIS /'), zlib; wixl $(wixl --version | tail -1)"
} >>"$results"
measure report "$results" $document
