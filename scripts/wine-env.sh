# Sourced by run.sh, test.sh and tests/e2e: Wine prefixes, a virtual display and a Wine desktop, all cleaned up on exit.
#
#   wine_begin WORK         private folder for this run (prefixes, display); sets the trap that ends what was started
#   prefix_new NAME         a fresh 32-bit prefix in WORK, from the template; becomes the current one (WINEPREFIX)
#   display_start           an Xvfb on a free display
#   desktop_start NAME      a Wine desktop of 1024x768 in the current prefix
#   ui VERB ...             tests/ui/ui.exe on that desktop
#   shot FILE               a picture of the desktop, once it has come to rest
#   run_wait                waits for what `run_start DIRECTORY COMMAND...` started; its exit code is in run_code
#   win_path PATH           a host path as the programs see it
# Needs ORBIT_ROOT (the repository) and, for ui, the build of the windows preset.

export WINEARCH=win32 WINEDEBUG=${WINEDEBUG:--all} LC_ALL=C.UTF-8
# No wizards for Mono and Gecko, nothing written to the menus of the user who runs this.
export WINEDLLOVERRIDES="mscoree,mshtml=;winemenubuilder.exe=d"

ORBIT_TEMPLATE=$ORBIT_ROOT/build/wine-template
ORBIT_UI=$ORBIT_ROOT/build/windows/tests/ui/ui.exe
ORBIT_DESKTOP=orbit
xvfb_pid='' wine_prefixes=() run_pid='' run_code=''

win_path() { local path; path=$(readlink -m "$1"); printf 'Z:%s' "${path//\//\\}"; }

wine_begin() {
  ORBIT_WORK=$1
  rm -rf "$ORBIT_WORK"
  mkdir -p "$ORBIT_WORK"
  trap wine_end EXIT
  trap 'exit 130' INT TERM
}

wine_end() {
  local status=$?
  for prefix in "${wine_prefixes[@]}"; do
    [ -d "$prefix" ] && WINEPREFIX=$prefix wineserver -k 2>/dev/null || true
  done
  [ -n "$xvfb_pid" ] && kill "$xvfb_pid" 2>/dev/null || true
  [ -n "$xvfb_pid" ] && wait "$xvfb_pid" 2>/dev/null || true
  return $status
}

# Made once: a prefix takes half a minute to make and half a gigabyte to keep.
template_make() {
  [ -f "$ORBIT_TEMPLATE/ready" ] && return
  echo "Making the Wine prefix that all runs start from (once)"
  rm -rf "$ORBIT_TEMPLATE"
  mkdir -p "$ORBIT_TEMPLATE/home"
  HOME=$ORBIT_TEMPLATE/home WINEPREFIX=$ORBIT_TEMPLATE/prefix DISPLAY='' wineboot -i >/dev/null 2>&1
  WINEPREFIX=$ORBIT_TEMPLATE/prefix wineserver -w
  # The user's folders are links into the home folder: an installation must stay inside its prefix.
  find "$ORBIT_TEMPLATE/prefix/drive_c/users" -type l -print0 | while IFS= read -r -d '' link; do
    rm "$link"
    mkdir "$link"
  done
  # Debian keeps Wine's own fonts beside the prefix; without them the close box shows a letter instead of its cross.
  cp /usr/share/wine/fonts/*.ttf /usr/share/wine/fonts/*.fon "$ORBIT_TEMPLATE/prefix/drive_c/windows/Fonts/"
  touch "$ORBIT_TEMPLATE/ready"
}

prefix_new() {
  template_make
  WINEPREFIX=$ORBIT_WORK/$1
  export WINEPREFIX
  # Hard links: Wine's own files are never written in place. The registry is; it gets a copy.
  cp -al "$ORBIT_TEMPLATE/prefix" "$WINEPREFIX"
  for file in "$WINEPREFIX"/*.reg; do
    cp "$file" "$file.copy"
    mv "$file.copy" "$file"
  done
  wine_prefixes+=("$WINEPREFIX")
}

display_start() {
  mkdir -p "$ORBIT_WORK/screen"
  # The frame buffer is a file: a picture is a copy of it, which is quick and never halfway.
  Xvfb -displayfd 3 -screen 0 1024x768x24 -fbdir "$ORBIT_WORK/screen" -nolisten tcp \
    3>"$ORBIT_WORK/display" >"$ORBIT_WORK/xvfb.log" 2>&1 &
  xvfb_pid=$!
  wait_until 60 test -s "$ORBIT_WORK/display" || { cat "$ORBIT_WORK/xvfb.log" >&2; return 1; }
  DISPLAY=:$(cat "$ORBIT_WORK/display")
  export DISPLAY
}

# wait_until SECONDS COMMAND...
wait_until() {
  local end=$((SECONDS + $1))
  shift
  until "$@" 2>/dev/null; do
    [ $SECONDS -gt $end ] && return 1
    sleep 0.05
  done
}

desktop_start() {
  ORBIT_DESKTOP=$1
  wine explorer "/desktop=$1,1024x768" >/dev/null 2>&1 &
  ui hold >/dev/null 2>&1 &
  ui park
}

ui() { wine "$ORBIT_UI" --desktop "$ORBIT_DESKTOP" "$@"; }

# run_start DIRECTORY PROGRAM [ARGUMENT...]: on the desktop, in the background.
run_start() {
  local folder=$1
  shift
  rm -f "$ORBIT_WORK/run.out"
  ui run "$(win_path "$folder")" "$@" >"$ORBIT_WORK/run.out" 2>&1 &
  run_pid=$!
}

run_ended() { ! kill -0 "$run_pid"; }

# A program that does not end within a minute is ended; its exit code is then "none".
run_wait() {
  wait_until "${1:-60}" run_ended || kill "$run_pid"
  wait "$run_pid" || true
  run_pid=''
  run_code=$(sed -n 's/^exit code \(-\?[0-9]*\).*/\1/p' "$ORBIT_WORK/run.out" | tail -1)
  run_code=${run_code:-none}
}

screen_hash() { md5sum <"$ORBIT_WORK/screen/Xvfb_screen0"; }

shot() {
  local before after tries=0
  ui park
  before=$(screen_hash)
  while sleep 0.1; do
    after=$(screen_hash)
    [ "$before" = "$after" ] && break
    before=$after
    tries=$((tries + 1))
    [ $tries -gt 20 ] && break  # something keeps moving; a picture all the same
  done
  convert "xwd:$ORBIT_WORK/screen/Xvfb_screen0" "$1"
}

# catch_start WIDTH HEIGHT ... catch_end FILE: a picture of a page of that size that is shown for a moment between them.
catch_start() {
  python3 "$ORBIT_ROOT/scripts/catch-frame.py" "$ORBIT_WORK/screen/Xvfb_screen0" "$1" "$2" "$ORBIT_WORK/caught.xwd" &
  catch_pid=$!
}

catch_end() {
  sleep 0.05
  kill "$catch_pid"
  wait "$catch_pid" || { echo "The page for $(basename "$1") was not seen this time"; return 1; }
  convert "xwd:$ORBIT_WORK/caught.xwd" "$1"
}
