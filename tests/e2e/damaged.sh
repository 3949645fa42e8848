#!/usr/bin/env bash
# A packed file that is cut or changed at random places ends with an exit code, never a crash, and leaves nothing.
# usage: damaged.sh [COUNT [SEED]]   30 places in the ordinary run; 1000 take about ten minutes
. "$(dirname "$0")/lib.sh"
test_begin
packed=$ORBIT_WORK/packed.exe
places=$(python3 "$(dirname "$0")/make_packed.py" "$BOOTSTRAP_EXE" "$SETUP_EXE" "$ORBIT_ROOT/src/installer/scripts/installer.txt" \
  "$PLUMO_PROGRAMS" "$packed")

case_begin 'the whole file installs'
wine "$packed" /S '/DIR=C:\good' '/LOG=C:\good.log'
code=$?
same "the exit code ($(tail -4 "$WINEPREFIX/drive_c/good.log" | tr '\r\n' ' '))" $code 0
same 'what is left' "$(find "$WINEPREFIX/drive_c/windows/temp" "$(temp_folder)" -mindepth 1)" ''
case_end

case_begin "${1:-30} damaged ones"
python3 "$(dirname "$0")/damage.py" "$packed" $(echo "$places" | cut -d' ' -f1,2) "${1:-30}" "${2:-7}" \
  "$WINEPREFIX/drive_c/good" "$ORBIT_WORK" || bad 'see above'

test_end
