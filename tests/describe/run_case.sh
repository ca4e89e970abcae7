#!/usr/bin/env bash
# Runs one zor2describe case: a folder holding the commands to run, their inputs, and what is
# expected of them.
#
#   steps              one command per line: "zor2describe" or "zor2check", then its arguments
#                      separated by blanks (paths relative to the folder), or "bash" and a script
#                      of the folder with its arguments, for a step that needs a link, a limit or
#                      a signal around the run (the script finds the programs in ZOR2DESCRIBE and
#                      ZOR2CHECK, and the end-to-end folder in E2E_DIR); "#" starts a comment
#   expected.status    the exit status of each step, one per line (all 0 when absent)
#   expected.stdout    standard output of all the steps (empty when absent)
#   expected.stderr    standard error of all the steps (empty when absent)
#   expected.NAME      any other expected file is compared with the file NAME that the steps
#                      wrote (expected.out.xml with out.xml, expected.report.xml with report.xml)
#
# With UPDATE=1 in the environment, the expected files of the case folder are rewritten from what
# the steps produced (expected.stdout, .stderr and .status when not empty or all 0 or already
# there, and each expected.NAME that the folder already holds), to be reviewed as a diff; an
# expected file that is a link is written through, to the file it shares. The case still fails
# on what changed.
#
# The case runs in a fresh copy of its folder (links followed, so that cases share the test
# library through a link), with each program named as in the steps whatever its path, and every
# expected file must match byte for byte.
set -u
tests_dir=$(cd "$(dirname "$0")/.." && pwd)
describe_bin=$(realpath "$1")
check_bin=$(realpath "$2")
case_dir=$(cd "$3" && pwd) || exit 1

ZOR2DESCRIBE=$describe_bin
ZOR2CHECK=$check_bin
E2E_DIR=$tests_dir/e2e
export ZOR2DESCRIBE ZOR2CHECK E2E_DIR

work=$(mktemp -d)
trap 'chmod -R u+rwX "$work" 2>/dev/null; rm -rf "$work"' EXIT
cp -RL "$case_dir/." "$work/"
cd "$work" || exit 1

: >actual.stdout
: >actual.stderr
: >actual.status
while read -r program arguments; do
  case "$program" in
    "" | "#"*) continue ;;
    zor2describe) bin=$describe_bin ;;
    zor2check) bin=$check_bin ;;
    bash)
      read -r -a args <<<"$arguments"
      bash "${args[@]}" >>actual.stdout 2>>actual.stderr </dev/null
      echo $? >>actual.status
      continue
      ;;
    *)
      echo "--- unknown program in steps: $program"
      exit 1
      ;;
  esac
  read -r -a args <<<"$arguments"
  (bash -c 'exec -a "$0" "$1" "${@:2}"' "$program" "$bin" "${args[@]}") \
    >>actual.stdout 2>>actual.stderr </dev/null
  echo $? >>actual.status
done <steps

# shellcheck source=tests/expect.sh
source "$tests_dir/expect.sh"

if [ "${UPDATE:-0}" = 1 ]; then
  for name in stdout stderr; do
    if [ -s "actual.$name" ] || [ -e "$case_dir/expected.$name" ]; then
      update_expected "actual.$name" "$case_dir/expected.$name"
    fi
  done
  if grep -qv '^0$' actual.status || [ -e "$case_dir/expected.status" ]; then
    update_expected actual.status "$case_dir/expected.status"
  fi
  for expected in "$case_dir"/expected.*; do
    name=${expected##*/expected.}
    case "$name" in
      status | stdout | stderr) ;;
      *) [ -f "$name" ] && update_expected "$name" "$expected" ;;
    esac
  done
fi

[ -f expected.status ] || sed 's/.*/0/' actual.status >expected.status
[ -f expected.stdout ] || : >expected.stdout
[ -f expected.stderr ] || : >expected.stderr
for expected in expected.*; do
  name=${expected#expected.}
  case "$name" in
    status | stdout | stderr) expect "$expected" "actual.$name" ;;
    *) expect "$expected" "$name" ;;
  esac
done
exit $failed
