#!/usr/bin/env bash
# Installs what is missing (haproxy and rabbitmq-server with the rest), builds
# the cluster tests and runs them: three private RabbitMQ nodes behind haproxy,
# started and stopped by the ctest fixture "cluster". Ends with the cluster's
# boot time, each recovery time and one summary line.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/install-deps.sh --with-cluster

build="${BUILD_DIR:-build}"
# Under the build lock, so that a build of a shared tree waits for this one.
(
  flock 9
  cmake -S . -B "$build" -G Ninja -DKVVELDRA_WERROR=ON -DKVVELDRA_TESTS=ON -DKVVELDRA_BENCH=ON
  cmake --build "$build" -j"$(nproc)" --target kvveldra_cluster_tests kvveldra-tagservice
) 9>>"${KVVELDRA_BUILD_LOCK:-/tmp/kvveldra-build.lock}"

status=0
scripts/run-tests.sh "$build" -L cluster || status=$?
# The figures the tests printed, which ctest keeps in its log.
grep -ho 'cluster of [0-9]* nodes up in [0-9]*s\|cluster recovery (.*' \
  "$build/Testing/Temporary/LastTest.log" 2>/dev/null || true
cat "$build/ctest-summary.txt" 2>/dev/null || true
exit "$status"
