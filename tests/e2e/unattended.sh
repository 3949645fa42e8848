#!/usr/bin/env bash
# The packed file as a fleet starts it: no window, the log, and every exit code.
. "$(dirname "$0")/lib.sh"
. "$ORBIT_ROOT/scripts/report-installation.sh"
test_begin
drive_c=$WINEPREFIX/drive_c
log=$ORBIT_WORK/log.txt
log_path=$(win_path "$log")

# pack NAME FILES [LINE...]: a product of those files; the lines are its [variables]. Its script is the carried one,
# with a last page that restarts the computer after an upgrade.
script=$ORBIT_WORK/script.txt
sed -e 's/^      UpdateRegistry (ND)/&\n      Reboot ()/' "$ORBIT_ROOT/src/installer/scripts/installer.txt" >"$script"
pack() {
  local name=$1 files=$2
  shift 2
  printf '%s\n' "name = \"$name\"" 'version = "1.10"' 'publisher = "Tavola"' "files = \"$files\"" \
    "script = \"$script\"" '[variables]' "$@" >"$ORBIT_WORK/$name.toml"
  "$ORBIT_TOOL" pack "$ORBIT_WORK/$name.toml" --output "$ORBIT_WORK/$name.exe"
}

# run NAME [SWITCH...]: its exit code becomes run_code; the log is the one of this run.
start() {
  local name=$1
  shift
  rm -f "$log"
  run_start "$ORBIT_WORK" "$(win_path "$ORBIT_WORK/$name.exe")" "/LOG=$log_path" "$@"
}
run() {
  start "$@"
  run_wait
}
logged() { grep -qF -- "$1" "$log"; }
# ends WHAT CODE LOGGED
ends() {
  same "the exit code ($1)" "$run_code" "$2"
  expect "the log says: $3 (it ends: $(tail -2 "$log" 2>&1 | cut -c25- | tr '\r\n' '  '))" logged "$3"
}

# The names of all windows on the display that there ever are between the two.
window_names() { xwininfo -root -tree | sed -n 's/^ *0x[0-9a-f]* \("[^"]*"\).*/\1/p'; }
watch_start() {
  (while :; do window_names; done >"$ORBIT_WORK/windows.seen") &
  watch_pid=$!
}
watch_end() {
  kill $watch_pid
  wait $watch_pid 2>/dev/null
  sort -u "$ORBIT_WORK/windows.seen"
}

