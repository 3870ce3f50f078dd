#!/usr/bin/env bash
# Makes the Debian packages of a built tree with cpack, checks their control
# fields and contents, unpacks them into a scratch root (dpkg-deb -x, no root
# rights) and builds and runs a consumer against that root twice: through the
# CMake package and through pkg-config. Everything it makes lies under WORK_DIR,
# which it removes at the end.
#
# Environment, set by the CTest entry in tests/package/CMakeLists.txt:
#   SOURCE_DIR BUILD_DIR                 source and build tree
#   CONSUMER_DIR WORK_DIR                consumer source, scratch dir
#   PROJECT_VERSION                      the upstream version, e.g. 1.0.0
#   LIBDIR BINDIR INCLUDEDIR             the install directories (relative)
#   CMAKE CPACK CXX GENERATOR MAKE_PROGRAM
#   EXPECT_KVTAG                         1 when the tree has the kvtag tool
set -euo pipefail

fail() {
    echo "package test: FAILED: $*" >&2
    exit 1
}
# Shows a log, then fails.
fail_log() {
    local log=$1
    shift
    echo "---- $log" >&2
    cat "$log" >&2 || true
    echo "----" >&2
    fail "$@"
}

for v in SOURCE_DIR BUILD_DIR CONSUMER_DIR WORK_DIR PROJECT_VERSION LIBDIR BINDIR INCLUDEDIR CMAKE CPACK \
    CXX GENERATOR MAKE_PROGRAM EXPECT_KVTAG; do
    [ -n "${!v:-}" ] || fail "$v is not set"
done
case "$WORK_DIR" in
    "$BUILD_DIR"/*) ;;
    *) fail "WORK_DIR ($WORK_DIR) must lie inside the build tree" ;;
esac

rm -rf -- "$WORK_DIR"
mkdir -p "$WORK_DIR"
trap 'rm -rf -- "$WORK_DIR"' EXIT
WORK_DIR=$(realpath "$WORK_DIR")
root="$WORK_DIR/root"
usr="$root/usr"
logs="$WORK_DIR/logs"
mkdir -p "$root" "$logs"

# ---------------------------------------------------------------- packages
"$CPACK" -G DEB --config "$BUILD_DIR/CPackConfig.cmake" -B "$WORK_DIR/debs" \
    >"$logs/cpack" 2>&1 || fail_log "$logs/cpack" "cpack -G DEB did not succeed"

arch=$(dpkg --print-architecture)
runtime_debs=("$WORK_DIR"/debs/libkvveldra-tag1_*_"$arch".deb)
if [ ${#runtime_debs[@]} -ne 1 ] || [ ! -f "${runtime_debs[0]}" ]; then
    fail_log "$logs/cpack" "expected one libkvveldra-tag1_*_$arch.deb; found: $(ls "$WORK_DIR/debs")"
fi
version=$(dpkg-deb -f "${runtime_debs[0]}" Version)
case "$version" in
    "$PROJECT_VERSION"-*) ;;
    *) fail "libkvveldra-tag1 has version '$version', not $PROJECT_VERSION-<release>" ;;
esac

declare -A deb
for name in libkvveldra-tag1 libkvveldra-tag-dev kvveldra-tools; do
    deb[$name]="$WORK_DIR/debs/${name}_${version}_$arch.deb"
    [ -f "${deb[$name]}" ] || fail "missing ${deb[$name]##*/}; found: $(ls "$WORK_DIR/debs")"
done
found=$(find "$WORK_DIR/debs" -maxdepth 1 -name '*.deb' | wc -l)
[ "$found" -eq 3 ] || fail "cpack made $found packages, not 3: $(ls "$WORK_DIR/debs")"

# field PACKAGE NAME: one control field of one package.
field() { dpkg-deb -f "${deb[$1]}" "$2"; }

for name in "${!deb[@]}"; do
    [ "$(field "$name" Package)" = "$name" ] || fail "${deb[$name]##*/} is not package $name"
    [ "$(field "$name" Version)" = "$version" ] || fail "$name has version $(field "$name" Version)"
    [ -n "$(field "$name" Maintainer)" ] || fail "$name has no Maintainer"
    [ -n "$(field "$name" Section)" ] || fail "$name has no Section"
    [ -n "$(field "$name" Description)" ] || fail "$name has no Description"
done

