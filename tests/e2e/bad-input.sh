#!/usr/bin/env bash
# What a setup program says and leaves when its input or its destination is bad.
. "$(dirname "$0")/lib.sh"
test_begin
drive_c=$WINEPREFIX/drive_c
make_sfx() { python3 "$(dirname "$0")/make_sfx.py" "$SETUP_EXE" "$PLUMO_PROGRAMS" "$@"; }

# ---- the argument ----

# refuses COMMAND-LINE-ARGUMENT...: the message, the exit code and the log line of a file that cannot be opened.
refuses() {
  setup_start "$PLUMO_SETUP" "$@"
  expect 'the message' ui wait Error
  expect 'its text' grep -qF "Failed to Open the SFX!? $(win_path "$PLUMO_SETUP") $1 $1" <(message_text Error)
  expect 'OK' ui click Error OK
  run_wait
  same 'the exit code' "$run_code" -200
  expect 'the log line' grep -q 'ERROR: Failed to Open the SFX!? -> ' "$SETUP_FOLDER/execution.log"
  expect 'no temporary file' no_temp_files
}

case_begin 'a missing file'
refuses 'C:\missing.exe'

case_begin 'no argument'
setup_start "$PLUMO_SETUP"
expect 'the message' ui wait Error
expect 'its text' grep -q '^Failed to Open the SFX!? .*PlumoSetup.exe' <(message_text Error)
expect 'OK' ui click Error OK
run_wait
same 'the exit code' "$run_code" -200

# ---- the payload ----

# gives_up PROGRAM TEXT FOLDER: the copying page says so, the wizard ends, nothing is installed.
gives_up() {
  setup_run "$1"
  expect 'page 5' walk_to 5 "C:\\$3"
  expect 'the message' ui wait 'Error!'
  same 'its text' "$(message_text 'Error!')" "$2"
  expect 'OK' ui click 'Error!' OK
  run_wait
  same 'the exit code' "$run_code" 0
  expect_not 'the folder made on consent stays' test -e "$drive_c/$3"
  expect 'no temporary file stays' no_temp_files
}

case_begin 'an unstamped executable: said before anything is made'
setup_run "$SETUP_EXE"
expect 'page 3' walk_to 3 'C:\unstamped'
expect 'Next' ui click "$PAGE3" 'Next >'
expect 'the message' ui wait 'Error!'
same 'its text' "$(message_text 'Error!')" 'Records.dat file is missing.'
expect 'OK' ui click 'Error!' OK
expect 'Cancel' ui click "$PAGE3" Cancel
expect 'Exit Setup' exit_setup
expect_not 'nothing is made' test -e "$drive_c/unstamped"
expect 'no temporary file' no_temp_files

for kind in past-end truncated corrupted wrong-check; do
  case_begin "payload: $kind"
  make_sfx "$ORBIT_WORK/$kind.exe" $kind
  gives_up "$ORBIT_WORK/$kind.exe" 'Records.dat file is corrupted.' $kind
done

case_begin 'a sound program made from the description of the format alone'
make_sfx "$ORBIT_WORK/good.exe" good
expect 'orbit list agrees' "$ORBIT_TOOL" list "$ORBIT_WORK/good.exe"
setup_run "$ORBIT_WORK/good.exe"
expect 'page 5' walk_to 5 'C:\good'
expect 'the end' finish_setup
same 'good.txt' "$(cat "$drive_c/good/good.txt")" $'good\r'
same 'plain.bin' "$(cat "$drive_c/good/Dir/Sub/plain.bin")" 'no gzip header'
same 'write time, upper half' "$(ui stat 'C:\good\good.txt' | cut -d' ' -f3)" 01c43b00

case_begin 'entries that would leave the destination'
evil=('..\..\evil.txt' 'C:\evil.txt' '\evil.txt' 'a:evil.txt' 'nul' 'Dir\..\..\evil.txt' 'con.txt' '../evil.txt')
make_sfx "$ORBIT_WORK/evil.exe" good "${evil[@]}"
setup_run "$ORBIT_WORK/evil.exe"
expect 'page 5' walk_to 5 'C:\Deep\evil'
expect 'the message' ui wait 'Error!'
for name in "${evil[@]}"; do
  expect "it names $name" grep -qF -- "$name" <(message_text 'Error!')
