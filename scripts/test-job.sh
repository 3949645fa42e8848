#!/usr/bin/env bash
# One job of test.sh: a test program, an end-to-end test, or clang-tidy over what changed. Several may run at a time.
#   test-job.sh RESULTS host|wine|e2e|lint NAME
# Writes RESULTS/KIND-NAME.log, adds a line "PASSED FAILED" to RESULTS/counts, and prints the outcome in one piece.
set -uo pipefail
cd "$(dirname "$0")/.."
ORBIT_ROOT=$PWD
results=$1 kind=$2 name=$3
log=$results/$kind-$name.log
started=$SECONDS

host() {
  mkdir -p "$results/cwd-$name"
  (cd "$results/cwd-$name" && exec timeout 120 "$ORBIT_ROOT/build/host/tests/$name" --gtest_brief=1)
}

wine_program() {
  . scripts/wine-env.sh
  wine_begin "$ORBIT_ROOT/build/test-work/$name"
  display_start || return 1
  prefix_new prefix
  desktop_start "$name"
  mkdir -p "$ORBIT_WORK/cwd"
  run_start "$ORBIT_WORK/cwd" "$(win_path "build/windows/tests/$name.exe")" --gtest_brief=1
  run_wait 240
  cat "$ORBIT_WORK/run.out"
  [ "$run_code" = 0 ]
}

passed=0 failed=0
case $kind in
  host) (host) >"$log" 2>&1 ;;
  wine) (wine_program) >"$log" 2>&1 ;;
  lint) scripts/lint.sh >"$log" 2>&1 ;;
  e2e) timeout 300 "tests/e2e/$name.sh" >"$log" 2>&1 ;;
esac
status=$?
summary=$(grep -oE "^$name: [0-9]+ passed, [0-9]+ failed" "$log" | tail -1)
if [ $kind = e2e ] && [ -n "$summary" ]; then
  read -r _ passed _ failed _ <<<"$summary"
elif [ $status = 0 ] && [ $kind != e2e ]; then
  passed=1
else
  failed=1
fi
{
  flock 9
  echo "$passed $failed" >>"$results/counts"
  echo "$([ $failed = 0 ] && echo passed || echo FAILED) $kind $name, $((SECONDS - started)) s: $(grep -E ' (tests ran|passed|PASSED)' "$log" | tail -1)"
  [ $failed = 0 ] || tail -60 "$log"
} 9>>"$results/counts"
