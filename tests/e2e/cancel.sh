#!/usr/bin/env bash
# Leaving the wizard: Cancel and the close box on pages 1 to 4, and while files are being copied.
. "$(dirname "$0")/lib.sh"
test_begin
drive_c=$WINEPREFIX/drive_c

# leave_by cancel|close PAGE: until the confirmation is there.
leave_by() {
  if [ "$1" = cancel ]; then expect 'Cancel' ui click "$2" Cancel; else expect 'the close box' ui close "$2"; fi
  expect "the confirmation comes ($1)" ui wait "$EXIT_PAGE"
}

# resume PAGE: the confirmation goes, the page stays.
resume() {
  expect 'Resume' ui click "$EXIT_PAGE" Resume
  expect 'the confirmation goes' ui gone "$EXIT_PAGE"
  expect 'the page stays' ui wait "$1"
}

case_begin 'each page can be left and resumed, the last one is left for good'
touch "$ORBIT_WORK/before"
setup_run "$PLUMO_SETUP"
expect 'page 1' ui wait "$PAGE1"
leave_by cancel "$PAGE1"
resume "$PAGE1"
expect 'page 2' next_from "$PAGE1" "$PAGE2"
leave_by close "$PAGE2"
expect 'the confirmation closed is no consent' ui key "$EXIT_PAGE" Alt+F4
expect 'it goes' ui gone "$EXIT_PAGE"
expect 'page 3' next_from "$PAGE2" "$PAGE3"
leave_by close "$PAGE3"
resume "$PAGE3"
expect 'the destination' ui type "$PAGE3" Edit:0 'C:\Programi\Plumo'
expect 'Next' ui click "$PAGE3" 'Next >'
expect 'Yes' ui click "$QUESTION" Yes
expect 'page 4' ui wait "$PAGE4"
expect 'the folder is made' test -d "$drive_c/Programi/Plumo"
leave_by close "$PAGE4"
resume "$PAGE4"
leave_by cancel "$PAGE4"
expect 'Exit Setup' exit_setup
same 'the exit code' "$run_code" 0
same 'files made' "$(find "$drive_c" -type f -newer "$ORBIT_WORK/before" ! -path '*/windows/*' ! -path '*/users/*')" ''
expect_not 'the folder made on consent stays' test -e "$drive_c/Programi"
expect 'no temporary file stays' no_temp_files

case_begin 'closing while files are copied is held back'
many=$ORBIT_WORK/many
mkdir -p "$many"
cp "$PLUMO_PROGRAMS"/*.exe "$many"
for i in $(seq 1500); do echo "file $i" >"$many/$i.txt"; done
"$ORBIT_TOOL" pack "$many" --setup "$SETUP_EXE" --output "$ORBIT_WORK/Many.exe" >/dev/null 2>&1
setup_run "$ORBIT_WORK/Many.exe"
expect 'page 4' walk_to 4 'C:\Many'
ui close "$PAGE5" &  # waits for the page from now on, and presses in its first moment
closing=$!
expect 'Next' ui click "$PAGE4" 'Next >'
expect 'the close box' wait $closing
expect 'setup goes on to its end' finish_setup
same 'the exit code' "$run_code" 0
same 'files installed' "$(ls "$drive_c/Many" | grep -c '^[0-9]*\.txt$')" 1500

test_end
