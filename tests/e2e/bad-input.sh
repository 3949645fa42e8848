#!/usr/bin/env bash
# What a setup program says and leaves when its input is bad.
. "$(dirname "$0")/lib.sh"
test_begin
drive_c=$WINEPREFIX/drive_c
make_sfx() { python3 "$(dirname "$0")/make_sfx.py" "$SETUP_EXE" "$PLUMO_PROGRAMS" "$@"; }

case_begin 'a missing file: the message, the exit code and the log line'
setup_start "$PLUMO_SETUP" 'C:\missing.exe'
expect 'the message' ui wait Error
expect 'its text' grep -qF "Failed to Open the SFX!? $(win_path "$PLUMO_SETUP") C:\missing.exe C:\missing.exe" <(message_text Error)
expect 'OK' ui click Error OK
run_wait
same 'the exit code' "$run_code" -200
expect 'the log line' grep -q 'ERROR: Failed to Open the SFX!? -> ' "$SETUP_FOLDER/execution.log"
expect 'no temporary file' no_temp_files

case_begin 'a corrupted payload: the copying page says so, the wizard ends, nothing is installed'
make_sfx "$ORBIT_WORK/corrupted.exe" corrupted
setup_run "$ORBIT_WORK/corrupted.exe"
expect 'page 5' walk_to 5 'C:\corrupted'
expect 'the message' ui wait 'Error!'
same 'its text' "$(message_text 'Error!')" 'Records.dat file is corrupted.'
expect 'OK' ui click 'Error!' OK
run_wait
same 'the exit code' "$run_code" 0
expect_not 'the folder made on consent stays' test -e "$drive_c/corrupted"
expect 'no temporary file stays' no_temp_files

case_begin 'entries that would leave the destination, in a program made from the description of the format alone'
evil=('..\..\evil.txt' 'C:\evil.txt' '\evil.txt' 'a:evil.txt' 'nul' 'Dir\..\..\evil.txt' 'con.txt' '../evil.txt')
make_sfx "$ORBIT_WORK/evil.exe" good "${evil[@]}"
same 'names that orbit list refuses' "$("$ORBIT_TOOL" list "$ORBIT_WORK/evil.exe" 2>&1 | grep -c 'the name is unsafe')" ${#evil[@]}
make_sfx "$ORBIT_WORK/good.exe" good
expect 'orbit list agrees without them' "$ORBIT_TOOL" list "$ORBIT_WORK/good.exe"
setup_run "$ORBIT_WORK/evil.exe"
expect 'page 5' walk_to 5 'C:\Deep\evil'
expect 'the message' ui wait 'Error!'
text=$(message_text 'Error!')
for name in "${evil[@]}"; do expect "it names $name" grep -qF -- "$name" <<<"$text"; done
expect 'OK' ui click 'Error!' OK
expect 'the end' finish_setup
same 'what is outside the destination' "$(find "$WINEPREFIX" / "$drive_c" -maxdepth 2 -name '*evil.txt*' 2>/dev/null)" ''
same 'what is inside' "$(cd "$drive_c/Deep/evil" && find . -type f | sort | tr '\n' ' ')" \
  './Dir/Sub/plain.bin ./Installed.lst ./Plumo.exe ./UnInstall.exe ./Uninstall.log ./config.ini ./good.txt '
same 'good.txt' "$(cat "$drive_c/Deep/evil/good.txt")" $'good\r'
same 'plain.bin' "$(cat "$drive_c/Deep/evil/Dir/Sub/plain.bin")" 'no gzip header'
same 'write time, upper half' "$(ui stat 'C:\Deep\evil\good.txt' | cut -d' ' -f3)" 01c43b00
same 'lines in the log' "$(grep -c 'evil.txt\|nul\|con.txt' "$SETUP_FOLDER/execution.log")" ${#evil[@]}

test_end
