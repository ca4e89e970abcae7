#!/usr/bin/env bash
# Runs one end-to-end case: a folder holding the command's arguments and its
# inputs, and the output expected of it.
#
#   args               one argument per line, paths relative to the folder
#   expected.status    the exit status (0 when absent)
#   expected.stdout    standard output (empty when absent; a case whose output
#                      is only the run's banner links to one of the
#                      ../../expected.banner*.stdout)
#   expected.stderr    standard error (empty when absent)
#   expected.report.xml  when present, compared with the file out.xml
#   expected.help.htm    when present, compared with the file help.htm (the cases
#                        that write the help page link to ../../expected.help.htm)
#   expected.files/NAME  when present, each compared with the file NAME that the
#                        run wrote (exports, for example)
#   setup.sh           when present, run (with bash) in the working copy first
#   run.sh             when present, run (with bash) instead of the program, with
#                      the program's command line as its arguments ("$@" runs
#                      it): for a case that needs a signal, a pipe, a limit or
#                      a mount around the run; its output and status are the
#                      case's
#   check.sh           when present, run (with bash) after the program; a
#                      non-zero status fails the case (files left behind or
#                      kept intact)
#   run_as             when present, a user name: run as root, the program runs
#                      as that user, since file modes do not bind root
#
# The case runs in a fresh copy of its folder, with the program named
# "zor2check" whatever its path, and every expected file must match byte for
# byte. A case that cannot be arranged on this machine says so and exits
# with 77 (skipped), from setup.sh or run.sh as well. The hooks find the
# program's path in ZOR2CHECK, and this folder's (which holds interpose.c and
# memory_limit.c, the libraries some cases preload) in E2E_DIR.
#
# A folder holding a file "table" holds many cases, one a row, each run as
#   run_case.sh PROGRAM FOLDER ROW
# (table_row.sh says what a row holds): the row becomes a case folder as above.
#
# With UPDATE=1 in the environment, the case's expected files are rewritten
# from what the program produced, to be reviewed as a diff: expected.stdout,
# .stderr and .status when not empty or not 0 or already there, and each
# expected.report.xml, expected.help.htm and expected.files/NAME already there
# (for a row, its status, its texts and its report). An expected file that is a
# link is written through, once, to the file it shares: when only this case
# changed, give it a file of its own first. The case still fails on what
# changed.
set -u
bin=$1
case_dir=$(cd "$2" && pwd) || exit 1
row=${3:-}
E2E_DIR=$(cd "$(dirname "$0")" && pwd)
tests_dir=$(dirname "$E2E_DIR")
export E2E_DIR

work=$(mktemp -d)
trap 'chmod -R u+rwX "$work" 2>/dev/null; rm -rf "$work"' EXIT
# shellcheck source=tests/expect.sh
source "$tests_dir/expect.sh"
if [ -n "$row" ]; then
  # shellcheck source=tests/e2e/table_row.sh
  source "$E2E_DIR/table_row.sh"
  row_case "$case_dir" "$row" "$work" || exit 1
else
  # Links are followed, so that cases can share one expected file (the help page).
  cp -RL "$case_dir/." "$work/"
fi
cd "$work" || exit 1
export ZOR2CHECK=$bin
if [ -f setup.sh ]; then
  bash setup.sh
  setup_status=$?
  [ "$setup_status" -eq 77 ] && exit 77
  [ "$setup_status" -ne 0 ] && { echo "setup.sh failed"; exit 1; }
fi

# As another user, the program runs from a copy in the working folder, which
# that user can reach and write whatever the build directory's modes.
as_user=()
if [ -f run_as ] && [ "$(id -u)" -eq 0 ]; then
  user=$(cat run_as)
  as_user=(setpriv "--reuid=$user" "--regid=$(id -g "$user" 2> /dev/null)" --clear-groups)
  if ! command -v setpriv > /dev/null || ! "${as_user[@]}" true 2> /dev/null; then
    echo "SKIPPED: cannot run the program as user $user here"
    exit 77
  fi
  cp "$bin" "$work/.zor2check" && chmod 0755 "$work/.zor2check" && chmod 0777 "$work" || exit 1
  bin=$work/.zor2check
fi

args=()
[ -f args ] && mapfile -t args < args
command=("${as_user[@]}" bash -c 'exec -a zor2check "$0" "$@"' "$bin" "${args[@]}")
[ -f run.sh ] && command=(bash run.sh "${command[@]}")
("${command[@]}") > actual.stdout 2> actual.stderr < /dev/null
status=$?
if [ -f run.sh ] && [ "$status" -eq 77 ]; then
  cat actual.stdout
  exit 77
fi

want_status=0
[ -f expected.status ] && want_status=$(cat expected.status)
if [ "$status" != "$want_status" ]; then
  echo "--- exit status $status, expected $want_status"
  failed=1
fi
[ -f expected.stdout ] || : > expected.stdout
[ -f expected.stderr ] || : > expected.stderr
expect expected.stdout actual.stdout
expect expected.stderr actual.stderr
[ -f expected.report.xml ] && expect expected.report.xml out.xml
[ -f expected.help.htm ] && expect expected.help.htm help.htm
if [ -d expected.files ]; then
  for expected_file in expected.files/*; do expect "$expected_file" "${expected_file#expected.files/}"; done
fi
if [ -f check.sh ] && ! bash check.sh; then
  echo "--- check.sh failed"
  failed=1
fi

if [ "${UPDATE:-0}" = 1 ]; then
  if [ -n "$row" ]; then
    row_update "$case_dir" "$row" "$status"
  else
    for name in stdout stderr; do
      if [ -s "actual.$name" ] || [ -e "$case_dir/expected.$name" ]; then
        update_expected "actual.$name" "$case_dir/expected.$name"
      fi
    done
    if [ "$status" != 0 ] || [ -e "$case_dir/expected.status" ]; then
      echo "$status" >actual.status
      update_expected actual.status "$case_dir/expected.status"
    fi
    [ -e "$case_dir/expected.report.xml" ] && [ -f out.xml ] &&
      update_expected out.xml "$case_dir/expected.report.xml"
    [ -e "$case_dir/expected.help.htm" ] && [ -f help.htm ] &&
      update_expected help.htm "$case_dir/expected.help.htm"
    for expected_file in "$case_dir"/expected.files/*; do
      name=${expected_file##*/}
      [ -f "$name" ] && update_expected "$name" "$expected_file"
    done
  fi
fi
exit $failed
