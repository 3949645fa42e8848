#!/usr/bin/env bash
# Builds the loading benchmark for the host, without sanitizers, and runs it: bench/README.md. Fails when the time grows
# faster than the script, or when 10,000 lines take longer to load than their budget.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/install-tools.sh
[ -f build/release/build.ninja ] || cmake --preset release >/dev/null
cmake --build --preset release --target load_bench
exec build/release/bench/load_bench
