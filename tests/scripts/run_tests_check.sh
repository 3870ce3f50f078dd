#!/usr/bin/env bash
# scripts/run-tests.sh on three tiny trees: one with no test must fail and say
# so, one whose test fails must fail, one whose test passes must pass with its
# count. Arguments: the source tree, a scratch directory, the CMake generator.
set -euo pipefail
source_dir=$1
scratch=$2
generator=$3

rm -rf -- "$scratch"
mkdir -p "$scratch/project"
trap 'rm -rf -- "$scratch"' EXIT
cat >"$scratch/project/CMakeLists.txt" <<'CMAKE'
cmake_minimum_required(VERSION 3.25)
project(run_tests_check NONE)
enable_testing()
if(TESTS STREQUAL "pass")
  add_test(NAME passes COMMAND ${CMAKE_COMMAND} -E true)
elseif(TESTS STREQUAL "fail")
  add_test(NAME fails COMMAND ${CMAKE_COMMAND} -E false)
endif()
CMAKE

fail() { echo "run-tests check: FAILED: $*" >&2; exit 1; }

# run KIND: configures the tree for KIND and runs the script on it; sets
# $status and $output.
run() {
    cmake -S "$scratch/project" -B "$scratch/build" -G "$generator" -DTESTS="$1" >/dev/null
    set +e
    output=$("$source_dir/scripts/run-tests.sh" "$scratch/build" 2>&1)
    status=$?
    set -e
}

run none
[ "$status" -ne 0 ] || fail "a tree without tests passed: $output"
grep -q "no test ran" <<<"$output" || fail "a tree without tests did not say so: $output"

run fail
[ "$status" -ne 0 ] || fail "a failing test passed: $output"
grep -qx "ctest: 0 passed, 1 failed" <<<"$output" || fail "no count for a failing test: $output"

run pass
[ "$status" -eq 0 ] || fail "a passing test failed: $output"
grep -qx "ctest: 1 passed, 0 failed" <<<"$output" || fail "no count for a passing test: $output"
echo "run-tests check: passed"
