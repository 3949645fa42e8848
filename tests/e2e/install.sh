#!/usr/bin/env bash
# A whole installation through the real windows, what it leaves, and its removal. The folder has a Croatian name.
. "$(dirname "$0")/lib.sh"
. "$ORBIT_ROOT/scripts/report-installation.sh"
test_begin
drive_c=$WINEPREFIX/drive_c
destination='C:\Programi\Plumo čitač'
folder=$drive_c/Programi/'Plumo čitač'

case_begin 'pages forth and back keep what was typed'
setup_run "$PLUMO_SETUP"
expect 'page 1' ui wait "$PAGE1"
expect 'page 2' next_from "$PAGE1" "$PAGE2"
expect 'typing the name' ui type "$PAGE2" Edit:0 'Željka Šarić-Đurđević'
expect 'typing the company' ui type "$PAGE2" Edit:1 'A & B = 50%'
expect 'page 3' next_from "$PAGE2" "$PAGE3"
same 'the proposed destination' "$(ui text "$PAGE3" Edit:0)" 'C:\Program Files\Tavola\Plumo'
expect 'typing the destination' ui type "$PAGE3" Edit:0 "$destination"
expect 'back to page 2' ui click "$PAGE3" '< Back'
expect 'page 2 again' ui wait "$PAGE2"
same 'the name' "$(ui text "$PAGE2" Edit:0)" 'Željka Šarić-Đurđević'
same 'the company' "$(ui text "$PAGE2" Edit:1)" 'A & B = 50%'
expect 'back to page 1' ui click "$PAGE2" '< Back'
expect 'page 1 again' ui wait "$PAGE1"
expect 'page 2' next_from "$PAGE1" "$PAGE2"
expect 'page 3' next_from "$PAGE2" "$PAGE3"
same 'the destination' "$(ui text "$PAGE3" Edit:0)" "$destination"

case_begin 'the folder question: No stays, Yes makes the folder'
expect 'Next' ui click "$PAGE3" 'Next >'
expect 'the question' ui wait "$QUESTION"
expect 'it names the folder' grep -q "'C:.Programi.Plumo čitač'" <(ui list "$QUESTION")
expect 'No' ui click "$QUESTION" No
expect 'the page stays' ui wait "$PAGE3"
expect_not 'nothing is made' test -e "$drive_c/Programi"
expect 'Next' ui click "$PAGE3" 'Next >'
expect 'Yes' ui click "$QUESTION" Yes
expect 'page 4' ui wait "$PAGE4"
expect 'the folder is made' test -d "$folder"

case_begin 'both check boxes start checked; the rest of the pages'
same 'check boxes' "$(ui list "$PAGE4" | grep -c ' checked')" 2
expect 'typing the program folder' ui type "$PAGE4" Edit:0 'Čitači'
expect 'pages 5 and 6' next_from "$PAGE4" "$PAGE6"
expect 'OK' ui click "$PAGE6" OK
expect 'Plumo starts and knows its user' ui wait 'Plumo - Željka Šarić-Đurđević'
expect 'closing Plumo' ui close Plumo
run_wait
same 'the exit code' "$run_code" 0
expect 'no temporary file stays' no_temp_files

case_begin 'files are there byte for byte, with times and attributes'
mapfile -t files < <(cd "$PLUMO_FOLDER" && find . -type f ! -name UnInstall01.exe | cut -c3- | sort)
# looks FOLDER: attributes, write times and sizes of the files there
looks() {
  local file paths=()
  for file in "${files[@]}"; do paths+=("$1\\${file//\//\\}"); done
  ui stat "${paths[@]}" | cut -d' ' -f1,3,4
}
for file in "${files[@]}"; do expect "content of $file" cmp "$PLUMO_FOLDER/$file" "$folder/$file"; done
same 'attributes, times and sizes' "$(looks "$destination")" "$(looks "$(win_path "$PLUMO_FOLDER")")"
same 'the read-only one' "$(ui stat "$destination\\Licence.txt" | cut -c8)" 1
expect 'the uninstaller in the Windows folder' cmp "$PLUMO_FOLDER/UnInstall01.exe" "$drive_c/windows/UnInstall01.exe"
same 'files' "$(cd "$folder" && find . -type f | cut -c3- | sort)" \
  "$(printf '%s\n' "${files[@]}" Installed.lst Uninstall.log config.ini | sort)"

case_begin 'four shortcuts lead to the programs'
link_target() { ui link "$(win_path "$1")" | sed -n 's/^target=//p'; }
programs="$drive_c/ProgramData/Microsoft/Windows/Start Menu/Programs/Čitači"
quick_launch="$drive_c/users/$(whoami)/AppData/Roaming/Microsoft/Internet Explorer/Quick Launch"
for link in "$programs/Plumo.lnk" "$drive_c/users/Public/Desktop/Plumo.lnk" "$quick_launch/Plumo.lnk"; do
  same "target of $link" "$(link_target "$link")" "$destination\\Plumo.exe"
done
same 'the uninstall shortcut' "$(link_target "$programs/UnInstall plumo.lnk")" "$destination\\UnInstall.exe"

case_begin 'the programs entry, Uninstall.log and config.ini'
escaped=${destination//\\/\\\\}
same 'the entry' "$(programs_entry | tail -n +2 | sort | sed -E 's/(Date"=")[0-9]{8}/\1today/; s/(dword:)[0-9a-f]{6}../\1size/')" \
  "$(printf '%s\n' "\"DisplayIcon\"=\"$escaped\\\\Plumo.exe\"" '"DisplayName"="Plumo"' '"EstimatedSize"=dword:size' \
    '"InstallDate"="today"' "\"InstallLocation\"=\"$escaped\"" '"NoModify"=dword:size' '"NoRepair"=dword:size' \
    "\"QuietUninstallString\"=\"\\\"$escaped\\\\UnInstall.exe\\\" /S \\\"$escaped\\\"\"" \
    "\"UninstallString\"=\"$escaped\\\\UnInstall.exe $escaped\"")"
same 'Uninstall.log' "$(iconv -f CP1250 -t UTF-8 "$folder/Uninstall.log")" "$(printf '%s\r\n' 005 program_name=Plumo \
  'program_folder=Čitači' "default_path=$destination" quick_launch=1)"$'\n'dict_path=none
same 'config.ini' "$(iconv -f CP1250 -t UTF-8 "$folder/config.ini")" "$(printf '%s\r\n' 005 "Dir=$destination\\" \
  "UserDir=$destination\\New\\" FirstTime=1 'User=Željka Šarić-Đurđević')"$'\n''Company=A & B = 50%'

case_begin "removal leaves a user's own file and nothing else, and says so at its end"
echo mine >"$folder/Texts/mine.txt"
run_start / "$destination\\UnInstall.exe" "$destination"
expect 'the question' ui click Uninstall Yes
expect 'the end' ui wait Uninstall
expect 'the file is named' grep -q 'changed or added, and stay.*Plumo čitač.Texts.mine.txt' <(message_text Uninstall | tr '\n' ' ')
expect 'OK' ui click Uninstall OK
run_wait
same 'the exit code' "$run_code" 0
same 'what is left' "$(cd "$folder" && find . -mindepth 1 | sort | tr '\n' ' ')" './Texts ./Texts/mine.txt '
same 'shortcuts left' "$(find "$drive_c" -name '*.lnk' | wc -l)" 0
expect_not 'the program folder' test -e "$programs"
expect_not 'the copy in the Windows folder' test -e "$drive_c/windows/UnInstall01.exe"
expect_not 'the programs entry' programs_entry

test_end
