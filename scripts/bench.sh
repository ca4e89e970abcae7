#!/usr/bin/env bash
# Measures zor2check on generated workspaces: for a pair of about 100 MB per side in each layout,
# its wall time against the floor (pugixml parsing the same inputs on one thread), as paired runs
# that alternate the two so that a drift of the machine's speed touches both alike (the median of
# the ratios is kept), its throughput and its peak memory against the size of the inputs; then
# how its time grows with the size of a class, a file, a group and a workspace; and whether each
# report is the one stored for its input. Prints PASS or MISS per target; exits non-zero only
# when something failed to run.
#
# Settings, from the environment:
#   BENCH_MB=100          size per side of the main pairs (the workspace growth run uses a quarter)
#   BENCH_RUNS=5          runs per measure, or pairs of runs against the floor (medians kept)
#   BENCH_N=10000         n of the growth runs (each is measured at n and 4n)
#   BENCH_SEED=1          seed of the generator
#   BENCH_UPDATE_DIGESTS=1  store this run's report digests in bench/expected-digests.txt
#   BENCH_KEEP=1          keep the generated workspaces under bench/work/
set -euo pipefail
cd "$(dirname "$0")/.."

mb=${BENCH_MB:-100}
runs=${BENCH_RUNS:-5}
n=${BENCH_N:-10000}
seed=${BENCH_SEED:-1}
build="build-bench"
work=bench/work
digests=bench/expected-digests.txt
status=0

log() { echo "bench: $*" >&2; }

# --- Setup and build -------------------------------------------------------------------------

bash scripts/setup.sh
missing=()
for p in libpugixml-dev time; do
  dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed" || missing+=("$p")
