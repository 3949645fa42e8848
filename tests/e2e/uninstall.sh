#!/usr/bin/env bash
# The uninstaller against installations made by hand: what it removes, what it leaves, what it refuses.
. "$(dirname "$0")/lib.sh"
test_begin

PROGRAMS_KEY='HKLM\Software\Microsoft\Windows\CurrentVersion\Uninstall'
drive_c=$WINEPREFIX/drive_c
installed=$drive_c/Tavola/Plumo

lines() { printf '%s\r\n' "$@"; }

# A small installation in C:\Tavola\Plumo, as setup leaves it. $1: further lines of the list.
install_by_hand() {
  rm -rf "$drive_c/Tavola"
  mkdir -p "$installed/Texts/Deep"
  cp "$PLUMO_PROGRAMS/UnInstall.exe" "$installed/"
  cp "$PLUMO_PROGRAMS/UnInstall01.exe" "$drive_c/windows/"
  echo text >"$installed/Texts/Deep/a.txt"
  echo text >"$installed/read-only.txt"
  chmod 0444 "$installed/read-only.txt"
  printf '005\r\nprogram_name=Plumo\r\nprogram_folder=Plumo\r\ndefault_path=C:\\Tavola\\Plumo\r\nquick_launch=1\r\ndict_path=none' \
    >"$installed/Uninstall.log"
  printf '001\r\nUser=Ana' >"$installed/config.ini"
  lines 'F UnInstall.exe' 'D Texts' 'D Texts\Deep' 'F Texts\Deep\a.txt' 'F read-only.txt' 'F UnInstall01.exe' \
    'W UnInstall01.exe' "$@" >"$installed/Installed.lst"
  wine reg add "$PROGRAMS_KEY\\Plumo" /v UninstallString /d 'C:\Tavola\Plumo\UnInstall.exe C:\Tavola\Plumo' /f >/dev/null
}

# Runs the installed uninstaller. All is gone when it ends; its file in the temporary folder goes a moment later.
uninstall() {
  run_start / 'C:\Tavola\Plumo\UnInstall.exe' "$@"
  run_wait
}

case_begin 'silent removal leaves nothing'
install_by_hand
uninstall -Quiet '/log=C:\zapisnik č.txt' 'C:\Tavola\Plumo' /norestart
same 'the exit code' "$run_code" 0
log="$drive_c/zapisnik č.txt"
same 'lines of the log without a time' "$(grep -cvE '^[0-9]{4}-[0-9]{2}-[0-9]{2} [0-9:.]{12} ' "$log")" 0
for line in 'removal of C:.Tavola.Plumo by C:.Tavola.Plumo.UnInstall.exe' 'deleted: C:.Tavola.Plumo.Texts.Deep.a.txt' \
  'deleted: .*CurrentVersion.Uninstall.Plumo' 'end, exit code 0'; do
  expect "the log says: $line" grep -q " $line" "$log"
done
expect 'the empty folder above it goes too' test ! -e "$drive_c/Tavola"
expect_not 'the copy in the Windows folder goes' test -e "$drive_c/windows/UnInstall01.exe"
expect_not 'the programs entry goes' wine reg query "$PROGRAMS_KEY\\Plumo"
expect 'no temporary copy stays' wait_until 30 no_temp_files

case_begin 'a doctored list removes nothing outside, and says so'
install_by_hand 'F ..\outside.txt' 'F C:\outside.txt' 'F \outside.txt' 'W system.ini' 'W system32\user32.dll' 'F nul' \
  'D ..\Other' 'F linked\victim.txt'
mkdir -p "$drive_c/Tavola/Other" "$drive_c/elsewhere"
echo keep | tee "$drive_c/Tavola/outside.txt" "$drive_c/outside.txt" >"$drive_c/elsewhere/victim.txt"
ln -s ../../elsewhere "$installed/linked"
uninstall /S 'C:\Tavola\Plumo'
same 'the exit code' "$run_code" 1603
for file in Tavola/outside.txt outside.txt elsewhere/victim.txt windows/system.ini windows/system32/user32.dll Tavola/Other; do
  expect "$file stays" test -e "$drive_c/$file"
done
rm -rf "$installed/linked"

case_begin 'it asks once, and No removes nothing'
install_by_hand
run_start / 'C:\Tavola\Plumo\UnInstall.exe' 'C:\Tavola\Plumo'
expect 'the question is asked' ui wait Uninstall
expect 'No' ui click Uninstall No
run_wait
same 'the exit code' "$run_code" 1602
same 'the files left' "$(find "$installed" -type f | wc -l)" 6

case_begin 'Yes removes and says so'
run_start / 'C:\Tavola\Plumo\UnInstall.exe' 'C:\Tavola\Plumo'
expect 'Yes' ui click Uninstall Yes
expect 'the end is told' ui click Uninstall OK
run_wait
same 'the exit code' "$run_code" 0
expect 'nothing is left' test ! -e "$drive_c/Tavola"

case_begin 'no folder given, or none with a log: a clear message'
mkdir -p "$drive_c/empty"
cp "$PLUMO_PROGRAMS/UnInstall.exe" "$drive_c/empty/"
for argument in '' 'C:\empty'; do
  run_start / 'C:\empty\UnInstall.exe' ${argument:+"$argument"}
  expect 'a message comes' ui wait Uninstall
  expect 'it says that nothing was removed' grep -q 'Nothing was removed' <(ui text Uninstall Static:1)
  expect 'OK' ui click Uninstall OK
  run_wait
  same 'the exit code' "$run_code" 1603
done
run_start / 'C:\empty\UnInstall.exe' /S /DIR=C:\x 'C:\empty'
run_wait
same 'the exit code for a wrong switch' "$run_code" 87
same 'the files left' "$(ls "$drive_c/empty")" UnInstall.exe

test_end
