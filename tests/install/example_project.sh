#!/usr/bin/env bash
# The CMake workflow end to end: installs this build into a prefix, configures the example
# project examples/geometry against it, and checks that its interface test passes on release 1,
# passes on a compatible change (saying that the interface changed), fails on the incompatible
# change of release 2 (examples/geometry-release-2) with the finding in CTest's output, and
# passes again once the target geometry_update_interface has rewritten the reference.
#
#   example_project.sh BUILD_DIR SOURCE_DIR WORK_DIR
#
# The prefix and the project sit in directories whose names hold blanks. WORK_DIR is left for
# inspection; the test of the CI recipes reads the exports there.
set -uo pipefail
# shellcheck source=tests/install/common.sh
source "$(dirname "$0")/common.sh"
prefix="$work/installed zor2check"
project="$work/geometry project"

# check_step NAME pass|fail: builds the project and runs its tests into $work/NAME.log.
check_step() {
  local name=$1 expected=$2 status=0
  run "$name.build.log" cmake --build "$project/build"
  ctest --test-dir "$project/build" --output-on-failure >"$work/$name.log" 2>&1 || status=$?
  if { [ "$expected" = pass ] && [ "$status" -ne 0 ]; } ||
    { [ "$expected" = fail ] && [ "$status" -eq 0 ]; }; then
    cat "$work/$name.log"
    fail "$name: the interface test should $expected (ctest exit status $status)"
  fi
}

# expect_in LOG TEXT: $work/LOG.log holds TEXT; expect_not_in: it does not.
expect_in() {
  grep -qF -- "$2" "$work/$1.log" || fail "$work/$1.log lacks \"$2\""
}
expect_not_in() {
  if grep -qF -- "$2" "$work/$1.log"; then
    fail "$work/$1.log holds \"$2\""
    return 1
  fi
}

# The README shows the example's CMakeLists.txt, less its opening comment.
if ! diff -u <(awk '/^```cmake$/ { shown = 1; next } /^```$/ { shown = 0 } shown' \
  "$source/README.md") <(grep -v '^#' "$source/examples/geometry/CMakeLists.txt"); then
  fail "the README's CMake project is not examples/geometry/CMakeLists.txt"
fi

run install.log cmake --install "$build" --prefix "$prefix"
cp -R "$source/examples/geometry" "$project"
run configure.log cmake -S "$project" -B "$project/build" -DCMAKE_PREFIX_PATH="$prefix"

# Release 1: its headers give the committed reference exactly.
check_step release-1 pass
expect_not_in release-1.build "the interface changed" ||
  echo "(if the describer's output changed on purpose, copy $project/build/zor2check/geometry/" \
    "description.xml, from the release 1 headers, to examples/geometry/api/geometry.xml)"

# A new header is a compatible change; the build says so, for the reference to be updated.
cat >"$project/include/geometry/circle.h" <<'HEADER'
// A circle of the plane.
// @ZOR2Usage U1
#pragma once

#include "geometry/point.h"

namespace geometry {

class Circle {
 public:
  Circle(const Point& center, Real radius);
  Real Area() const;
};

}  // namespace geometry
HEADER
check_step compatible pass
expect_in compatible.build "geometry: the interface changed"

# Release 2 changes a returned type.
cp -R "$source/examples/geometry-release-2/." "$project/"
check_step release-2 fail
for text in "FAILED: 1 new finding" "Method Returned Type Has Changed" \
  "std::size_t VertexCount() const" "--target geometry_update_interface"; do
  expect_in release-2 "$text"
done
for export in findings.md findings.html findings.sarif report.xml; do
  [ -s "$project/build/zor2check/geometry/$export" ] || fail "release-2: no $export"
done

# Accepting the change: the reference is rewritten and the test passes.
run update.log cmake --build "$project/build" --target geometry_update_interface
check_step updated pass
if ! cmp -s "$project/api/geometry.xml" "$project/build/zor2check/geometry/description.xml" ||
  ! grep -q 'File Name="geometry/circle.h"' "$project/api/geometry.xml" ||
  ! grep -q 'Signature="int VertexCount() const"' "$project/api/geometry.xml"; then
  fail "updated: api/geometry.xml is not the description of release 2"
fi
exit "$failed"
