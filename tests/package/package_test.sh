#!/usr/bin/env bash
# Makes the Debian packages of a built tree with cpack, runs lintian on them,
# checks their control fields and contents against Debian's layout (usr/bin,
# usr/include, usr/lib/<triplet>), unpacks them into a scratch root (dpkg-deb
# -x, no root rights) and builds and runs a consumer against that root twice:
# through the CMake package and through pkg-config. Everything it makes lies
# under WORK_DIR, which it removes at the end.
#
# Environment, set by the CTest entry in tests/package/CMakeLists.txt:
#   SOURCE_DIR BUILD_DIR                 source and build tree
#   CONSUMER_DIR WORK_DIR                consumer source, scratch dir
#   PROJECT_VERSION                      the upstream version, e.g. 1.0.0
#   CMAKE CPACK CXX GENERATOR MAKE_PROGRAM
#   EXPECT_KVTAG                         1 when the tree has the kvtag tool
#   EXPECT_PYTHON                        1 when the tree has the Python module
set -euo pipefail

# shellcheck source=tests/package/consumer_lib.sh
source "$(dirname "$0")/consumer_lib.sh"

for v in SOURCE_DIR BUILD_DIR CONSUMER_DIR WORK_DIR PROJECT_VERSION CMAKE CPACK \
    CXX GENERATOR MAKE_PROGRAM EXPECT_KVTAG EXPECT_PYTHON; do
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
mkdir -p "$root"
consumer_setup

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
names=(libkvveldra-tag1 libkvveldra-tag-dev kvveldra-tools)
[ "$EXPECT_PYTHON" != 1 ] || names+=(python3-kvveldra)
for name in "${names[@]}"; do
    deb[$name]="$WORK_DIR/debs/${name}_${version}_$arch.deb"
    [ -f "${deb[$name]}" ] || fail "missing ${deb[$name]##*/}; found: $(ls "$WORK_DIR/debs")"
done
found=$(find "$WORK_DIR/debs" -maxdepth 1 -name '*.deb' | wc -l)
[ "$found" -eq ${#names[@]} ] || fail "cpack made $found packages, not ${#names[@]}: $(ls "$WORK_DIR/debs")"

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
for name in "${names[@]:1}"; do
    has_depends "$name" "libkvveldra-tag1 \(= ${version//./\\.}\)" ||
        fail "$name does not depend on libkvveldra-tag1 (= $version): $(field "$name" Depends)"
done

# The runtime package's shlibs file names it for both of its libraries.
shlibs=$(dpkg-deb -I "${deb[libkvveldra-tag1]}" shlibs) || fail "libkvveldra-tag1 has no shlibs file"
for entry in 'libkvveldra_tag 1' 'libkvsslinit 13'; do
    grep -qxF "$entry libkvveldra-tag1 (>= $version)" <<<"$shlibs" ||
        fail "libkvveldra-tag1's shlibs lacks '$entry libkvveldra-tag1 (>= $version)': $shlibs"
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

lib="usr/lib/$(dpkg-architecture -qDEB_HOST_MULTIARCH)"
soname=libkvveldra_tag.so.1
real=libkvveldra_tag.so.$PROJECT_VERSION
expect libkvveldra-tag1 -rw-r--r-- "$lib/$real"
expect libkvveldra-tag1 lrwxrwxrwx "$lib/$soname" "$real"
expect libkvveldra-tag1 -rw-r--r-- "$lib/libkvsslinit.so.13"
# debian_files PACKAGE: the regex of the files that Debian wants in PACKAGE.
debian_files() { echo "usr/share/(doc/$1/(copyright|changelog\\.Debian\\.gz)|lintian/overrides/$1)"; }
only libkvveldra-tag1 "${lib//./\\.}/(libkvveldra_tag\.so\.1(\.[0-9.]+)?|libkvsslinit\.so\.13)|$(debian_files libkvveldra-tag1)"

expect libkvveldra-tag-dev lrwxrwxrwx "$lib/libkvveldra_tag.so" "$soname"
for header in "$SOURCE_DIR"/include/kvveldra/*.h; do
    expect libkvveldra-tag-dev -rw-r--r-- "usr/include/kvveldra/${header##*/}"
done
for file in kvveldra_tagConfig.cmake kvveldra_tagConfigVersion.cmake kvveldra_tagTargets.cmake; do
    expect libkvveldra-tag-dev -rw-r--r-- "$lib/cmake/kvveldra_tag/$file"
done
expect libkvveldra-tag-dev -rw-r--r-- "$lib/pkgconfig/kvveldra_tag.pc"
only libkvveldra-tag-dev "usr/include/kvveldra/[A-Za-z]+\.h|${lib//./\\.}/(libkvveldra_tag\.so|cmake/kvveldra_tag/kvveldra_tag[A-Za-z-]*\.cmake|pkgconfig/kvveldra_tag\.pc)|usr/share/doc/libkvveldra-tag-dev/[^/]+\.md|$(debian_files libkvveldra-tag-dev)"

# The programs, with their manual pages (lintian checks that each has one).
expect kvveldra-tools -rwxr-xr-x usr/bin/kvveldra-tagservice
[ "$EXPECT_KVTAG" != 1 ] || expect kvveldra-tools -rwxr-xr-x usr/bin/kvtag
only kvveldra-tools "usr/bin/(kvveldra-tagservice|kvtag)|usr/share/man/man1/[^/]+\\.1\\.gz|$(debian_files kvveldra-tools)"

# The Python module in Debian's dist-packages, the extension with its stubs.
pydir=usr/lib/python3/dist-packages/kvveldra
if [ "$EXPECT_PYTHON" = 1 ]; then
    has_depends python3-kvveldra 'python3 \(>= 3\.[0-9]+\)' ||
        fail "python3-kvveldra does not depend on python3: $(field python3-kvveldra Depends)"
    for file in __init__.py _errors.py _records.py _kvveldra.pyi py.typed; do
        expect python3-kvveldra -rw-r--r-- "$pydir/$file"
    done
    only python3-kvveldra "${pydir//./\\.}/([a-z_]+\\.pyi?|py\\.typed|_kvveldra(\\.cpython-[0-9a-z_-]+)?\\.so)|$(debian_files python3-kvveldra)"
    grep -Eq " ${pydir//./\\.}/_kvveldra(\\.cpython-[0-9a-z_-]+)?\\.so\$" "$logs/python3-kvveldra.contents" ||
        fail "python3-kvveldra has no extension _kvveldra*.so"
fi

# ---------------------------------------------------------------- lintian
# No error and no warning; the info tags that remain are printed.
command -v lintian >/dev/null || fail "lintian is not installed (scripts/install-deps.sh installs it)"
lintian --no-cfg --fail-on error,warning --display-info "${deb[@]}" >"$logs/lintian" 2>&1 ||
    fail_log "$logs/lintian" "lintian finds errors or warnings in the packages"
sed -n 's/^I: /package test: lintian info: /p' "$logs/lintian"

# ---------------------------------------------------------------- unpacked
for name in "${!deb[@]}"; do
    dpkg-deb -x "${deb[$name]}" "$root" || fail "dpkg-deb -x ${deb[$name]##*/} did not succeed"
    # packaging/changelog has an entry for the packages' version.
    top=$(zcat "$usr/share/doc/$name/changelog.Debian.gz" | head -n 1)
    case "$top" in
        *" ($version) "*) ;;
        *) fail "$name's changelog starts with '$top', not an entry for $version (packaging/changelog)" ;;
    esac
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
# RUNPATH) leads to the directory that holds libkvsslinit.so.13.
service="$usr/bin/kvveldra-tagservice"
env -u LD_LIBRARY_PATH "$service" --help >"$logs/service-help" 2>&1 ||
    fail_log "$logs/service-help" "kvveldra-tagservice --help did not succeed"