mkdir -p "$ORBIT_WORK/files" "$ORBIT_WORK/large"
cp -r "$PLUMO_FOLDER"/. "$ORBIT_WORK/files"
cp "$PLUMO_PROGRAMS"/*.exe "$ORBIT_WORK/large"
for i in $(seq 20); do head -c 4000000 /dev/zero >"$ORBIT_WORK/large/zeros$i.bin"; done
case_begin 'the products are packed'
for product in "Plumo files refuse_installed=\"0\"" "Newer files refuse_installed=\"1\"" "Large large"; do
  expect "$product" pack $product
done

case_begin 'silent: installed, no window, everything in the log'
sleep 1  # the desktop's own windows have come
window_names | sort -u >"$ORBIT_WORK/windows.before"
before=$(screen_hash)
watch_start
run Plumo /S '/DIR=C:\Apps\Plumo č' /SET 'desktop_shortcut=0'
same 'windows' "$(watch_end | comm -13 "$ORBIT_WORK/windows.before" -)" ''
same 'the screen' "$(screen_hash)" "$before"
ends silent 0 'end, exit code 0'
expect 'the program' cmp "$PLUMO_FOLDER/Plumo.exe" "$drive_c/Apps/Plumo č/Plumo.exe"
same 'its version' "$(programs_entry | sed -n 's/^"DisplayVersion"="\(.*\)"/\1/p')" 1.10
expect 'no temporary file stays' no_temp_files
same 'shortcuts on the desktop' "$(find "$drive_c/users" -path '*Desktop*' -name '*.lnk' | wc -l)" 0
for line in 'switches: /LOG=' '"/DIR=C:\Apps\Plumo č"' 'product Plumo 1.10' 'page PL-dlg3' 'press btn_next_folder' '-> yes' \
  'command Unzip () -> 0' 'copied 100%' 'command FinalizeInstallation () -> 0' 'not opened: C:\Apps\Plumo č\Plumo.exe'; do
  expect "logged: $line" logged "$line"
done
same 'lines without a time' "$(grep -cvE '^20[0-9-]{8} [0-9:]{8}\.[0-9]{3} ' "$log")" 0

case_begin 'passive: only the copying page, whose close box cancels'
watch_start
run Large /passive '/DIR=C:\Large'
seen=$(watch_end | comm -13 "$ORBIT_WORK/windows.before" - | grep -v '"Default IME"\|"ui.exe"\|"default"')
ends passive 0 'end, exit code 0'
same 'windows' "$seen" '" Decompressing and copying files, please wait..."'
start Large /passive '/DIR=C:\Large 2'
expect 'the copying page' ui wait "$PAGE5"
expect 'its close box' ui close "$PAGE5"
run_wait
ends cancelled 1602 'cancelled by the user'
expect_not 'the last file' test -e "$drive_c/Large 2/zeros9.bin"

case_begin 'cancelled by the answers, a wrong switch, a file that cannot be written'
printf 'page PL-dlg2\r\n  press b_cancel\r\n' >"$ORBIT_WORK/answers.txt"
run Plumo /quiet "/ANSWERS=$(win_path "$ORBIT_WORK/answers.txt")"
ends 'the answers cancel' 1602 'press b_exit'
run Plumo -verysilent /REBOOT
ends 'a switch that there is not' 87 'The switch /REBOOT is not known.'
start Plumo /REBOOT
expect 'the message' ui wait Setup
expect 'it names the switch' grep -q '/REBOOT is not known' <(message_text Setup)
expect 'OK' ui click Setup OK
run_wait
same 'the exit code' "$run_code" 87
mkdir -p "$drive_c/Taken/Plumo.exe/x"
run Plumo /S '/DIR=C:\Taken'
ends 'a folder in the place of a file' 1603 'the file Plumo.exe could not be installed'
run Plumo /S '/DIR=C:\Apps\Plumo č\Plumo.exe'
ends 'a file in the place of the folder' 1603 'the page PL-dlg3 stays although its button was pressed'
rm -f "$log"
run_start "$ORBIT_WORK" "$(win_path "$ORBIT_WORK/Plumo.exe")" /S '/LOG=C:\no such folder\log.txt'
run_wait
same 'the exit code without a log' "$run_code" 1603

case_begin 'a damaged payload'
cp "$ORBIT_WORK/Plumo.exe" "$ORBIT_WORK/Damaged.exe"
printf 'XXXXXXXX' | dd of="$ORBIT_WORK/Damaged.exe" bs=1 seek=$(($(stat -c %s "$ORBIT_WORK/Plumo.exe") - 20000)) conv=notrunc 2>/dev/null
run Damaged /S '/DIR=C:\Damaged'
ends damaged 1603 'The packed files are missing or damaged.'
expect_not 'nothing is made' test -e "$drive_c/Damaged"

case_begin 'restart needed; not restarted, nothing asked'
run Plumo /S /SET upgrade=1 '/DIR=C:\Apps\Plumo č'
ends restart 3010 'a restart is needed'

case_begin 'one setup of a product at a time'
run_start "$ORBIT_WORK" "$(win_path "$ORBIT_WORK/Plumo.exe")"
first_pid=$run_pid
expect 'page 1' ui wait "$PAGE1"
run Plumo /S
ends 'a second one' 1618 'Another setup of this product is running'
run_start "$ORBIT_WORK" "$(win_path "$ORBIT_WORK/Plumo.exe")"
expect 'the message' ui wait Setup
expect 'OK' ui click Setup OK
run_wait
same 'the exit code' "$run_code" 1618
expect 'Cancel' ui click "$PAGE1" Cancel
expect 'Exit Setup' ui click "$EXIT_PAGE" 'Exit Setup'
wait $first_pid

case_begin 'this version is there already'
run Newer /S '/DIR=C:\Newer'
ends 'the first time' 0 'end, exit code 0'
run Newer /S '/DIR=C:\Newer'
ends 'the second time' 1638 'is installed already'
start Newer
expect 'the message' ui wait Setup
expect 'OK' ui click Setup OK
run_wait
same 'the exit code' "$run_code" 1638
sed -i 's/^version = .*/version = "1.11"/' "$ORBIT_WORK/Newer.toml"
"$ORBIT_TOOL" pack "$ORBIT_WORK/Newer.toml" --output "$ORBIT_WORK/Newer.exe" >/dev/null 2>&1
run Newer /S '/DIR=C:\Newer'
ends 'a newer one' 0 'end, exit code 0'

case_begin 'no space'
disk=$ORBIT_WORK/disk
mkdir -p "$disk"
if mount -t tmpfs -o size=100k none "$disk" 2>/dev/null; then
  ln -s "$disk" "$WINEPREFIX/dosdevices/f:"
  run Plumo /S '/DIR=F:\Plumo'
  ends 'a full disk' 112 'no space on F:\'
  same 'nothing is made' "$(ls "$disk")" ''
  umount "$disk"
else
  case_skip 'no small disk can be mounted here'
fi

test_end
