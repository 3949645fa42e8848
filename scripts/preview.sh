#!/usr/bin/env bash
# Shows a wizard script with native windows: runs the Windows program orbit-preview.exe through Wine.
#
#   scripts/preview.sh SCRIPT [--page NAME] [--dpi N] [--picture DIR]
#
# `orbit preview` calls it. What the program needs of Wine is kept in a prefix of its own under the user's cache folder.
# Pictures are taken on a virtual display, so nothing appears on the screen and nobody's windows are in them.
# ORBIT_PREVIEW names the program when it is not beside this script or in build/windows.
set -euo pipefail
ORBIT_ROOT=$(cd "$(dirname "$0")/.." && pwd)
prefix=${XDG_CACHE_HOME:-$HOME/.cache}/orbit-setup/preview-prefix
export WINEARCH=win32 WINEDEBUG=${WINEDEBUG:--all} WINEDLLOVERRIDES='mscoree,mshtml=;winemenubuilder.exe=d'

fail() { echo "error: $*" >&2; exit 2; }

find_program() {
  local candidate
  for candidate in "${ORBIT_PREVIEW:-}" "$(dirname "$0")/orbit-preview.exe" \
    "$ORBIT_ROOT/build/windows/tools/preview/orbit-preview.exe"; do
    [ -n "$candidate" ] && [ -f "$candidate" ] && { readlink -f "$candidate"; return; }
  done
  return 1
}

# The dots per inch and whether windows go to a desktop of their own belong to the prefix, not to a program.
prefix_settings() { # prefix_settings DPI PICTURES
  local state="$1 $2" desktop
  [ "$(cat "$prefix/orbit-state" 2>/dev/null)" = "$state" ] && return
  wineserver -k 2>/dev/null || true
  wineserver -w 2>/dev/null || true
  [ "$2" = yes ] && desktop='"Desktop"="Default"' || desktop='"Desktop"=-'
  printf 'REGEDIT4\n\n[HKEY_CURRENT_USER\\Control Panel\\Desktop]\n"LogPixels"=dword:%08x\n
[HKEY_CURRENT_USER\\Software\\Wine\\Explorer]\n%s\n
[HKEY_CURRENT_USER\\Software\\Wine\\Explorer\\Desktops]\n"Default"="1600x1200"\n' "$1" "$desktop" >"$prefix/orbit.reg"
  DISPLAY='' wine regedit /S "$(winepath -w "$prefix/orbit.reg" 2>/dev/null)" >/dev/null 2>&1 || fail 'Wine cannot be set up'
  wineserver -k 2>/dev/null || true
  wineserver -w 2>/dev/null || true
  echo "$state" >"$prefix/orbit-state"
}

prefix_make() {
  [ -f "$prefix/orbit-ready" ] && return
  echo 'Making a Wine prefix for the preview (once; half a minute)' >&2
  rm -rf "$prefix"
  mkdir -p "$prefix"
  DISPLAY='' wineboot -i >/dev/null 2>&1 || fail 'Wine cannot make a prefix; try "wineboot -i" to see why'
  wineserver -w
  # Debian keeps Wine's own fonts beside the prefix; without them captions and close boxes lose theirs.
  cp /usr/share/wine/fonts/*.ttf /usr/share/wine/fonts/*.fon "$prefix/drive_c/windows/Fonts/" 2>/dev/null || true
  touch "$prefix/orbit-ready"
}

win_path() { local path; path=$(readlink -m "$1"); printf 'Z:%s' "${path//\//\\}"; }

dpi=96 pictures=no arguments=() script=''
while [ $# -gt 0 ]; do
  case "$1" in
    --dpi) dpi=${2:-}; shift ;;
    --dpi=*) dpi=${1#*=} ;;
    --picture) [ $# -gt 1 ] || fail '--picture needs a folder'; pictures=yes; mkdir -p "$2"; arguments+=(--picture "$(win_path "$2")"); shift ;;
    --picture=*) pictures=yes; mkdir -p "${1#*=}"; arguments+=(--picture "$(win_path "${1#*=}")") ;;
    --page) [ $# -gt 1 ] || fail '--page needs a name'; arguments+=("$1" "$2"); shift ;;
    -h | --help) sed -n '2,8s/^# \{0,1\}//p' "$0"; exit ;;
    -*) arguments+=("$1") ;;
    *) script=$1; arguments+=("$(win_path "$1")") ;;
  esac
  shift
done
[ -n "$script" ] || fail 'no script is named; usage: orbit preview SCRIPT [--page NAME] [--dpi N] [--picture DIR]'
[ -f "$script" ] || fail "$script cannot be read"
[[ $dpi =~ ^[0-9]{2,3}$ ]] && [ "$dpi" -ge 72 ] && [ "$dpi" -le 480 ] || fail '--dpi takes a number from 72 to 480'
command -v wine >/dev/null || fail 'Wine is not installed; the preview is a Windows program (on Debian: apt install wine32)'
program=$(find_program) || fail 'orbit-preview.exe is missing; build it with: cmake --build --preset windows --target orbit-preview'

export WINEPREFIX=$prefix
prefix_make
prefix_settings "$dpi" "$pictures"
if [ $pictures = no ]; then
  [ -n "${DISPLAY:-}" ] || fail 'there is no display (DISPLAY is not set); --picture works without one'
  exec wine "$program" "${arguments[@]}" --dpi "$dpi"
fi
command -v Xvfb >/dev/null || fail 'Xvfb is not installed; pictures need a virtual display (on Debian: apt install xvfb)'
work=$(mktemp -d)
xvfb_pid=''
cleanup() {
  wineserver -k 2>/dev/null || true
  [ -z "$xvfb_pid" ] || kill "$xvfb_pid" 2>/dev/null || true
  rm -rf "$work"
}
trap cleanup EXIT
Xvfb -displayfd 3 -screen 0 1600x1200x24 -nolisten tcp 3>"$work/display" >"$work/log" 2>&1 &
xvfb_pid=$!
for _ in $(seq 200); do [ -s "$work/display" ] && break; sleep 0.05; done
[ -s "$work/display" ] || fail "the virtual display did not start: $(cat "$work/log")"
DISPLAY=:$(cat "$work/display") wine "$program" "${arguments[@]}" --dpi "$dpi"
