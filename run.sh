#!/usr/bin/env bash
# Builds everything, packs the sample product into one executable, double-clicks it in a fresh Wine prefix and installs
# by pressing the real controls; shows what that left behind, uninstalls it again and shows that the prefix is as it was
# before. Then the same once more as a fleet does it: without a window, with a log.
#
#   ./run.sh          on a virtual display; a picture of every page under build/run/
#   ./run.sh --show   on your own display, for you to press
#
# Needs Debian 12 and root, to install what is missing (scripts/install-tools.sh says what).
set -euo pipefail
cd "$(dirname "$0")"
ORBIT_ROOT=$PWD
started=$SECONDS
pictures=$ORBIT_ROOT/build/run

say() { printf '\n[%ds] %s\n' $((SECONDS - started)) "$*"; }

case "${1:-}" in
  '' | --show) ;;
  *) sed -n '2,9s/^# \{0,1\}//p' "$0"; exit 2 ;;
esac
say 'Tools'
scripts/install-tools.sh
say 'Building and packing'
scripts/build-plumo.sh

packed=build/Plumo-$(sed -n 's/^version = "\(.*\)"/\1/p' products/plumo/product.toml)-install.exe
echo "Packed: $packed, $(stat -c %s "$packed") bytes"

. scripts/wine-env.sh
. scripts/wizard-steps.sh
. scripts/report-installation.sh
wine_begin "$ORBIT_ROOT/build/run-work"

if [ "${1:-}" = --show ]; then
  [ -n "${DISPLAY:-}" ] || { echo 'There is no display (DISPLAY is not set).' >&2; exit 1; }
  prefix_new prefix
  cp "$packed" "$WINEPREFIX/drive_c/"
  say 'The setup program is on your display'
  wine explorer '/desktop=orbit,1024x768' "C:\\$(basename "$packed")"
  wineserver -w
  exit
fi

say 'A fresh prefix and a virtual display'
rm -rf "$pictures"
mkdir -p "$pictures"
display_start
prefix_new prefix
desktop_start orbit
prefix_state() { python3 tests/e2e/prefix.py "$ORBIT_ROOT" "$ORBIT_WORK" prefix "$@"; }
prefix_state save "$ORBIT_WORK/before.state"

destination='C:\Program Files\Tavola\Plumo čitač'
say 'Walking through the pages'
# The first page is there for a blink only: when the picture missed it, leave and start again.
for try in 1 2 3 4 5; do
  catch_start 500 100
  setup_start "$packed"
  ui wait "$PAGE1"
  catch_end "$pictures/00-please-wait.png" && break
  [ $try -lt 5 ]
  ui click "$PAGE1" Cancel
  exit_setup
done
shot "$pictures/01-welcome.png"
next_from "$PAGE1" "$PAGE2"
shot "$pictures/02-user-information.png"
ui type "$PAGE2" Edit:0 'Željka Šarić-Đurđević'
ui type "$PAGE2" Edit:1 'Čitaonica d.o.o.'

ui click "$PAGE2" Cancel
ui wait "$EXIT_PAGE"
shot "$pictures/exit-confirmation.png"
ui click "$EXIT_PAGE" Resume
ui gone "$EXIT_PAGE"

ui click "$PAGE2" '< Back'
ui wait "$PAGE1"
next_from "$PAGE1" "$PAGE2"
[ "$(ui text "$PAGE2" Edit:0)" = 'Željka Šarić-Đurđević' ] || { echo 'The name was lost on the way back' >&2; exit 1; }
shot "$pictures/02-user-information-filled.png"
next_from "$PAGE2" "$PAGE3"
shot "$pictures/03-destination.png"
ui type "$PAGE3" Edit:0 "$destination"
ui click "$PAGE3" 'Next >'
ui wait "$QUESTION"
shot "$pictures/folder-question.png"
ui click "$QUESTION" Yes
ui wait "$PAGE4"
ui type "$PAGE4" Edit:0 'Plumo čitač'
shot "$pictures/04-program-folder.png"
catch_start 400 150
next_from "$PAGE4" "$PAGE6"
catch_end "$pictures/05-copying.png"
shot "$pictures/06-information.png"
ui click "$PAGE6" OK
ui wait 'Plumo - Željka Šarić-Đurđević'
shot "$pictures/plumo.png"
plumo_title=$(ui text Plumo)
ui close Plumo
run_wait

say 'What the installation left'
report_installation "$destination"
printf 'The installed program started: its window said "%s".\n' "$plumo_title"
printf 'Exit code of the setup program: %s\n' "$run_code"
printf 'Temporary files left: %s\n' "$(temp_files | wc -l)"
printf 'Diagnostic lines (execution.log):\n%s\n' "$(sed '/^$/d; s/^/  /' "$SETUP_FOLDER/execution.log")"
say 'Uninstalling'
run_start / "$destination\\UnInstall.exe" "$destination"
ui wait Uninstall
shot "$pictures/uninstall-question.png"
ui click Uninstall Yes
ui wait Uninstall
shot "$pictures/uninstall-end.png"
ui click Uninstall OK
setup_code=$run_code
run_wait
uninstall_code=$run_code
printf 'Exit code of the uninstaller: %s\n' "$uninstall_code"
echo 'The prefix compared with what it was before setup came (files with their sizes and times, the whole registry):'
as_before=0
prefix_state compare "$ORBIT_WORK/before.state" || as_before=$?

say 'Unattended: installed and removed without a window'
fleet='C:\Apps\Plumo č'
log=$ORBIT_WORK/fleet.log
silent() { # silent PROGRAM [SWITCH...]: prints its exit code
  run_start "$ORBIT_WORK" "$@" "/LOG=$(win_path "$log")"
  run_wait
  printf '%s: exit code %s\n' "${1##*[\\/]} ${*:2}" "$run_code"
}
silent "$(win_path "$packed")" /S "/DIR=$fleet"
silent_code=$run_code
silent "$fleet\UnInstall.exe" /S "$fleet"
sed 's/^/  /' "$log"
prefix_state compare "$ORBIT_WORK/before.state" || as_before=$?
say "Pictures: $(ls "$pictures" | wc -l) in build/run/"
[ "$setup_code" = 0 ] && [ "$uninstall_code" = 0 ] && [ "$silent_code" = 0 ] && [ "$run_code" = 0 ] &&
  [ $as_before = 0 ] && no_temp_files
