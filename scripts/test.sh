#!/usr/bin/env bash
# Installs what is missing, builds everything with warnings as errors, and runs
# every test: the unit tests, the broker-backed integration tests and the
# bounded fuzz runs. Ends with one summary line of the ctest counts.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/install-deps.sh --with-broker

build="${BUILD_DIR:-build}"
cmake -S . -B "$build" -G Ninja -DKVVELDRA_WERROR=ON
cmake --build "$build" -j"$(nproc)"

set +e
ctest --test-dir "$build" --output-on-failure -j"$(nproc)" 2>&1 | tee "$build/ctest-output.log"
ctest_status=${PIPESTATUS[0]}
set -e

fuzz_status=0
if [ -x scripts/fuzz.sh ]; then
  scripts/fuzz.sh || fuzz_status=$?
fi

# "100% tests passed, 0 tests failed out of 331" -> "ctest: 331 passed, 0 failed"
summary=$(grep -E '^[0-9]+% tests passed, [0-9]+ tests failed out of [0-9]+' "$build/ctest-output.log" | tail -n 1 || true)
if [ -n "$summary" ]; then
  failed=$(sed -E 's/.* ([0-9]+) tests failed out of ([0-9]+).*/\1/' <<<"$summary")
  total=$(sed -E 's/.* tests failed out of ([0-9]+).*/\1/' <<<"$summary")
  echo "ctest: $((total - failed)) passed, $failed failed"
fi
if [ "$fuzz_status" -ne 0 ]; then echo "fuzz: a fuzzer found a problem (see above)"; fi
[ "$ctest_status" -eq 0 ] && [ "$fuzz_status" -eq 0 ]
