#!/usr/bin/env bash
# What anybody may have put beside the packed file, into the working folder or above the private folder changes nothing:
# neither what is shown nor what is installed, and no library is loaded from there.
. "$(dirname "$0")/lib.sh"
wine_begin "$ORBIT_ROOT/build/e2e/$TEST_NAME"
PLANTED=$ORBIT_ROOT/build/windows/tests/e2e/planted
SCRIPT=$ORBIT_WORK/script.txt
# Not those that the system itself never looks for anywhere else. Wine prefers its own unless it is told otherwise.
LIBRARIES='apphelp comctl32 cryptbase cryptsp dwmapi msimg32 netapi32 ntmarta profapi propsys riched20 userenv uxtheme
  version winmm wintrust'
WINEDLLOVERRIDES="$WINEDLLOVERRIDES;$(echo $LIBRARIES | tr ' ' ',')=n,b"

# A page with a picture of the bundle's, one that nobody has, and a text of the bundle's.
sed "/IMAGE 'img' IDB_PLUMO/a\\
  IMAGE 'own' own.bmp 200 20 32 32,NO_LOGPIXELS\\
  IMAGE 'none' none.bmp 250 20 32 32,NO_LOGPIXELS\\
  RICH_EDIT 'text' \"own.rtf\" 300 20 100 60,NO_LOGPIXELS" "$ORBIT_ROOT/src/installer/scripts/installer.txt" >"$SCRIPT"
convert -size 32x32 xc:red "BMP3:$ORBIT_WORK/own.bmp"
printf '{\\rtf1 own}' >"$ORBIT_WORK/own.rtf"
convert -size 32x32 xc:blue "BMP3:$ORBIT_WORK/planted.bmp"
cp -r "$PLUMO_PROGRAMS" "$ORBIT_WORK/programs"
python3 "$(dirname "$0")/make_packed.py" "$BOOTSTRAP_EXE" "$SETUP_EXE" "$SCRIPT" "$ORBIT_WORK/programs" \
  "$ORBIT_WORK/packed.exe" 'pict\own.bmp'="$ORBIT_WORK/own.bmp" 'pict\own.rtf'="$ORBIT_WORK/own.rtf" >/dev/null

# plant FOLDER: everything that the setup program itself brings or leaves, and every library that it may want.
plant() {
  mkdir -p "$1/pict"
  for library in $LIBRARIES; do cp "$PLANTED/planted.dll" "$1/$library.dll"; done
  sed -e 's/Plumo/Podvala/g' "$SCRIPT" >"$1/wizard.txt"
  cp "$1/wizard.txt" "$1/installer.txt"
  for name in own none; do
    cp "$ORBIT_WORK/planted.bmp" "$1/$name.bmp"
    cp "$ORBIT_WORK/planted.bmp" "$1/pict/$name.bmp"
    printf '{\\rtf1 planted}' | tee "$1/$name.rtf" >"$1/pict/$name.rtf"
  done
  for name in setup.exe Plumo.exe UnInstall.exe UnInstall01.exe; do cp "$PLANTED/tell.exe" "$1/$name"; done
  for name in answers.txt Uninstall.log Installed.lst config.ini orbit-folders.lst product.toml; do
    printf '001\r\ndefault_path=C:\\planted\r\nprogram_name=Podvala\r\n' >"$1/$name"
  done
  printf '<assembly xmlns="urn:schemas-microsoft-com:asm.v1" manifestVersion="1.0"/>' | tee "$1/setup.exe.manifest" >"$1/Plumo.exe.manifest"
}

# install NAME: in a fresh prefix; the first page's picture by hand, then an unattended run and what is there afterwards.
install() {
  prefix_new "$1"
  mkdir -p "$ORBIT_WORK/$1-from" "$ORBIT_WORK/$1-in"
  if [ "$1" = planted ]; then
    plant "$ORBIT_WORK/$1-from"
    plant "$ORBIT_WORK/$1-in"
    plant "$WINEPREFIX/drive_c/windows/temp"
    rm "$WINEPREFIX/drive_c/windows/temp"/{setup.exe,orbit-folders.lst}
  fi
  cp "$ORBIT_WORK/packed.exe" "$ORBIT_WORK/$1-from/Plumo-install.exe"
  before=$(ls -R "$ORBIT_WORK/$1-from" "$ORBIT_WORK/$1-in" "$WINEPREFIX/drive_c/windows/temp" | md5sum)
  desktop_start orbit
  run_start "$ORBIT_WORK/$1-in" "$(win_path "$ORBIT_WORK/$1-from/Plumo-install.exe")"
  expect "$1: page 1" ui wait "$PAGE1"
  shot "$ORBIT_WORK/$1.png"
  expect "$1: Cancel" ui click "$PAGE1" Cancel
  expect "$1: Exit Setup" exit_setup
  run_start "$ORBIT_WORK/$1-in" "$(win_path "$ORBIT_WORK/$1-from/Plumo-install.exe")" /S '/DIR=C:\Plumo'
  run_wait
  same "$1: the exit code" "$run_code" 0
  same "$1: the folders around" "$(ls -R "$ORBIT_WORK/$1-from" "$ORBIT_WORK/$1-in" "$WINEPREFIX/drive_c/windows/temp" | md5sum)" "$before"
  wineserver -k  # it writes the registry when it ends
  wineserver -w
  # Wine's own files are links into the template: both prefixes have the same ones, by their numbers.
  (cd "$WINEPREFIX/drive_c" && find . -path ./windows/temp -prune -o -name '*.lnk' -print -o -type f -links +1 -printf '%i %p\n' \
    -o -type f -exec md5sum {} +) | sort >"$ORBIT_WORK/$1.tree"
  sed -e '/^#time/d' -e 's/^\(\[.*\]\) [0-9]*$/\1/' "$WINEPREFIX/system.reg" | grep -i 'plumo\|podvala' >"$ORBIT_WORK/$1.reg"
}

case_begin 'the same page, files and registry with everything planted'
display_start
install clean
install planted
same 'pixels of the first page that differ' "$(compare -metric AE "$ORBIT_WORK/clean.png" "$ORBIT_WORK/planted.png" null: 2>&1)" 0
expect 'its own picture is shown' grep -q . <(convert "$ORBIT_WORK/clean.png" -unique-colors txt: | grep -i '#FF0000')
same 'files' "$(diff "$ORBIT_WORK"/{clean,planted}.tree)" ''
same 'registry' "$(diff "$ORBIT_WORK"/{clean,planted}.reg)" ''
expect_not 'no library was loaded' test -e "$WINEPREFIX/drive_c/planted.txt"

case_begin 'the library tells when it is loaded'
for library in version winmm uxtheme; do
  wine "$ORBIT_WORK/planted-in/setup.exe" $library.dll
  expect "$library" grep -qi "planted-in.$library.dll" "$WINEPREFIX/drive_c/planted.txt"
done

test_end