grep -q -- '--help' "$logs/service-help" ||
    fail_log "$logs/service-help" "kvveldra-tagservice --help printed no usage"
if [ "$EXPECT_KVTAG" = 1 ]; then
    env -u LD_LIBRARY_PATH "$usr/bin/kvtag" --help >"$logs/kvtag-help" 2>&1 ||
        fail_log "$logs/kvtag-help" "kvtag --help did not succeed from the unpacked root"
fi
service_runpath=$(dynamic RUNPATH "$service")
[ -n "$service_runpath" ] || service_runpath=$(dynamic RPATH "$service")
[ -f "${service_runpath/\$ORIGIN/$usr/bin}/libkvsslinit.so.13" ] ||
    fail "kvveldra-tagservice's RUNPATH '$service_runpath' does not lead to libkvsslinit.so.13"

# The module imports from the root with Debian's interpreter, which its
# package is built for, and finds the root's library.
if [ "$EXPECT_PYTHON" = 1 ]; then
    PYTHONPATH="$root/usr/lib/python3/dist-packages" LD_LIBRARY_PATH="$root/$lib" /usr/bin/python3 -c '
import kvveldra, pathlib, sys
assert kvveldra.__file__.startswith(sys.argv[1]), kvveldra.__file__
assert (kvveldra.DOUBLE, kvveldra.DATETIME) == (0, 5) and issubclass(kvveldra.TimeoutError, TimeoutError)
folder = pathlib.Path(kvveldra.__file__).parent
assert (folder / "py.typed").is_file() and "class Client" in (folder / "_kvveldra.pyi").read_text()
' "$root" >"$logs/python-import" 2>&1 || fail_log "$logs/python-import" "kvveldra does not import from the unpacked root"
fi

# ---------------------------------------------------------------- consumers
# Through find_package: the CMake package of the root alone.
cmake_consumer find_package "$usr" "$root/$lib/cmake/kvveldra_tag" "$root/$lib"
# Through pkg-config: the root's .pc file, which gives the root's paths; the
# program finds the library through LD_LIBRARY_PATH, as the .pc gives no run
# path.
pkgconfig_consumer pkg-config "$root/$lib/pkgconfig" "$usr/include" "$root/$lib" \
    LD_LIBRARY_PATH="$root/$lib"

echo "package test: passed (${deb[*]##*/})"