done
expect 'OK' ui click 'Error!' OK
expect 'the end' finish_setup
same 'what is outside the destination' "$(find "$WINEPREFIX" / "$drive_c" -maxdepth 2 -name '*evil.txt*' 2>/dev/null)" ''
same 'what is inside' "$(cd "$drive_c/Deep/evil" && find . -type f | sort | tr '\n' ' ')" \
  './Dir/Sub/plain.bin ./Installed.lst ./Plumo.exe ./UnInstall.exe ./Uninstall.log ./config.ini ./good.txt '
same 'lines in the log' "$(grep -c 'evil.txt\|nul\|con.txt' "$SETUP_FOLDER/execution.log")" ${#evil[@]}

# ---- the destination ----

# page_stays DESTINATION CAPTION-TEXT-PATTERN: page 3 tells what is wrong and stays.
page_stays() {
  setup_run "${3:-$PLUMO_SETUP}"
  expect 'page 3' walk_to 3 "$1"
  expect 'Next' ui click "$PAGE3" 'Next >'
  expect 'a message' ui wait "$QUESTION"
  if [ -n "$(ui list "$QUESTION" | grep '"&Yes"')" ]; then
    expect 'Yes' ui click "$QUESTION" Yes
    sleep 0.2
    expect 'a message' ui wait "$QUESTION"
  fi
  expect "its text (it is: $(message_text "$QUESTION"))" grep -q -- "$2" <(message_text "$QUESTION")
  expect 'OK' ui click "$QUESTION" OK
  expect 'the page stays' ui wait "$PAGE3"
  expect 'Cancel' ui click "$PAGE3" Cancel
  expect 'Exit Setup' exit_setup
}

case_begin 'a destination that is a file'
echo keep >"$drive_c/a-file"
page_stays 'C:\a-file' "^The directory:  *'C:.a-file'  *cannot be used: "
same 'the file' "$(cat "$drive_c/a-file")" keep

mounted=()
unmount() { for folder in "${mounted[@]}"; do umount "$folder" 2>/dev/null; done; }
trap 'unmount; wine_end' EXIT

# mount_drive LETTER OPTIONS
mount_drive() {
  mkdir -p "$ORBIT_WORK/drive-$1"
  mount -t tmpfs -o "$2" none "$ORBIT_WORK/drive-$1" 2>/dev/null || return
  mounted+=("$ORBIT_WORK/drive-$1")
  ln -s "$ORBIT_WORK/drive-$1" "$WINEPREFIX/dosdevices/$1:"
}

case_begin 'a drive without room for the product'
if mount_drive e size=64k; then
  page_stays 'E:\Plumo' '^You do not have enough place on your E: drive. Please exit the Setup program and free [0-9]* KB of space on your hard disk.$'
  same 'what is on the drive' "$(ls "$ORBIT_WORK/drive-e")" ''
else
  case_skip 'this machine refuses mount'
fi

case_begin 'a drive that gets full while files are copied'
if mount_drive f size=2m; then
  make_sfx "$ORBIT_WORK/big.exe" big
  setup_run "$ORBIT_WORK/big.exe"
  expect 'page 5' walk_to 5 'F:\Big'
  expect 'the message' ui wait 'Error!'
  expect 'it names the file' grep -q 'Some files could not be installed: *big.bin' <(message_text 'Error!')
  expect 'OK' ui click 'Error!' OK
  expect 'setup goes on to its end' finish_setup
else
  case_skip 'this machine refuses mount'
fi

case_begin 'a read-only drive'
if mount_drive g size=1m,ro; then
  page_stays 'G:\Plumo' "^The directory:  *'G:.Plumo'  *cannot be used: "
else
  case_skip 'this machine refuses mount'
fi

test_end
