#!/usr/bin/env bash
# What a person does in the ordinary wizard, saved, and an unattended run with these answers: for each product the tree,
# the registry and the records are the same afterwards.
. "$(dirname "$0")/lib.sh"
wine_begin "$ORBIT_ROOT/build/e2e/$TEST_NAME"
display_start
prefix_new silent
prefix_new hand
desktop_start orbit

for product in plumo gallery wizard97; do
  case_begin "$product is packed"
  expect 'pack' "$ORBIT_TOOL" pack "$ORBIT_ROOT/products/$product/product.toml" --output "$ORBIT_WORK/$product.exe"
done

by_hand() { run_start "$ORBIT_WORK" "$(win_path "$ORBIT_WORK/$1.exe")" "/SAVEANSWERS=$(win_path "$ORBIT_WORK/$1.txt")"; }
# silently PRODUCT: in the other prefix, without a screen, while the next product is installed by hand.
silently() {
  WINEPREFIX=$ORBIT_WORK/silent DISPLAY='' timeout 120 wine "$ORBIT_WORK/$1.exe" /S \
    "/ANSWERS=$(win_path "$ORBIT_WORK/$1.txt")" "/LOG=$(win_path "$ORBIT_WORK/$1.log")" >/dev/null 2>&1 &
  silent_pids+=($!)
}
silent_pids=()
saved() { grep -qF -- "$2" "$ORBIT_WORK/$1.txt"; }
shows() { ui list "$1" | grep -qF -- "$2"; }
# page_with TEXT WINDOW: waits until the window shows it.
page_with() { wait_until 90 shows "$2" "$1"; }

case_begin 'Plumo by hand'
by_hand plumo
expect 'page 1' ui wait "$PAGE1"
expect 'page 2' next_from "$PAGE1" "$PAGE2"
expect 'the name' ui type "$PAGE2" Edit:0 'Željka Šarić-Đurđević'
expect 'the company' ui type "$PAGE2" Edit:1 'A & B = 50% # | *'
expect 'page 3' next_from "$PAGE2" "$PAGE3"
expect 'a bad folder' ui type "$PAGE3" Edit:0 'nowhere'
expect 'Next' ui click "$PAGE3" 'Next >'
expect 'OK' ui click "$QUESTION" OK
expect 'back' ui click "$PAGE3" '< Back'
expect 'page 3' next_from "$PAGE2" "$PAGE3"
expect 'the folder' ui type "$PAGE3" Edit:0 'C:\Programi\Plumo čitač'
expect 'Next' ui click "$PAGE3" 'Next >'
expect 'Yes' ui click "$QUESTION" Yes
expect 'page 4' ui wait "$PAGE4"
expect 'the program folder' ui type "$PAGE4" Edit:0 'Čitači'
expect 'no desktop shortcut' ui click "$PAGE4" Button:0
expect 'pages 5 and 6' next_from "$PAGE4" "$PAGE6"
expect 'the end' finish_setup
same 'the exit code' "$run_code" 0
for line in 'page PL-dlg2' 'set name = Željka Šarić-Đurđević' 'set company = A & B = 50% # | *' \
  'set default_path = C:\Programi\Plumo čitač' 'message yes = The directory:' 'set desktop_shortcut = 0' 'press run_app'; do
  expect "saved: $line" saved plumo "$line"
done
expect_not 'the bad folder' saved plumo nowhere
silently plumo

case_begin 'a wizard of its own, by hand'
window='Wizard97 Setup'
next_page() { ui click "$window" "${2:-Next >}" && page_with "$1" "$window"; }
by_hand wizard97
expect 'the welcome' ui wait "$window"
expect 'the licence' next_page 'Please read what you may do'
expect 'accepted' ui click "$window" 'I accept the licence'
expect 'the user' next_page 'Whose program is it to be?'
expect 'the name' ui type "$window" Edit:0 'Ana Čić'
expect 'the kind' next_page 'Typical'
expect 'custom' ui click "$window" 'Custom'
expect 'the components' next_page 'What they are'
for key in Down Space Down Space; do expect "the key $key" ui key "$window" $key; done
expect 'the destination' next_page 'Destination folder'
expect 'the folder' ui type "$window" Edit:0 'C:\Programi\W97'
expect 'no icon' ui click "$window" 'An icon on the desktop'
expect 'Next' ui click "$window" 'Next >'
expect 'Yes' ui click "$QUESTION" Yes
expect 'the summary' page_with 'Press Install to begin' "$window"
expect 'the end' next_page 'Press Finish to leave the setup.' Install
expect 'Finish' ui click "$window" Finish
run_wait
same 'the exit code' "$run_code" 0
for line in 'set link_next_accept = 1' 'set custom = 1' 'tick part_help = 0' 'tick part_texts = 1' 'press b_finish'; do
  expect "saved: $line" saved wizard97 "$line"
done
silently wizard97

case_begin 'every kind of control, by hand'
by_hand gallery
expect 'the first page' ui wait 'Gallery - Welcome'
for page in Welcome Buttons 'Texts and check boxes' Fields Lists 'List views' 'Trees and headers' 'Formatted texts' \
  'Dates, addresses, keys' 'Sliders and progress' 'Pictures, clips, sounds' Containers Layout 'Menus, toolbars, status'; do
  [ "$page" = Fields ] && expect 'the field' ui type "Gallery - $page" Edit:0 'Ana'
  expect "Next on $page" ui click "Gallery - $page" 'Next >'
done
expect 'Finish' ui click 'Gallery - Message boxes' Finish
run_wait
same 'the exit code' "$run_code" 0
expect 'saved: the field' saved gallery '= Ana'
silently gallery

case_begin 'the unattended runs can give every answer'
for pid in "${silent_pids[@]}"; do expect 'the exit code' wait "$pid"; done
for product in plumo gallery wizard97; do
  expect "$product ($(tail -2 "$ORBIT_WORK/$product.log" | cut -c25- | tr '\r\n' '  '))" \
    grep -q 'end, exit code 0' "$ORBIT_WORK/$product.log"
done

case_begin 'everything is the same'
expect 'tree, registry and records' python3 "$(dirname "$0")/answers.py" "$ORBIT_ROOT" "$ORBIT_WORK" hand silent

test_end
