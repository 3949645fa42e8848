#!/usr/bin/env bash
# Leaving the wizard: Cancel and the close box on pages 1 to 4, and while files are being copied.
. "$(dirname "$0")/lib.sh"
test_begin
drive_c=$WINEPREFIX/drive_c
PAGES=("$PAGE1" "$PAGE2" "$PAGE3" "$PAGE4")
installed_files() { find "$drive_c" -type f -newer "$ORBIT_WORK/before" ! -path '*/windows/*' ! -path '*/users/*'; }

# leave_by cancel|close PAGE: until the confirmation is there.
leave_by() {
  if [ "$1" = cancel ]; then expect 'Cancel' ui click "$2" Cancel; else expect 'the close box' ui close "$2"; fi
  expect "the confirmation comes ($1)" ui wait "$EXIT_PAGE"
}

# leave_page N WAY
leave_page() {
  local page=${PAGES[$1 - 1]} way
  case_begin "page $1 is left by $2"
  touch "$ORBIT_WORK/before"
  setup_run "$PLUMO_SETUP"
  expect "page $1" walk_to "$1" 'C:\Programi\Plumo'
  for way in cancel close; do
    leave_by $way "$page"
    expect 'Resume' ui click "$EXIT_PAGE" Resume
    expect 'the confirmation goes' ui gone "$EXIT_PAGE"
    expect 'the page stays' ui wait "$page"
  done
  leave_by "$2" "$page"
  expect 'the confirmation closed is no consent' ui key "$EXIT_PAGE" Alt+F4
  expect 'the page stays' ui wait "$page"
  leave_by "$2" "$page"
  expect 'Exit Setup' exit_setup
  same 'the exit code' "$run_code" 0
  same 'files made' "$(installed_files)" ''
  expect_not 'the folder made on consent stays' test -e "$drive_c/Programi"
  expect 'no temporary file stays' no_temp_files
}

leave_page 1 cancel
leave_page 2 close
leave_page 3 cancel
leave_page 4 close

case_begin 'closing while files are copied is held back'
many=$ORBIT_WORK/many
mkdir -p "$many"
cp "$PLUMO_PROGRAMS"/*.exe "$many"
python3 - "$many" <<'PYTHON'
import sys
for i in range(6000):
    with open(f"{sys.argv[1]}/{i:04}.txt", "w") as file:
        file.write(f"file {i}\n")
PYTHON
"$ORBIT_TOOL" pack "$many" --setup "$SETUP_EXE" --output "$ORBIT_WORK/Many.exe" >/dev/null 2>&1
setup_run "$ORBIT_WORK/Many.exe"
expect 'page 5' walk_to 5 'C:\Many'
expect 'page 5 is there' ui wait "$PAGE5"
expect 'the close box' ui close "$PAGE5"
so_far=$(ls "$drive_c/Many" | wc -l)
expect 'it came while files were copied' test "$so_far" -lt 6000
expect 'no confirmation' ui gone "$EXIT_PAGE" 300
expect 'setup goes on to its end' finish_setup
same 'the exit code' "$run_code" 0
same 'files installed' "$(ls "$drive_c/Many" | grep -c '^[0-9]*\.txt$')" 6000

test_end