# has_depends PACKAGE REGEX: one of PACKAGE's Depends entries matches REGEX.
has_depends() {
    field "$1" Depends | tr ',' '\n' | sed 's/^ *//; s/ *$//' | grep -Eq "^($2)\$"
}
for lib in 'librabbitmq[0-9]+' 'libssl[0-9.]+' 'libstdc\+\+6' 'libc6'; do
    has_depends libkvveldra-tag1 "$lib( \(.*\))?" ||
        fail "libkvveldra-tag1 does not depend on $lib: $(field libkvveldra-tag1 Depends)"
done
has_depends kvveldra-tools 'libsqlite3-0( \(.*\))?' ||
    fail "kvveldra-tools does not depend on libsqlite3-0: $(field kvveldra-tools Depends)"
for name in libkvveldra-tag-dev kvveldra-tools; do
    has_depends "$name" "libkvveldra-tag1 \(= ${version//./\\.}\)" ||
        fail "$name does not depend on libkvveldra-tag1 (= $version): $(field "$name" Depends)"
done

# ---------------------------------------------------------------- contents
# One line a member: "<mode> <owner> <path>[ -> <target>]", paths without "./".
contents() {
    dpkg-deb -c "${deb[$1]}" |
        awk '{ path = $6; sub(/^\.\//, "", path); line = $1 " " $2 " " path;
               for (i = 7; i <= NF; ++i) line = line " " $i; print line }'
}
for name in "${!deb[@]}"; do
    contents "$name" >"$logs/$name.contents"
    bad=$(awk '$2 != "root/root"' "$logs/$name.contents")
    [ -z "$bad" ] || fail "$name has members not owned by root: $bad"
    bad=$(grep -v ' usr/share/doc/' "$logs/$name.contents" |
        grep -Ei 'gtest|gmock|benchmark|fuzz|_tests?\b|/tests?/|kvwbhost|demo|kvveldra_core|\.a$' || true)
    [ -z "$bad" ] || fail "$name holds files of the tests, benchmarks or demo: $bad"
    bad=$(awk '/^d/ && $1 != "drwxr-xr-x"' "$logs/$name.contents")
    [ -z "$bad" ] || fail "$name has directories not of mode 755: $bad"
done

# expect PACKAGE MODE PATH [TARGET]: PACKAGE holds PATH with MODE (a symbolic
# link to TARGET when given).
expect() {
    local line="$2 root/root $3"
    [ $# -lt 4 ] || line="$line -> $4"
    grep -qxF -- "$line" "$logs/$1.contents" ||
        fail "$1 lacks '$line'; it holds: $(grep -F -- "$3" "$logs/$1.contents" || echo nothing of that name)"
}
# only PACKAGE REGEX: every file or link of PACKAGE has a path matching REGEX.
only() {
    local bad
    bad=$(awk '!/^d/ { print $3 }' "$logs/$1.contents" | grep -Ev "^($2)\$" || true)
    [ -z "$bad" ] || fail "$1 holds unexpected files: $bad"
}

lib="usr/$LIBDIR"
soname=libkvveldra_tag.so.1
real=libkvveldra_tag.so.$PROJECT_VERSION
expect libkvveldra-tag1 -rw-r--r-- "$lib/$real"
expect libkvveldra-tag1 lrwxrwxrwx "$lib/$soname" "$real"
expect libkvveldra-tag1 -rw-r--r-- "$lib/libkvsslinit.so.13"
only libkvveldra-tag1 "${lib//./\\.}/(libkvveldra_tag\.so\.1(\.[0-9.]+)?|libkvsslinit\.so\.13)"

expect libkvveldra-tag-dev lrwxrwxrwx "$lib/libkvveldra_tag.so" "$soname"
for header in "$SOURCE_DIR"/include/kvveldra/*.h; do
    expect libkvveldra-tag-dev -rw-r--r-- "usr/$INCLUDEDIR/kvveldra/${header##*/}"
done
for file in kvveldra_tagConfig.cmake kvveldra_tagConfigVersion.cmake kvveldra_tagTargets.cmake; do
    expect libkvveldra-tag-dev -rw-r--r-- "$lib/cmake/kvveldra_tag/$file"
