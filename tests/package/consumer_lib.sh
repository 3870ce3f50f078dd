# shellcheck shell=bash
# Helpers of the package tests, sourced by package_test.sh and
# build_tree_test.sh: failing with a log, and building and running the
# consumer (consumer/) against one tree of the library, through the CMake
# package and through pkg-config.
#
# The sourcing script sets CONSUMER_DIR, WORK_DIR, CMAKE, CXX, GENERATOR,
# MAKE_PROGRAM and PROJECT_VERSION, and calls consumer_setup before the rest.

fail() {
    echo "package test: FAILED: $*" >&2
    exit 1
}
# fail_log LOG MESSAGE: shows LOG, then fails.
fail_log() {
    local log=$1
    shift
    echo "---- $log" >&2
    cat "$log" >&2 || true
    echo "----" >&2
    fail "$@"
}

# consumer_setup: the logs folder, and the configurations that the consumer
# opens, whose broker does not answer: port 1 of the loopback. The library
# wants its default ids present, as scripts/demo.sh writes them.
consumer_setup() {
    logs="$WORK_DIR/logs"
    data="$WORK_DIR/data"
    mkdir -p "$logs" "$data/VeldraConfigurations"
    local id
    for id in veldra_localhost veldra_master; do
        cat >"$data/VeldraConfigurations/$id.json" <<JSON
{"Id":"$id","DisplayName":"package test","ExchangeName":"kvveldra.packagetest","Host":"127.0.0.1","Port":1,"User":"guest","Password":"guest","UseTls":false}
JSON
    done
}

# run_consumer LABEL PROGRAM LIBDIR [ENV...]: runs PROGRAM with ENV and checks
# that it succeeded and loaded libkvveldra_tag.so.1 and libkvsslinit.so.13
# from LIBDIR.
run_consumer() {
    local label=$1 program=$2 libdir=$3
    shift 3
    env -u LD_LIBRARY_PATH VELDRA_DATA_DIR="$data" LD_DEBUG=libs "$@" \
        "$program" veldra_master >"$logs/$label.out" 2>"$logs/$label.err" ||
        fail_log "$logs/$label.out" "the $label consumer failed: $(grep -v '^ *[0-9]*:' "$logs/$label.err")"
    local loaded
    loaded=$(sed -n 's/^library: //p' "$logs/$label.out")
    [ "$(realpath "$loaded")" = "$(realpath "$libdir/libkvveldra_tag.so.1")" ] ||
        fail "the $label consumer loaded $loaded, not $libdir/libkvveldra_tag.so.1"
    loaded=$(sed -n 's/.*calling init: \(.*libkvsslinit\.so\.13\)$/\1/p' "$logs/$label.err" | head -n 1)
    [ -n "$loaded" ] || fail "the $label consumer did not load libkvsslinit.so.13"
    [ "$(realpath "$loaded")" = "$(realpath "$libdir/libkvsslinit.so.13")" ] ||
        fail "the $label consumer loaded $loaded, not $libdir/libkvsslinit.so.13"
    echo "package test: $label consumer: $(tr '\n' ' ' <"$logs/$label.out")"
}

# cmake_consumer LABEL PREFIX_PATH PACKAGE_DIR LIBDIR: configures the consumer
# with CMAKE_PREFIX_PATH=PREFIX_PATH alone, checks that
# find_package(kvveldra_tag) found PACKAGE_DIR, builds it and runs it against
# LIBDIR. The program's own run path finds the library; libkvsslinit.so.13
# comes through the library's $ORIGIN, with no LD_LIBRARY_PATH.
cmake_consumer() {
    local label=$1 prefix=$2 package_dir=$3 libdir=$4
    local dir="$WORK_DIR/$label"
    "$CMAKE" -S "$CONSUMER_DIR" -B "$dir" -G "$GENERATOR" \
        -DCMAKE_MAKE_PROGRAM="$MAKE_PROGRAM" -DCMAKE_CXX_COMPILER="$CXX" -DCMAKE_BUILD_TYPE=Release \
        -DCMAKE_PREFIX_PATH="$prefix" -DCMAKE_FIND_USE_PACKAGE_REGISTRY=OFF \
        -DCMAKE_FIND_USE_SYSTEM_PACKAGE_REGISTRY=OFF >"$logs/$label-configure" 2>&1 ||
        fail_log "$logs/$label-configure" "configuring the $label consumer failed"
    local found
    found=$(sed -n 's/^-- kvveldra_tag package: //p' "$logs/$label-configure")
    [ "$(realpath "$found")" = "$(realpath "$package_dir")" ] ||
        fail "the $label consumer's find_package(kvveldra_tag) found '$found', not $package_dir"
    "$CMAKE" --build "$dir" >"$logs/$label-build" 2>&1 ||
        fail_log "$logs/$label-build" "building the $label consumer failed"
    run_consumer "$label" "$dir/consumer" "$libdir"
}

# pkgconfig_consumer LABEL PC_DIR INCLUDE_DIR LIBDIR [RUN_ENV...]: with
# PKG_CONFIG_PATH=PC_DIR, checks that pkg-config gives kvveldra_tag's version,
# -I INCLUDE_DIR and -L LIBDIR -lkvveldra_tag, compiles the consumer with a
# plain compiler line of those flags and runs it with RUN_ENV against LIBDIR.
pkgconfig_consumer() {
    local label=$1 pc_dir=$2 include_dir=$3 libdir=$4
    shift 4
    pc() {
        env -u PKG_CONFIG_LIBDIR -u PKG_CONFIG_DISABLE_UNINSTALLED PKG_CONFIG_PATH="$pc_dir" \
            pkg-config "$@" kvveldra_tag
    }
    [ "$(pc --modversion)" = "$PROJECT_VERSION" ] ||
        fail "$label: pkg-config --modversion kvveldra_tag gives '$(pc --modversion)', not $PROJECT_VERSION"
    local cflags libs word found_include="" found_libdir="" found_lib=""
    cflags=$(pc --cflags)
    libs=$(pc --libs)
    for word in $cflags; do
        case "$word" in -I*) found_include=$(realpath -m "${word#-I}") ;; esac
    done
    for word in $libs; do
        case "$word" in
            -L*) found_libdir=$(realpath -m "${word#-L}") ;;
            -lkvveldra_tag) found_lib=1 ;;
        esac
    done
    [ "$found_include" = "$(realpath "$include_dir")" ] ||
        fail "$label: pkg-config --cflags kvveldra_tag gives '$cflags', not -I$include_dir"
    if [ "$found_libdir" != "$(realpath "$libdir")" ] || [ -z "$found_lib" ]; then
        fail "$label: pkg-config --libs kvveldra_tag gives '$libs', not -L$libdir -lkvveldra_tag"
    fi
    # shellcheck disable=SC2086 # the flags split into words
    "$CXX" -std=c++17 -Wall -Wextra -Werror $cflags "$CONSUMER_DIR/main.cpp" $libs -ldl \
        -o "$WORK_DIR/$label" >"$logs/$label-build" 2>&1 ||
        fail_log "$logs/$label-build" "building the $label consumer failed"
    run_consumer "$label" "$WORK_DIR/$label" "$libdir" "$@"
}
