# shellcheck shell=bash
# Sourced by run_case.sh: the cases of a table, a case folder holding a file "table" with one
# case a row, for cases that differ only in their arguments and what is expected of them. A row:
#
#   NAME  STATUS  INPUTS  STDOUT  STDERR  REPORT  ARGUMENTS...
#
#   NAME       says the behaviour; CTest runs the row as FOLDER_NAME
#   STATUS     the exit status
#   INPUTS     the folder under inputs/ that the case runs in a copy of ("-": an empty folder)
#   STDOUT     standard output: the texts expected/PIECE.stdout joined by "+", in that order, so
#              that a text that many cases print is kept once ("-": empty)
#   STDERR     standard error, likewise from expected/PIECE.stderr
#   REPORT     expected/REPORT.report.xml, compared with the file out.xml ("-": none)
#   ARGUMENTS  the rest of the line, quoted as the shell does ('' is an empty argument)
#
# The columns are separated by blanks; a line starting with "#" is a comment. A text used by one
# row only is named after it.

# row_fields TABLE_DIR ROW reads the row's columns into row_status, row_inputs, row_stdout,
# row_stderr, row_report and row_arguments.
row_fields() {
  local name
  while read -r name row_status row_inputs row_stdout row_stderr row_report row_arguments; do
    [ "$name" = "$2" ] && return 0
  done <"$1/table"
  echo "--- $1/table has no row $2"
  return 1
}

# row_text TABLE_DIR PIECES STREAM [FIRST [COUNT]] writes the pieces' texts joined, or COUNT of
# them from the FIRST (counted from 0).
row_text() {
  local -a pieces=()
  local piece
  [ "$2" = - ] || IFS=+ read -r -a pieces <<<"$2"
  for piece in "${pieces[@]:${4:-0}:${5:-${#pieces[@]}}}"; do
    cat "$1/expected/$piece.$3" || return 1
  done
}

# row_case TABLE_DIR ROW WORK makes the folder WORK the row's case folder.
row_case() {
  local table_dir=$1 work=$3
  row_fields "$table_dir" "$2" || return 1
  if [ "$row_inputs" != - ]; then
    cp -RL "$table_dir/inputs/$row_inputs/." "$work/" || return 1
  fi
  printf '%s\n' "$row_arguments" | xargs -r printf '%s\n' >"$work/args" || return 1
  [ "$row_status" = 0 ] || echo "$row_status" >"$work/expected.status"
  row_text "$table_dir" "$row_stdout" stdout >"$work/expected.stdout" || return 1
  row_text "$table_dir" "$row_stderr" stderr >"$work/expected.stderr" || return 1
  if [ "$row_report" != - ]; then
    cp "$table_dir/expected/$row_report.report.xml" "$work/expected.report.xml" || return 1
  fi
}

# row_set TABLE_DIR ROW FIELD VALUE sets the FIELDth column (from 1) of the row to VALUE, keeping
# the columns that follow where they were when there is room.
row_set() {
  local table=$1/table line pad
  local pattern="^(([^[:space:]]+[[:space:]]+){$(($3 - 1))})([^[:space:]]+)([[:space:]]*)(.*)$"
  while IFS= read -r line; do
    if [ "${line%%[[:space:]]*}" = "$2" ] && [[ $line =~ $pattern ]]; then
      pad=$((${#BASH_REMATCH[3]} + ${#BASH_REMATCH[4]} - ${#4}))
      [ "$pad" -ge 1 ] || pad=1
      [ -n "${BASH_REMATCH[5]}" ] || pad=0
      line=${BASH_REMATCH[1]}$4$(printf '%*s' "$pad" '')${BASH_REMATCH[5]}
    fi
    printf '%s\n' "$line"
  done <"$table" >"$table.updating" && mv -f "$table.updating" "$table"
}

# row_update_text TABLE_DIR ROW FIELD COLUMN STREAM rewrites one output of the row from the file
# actual.STREAM: when one piece alone differs, that piece (shared or not); otherwise a text of
# the row's own.
row_update_text() {
  local table_dir=$1 row=$2 column=$4 stream=$5 actual=actual.$5
  local -a names=()
  local k size before after found=-1 found_before found_after
  if [ ! -s "$actual" ]; then
    [ "$column" = - ] || row_set "$table_dir" "$row" "$3" -
    return
  fi
  row_text "$table_dir" "$column" "$stream" | cmp -s - "$actual" && return
  [ "$column" = - ] || IFS=+ read -r -a names <<<"$column"
  size=$(wc -c <"$actual")
  for k in "${!names[@]}"; do
    before=$(row_text "$table_dir" "$column" "$stream" 0 "$k" | wc -c)
    after=$(row_text "$table_dir" "$column" "$stream" $((k + 1)) | wc -c)
    [ $((before + after)) -le "$size" ] || continue
    head -c "$before" "$actual" | cmp -s - <(row_text "$table_dir" "$column" "$stream" 0 "$k") ||
      continue
    tail -c "$after" "$actual" | cmp -s - <(row_text "$table_dir" "$column" "$stream" $((k + 1))) ||
      continue
    [ "$found" = -1 ] || { found=-2 && break; }
    found=$k found_before=$before found_after=$after
  done
  if [ "$found" -ge 0 ]; then
    tail -c +$((found_before + 1)) "$actual" | head -c $((size - found_before - found_after)) \
      >actual.piece
    update_expected actual.piece "$table_dir/expected/${names[found]}.$stream"
  else
    update_expected "$actual" "$table_dir/expected/$row.$stream"
    row_set "$table_dir" "$row" "$3" "$row"
  fi
}

# row_update TABLE_DIR ROW STATUS, in the working folder after the run, rewrites the row from
# what the run produced (UPDATE=1), under a lock on the table's folder.
row_update() {
  (
    flock 9
    row_fields "$1" "$2" || exit 1
    [ "$3" = "$row_status" ] || row_set "$1" "$2" 2 "$3"
    row_update_text "$1" "$2" 4 "$row_stdout" stdout
    row_update_text "$1" "$2" 5 "$row_stderr" stderr
    if [ "$row_report" != - ] && [ -f out.xml ]; then
      update_expected out.xml "$1/expected/$row_report.report.xml"
    fi
  ) 9<"$1"
}
