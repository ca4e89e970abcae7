#!/usr/bin/env bash
# The Debian packages: makes them with CPack from this build, checks what each holds and needs
# (the checker: the C and C++ libraries only; the describer: libclang's runtime and headers
# too), extracts them into an empty root and runs both programs from there (-h, --version, a
# check of the example workspaces, the description of the example library), and finds the
# extracted CMake package with find_package(zor2check), with and without the describer.
#
#   package.sh BUILD_DIR SOURCE_DIR WORK_DIR [sanitized]
#
# "sanitized" allows the sanitizers' runtimes among the dependencies. WORK_DIR is left for
# inspection.
set -uo pipefail
# shellcheck source=tests/install/common.sh
source "$(dirname "$0")/common.sh"
sanitized=${4:-}

version=$("$build/zor2check" --version | cut -d ' ' -f 2)
(cd "$build" && run cpack.log cpack -G DEB -B "$work/packages")
checker=$(ls "$work"/packages/zor2check_"$version"_*.deb)
describer=$(ls "$work"/packages/zor2describe_"$version"_*.deb)
if [ ! -f "$checker" ] || [ ! -f "$describer" ]; then
  ls "$work/packages"
  fail "cpack did not make the two packages of release $version"
  exit 1
fi

# expect_depends PACKAGE ALLOWED-NAMES-REGEX REQUIRED-NAME...: the package's dependencies are
# all among the allowed ones and include the required ones.
expect_depends() {
  local package=$1 allowed=$2 depends names
  shift 2
  depends=$(dpkg-deb -f "$package" Depends)
  names=$(tr ',' '\n' <<<"$depends" | sed 's/^ *//; s/ .*//')
  if [ -n "$sanitized" ]; then
    allowed="$allowed|libasan[0-9]+|libubsan[0-9]+"
  fi
  for name in $names; do
    grep -Eqx "$allowed" <<<"$name" || fail "$(basename "$package") depends on $name: $depends"
  done
  for name in "$@"; do
    grep -Eqx "$name" <<<"$names" || fail "$(basename "$package") lacks $name: $depends"
  done
}
expect_depends "$checker" 'libc6|libstdc\+\+6|libgcc-s1' libc6 'libstdc\+\+6'
expect_depends "$describer" \
  'zor2check|libclang1-[0-9]+|libclang-common-[0-9]+-dev|libc6|libstdc\+\+6|libgcc-s1' \
  zor2check 'libclang1-[0-9]+' 'libclang-common-[0-9]+-dev'
dpkg-deb -f "$describer" Depends | grep -qF "zor2check (= $version)" ||
  fail "zor2describe does not depend on this release of zor2check"

# expect_files PACKAGE PATH...: the package holds each path.
expect_files() {
  local package=$1 contents
  shift
  contents=$(dpkg-deb -c "$package" | awk '{ print $6 }')
  for path in "$@"; do
    grep -qx "./$path" <<<"$contents" || fail "$(basename "$package") lacks $path"
  done
}
expect_files "$checker" usr/bin/zor2check usr/share/man/man1/zor2check.1 \
  usr/share/doc/zor2check/README.md usr/share/doc/zor2check/docs/ci.md \
  usr/lib/cmake/zor2check/zor2checkConfig.cmake usr/lib/cmake/zor2check/zor2checkInterface.cmake
expect_files "$describer" usr/bin/zor2describe usr/share/man/man1/zor2describe.1 \
  usr/lib/cmake/zor2check/zor2describeTargets.cmake
dpkg-deb -c "$checker" | grep -q zor2describe && fail "zor2check holds a part of zor2describe"

root=$work/root
run extract.log dpkg-deb -x "$checker" "$root"
checker_root=$work/checker-root
run extract.log dpkg-deb -x "$checker" "$checker_root"
run extract.log dpkg-deb -x "$describer" "$root"

# expect_output NAME EXPECTED-STATUS TEXT COMMAND...: the command ends with the status and its
# standard output holds TEXT (any, when empty).
expect_output() {
  local name=$1 expected=$2 text=$3 status=0
  shift 3
  "$@" >"$work/$name.out" 2>"$work/$name.err" || status=$?
  [ "$status" -eq "$expected" ] || fail "$name: status $status, not $expected: $*"
  [ -z "$text" ] || grep -qF -- "$text" "$work/$name.out" || fail "$name: the output lacks \"$text\": $*"
}
bin=$root/usr/bin
expect_output check-help 0 "-export PATH" "$bin/zor2check" -h
expect_output check-version 0 "zor2check $version" "$bin/zor2check" --version
expect_output describe-help 0 "-framework NAME" "$bin/zor2describe" --help
expect_output describe-version 0 "zor2describe $version" "$bin/zor2describe" --version

# The example workspaces: the same report as this build's program, and the findings that the
# baseline does not accept.
arguments=(-r "$source/examples/reference" -c "$source/examples/checked" -L -level M4R20 -fail
  -baseline "$source/examples/baseline.xml")
expect_output check-examples 3 "Summary: 13 findings" \
  "$bin/zor2check" "${arguments[@]}" -o "$work/report.xml"
"$build/zor2check" "${arguments[@]}" -o "$work/build-report.xml" >/dev/null 2>&1
cmp -s "$work/report.xml" "$work/build-report.xml" ||
  fail "the packaged zor2check writes another report than the build's"

# The example library's headers, described as its CMake target does, give its reference.
geometry=$source/examples/geometry
expect_output describe-example 0 "" "$bin/zor2describe" -framework geometry \
  -public "$geometry/include" -I "$geometry/include" -D GEOMETRY_REAL=double -std c++20 \
  -default-level L1 -o "$work/geometry.xml"
cmp -s "$work/geometry.xml" "$geometry/api/geometry.xml" ||
  fail "the packaged zor2describe does not give examples/geometry/api/geometry.xml"

# The CMake package, found where it was extracted.
mkdir -p "$work/probe"
cat >"$work/probe/CMakeLists.txt" <<'PROBE'
cmake_minimum_required(VERSION 3.16)
project(probe NONE)
find_package(zor2check ${VERSION} REQUIRED COMPONENTS ${COMPONENTS})
foreach(program zor2check zor2describe)
  if(TARGET zor2check::${program})
    get_target_property(location zor2check::${program} LOCATION)
    message(STATUS "${program}: ${location}")
  endif()
endforeach()
PROBE
run probe.log cmake -S "$work/probe" -B "$work/probe/build" -DCMAKE_PREFIX_PATH="$root/usr" \
  -DVERSION="$version" -DCOMPONENTS="zor2check;zor2describe"
for program in zor2check zor2describe; do
  grep -qF -- "-- $program: $bin/$program" "$work/probe.log" ||
    fail "find_package does not locate $program in the extracted root (see $work/probe.log)"
done
# Without the describer, asking for it fails and names its package.
if cmake -S "$work/probe" -B "$work/probe/checker-build" -DCMAKE_PREFIX_PATH="$checker_root/usr" \
  -DVERSION="$version" -DCOMPONENTS=zor2describe >"$work/probe-checker.log" 2>&1; then
  fail "find_package(zor2check COMPONENTS zor2describe) succeeds without zor2describe"
fi
# CMake wraps the message: its words are compared with the line ends made blanks.
tr -s ' \n' '  ' <"$work/probe-checker.log" | grep -q "Debian package zor2describe" ||
  fail "find_package without zor2describe does not name its package (see $work/probe-checker.log)"
exit "$failed"
