#!/usr/bin/env bash
# Sets everything up and runs all tests. The last line counts test programs and end-to-end cases; exit code 1 when any
# failed.
#   ./test.sh
set -uo pipefail
cd "$(dirname "$0")"
ORBIT_ROOT=$PWD
started=$SECONDS
passed=0 failed=0
results=$ORBIT_ROOT/build/test-results
mkdir -p "$results"

say() { printf '\n[%3ds] %s\n' $((SECONDS - started)) "$*"; }
count() { # count NAME STATUS
  if [ "$2" = 0 ]; then passed=$((passed + 1)); else failed=$((failed + 1)); echo "FAILED: $1"; fi
}
finish() {
  say 'Done'
  echo "$passed passed, $failed failed"
  [ $failed = 0 ]
  exit
}

say 'Tools'
scripts/install-tools.sh || { count 'installing the tools' 1; finish; }

say 'Format'
folders=()
for folder in src tests tools products bench fuzz; do [ -d $folder ] && folders+=("$folder"); done
sources() { find "${folders[@]}" -name '*.cpp' -o -name '*.h' | sort; }
sources | xargs clang-format-14 --dry-run -Werror
count 'clang-format' $?

say 'Building'
export NINJA_STATUS='[%f/%t, %es] '
for preset in host windows release; do
  target=all
  [ $preset = release ] && target=orbit  # all that this preset is for
  { [ -f build/$preset/build.ninja ] || cmake --preset $preset >/dev/null; } && cmake --build --preset $preset --target $target >"$results/build-$preset.log" 2>&1
  status=$?
  [ $status = 0 ] || tail -40 "$results/build-$preset.log"
  grep 'Setup program, stripped' "$results/build-$preset.log" || true
  count "building $preset" $status
done
scripts/build-plumo.sh >"$results/pack.log" 2>&1
status=$?
[ $status = 0 ] || tail -20 "$results/pack.log"
count 'packing the sample product' $status

say 'Unit tests on the host, under sanitizers'
for program in build/host/tests/*_tests; do
  [ -x "$program" ] || continue
  name=$(basename "$program")
  (mkdir -p "$results/host-$name" && cd "$results/host-$name" && timeout 120 "$ORBIT_ROOT/$program" --gtest_brief=1) >"$results/host-$name.log" 2>&1
  status=$?
  tail -n $([ $status = 0 ] && echo 2 || echo 60) "$results/host-$name.log"
  count "$name on the host" $status
done

say 'Unit tests as Windows programs'
. scripts/wine-env.sh
wine_begin "$ORBIT_ROOT/build/test-work"
display_start
for program in build/windows/tests/*_tests.exe; do
  [ -f "$program" ] || continue
  name=$(basename "$program" .exe)
  prefix_new "$name"
  desktop_start "$name"
  mkdir -p "$ORBIT_WORK/cwd-$name"
  run_start "$ORBIT_WORK/cwd-$name" "$(win_path "$program")" --gtest_brief=1
  run_wait 180
  cp "$ORBIT_WORK/run.out" "$results/wine-$name.log"
  tail -n $([ "$run_code" = 0 ] && echo 3 || echo 60) "$results/wine-$name.log"
  [ "$run_code" = 0 ]
  count "$name under Wine" $?
  wineserver -k
done

say 'Lint (what the last commit changed; scripts/lint.sh --all for everything)'
scripts/lint.sh
count 'clang-tidy' $?

say 'End to end'
for test in tests/e2e/*.sh; do
  [ "$test" = tests/e2e/lib.sh ] && continue
  name=$(basename "$test" .sh)
  timeout 240 "$test" >"$results/e2e-$name.log" 2>&1
  cat "$results/e2e-$name.log"
  summary=$(grep -oE "^$name: [0-9]+ passed, [0-9]+ failed" "$results/e2e-$name.log" | tail -1)
  if [ -z "$summary" ]; then
    count "$test did not come to its end" 1
  else
    passed=$((passed + $(echo "$summary" | awk '{print $2}')))
    failed=$((failed + $(echo "$summary" | awk '{print $4}')))
  fi
done
finish
