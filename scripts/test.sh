#!/usr/bin/env bash
# Installs what is missing, builds everything with warnings as errors, and runs
# every test: the unit tests, the broker-backed integration tests, the cluster
# tests and the bounded fuzz runs. Ends with one summary line of the ctest
# counts.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/install-deps.sh --with-cluster

build="${BUILD_DIR:-build}"
# Tests and benchmarks on, whatever an earlier configure of this tree chose
# (the demo builds only its own programs, but a hand-made tree may differ).
cmake -S . -B "$build" -G Ninja -DKVVELDRA_WERROR=ON -DKVVELDRA_TESTS=ON -DKVVELDRA_BENCH=ON
cmake --build "$build" -j"$(nproc)"

ctest_status=0
scripts/run-tests.sh "$build" -LE cluster || ctest_status=$?
cp "$build/ctest-summary.txt" "$build/ctest-summary-main.txt" 2>/dev/null || true
# The cluster tests after the rest, so that no other broker shares the two
# cores with the three nodes while their recovery times are taken.
scripts/run-tests.sh "$build" -L cluster || ctest_status=$?
grep -ho 'cluster of [0-9]* nodes up in [0-9]*s\|cluster recovery (.*' \
  "$build/Testing/Temporary/LastTest.log" 2>/dev/null || true
# One line for both runs: "ctest: N passed, M failed".
cat "$build/ctest-summary-main.txt" "$build/ctest-summary.txt" 2>/dev/null |
  awk '/^ctest: [0-9]+ passed, [0-9]+ failed/ { p += $2; f += $4; n++ }
       END { if (n == 2) printf "ctest: %d passed, %d failed\n", p, f }' \
  > "$build/ctest-summary-all.txt"
[ -s "$build/ctest-summary-all.txt" ] && mv "$build/ctest-summary-all.txt" "$build/ctest-summary.txt"

fuzz_status=0
if [ -x scripts/fuzz.sh ]; then
  scripts/fuzz.sh || fuzz_status=$?
fi

# The counts again, below the fuzzers' output.
cat "$build/ctest-summary.txt" 2>/dev/null || echo "ctest: no summary (see above)"
if [ "$fuzz_status" -ne 0 ]; then echo "fuzz: a fuzzer found a problem (see above)"; fi
[ "$ctest_status" -eq 0 ] && [ "$fuzz_status" -eq 0 ]
