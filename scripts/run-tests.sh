#!/usr/bin/env bash
# Runs every test of a built tree with ctest and ends with one summary line of
# the counts. Fails when a test fails and also when the tree has no test at all:
# a build configured without tests is no pass.
#
#   scripts/run-tests.sh BUILD_DIR [ctest options...]
set -euo pipefail

build=${1:?usage: scripts/run-tests.sh BUILD_DIR [ctest options...]}
shift
log="$build/ctest-output.log"
rm -f "$build/ctest-summary.txt"

set +e
ctest --test-dir "$build" --no-tests=error --output-on-failure -j"$(nproc)" "$@" 2>&1 | tee "$log"
status=${PIPESTATUS[0]}
set -e

# "100% tests passed, 0 tests failed out of 331" -> "ctest: 331 passed, 0 failed"
summary=$(grep -E '^[0-9]+% tests passed, [0-9]+ tests failed out of [0-9]+' "$log" | tail -n 1 || true)
if [ -z "$summary" ]; then
    echo "ctest: no test ran in $build (was it configured with -DKVVELDRA_TESTS=OFF?)" >&2
    exit 1
fi
failed=$(sed -E 's/.* ([0-9]+) tests failed out of ([0-9]+).*/\1/' <<<"$summary")
total=$(sed -E 's/.* tests failed out of ([0-9]+).*/\1/' <<<"$summary")
echo "ctest: $((total - failed)) passed, $failed failed" | tee "$build/ctest-summary.txt"
if [ "$total" -eq 0 ]; then
    echo "ctest: no test ran in $build" >&2
    exit 1
fi
exit "$status"
