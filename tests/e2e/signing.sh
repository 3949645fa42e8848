#!/usr/bin/env bash
# A packed file is signed by its maker: the signature covers all of it, the payload is still found, and it installs.
. "$(dirname "$0")/lib.sh"
wine_begin "$ORBIT_ROOT/build/e2e/$TEST_NAME"
display_start
prefix_new prefix
product=$ORBIT_ROOT/products/plumo/product.toml
packed=$ORBIT_WORK/packed.exe signed=$ORBIT_WORK/signed.exe

sign() { osslsigncode sign -certs "$ORBIT_WORK/cert.pem" -key "$ORBIT_WORK/key.pem" -h sha256 -n Plumo -in "$1" -out "$2"; }
verify() { osslsigncode verify -CAfile "$ORBIT_WORK/cert.pem" -in "$1"; }
size_of() { stat -c %s "$1"; }
number_at() { od -An -tu4 -j "$2" -N 4 "$1" | tr -d ' '; } # number_at FILE PLACE
# flipped FILE PLACE: a copy with one byte changed
flipped() {
  local byte
  byte=$(od -An -tu1 -j "$2" -N 1 "$1")
  cp "$1" "$ORBIT_WORK/flipped.exe"
  printf "\\x$(printf %x $((byte ^ 1)))" | dd of="$ORBIT_WORK/flipped.exe" bs=1 seek="$2" conv=notrunc status=none
  echo "$ORBIT_WORK/flipped.exe"
}
contents() { "$ORBIT_TOOL" list "$1" | grep -E '^ +[0-9]+ |everything verified'; } # the product's

case_begin 'icon and version stand in the packed file, which is the same every time'
expect 'packing' "$ORBIT_TOOL" pack "$product" --output "$packed"
[ -s "$packed" ] || { test_end; exit 1; }
cp "$packed" "$ORBIT_WORK/first.exe"
expect 'packing again' "$ORBIT_TOOL" pack "$product" --output "$packed"
expect 'the same bytes' cmp "$packed" "$ORBIT_WORK/first.exe"
i686-w64-mingw32-windres -i "$packed" -O rc -o "$ORBIT_WORK/packed.rc"
same 'the texts' "$(grep -oE '"(CompanyName|FileVersion|OriginalFilename|ProductName)", ".*"' "$ORBIT_WORK/packed.rc" | tr '\n' ' ')" \
  '"CompanyName", "Tavola" "FileVersion", "1.0.0" "OriginalFilename", "packed.exe" "ProductName", "Plumo" '
same 'the numbers' "$(grep -o 'FILEVERSION .*' "$ORBIT_WORK/packed.rc")" 'FILEVERSION 1, 0, 0, 0'
same 'the icon groups' "$(grep -c RT_GROUP_ICON "$ORBIT_WORK/packed.rc")" 1
expect 'the manifest' grep -q RT_MANIFEST "$ORBIT_WORK/packed.rc"

case_begin 'signed, every part of it is covered'
openssl req -x509 -newkey rsa:2048 -nodes -days 3 -subj '/O=Tavola/CN=Tavola test' -addext extendedKeyUsage=codeSigning \
  -keyout "$ORBIT_WORK/key.pem" -out "$ORBIT_WORK/cert.pem" 2>/dev/null
expect 'signing' sign "$packed" "$signed"
expect 'the signature' verify "$signed"
payload=$(number_at "$signed" 44) length=$(number_at "$signed" 48)
same 'the end of the payload' $((payload + length)) "$(size_of "$packed")"
for place in 100 $((payload - 100)) "$payload" $((payload + length - 1)); do
  expect "a changed byte at $place is seen" grep -q 'MISMATCH' <(verify "$(flipped "$signed" "$place")" 2>&1)
done

case_begin 'the payload is found and whole, and what is signed cannot be packed again'
expect 'everything is verified' grep -q 'everything verified' <(contents "$signed")
same 'the contents' "$(contents "$signed")" "$(contents "$packed")"
expect 'signing the starter' sign "$BOOTSTRAP_EXE" "$ORBIT_WORK/starter.exe"
"$ORBIT_TOOL" pack "$product" --starter "$ORBIT_WORK/starter.exe" --output "$ORBIT_WORK/again.exe" 2>"$ORBIT_WORK/refusal"
same 'the exit code for a signed starter' $? 1
expect "the reason" grep -qE 'signed|behind its last section' "$ORBIT_WORK/refusal"
expect_not 'something is left' test -e "$ORBIT_WORK/again.exe"

case_begin 'it installs'
desktop_start orbit  # an empty one ends after a second
run_start / "$(win_path "$signed")" /S '/DIR=C:\Plumo č'
run_wait
same 'the exit code' "$run_code" 0
expect 'what was installed' cmp "$PLUMO_FOLDER/Plumo.exe" "$WINEPREFIX/drive_c/Plumo č/Plumo.exe"

test_end