done
if [ ${#missing[@]} -gt 0 ]; then
  if [ "$(id -u)" -ne 0 ]; then
    log "missing packages: ${missing[*]}; run this script as root to install them"
    exit 1
  fi
  export DEBIAN_FRONTEND=noninteractive
  apt-get update -qq
  apt-get install -y -qq --no-install-recommends "${missing[@]}"
fi

cmake -S . -B "$build" -DCMAKE_BUILD_TYPE=Release -DZOR2_BENCH=ON -DBUILD_TESTING=OFF >/dev/null
cmake --build "$build" -j "$(nproc)" --target zor2check generate_workspace pugixml_yardstick \
  >/dev/null
zor2check=$build/zor2check
generate=$build/bench/generate_workspace
yardstick=$build/bench/pugixml_yardstick
mkdir -p "$work"

# --- Helpers ---------------------------------------------------------------------------------

# calc FORMAT EXPRESSION: the value of an awk expression, printed with FORMAT.
calc() { awk "BEGIN { printf \"$1\", $2 }"; }

# verdict VALUE OP LIMIT: PASS when VALUE OP LIMIT holds (OP is <= or <), else MISS.
verdict() { awk -v v="$1" -v l="$3" "BEGIN { print (v $2 l) ? \"PASS\" : \"MISS\" }"; }

# median VALUES...: the median, with 4 decimals.
median() {
  printf '%s\n' "$@" | sort -g |
    awk '{ v[NR] = $1 } END { printf "%.4f", NR % 2 ? v[(NR + 1) / 2] : (v[NR / 2] + v[NR / 2 + 1]) / 2 }'
}

# generate NAME OPTIONS...: a fresh pair in $work/NAME/ref and $work/NAME/chk.
generate() {
  local name=$1
  shift
  rm -rf "${work:?}/$name"
  mkdir -p "$work/$name"
  log "generating $name"
  "$generate" --reference "$work/$name/ref" --checked "$work/$name/chk" --seed "$seed" "$@" \
    >"$work/$name/generated.txt"
}

# inputs NAME: the reference and checked paths of a pair (documents, or directories of them).
inputs() {
  if [ -f "$work/$1/ref/Workspace.xml" ]; then
    echo "$work/$1/ref/Workspace.xml $work/$1/chk/Workspace.xml"
  else
    echo "$work/$1/ref $work/$1/chk"
  fi
}

# measure NAME [floor]: runs zor2check $runs times on the pair NAME and sets seconds (median wall
# time), peak_kb (largest peak resident set), ref_bytes and bytes (reference side, both sides) and
# report_bytes, then checks the digest of the report. With "floor", runs the yardstick after each
# run of zor2check, and sets yard_seconds (median of the yardstick's own times) and ratio (the
# median of the ratios of each pair of runs).
measure() {
  local name=$1 floor=${2:-} dir=$work/$1 times=() yards=() ratios=() start end kb out t
  local ref chk
  read -r ref chk <<<"$(inputs "$name")"
  peak_kb=0
  log "running zor2check${floor:+ and the yardstick in turn} on $name, $runs times"
  for ((i = 0; i < runs; i++)); do
    start=$(date +%s%N)
    if ! /usr/bin/time -f %M -o "$dir/time.txt" "$zor2check" -r "$ref" -c "$chk" \
      -o "$dir/report.xml" -L -level M4R20 >"$dir/stdout.txt" 2>"$dir/stderr.txt"; then
      log "zor2check failed on $name (see $dir/stderr.txt)"
      status=1
      seconds=failed yard_seconds=failed peak_kb=0 report_bytes=0
      return 0
    fi
    end=$(date +%s%N)
    t=$(calc %.4f "$((end - start)) / 1e9")
    times+=("$t")
    kb=$(tail -n 1 "$dir/time.txt")
    ((kb > peak_kb)) && peak_kb=$kb
    [ -n "$floor" ] || continue
    if ! out=$("$yardstick" "$ref" "$chk"); then
      log "the yardstick failed on $name"
      status=1
      yard_seconds=failed
      return 0
    fi
    yards+=("${out%% *}")
    ratios+=("$(calc %.4f "$t / ${out%% *}")")
  done
  seconds=$(median "${times[@]}")
  if [ -n "$floor" ]; then
    yard_seconds=$(median "${yards[@]}")
    ratio=$(median "${ratios[@]}")
  fi
  ref_bytes=$(du -bc "$ref" | tail -n 1 | cut -f 1)
  bytes=$(du -bc "$ref" "$chk" | tail -n 1 | cut -f 1)
  report_bytes=$(stat -c %s "$dir/report.xml")
  digest=$(sha256sum "$dir/report.xml" | cut -d ' ' -f 1)
  check_digest "$name" "$digest"
}

# check_digest KEY DIGEST: compares a report's digest with the stored one (or stores it).
digest_lines=()
check_digest() {
  local key=$1 digest=$2 stored result
  stored=$(awk -v k="$key" '$1 == k { print $2 }' "$digests" 2>/dev/null || true)
  if [ "${BENCH_UPDATE_DIGESTS:-0}" = 1 ]; then
    { grep -v "^$key " "$digests" 2>/dev/null || true; echo "$key $digest"; } >"$digests.new"
    mv "$digests.new" "$digests"
    result="stored"
  elif [ -z "$stored" ]; then
    result="no stored digest ($digest)"
  elif [ "$stored" = "$digest" ]; then
    result="PASS"
  else
    result="MISS: differs from the stored digest ($digest)"
  fi
  digest_lines+=("$(printf '%-24s %s' "$key" "$result")")
}

# done_with NAME: removes the generated inputs of a pair unless BENCH_KEEP is set.
done_with() {
  [ "${BENCH_KEEP:-0}" = 1 ] || rm -rf "${work:?}/$1/ref" "${work:?}/$1/chk"
}

# add_row LAYOUT: a line of the main table, from the last measure and yardstick.
add_row() {
  if [ "$seconds" = failed ] || [ "$yard_seconds" = failed ]; then
    rows+=("$(printf '%-10s failed to run' "$1")")
    return
  fi
  local peak_ratio peak_target=-
  peak_ratio=$(calc %.2f "$peak_kb * 1024 / $bytes")
  # One document per side must be held in less memory than its text; a directory's pairs are
  # held one after the other (see below).
  [ "$1" = single ] && peak_target=$(verdict "$peak_ratio" '<=' 1.0)
  rows+=("$(printf '%-10s %7.1f %8.3f %7.1f %8.0f %6.2f %-4s %8.3f %6.2f %-4s' "$1" \
    "$(calc %.1f "$ref_bytes / 1048576")" "$seconds" "$(calc %.1f "$bytes / 1048576 / $seconds")" \
    "$(calc %.0f "$peak_kb / 1024")" "$peak_ratio" "$peak_target" \
    "$yard_seconds" "$(calc %.2f "$ratio")" "$(verdict "$ratio" '<=' 0.7)")")
}

# add_growth LABEL SMALL_SECONDS LARGE_SECONDS: a line of the growth table.
add_growth() {
  if [ "$2" = failed ] || [ "$3" = failed ]; then
    growth+=("$(printf '%-34s failed to run' "$1")")
    return
  fi
  local factor
  factor=$(calc %.2f "$3 / $2")
  growth+=("$(printf '%-34s %8.3f %8.3f %6.2f  %s' "$1" "$2" "$3" "$factor" \
    "$(verdict "$factor" '<=' 4.5)")")
}

# --- The main pairs --------------------------------------------------------------------------

rows=()
declare -A time_of peak_of report_of
quarter=$(calc %g "$mb / 4")
for layout in single directory; do
  for size in "$mb" "$quarter"; do
    name=$layout-${size}MB-s$seed
    generate "$name" --layout "$layout" --size "$size"
    if [ "$size" = "$mb" ]; then
      measure "$name" floor
      changes=$(grep '^changes:' "$work/$name/generated.txt")
      add_row "$layout"
    else
      measure "$name"
    fi
    time_of[$layout-$size]=$seconds
    peak_of[$layout-$size]=$peak_kb
    report_of[$layout-$size]=$report_bytes
    done_with "$name"
  done
done

# --- Growth ----------------------------------------------------------------------------------

growth=()
for shape in class file group overloads; do
  for count in "$n" $((4 * n)); do
    name=$shape-$count-s$seed
    generate "$name" --shape "$shape" --count "$count"
    measure "$name"
    time_of[$shape-$count]=$seconds
    done_with "$name"
  done
done

add_growth "one class of n methods" "${time_of[class-$n]}" "${time_of[class-$((4 * n))]}"
add_growth "one file of n classes" "${time_of[file-$n]}" "${time_of[file-$((4 * n))]}"
add_growth "one group of n files" "${time_of[group-$n]}" "${time_of[group-$((4 * n))]}"
add_growth "one class of n overloads of a name" "${time_of[overloads-$n]}" \
  "${time_of[overloads-$((4 * n))]}"
for layout in single directory; do
  add_growth "workspace, $layout, ${quarter} -> ${mb} MB" \
    "${time_of[$layout-$quarter]}" "${time_of[$layout-$mb]}"
done

# --- Report ----------------------------------------------------------------------------------

echo
echo "zor2check -L -level M4R20 on generated workspaces (seed $seed, median of $runs runs)"
echo "targets: time <= 0.7 x yardstick (median of $runs paired runs); one document per side:"
echo "peak <= 1.0 x both inputs"
echo
printf '%-10s %7s %8s %7s %8s %6s %-4s %8s %6s %-4s\n' layout MB/side time,s MB/s peak,MB \
  peak/in mem yard,s ratio time
printf '%s\n' "${rows[@]}"
echo "MB = 2^20 bytes; MB/s and peak/in count both inputs; yard = pugixml parsing both inputs in"
echo "place on one thread and touching every attribute value (reading the files not timed);"
echo "ratio = median of time / yard over the pairs of runs"
echo "changes on the checked side: ${changes#changes: }"
echo
echo "growth of the time from n to 4n (n = $n; target: factor <= 4.5)"
printf '%-34s %8s %8s %6s\n' run "n,s" "4n,s" factor
printf '%s\n' "${growth[@]}"
# In directory mode the pairs are compared one after the other: the peak may grow with the report
# (allowed 5 bytes per byte of report file, for the tree's overhead) but not with the pairs.
small=directory-$quarter large=directory-$mb
if [ "${time_of[$small]}" != failed ] && [ "${time_of[$large]}" != failed ]; then
  peak_growth=$(calc %.1f "(${peak_of[$large]} - ${peak_of[$small]}) / 1024")
  report_growth=$(calc %.1f "(${report_of[$large]} - ${report_of[$small]}) / 1048576")
  echo "directory mode, $quarter -> $mb MB per side: peak $(calc %.0f "${peak_of[$small]} / 1024")" \
    "-> $(calc %.0f "${peak_of[$large]} / 1024") MB, +$peak_growth MB for +$report_growth MB of" \
    "report (target: at most 5 x that + 16 MB)" \
    "$(verdict "$peak_growth" '<=' "$(calc %.1f "5 * $report_growth + 16")")"
fi
echo
echo "report digests ($digests)"
printf '%s\n' "${digest_lines[@]}"
exit "$status"
