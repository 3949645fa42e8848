# Sourced after wine-env.sh: the steps that a person takes through Plumo's setup, by the controls' own captions.

PAGE1='Plumo Setup - version'
PAGE2='User Information'
PAGE3='Choose Destination Location'
PAGE4='Select Program Folder'
PAGE5='Decompressing and copying files'
PAGE6='Information'
EXIT_PAGE='Exit Setup'
QUESTION='Setup'

# setup_start SETUP.EXE [ARGUMENT...]: runs in a folder of its own, where execution.log collects the failures.
setup_start() {
  local program
  program=$(win_path "$1")
  shift
  SETUP_FOLDER=$ORBIT_WORK/setup-run
  rm -rf "$SETUP_FOLDER"
  mkdir -p "$SETUP_FOLDER"
  : >"$SETUP_FOLDER/execution.log"
  run_start "$SETUP_FOLDER" "$program" "$@"
}

# setup_run SETUP.EXE: started as it is meant to be, with its own path as the argument.
setup_run() { setup_start "$1" "$(win_path "$1")"; }

temp_folder() { echo "$WINEPREFIX/drive_c/users/$(whoami)/Temp"; }
# Every file that the setup program and its tools leave in the temporary folder.
temp_files() { find "$(temp_folder)" "$WINEPREFIX/drive_c/windows/temp" -type f 2>/dev/null || true; }
no_temp_files() { [ -z "$(temp_files)" ]; }

# next_from PAGE NEXT-PAGE
next_from() {
  ui click "$1" 'Next >' && ui wait "$2"
}

# exit_setup: the exit confirmation is on the screen; leave.
exit_setup() {
  ui click "$EXIT_PAGE" 'Exit Setup' && ui gone "$EXIT_PAGE" && run_wait
}

# walk_to N [DESTINATION]: from page 1 to page N (2 to 4), or with 5 through Next on page 4; the folder is made on consent.
walk_to() {
  ui wait "$PAGE1" || return
  [ "$1" -lt 2 ] && return
  next_from "$PAGE1" "$PAGE2" || return
  [ "$1" -lt 3 ] && return
  next_from "$PAGE2" "$PAGE3" || return
  [ -z "${2:-}" ] || ui type "$PAGE3" Edit:0 "$2" || return
  [ "$1" -lt 4 ] && return
  ui click "$PAGE3" 'Next >' || return
  [ "$(ui first "$QUESTION" "$PAGE4")" != "$QUESTION" ] || ui click "$QUESTION" Yes || return
  ui wait "$PAGE4" || return
  [ "$1" -lt 5 ] && return
  ui click "$PAGE4" 'Next >'
}

# finish_setup: from page 6 to the end, closing Plumo when it comes.
finish_setup() {
  ui wait "$PAGE6" 60000 && ui click "$PAGE6" OK && ui wait Plumo && ui close Plumo && ui gone Plumo && run_wait
}

# message_text WINDOW: what a message box says, in one line.
message_text() { ui list "$1" | sed -n 's/^Static .*"\(..*\)"$/\1/p'; }
