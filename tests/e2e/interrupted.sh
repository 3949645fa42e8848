#!/usr/bin/env bash
# Kills an installation at many moments, spread over all that it writes; some with the Wine server, which is a power cut
# to it. Each time either installs again and uninstalls, or uninstalls at once. Then the whole prefix, its files and its
# registry, must be as it was before the product came.
#   interrupted.sh [MOMENTS]     6 of them unless told otherwise
. "$(dirname "$0")/lib.sh"
wine_begin "$ORBIT_ROOT/build/e2e/$TEST_NAME"
unset DISPLAY
product=$ORBIT_WORK/product
mkdir -p "$product/Help/Deep" "$product/Texts"
cp "$PLUMO_PROGRAMS"/*.exe "$product/"
for i in $(seq 30); do echo "text $i" >"$product/Texts/$i.txt"; done
head -c 1500000 /dev/urandom >"$product/Help/big.bin"
echo deep >"$product/Help/Deep/deep.txt"
echo font >"$product/OrbitTest.ttf"
chmod 0444 "$product/Texts/7.txt"
"$ORBIT_TOOL" pack "$product" --setup "$SETUP_EXE" --output "$ORBIT_WORK/Setup.exe" >/dev/null 2>&1
prefix_new one
prefix_new two
python3 "$ORBIT_ROOT/tests/e2e/interrupted.py" "$ORBIT_ROOT" "$ORBIT_WORK" "${1:-6}"
