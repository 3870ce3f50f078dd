#!/usr/bin/env bash
# Installs what is missing, builds everything with warnings as errors, and runs
# every test: the unit tests, the broker-backed integration tests and the
# bounded fuzz runs.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/install-deps.sh --with-broker

build="${BUILD_DIR:-build}"
cmake -S . -B "$build" -G Ninja -DKVVELDRA_WERROR=ON
cmake --build "$build" -j"$(nproc)"
ctest --test-dir "$build" --output-on-failure -j"$(nproc)"

if [ -x scripts/fuzz.sh ]; then
  scripts/fuzz.sh
fi
