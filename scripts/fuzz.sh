#!/usr/bin/env bash
# Fuzzes one target (see fuzz/README.md) for SECONDS with clang 14's libFuzzer, in PROCESSES at once.
#   scripts/fuzz.sh TARGET SECONDS [PROCESSES]     TARGET "all": one after the other
# What is found is kept in fuzz/findings/TARGET/, what was learnt in build/fuzz/corpus/TARGET/. Exit code 1 on a finding.
set -uo pipefail
cd "$(dirname "$0")/.."
root=$PWD
target=${1:?usage: scripts/fuzz.sh TARGET SECONDS [PROCESSES]} seconds=${2:?how many seconds} processes=${3:-1}
known=$(ls fuzz/seeds)

if [ "$target" = all ]; then
  status=0
  for each in $known; do "$0" "$each" "$seconds" "$processes" || status=1; done
  exit $status
fi
grep -qx "$target" <<<"$known" || { echo "no target '$target'; there are:" $known >&2; exit 2; }
command -v clang++-14 >/dev/null || { echo 'needs the packages clang-14 and libclang-rt-14-dev' >&2; exit 2; }

build=$root/build/fuzz
[ -f "$build/build.ninja" ] ||
  cmake -S fuzz -B "$build" -G Ninja -DCMAKE_C_COMPILER=clang-14 -DCMAKE_CXX_COMPILER=clang++-14 >/dev/null || exit 2
cmake --build "$build" --target "fuzz_$target" >"$build/build.log" 2>&1 || { tail -40 "$build/build.log" >&2; exit 2; }

corpus=$build/corpus/$target findings=$root/fuzz/findings/$target
mkdir -p "$corpus" "$findings"
before=$(ls "$findings")
# Files live in memory, in a folder of each process's own.
scratch=$(mktemp -d /dev/shm/orbit-fuzz.XXXXXX)
trap 'rm -rf "$scratch"; rmdir --ignore-fail-on-non-empty "$findings"' EXIT
trap 'kill $(jobs -p) 2>/dev/null; wait; exit 130' INT TERM

inputs=("$corpus" "$root/fuzz/seeds/$target" "$findings")
case $target in script | engine) inputs+=("$root/tests/scripts" "$root/tests/orbit/check") ;; esac
dictionary=$root/fuzz/$target.dict
[ -f "$dictionary" ] || dictionary=$root/fuzz/script.dict
for ((i = 1; i <= processes; i++)); do
  mkdir "$scratch/$i"
  # Diagnostic lines are formatted too, to nowhere; the configuration file writes too many of them for that.
  [ "$target" = config ] || ln -s /dev/null "$scratch/$i/execution.log"
  (cd "$scratch/$i" && exec env ASAN_OPTIONS=detect_leaks=1 UBSAN_OPTIONS=print_stacktrace=1 \
    "$build/fuzz_$target" -max_total_time="$seconds" -max_len=8192 -timeout=20 -rss_limit_mb=2048 -report_slow_units=5 \
    -dict="$dictionary" -artifact_prefix="$findings/" -reload=10 -print_final_stats=1 "${inputs[@]}") \
    >"$build/$target-$i.log" 2>&1 &
done
wait

for ((i = 1; i <= processes; i++)); do
  printf '%s: %s executions; %s\n' "$target" \
    "$(grep -oP 'stat::number_of_executed_units: \K.*' "$build/$target-$i.log" || echo 'unknown')" \
    "$(grep -oE 'cov: [0-9]+ ft: [0-9]+ corp: [0-9]+' "$build/$target-$i.log" | tail -1)"
done
found=$(comm -13 <(sort <<<"$before") <(ls "$findings" | sort))
[ -z "$found" ] && exit 0
echo "FOUND in fuzz/findings/$target:" $found
grep -hE 'ERROR: |SUMMARY: |runtime error|does not hold' "$build/$target"-*.log
exit 1
