#!/usr/bin/env bash
# A second version over a first that the user has worked with, then removal; and a disk that fills up while files are
# copied. Each time the whole prefix is compared.
. "$(dirname "$0")/lib.sh"
wine_begin "$ORBIT_ROOT/build/e2e/$TEST_NAME"
unset DISPLAY
pack() { "$ORBIT_TOOL" pack "$ORBIT_WORK/$1" --setup "$SETUP_EXE" --output "$ORBIT_WORK/$1.exe" >/dev/null 2>&1; }
# version NAME: what both have.
version() {
  mkdir -p "$ORBIT_WORK/$1"
  cp "$PLUMO_PROGRAMS"/*.exe "$ORBIT_WORK/$1/"
  echo same >"$ORBIT_WORK/$1/same.txt"
  echo edited >"$ORBIT_WORK/$1/edited.txt"
  echo "changed in $1" >"$ORBIT_WORK/$1/changed.txt"
}
version first
mkdir -p "$ORBIT_WORK/first/Old/Deep"
for name in Old/Deep/stale Old/stale 'Old/stale, read-only' 'Old/stale, touched' 'Old/stale, edited'; do
  echo old >"$ORBIT_WORK/first/$name.txt"
done
chmod 0444 "$ORBIT_WORK/first/Old/stale, read-only.txt"
version second
mkdir -p "$ORBIT_WORK/second/New"
echo added >"$ORBIT_WORK/second/New/added.txt"
echo grown >>"$ORBIT_WORK/second/UnInstall01.exe"
version large
head -c 5000000 /dev/zero >"$ORBIT_WORK/large/zeros.bin"
head -c 3000000 /dev/zero >"$ORBIT_WORK/large/zeros 2.bin"
for name in first second large; do pack $name; done
prefix_new one
# A drive of 4 MB.
disk=$ORBIT_WORK/disk
mkdir -p "$disk"
mount -t tmpfs -o size=4m none "$disk" 2>/dev/null && mounted=yes || mounted=''
python3 "$ORBIT_ROOT/tests/e2e/upgrade.py" "$ORBIT_ROOT" "$ORBIT_WORK" "$mounted"
status=$?
[ -z "$mounted" ] || { WINEPREFIX=$ORBIT_WORK/one wineserver -k; umount "$disk"; }
exit $status
