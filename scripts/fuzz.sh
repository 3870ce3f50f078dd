#!/usr/bin/env bash
# Builds the libFuzzer targets with clang in a build directory of their own
# and runs each for a bounded time. Exits non-zero when a fuzzer finds a
# crash, a leak, a hang or undefined behaviour; the input that triggered it
# is kept in <build>/artifacts.
#
#   FUZZ_SECONDS     run time of each fuzzer (default 30)
#   FUZZ_BUILD_DIR   build directory (default <source>/build-fuzz)
#   FUZZ_JOBS        parallel build jobs (default 2)
#   FUZZ_ONLY        run only the fuzzer of this name
set -euo pipefail

source_dir=$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)
build_dir=${FUZZ_BUILD_DIR:-$source_dir/build-fuzz}
seconds=${FUZZ_SECONDS:-30}
jobs=${FUZZ_JOBS:-2}

cmake -S "$source_dir" -B "$build_dir" -G Ninja \
    -DCMAKE_C_COMPILER=clang -DCMAKE_CXX_COMPILER=clang++ \
    -DCMAKE_BUILD_TYPE=RelWithDebInfo \
    -DKVVELDRA_FUZZ=ON -DKVVELDRA_TESTS=OFF -DKVVELDRA_BENCH=OFF
cmake --build "$build_dir" --target kvveldra_fuzzers -j "$jobs"

artifacts=$build_dir/artifacts
mkdir -p "$artifacts"
status=0
while read -r name executable corpus; do
    [[ -z "$name" ]] && continue
    [[ -n "${FUZZ_ONLY:-}" && "$name" != "$FUZZ_ONLY" ]] && continue
    # New inputs go to a scratch directory: the committed seeds stay as they are.
    scratch=$build_dir/corpus/$name
    mkdir -p "$scratch"
    echo "== $name: $seconds s"
    if ! "$executable" -max_total_time="$seconds" -timeout=10 -rss_limit_mb=2048 \
            -artifact_prefix="$artifacts/$name-" -print_final_stats=1 "$scratch" "$corpus"; then
        echo "== $name: FOUND A PROBLEM (see $artifacts)" >&2
        status=1
    fi
done < "$build_dir/fuzzers.txt"
exit $status
