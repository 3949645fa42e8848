#!/usr/bin/env bash
# The packed file as a person starts it: by a double click, without any argument.
. "$(dirname "$0")/lib.sh"
wine_begin "$ORBIT_ROOT/build/e2e/$TEST_NAME"
display_start
prefix_new prefix
drive_c=$WINEPREFIX/drive_c
windows_temp=$drive_c/windows/temp
folder="$ORBIT_WORK/preneseno č ž"
packed="$folder/Plumo 1 č.exe"
mkdir -p "$folder" "$ORBIT_WORK/programs" "$ORBIT_WORK/own"
cp "$PLUMO_PROGRAMS/"*.exe "$ORBIT_WORK/programs"
cp "$ORBIT_ROOT/build/windows/tests/e2e/planted/tell.exe" "$ORBIT_WORK/programs/Plumo.exe"
make_packed() { # make_packed SETUP SCRIPT PROGRAMS OUTPUT
  python3 "$(dirname "$0")/make_packed.py" "$BOOTSTRAP_EXE" "$@" >/dev/null
}
SCRIPT=$ORBIT_ROOT/src/installer/scripts/installer.txt
# All of them first: an empty desktop ends after a second.
kinds=$ORBIT_WORK/kinds
mkdir "$kinds"
make_packed "$SETUP_EXE" "$SCRIPT" "$ORBIT_WORK/programs" "$packed"
cp "$BOOTSTRAP_EXE" "$kinds/bare"
make_packed - - - "$kinds/no-bundle"
make_packed - "$SCRIPT" - "$kinds/no-setup"
make_packed - - - "$kinds/outside" '..\evil.txt'="$SCRIPT"
desktop_start orbit

# double_click [ARGUMENT...]
double_click() { run_start "$ORBIT_WORK/own" "$(win_path "$packed")" "$@"; }
left_behind() { find "$windows_temp" "$(temp_folder)" "$ORBIT_WORK/own" -mindepth 1; }
private_folder() { find "$windows_temp" -maxdepth 1 -name 'orbit-*' | head -1; }
setup_pid() { pgrep -f '^setup\.exe Z:.*Plumo 1 č\.exe$' | while read -r pid; do grep -qz "$WINEPREFIX" "/proc/$pid/environ" && echo "$pid"; done; }
starter_pid() { pgrep -f '^Z:.*Plumo 1 č\.exe' | while read -r pid; do grep -qz "$WINEPREFIX" "/proc/$pid/environ" && echo "$pid"; done; }

case_begin 'the wizard comes up, installs and leaves nothing in the temporary folders'
double_click
expect 'page 1' ui wait "$PAGE1"
same 'who may enter the folder' "$(stat -c %A "$(private_folder)" | cut -c8-)" '---'
same 'what is in it' "$(ls "$(private_folder)" | sed 's/^@.*/@/' | tr '\n' ' ')" '@ setup.exe wizard.txt '
expect 'page 5' walk_to 5 'C:\Plumo č'
expect 'page 6' ui wait "$PAGE6" 60000
expect 'OK' ui click "$PAGE6" OK
run_wait
same 'the exit code' "$run_code" 0
same 'the text' "$(cat "$drive_c/Plumo č/good.txt")" $'good\r'
expect 'the product was started' wait_until 30 test -s "$drive_c/told.txt"
same 'its folder, and nothing of ours around it' "$(iconv -f CP1252 -t ASCII//TRANSLIT "$drive_c/told.txt" | tr -d '\r')" 'C:\Plumo c'
same 'what is left while it runs' "$(left_behind)" ''
touch "$drive_c/enough"

case_begin 'setup killed: its folder goes, a link in it does not take along what it leads to'
double_click
expect 'page 1' ui wait "$PAGE1"
mkdir -p "$drive_c/victim" && echo keep >"$drive_c/victim/file.txt"
ln -s ../../../victim "$(private_folder)/linked"
kill -9 "$(setup_pid)"
run_wait
same 'the exit code' "$run_code" 1603
# Wine cannot delete a link of the host's; all else goes.
same 'what is left' "$(left_behind | sed 's/.*-[0-9a-f]*//' | tr '\n' ' ')" ' /linked '
same 'behind the link' "$(cat "$drive_c/victim/file.txt")" keep
rm -r "$windows_temp"/orbit-*

case_begin 'starter killed: setup goes on; a later start takes its folder away, but not while setup runs'
double_click
expect 'page 1' ui wait "$PAGE1"
kill -9 "$(starter_pid)"
run_wait
first=$(private_folder)
touch -d '2 minutes ago' "$first"
mkdir "$windows_temp/orbit-0123" && touch -d '2 minutes ago' "$windows_temp/orbit-0123"
cp "$kinds/no-setup" "$folder/other.exe"
other_start() { run_start "$ORBIT_WORK/own" "$(win_path "$folder/other.exe")" /S; run_wait; }
other_start
expect 'the folder in use stays' test -e "$first/setup.exe"
expect 'page 2' next_from "$PAGE1" "$PAGE2"
expect 'Cancel' ui click "$PAGE2" Cancel
expect 'Exit Setup' ui click "$EXIT_PAGE" 'Exit Setup'
expect 'setup ends' wait_until 30 eval '[ -z "$(setup_pid)" ]'
touch -d '2 minutes ago' "$first"
other_start
same 'what is left' "$(left_behind)" "$windows_temp/orbit-0123"
rmdir "$windows_temp/orbit-0123"

# refuses TEXT: a message, 1603, and nothing on the disk.
refuses() {
  double_click
  expect 'the message' ui wait Setup
  expect "its text" grep -q "$1" <(message_text Setup)
  expect 'OK' ui click Setup OK
  run_wait
  same 'the exit code' "$run_code" 1603
  same 'what is left' "$(left_behind)" ''
}

# With a silent switch no message.
refuses_silently() {
  double_click /norestart -Quiet
  run_wait
  same 'the exit code without a message' "$run_code" 1603
}

case_begin 'a folder or a file with the name and .local'
mkdir "$packed.local"
refuses '\.local'
refuses_silently
rmdir "$packed.local"
: >"$packed.local"
refuses_silently
rm "$packed.local"

case_begin 'nothing carried, or not a whole bundle'
while read -r kind text; do
  cp "$kinds/$kind" "$packed"
  refuses "$text"
done <<END
bare carries nothing
no-bundle carries nothing
outside is damaged
no-setup cannot be started
END

test_end
