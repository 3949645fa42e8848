# Sourced by every test of this folder: cases that are counted, expectations, and the programs under test.
set -uo pipefail  # no -e: a failed expectation is counted, and the test goes on
ORBIT_ROOT=$(cd "$(dirname "${BASH_SOURCE[0]}")/../.." && pwd)
. "$ORBIT_ROOT/scripts/wine-env.sh"
. "$ORBIT_ROOT/scripts/wizard-steps.sh"

TEST_NAME=$(basename "$0" .sh)
PLUMO_PROGRAMS=$ORBIT_ROOT/build/windows/products/plumo
SETUP_EXE=$ORBIT_ROOT/build/windows/src/starter/setup.exe
BOOTSTRAP_EXE=$ORBIT_ROOT/build/windows/src/bootstrap/bootstrap.exe
PLUMO_SETUP=$ORBIT_ROOT/build/PlumoSetup.exe
PLUMO_FOLDER=$ORBIT_ROOT/build/plumo
ORBIT_TOOL=$ORBIT_ROOT/build/host/tools/orbit/orbit
passed=0 failed=0 skipped=0 case_name='' case_bad=0

# test_begin: private folder, display, prefix and desktop.
test_begin() {
  wine_begin "$ORBIT_ROOT/build/e2e/$TEST_NAME"
  display_start
  prefix_new prefix
  desktop_start orbit
}

case_end() {
  [ -z "$case_name" ] && return
  if [ $case_bad = 0 ]; then passed=$((passed + 1)); else failed=$((failed + 1)); fi
  case_name=''
}

case_begin() {
  case_end
  case_name=$1 case_bad=0
}

bad() {
  case_bad=1
  echo "FAILED $TEST_NAME, $case_name: $*"
  # What was on the screen tells more than any message.
  [ -n "$xvfb_pid" ] && convert "xwd:$ORBIT_WORK/screen/Xvfb_screen0" "$ORBIT_WORK/failed-$((++pictures)).png" || true
}
pictures=0

case_skip() {
  echo "SKIPPED $TEST_NAME, $case_name: $*"
  skipped=$((skipped + 1))
  case_name=''
}

# expect WHAT COMMAND...: the command must succeed. It runs in this shell, so that it may set variables.
expect() {
  local what=$1
  shift
  "$@" >"$ORBIT_WORK/expect.out" 2>&1 || bad "$what ($(tr '\n' ' ' <"$ORBIT_WORK/expect.out"))"
}

# expect_not WHAT COMMAND...: the command must fail.
expect_not() {
  local what=$1
  shift
  ! "$@" >/dev/null 2>&1 || bad "$what"
}

# same WHAT ACTUAL EXPECTED
same() { [ "$2" = "$3" ] || bad "$1 is \"$2\", not \"$3\""; }

test_end() {
  case_end
  echo "$TEST_NAME: $passed passed, $failed failed, $skipped skipped"
  [ $failed = 0 ]
}
