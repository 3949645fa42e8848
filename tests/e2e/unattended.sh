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

# The names of all windows on the display that there ever are between the two, but for the desktop's own.
watch_start() {
  (while sleep 0.02; do xwininfo -root -tree; done >"$ORBIT_WORK/windows.seen") &
  watch_pid=$!
}
watch_end() {
  kill $watch_pid
  wait $watch_pid 2>/dev/null
  sed -n 's/^ *0x[0-9a-f]* \("[^"]*"\).*/\1/p' "$ORBIT_WORK/windows.seen" | sort -u |
    grep -v '"orbit - Wine desktop"\|"Default IME"\|"ui.exe"\|"default"'
}

mkdir -p "$ORBIT_WORK/files" "$ORBIT_WORK/large"
cp -r "$PLUMO_FOLDER"/. "$ORBIT_WORK/files"
cp "$PLUMO_PROGRAMS"/*.exe "$ORBIT_WORK/large"
for i in $(seq 10); do head -c 4000000 /dev/zero >"$ORBIT_WORK/large/zeros$i.bin"; done
case_begin 'the products are packed'
for product in "Plumo files" "Large large"; do
  expect "$product" pack $product
done

case_begin 'silent: installed, no window, everything in the log'
watch_start
run Plumo /S '/DIR=C:\Apps\Plumo č' /SET 'desktop_shortcut=0'
same 'windows' "$(watch_end)" ''
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
same 'windows' "$(watch_end)" '" Decompressing and copying files, please wait..."'
ends passive 0 'end, exit code 0'
for try in 1 2 3 4 5; do  # until the page did not go too soon
  ui close "$PAGE5" &  # waits for it from now on
  closing=$!
  run Large /passive '/DIR=C:\Large 2'
  wait $closing
  [ "$run_code" = 0 ] || break
  rm -r "$drive_c/Large 2"
done
ends cancelled 1602 'cancelled by the user'
expect_not 'the last file' test -e "$drive_c/Large 2/zeros9.bin"

case_begin 'a wrong switch; a log that cannot be written'
run Plumo -verysilent /REBOOT
ends 'a switch that there is not' 87 'The switch /REBOOT is not known.'
start Plumo /REBOOT
expect 'the message' ui wait Setup
expect 'it names the switch' grep -q '/REBOOT is not known' <(message_text Setup)
expect 'OK' ui click Setup OK
run_wait
same 'the exit code' "$run_code" 87
run_start "$ORBIT_WORK" "$(win_path "$ORBIT_WORK/Plumo.exe")" /S '/LOG=C:\no such folder\log.txt'
run_wait
same 'the exit code without a log' "$run_code" 1603

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

case_begin 'no space'
disk=$ORBIT_WORK/disk
mkdir -p "$disk"
if mount -t tmpfs -o size=100k none "$disk" 2>/dev/null; then
  ln -s "$disk" "$WINEPREFIX/dosdevices/f:"
  run Plumo /S '/DIR=F:\Plumo'
  ends 'a full disk' 112 'no space on F:\'
  same 'nothing is made' "$(ls "$disk")" ''
  mount -o remount,size=8m,ro "$disk"
  run Plumo /S '/DIR=F:\'
  ends 'a folder that cannot be written' 1603 'cannot be used'
  umount "$disk"
else
  case_skip 'no small disk can be mounted here'
fi

test_end
