#!/usr/bin/env bash
# Installs what is missing, builds the library and runs the demo end to end.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/install-deps.sh --with-broker

build="${BUILD_DIR:-build}"
cmake -S . -B "$build" -G Ninja -DKVVELDRA_TESTS=OFF -DKVVELDRA_BENCH=OFF
cmake --build "$build" -j"$(nproc)" --target kvveldra-demo
"$build/tools/demo/kvveldra-demo"
