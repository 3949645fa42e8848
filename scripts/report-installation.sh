# Sourced after wine-env.sh: prints what an installation of Plumo left behind.

unix_path() { WINEPREFIX=$WINEPREFIX wine winepath -u "$1" | tr -d '\r'; }

report_text() {
  printf '\n%s:\n' "$1"
  # The files are code page 1250, without an end to the last line.
  iconv -f CP1250 -t UTF-8 "$2" | tr -d '\r' | sed 's/^/  /'
  echo
}

report_files() {
  printf 'Files in %s:\n  attribut.  last write (UTC)     bytes  name\n' "$1"
  (
    cd "$(unix_path "$1")"
    find . -type f | sort | while IFS= read -r file; do
      printf '  %s  %s %9d  %s\n' "$([ -w "$file" ] && [ "$(stat -c %A "$file" | cut -c3)" = w ] && echo '---------' || echo 'read-only')" \
        "$(date -u -r "$file" '+%Y-%m-%d %H:%M:%S')" "$(stat -c %s "$file")" "${file#./}"
    done
  )
}

report_shortcuts() {
  printf '\nShortcuts:\n'
  find "$WINEPREFIX/drive_c" -name '*.lnk' | sort | while IFS= read -r link; do
    printf '  %s\n' "${link#"$WINEPREFIX/drive_c/"}"
    ui link "$(win_path "$link")" | sed 's/^/      /'
  done
}

# The entry among the installed programs. By way of a file: what is printed would lose letters.
programs_entry() {
  wine reg export 'HKLM\Software\Microsoft\Windows\CurrentVersion\Uninstall\Plumo' "$(win_path "$ORBIT_WORK/entry.reg")" /y \
    >/dev/null || return
  iconv -f UTF-16 -t UTF-8 "$ORBIT_WORK/entry.reg" | tr -d '\r' | grep '^\[\|^"'
}

# report_installation DESTINATION
report_installation() {
  local folder
  folder=$(unix_path "$1")
  report_files "$1"
  printf '\nIn the Windows folder:\n'
  ls -l "$WINEPREFIX"/drive_c/windows/UnInstall01.exe | sed "s|$WINEPREFIX/drive_c/||; s/^/  /"
  report_shortcuts
  printf '\nInstalled programs:\n'
  programs_entry | sed 's/^/  /'
  for name in Uninstall.log config.ini Installed.lst; do report_text "$name" "$folder/$name"; done
}
