#!/usr/bin/env bash
# Builds and runs the consumer against the build tree, with no install: through
# find_package with CMAKE_PREFIX_PATH=<build> and through pkg-config with
# PKG_CONFIG_PATH=<build>, and checks that both take the build tree's library
# and the source tree's headers. Everything it makes lies under WORK_DIR, which
# it removes at the end.
#
# Environment, set by the CTest entry in tests/package/CMakeLists.txt:
#   SOURCE_DIR BUILD_DIR                 source and build tree
#   LIBRARY_DIR                          the build tree's folder of the library
#   CONSUMER_DIR WORK_DIR                consumer source, scratch dir
#   PROJECT_VERSION                      the upstream version, e.g. 1.0.0
#   CMAKE CXX GENERATOR MAKE_PROGRAM
set -euo pipefail

# shellcheck source=tests/package/consumer_lib.sh
source "$(dirname "$0")/consumer_lib.sh"

for v in SOURCE_DIR BUILD_DIR LIBRARY_DIR CONSUMER_DIR WORK_DIR PROJECT_VERSION CMAKE CXX GENERATOR \
    MAKE_PROGRAM; do
    [ -n "${!v:-}" ] || fail "$v is not set"
done

rm -rf -- "$WORK_DIR"
mkdir -p "$WORK_DIR"
trap 'rm -rf -- "$WORK_DIR"' EXIT
consumer_setup

cmake_consumer build-tree-find_package "$BUILD_DIR" "$BUILD_DIR" "$LIBRARY_DIR"
pkgconfig_consumer build-tree-pkg-config "$BUILD_DIR" "$SOURCE_DIR/include" "$LIBRARY_DIR"

# The user's guide's console example builds against the build tree with the
# guide's own pkg-config line, so the example and the line stay right.
example="$WORK_DIR/console_example.cpp"
sed -n '/^\/\/ Writes two values to one tag/,/^```$/p' "$SOURCE_DIR/docs/users-guide.md" | sed '$d' >"$example"
[ -s "$example" ] || fail "the console example is missing from docs/users-guide.md"
# shellcheck disable=SC2046
"$CXX" -std=c++17 -Wall -Wextra -Werror "$example" \
    $(PKG_CONFIG_PATH="$BUILD_DIR" pkg-config --cflags --libs kvveldra_tag) \
    -o "$WORK_DIR/console_example" >"$WORK_DIR/example.log" 2>&1 ||
    fail_log "$WORK_DIR/example.log" "the user's guide's console example does not build"

echo "package test: the build tree builds consumers through find_package and pkg-config"