done
expect libkvveldra-tag-dev -rw-r--r-- "$lib/pkgconfig/kvveldra_tag.pc"
only libkvveldra-tag-dev "usr/${INCLUDEDIR//./\\.}/kvveldra/[A-Za-z]+\.h|${lib//./\\.}/(libkvveldra_tag\.so|cmake/kvveldra_tag/kvveldra_tag[A-Za-z-]*\.cmake|pkgconfig/kvveldra_tag\.pc)|usr/share/doc/libkvveldra-tag-dev/[^/]+\.md"

expect kvveldra-tools -rwxr-xr-x "usr/$BINDIR/kvveldra-tagservice"
if [ "$EXPECT_KVTAG" = 1 ]; then
    expect kvveldra-tools -rwxr-xr-x "usr/$BINDIR/kvtag"
    expect kvveldra-tools -rw-r--r-- "usr/share/man/man1/kvtag.1.gz"
fi
only kvveldra-tools "usr/${BINDIR//./\\.}/(kvveldra-tagservice|kvtag)|usr/share/man/man[1-8]/[^/]+\\.gz"

# ---------------------------------------------------------------- unpacked
for name in "${!deb[@]}"; do
    dpkg-deb -x "${deb[$name]}" "$root" || fail "dpkg-deb -x ${deb[$name]##*/} did not succeed"
done

# dynamic TAG FILE: the value of one dynamic-section entry.
dynamic() {
    readelf -d "$2" | sed -n "s/.*($1).*\[\(.*\)\]\$/\1/p"
}
[ "$(dynamic SONAME "$root/$lib/$real")" = "$soname" ] ||
    fail "$real has SONAME '$(dynamic SONAME "$root/$lib/$real")', not $soname"
[ "$(dynamic SONAME "$root/$lib/libkvsslinit.so.13")" = libkvsslinit.so.13 ] ||
    fail "libkvsslinit.so.13 has SONAME '$(dynamic SONAME "$root/$lib/libkvsslinit.so.13")'"
[ "$(dynamic RUNPATH "$root/$lib/$real")" = "\$ORIGIN" ] ||
    fail "$real has RUNPATH '$(dynamic RUNPATH "$root/$lib/$real")', not \$ORIGIN"

# The service runs from the root as it stands, and its run path (RPATH or
# RUNPATH) leads to the
# directory that holds libkvsslinit.so.13.
service="$usr/$BINDIR/kvveldra-tagservice"
env -u LD_LIBRARY_PATH "$service" --help >"$logs/service-help" 2>&1 ||
    fail_log "$logs/service-help" "kvveldra-tagservice --help did not succeed"
grep -q -- '--help' "$logs/service-help" ||
    fail_log "$logs/service-help" "kvveldra-tagservice --help printed no usage"
if [ "$EXPECT_KVTAG" = 1 ]; then
    env -u LD_LIBRARY_PATH "$usr/$BINDIR/kvtag" --help >"$logs/kvtag-help" 2>&1 ||
        fail_log "$logs/kvtag-help" "kvtag --help did not succeed from the unpacked root"
fi
service_runpath=$(dynamic RUNPATH "$service")
[ -n "$service_runpath" ] || service_runpath=$(dynamic RPATH "$service")
[ -f "${service_runpath/\$ORIGIN/$usr/$BINDIR}/libkvsslinit.so.13" ] ||
    fail "kvveldra-tagservice's RUNPATH '$service_runpath' does not lead to libkvsslinit.so.13"

# ---------------------------------------------------------------- consumers
# Configurations whose broker does not answer: port 1 of the loopback. The
# library wants its default ids present, as scripts/demo.sh writes them.
data="$WORK_DIR/data"
mkdir -p "$data/VeldraConfigurations"
for id in veldra_localhost veldra_master; do
    cat >"$data/VeldraConfigurations/$id.json" <<JSON
{"Id":"$id","DisplayName":"package test","ExchangeName":"kvveldra.packagetest","Host":"127.0.0.1","Port":1,"User":"guest","Password":"guest","UseTls":false}
JSON
done

