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
rm -rf "$results"
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
for preset in host windows; do
  { [ -f build/$preset/build.ninja ] || cmake --preset $preset >/dev/null; } && cmake --build --preset $preset >"$results/build-$preset.log" 2>&1
  status=$?
  [ $status = 0 ] || tail -40 "$results/build-$preset.log"
  grep 'Setup program, stripped' "$results/build-$preset.log" || true
  count "building $preset" $status
done
scripts/build-plumo.sh host >"$results/pack.log" 2>&1
status=$?
[ $status = 0 ] || tail -20 "$results/pack.log"
count 'packing the sample product' $status
[ $failed = 0 ] || finish  # nothing that follows would tell more

say 'Unit tests on the host and as Windows programs, end to end; clang-tidy'
# Two at a time, the long ones first: each has its own folder, prefix and display. Only what the last commit changed is
# linted; scripts/lint.sh --all does everything.
. scripts/wine-env.sh
template_make
{
  echo wine window_tests
  echo lint changes
  echo e2e upgrade
  for test in tests/e2e/*.sh; do
    name=$(basename "$test" .sh)
    [ "$name" = lib ] || [ "$name" = upgrade ] || echo "e2e $name"
  done
  for program in build/windows/tests/*_tests.exe; do
    name=$(basename "$program" .exe)
    [ "$name" = window_tests ] || echo "wine $name"
  done
  for program in build/host/tests/*_tests; do echo "host $(basename "$program")"; done
} | xargs -P 2 -L 1 scripts/test-job.sh "$results"
while read -r jobs_passed jobs_failed; do
  passed=$((passed + jobs_passed)) failed=$((failed + jobs_failed))
done <"$results/counts"
finish
