# shellcheck shell=bash disable=SC2034
# Shared by the tests of what is shipped, sourced with the arguments BUILD_DIR SOURCE_DIR
# WORK_DIR: sets build, source and work (emptied) to their absolute paths, and failed=0.

build=$(realpath "$1")
source=$(realpath "$2")
rm -rf "$3" && mkdir -p "$3" || exit 1
work=$(realpath "$3")
failed=0

# fail MESSAGE: reports a failure; the test goes on and ends with status 1.
fail() {
  echo "FAILED: $*"
  failed=1
}

# run LOG COMMAND...: runs the command with its output in $work/LOG; shows the output and
# stops the test when it fails.
run() {
  local log=$work/$1
  shift
  if ! "$@" >"$log" 2>&1; then
    cat "$log"
    echo "FAILED: $*"
    exit 1
  fi
}