# run_consumer LABEL PROGRAM [ENV...]: runs PROGRAM with ENV and checks that it
# succeeded and loaded both libraries from the root.
run_consumer() {
    local label=$1 program=$2
    shift 2
    env -u LD_LIBRARY_PATH VELDRA_DATA_DIR="$data" LD_DEBUG=libs "$@" \
        "$program" veldra_master >"$logs/$label.out" 2>"$logs/$label.err" ||
        fail_log "$logs/$label.out" "the $label consumer failed: $(grep -v '^ *[0-9]*:' "$logs/$label.err")"
    local loaded
    loaded=$(sed -n 's/^library: //p' "$logs/$label.out")
    [ "$(realpath "$loaded")" = "$(realpath "$root/$lib/$soname")" ] ||
        fail "the $label consumer loaded $loaded, not the unpacked $lib/$soname"
    loaded=$(sed -n 's/.*calling init: \(.*libkvsslinit\.so\.13\)$/\1/p' "$logs/$label.err" | head -n 1)
    [ -n "$loaded" ] || fail "the $label consumer did not load libkvsslinit.so.13"
    [ "$(realpath "$loaded")" = "$(realpath "$root/$lib/libkvsslinit.so.13")" ] ||
        fail "the $label consumer loaded $loaded, not the unpacked libkvsslinit.so.13"
    echo "package test: $label consumer: $(tr '\n' ' ' <"$logs/$label.out")"
}

# Through find_package: the CMake package of the root alone. The program's own
# run path finds libkvveldra_tag.so.1; libkvsslinit.so.13 comes through the
# library's $ORIGIN, with no LD_LIBRARY_PATH.
"$CMAKE" -S "$CONSUMER_DIR" -B "$WORK_DIR/cmake-consumer" -G "$GENERATOR" \
    -DCMAKE_MAKE_PROGRAM="$MAKE_PROGRAM" -DCMAKE_CXX_COMPILER="$CXX" -DCMAKE_BUILD_TYPE=Release \
    -DCMAKE_PREFIX_PATH="$usr" -DCMAKE_FIND_USE_PACKAGE_REGISTRY=OFF \
    -DCMAKE_FIND_USE_SYSTEM_PACKAGE_REGISTRY=OFF >"$logs/cmake-configure" 2>&1 ||
    fail_log "$logs/cmake-configure" "configuring the consumer with find_package(kvveldra_tag) failed"
package_dir=$(sed -n 's/^-- kvveldra_tag package: //p' "$logs/cmake-configure")
[ "$(realpath "$package_dir")" = "$(realpath "$root/$lib/cmake/kvveldra_tag")" ] ||
    fail "find_package(kvveldra_tag) found '$package_dir', not the unpacked package"
"$CMAKE" --build "$WORK_DIR/cmake-consumer" >"$logs/cmake-build" 2>&1 ||
    fail_log "$logs/cmake-build" "building the consumer with find_package(kvveldra_tag) failed"
run_consumer find_package "$WORK_DIR/cmake-consumer/consumer"

# Through pkg-config: the root's .pc file alone, which gives the root's paths.
pc() { PKG_CONFIG_LIBDIR="$root/$lib/pkgconfig" PKG_CONFIG_PATH="" pkg-config "$@" kvveldra_tag; }
[ "$(pc --modversion)" = "$PROJECT_VERSION" ] ||
    fail "pkg-config --modversion kvveldra_tag gives '$(pc --modversion)', not $PROJECT_VERSION"
cflags=$(pc --cflags)
libs=$(pc --libs)
read -r include_dir <<<"$cflags"
[ "$(realpath -m "${include_dir#-I}")" = "$(realpath "$usr/$INCLUDEDIR")" ] ||
    fail "pkg-config --cflags kvveldra_tag gives '$cflags', not -I<root>/usr/$INCLUDEDIR"
read -r libs_dir libs_name <<<"$libs"
if [ "$(realpath -m "${libs_dir#-L}")" != "$(realpath "$root/$lib")" ] ||
    [ "$libs_name" != -lkvveldra_tag ]; then
    fail "pkg-config --libs kvveldra_tag gives '$libs', not -L<root>/$lib -lkvveldra_tag"
fi
# shellcheck disable=SC2086 # the flags split into words
"$CXX" -std=c++17 -Wall -Wextra -Werror $cflags "$CONSUMER_DIR/main.cpp" $libs -ldl \
    -o "$WORK_DIR/pkgconfig-consumer" >"$logs/pkgconfig-build" 2>&1 ||
    fail_log "$logs/pkgconfig-build" "building the consumer with pkg-config failed"
run_consumer pkg-config "$WORK_DIR/pkgconfig-consumer" LD_LIBRARY_PATH="$root/$lib"

echo "package test: passed (${deb[*]##*/})"
