#!/usr/bin/env bash
# Installs what is missing, builds everything with warnings as errors, and runs
# every test: the unit tests, the broker-backed integration tests and the
# bounded fuzz runs. Ends with one summary line of the ctest counts.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/install-deps.sh --with-broker

build="${BUILD_DIR:-build}"
# Tests and benchmarks on, whatever an earlier configure of this tree chose
# (the demo builds only its own programs, but a hand-made tree may differ).
cmake -S . -B "$build" -G Ninja -DKVVELDRA_WERROR=ON -DKVVELDRA_TESTS=ON -DKVVELDRA_BENCH=ON
cmake --build "$build" -j"$(nproc)"

ctest_status=0
# The cluster tests run apart, in scripts/test-cluster.sh.
scripts/run-tests.sh "$build" -LE cluster || ctest_status=$?

fuzz_status=0
if [ -x scripts/fuzz.sh ]; then
  scripts/fuzz.sh || fuzz_status=$?
fi

# The counts again, below the fuzzers' output.
cat "$build/ctest-summary.txt" 2>/dev/null || echo "ctest: no summary (see above)"
if [ "$fuzz_status" -ne 0 ]; then echo "fuzz: a fuzzer found a problem (see above)"; fi
[ "$ctest_status" -eq 0 ] && [ "$fuzz_status" -eq 0 ]
