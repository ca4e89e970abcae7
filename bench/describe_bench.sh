#!/usr/bin/env bash
# Measures zor2describe: the time to describe a generated framework of 100 headers of a few
# hundred lines each, all including <string> and <vector> (target: at most 10 s on the 2-core
# machine), and a real library installed from a Debian package, described and then checked
# against itself with zor2check (target: no finding). Prints the figures and PASS or MISS per
# target; exits non-zero only when something failed to run.
#
# Settings, from the environment:
#   BENCH_RUNS=3            runs of the generated framework (the median time is kept)
#   BENCH_HEADERS=100       headers of the generated framework
#   BENCH_LIBRARY=/usr/include/gtest   headers of the real library (a -dev package's folder)
#   BENCH_LIBRARY_INCLUDE=/usr/include  its include directory
#   BENCH_KEEP=1            keep the generated headers and documents under bench/work/describe
set -euo pipefail
cd "$(dirname "$0")/.."

runs=${BENCH_RUNS:-3}
count=${BENCH_HEADERS:-100}
library=${BENCH_LIBRARY:-/usr/include/gtest}
library_include=${BENCH_LIBRARY_INCLUDE:-/usr/include}
build=build-bench
work=bench/work/describe
status=0

log() { echo "describe-bench: $*" >&2; }

bash scripts/setup.sh
cmake -S . -B "$build" -DCMAKE_BUILD_TYPE=Release -DBUILD_TESTING=OFF >/dev/null
cmake --build "$build" -j 2 --target zor2describe zor2check >/dev/null
describe=$build/zor2describe
check=$build/zor2check
rm -rf "$work"
mkdir -p "$work/headers"

# calc FORMAT EXPRESSION: the value of an awk expression, printed with FORMAT.
calc() { awk "BEGIN { printf \"$1\", $2 }"; }

# median VALUES...: the median, with 3 decimals.
median() {
  printf '%s\n' "$@" | sort -g |
    awk '{ v[NR] = $1 } END { printf "%.3f", NR % 2 ? v[(NR + 1) / 2] : (v[NR / 2] + v[NR / 2 + 1]) / 2 }'
}

# seconds COMMAND...: runs the command and prints its wall time in seconds.
seconds() {
  local start end
  start=$(date +%s%N)
  "$@"
  end=$(date +%s%N)
  calc %.3f "($end - $start) / 1e9"
}

# counts DOCUMENT: "files classes methods" of an interface description document.
counts() {
  echo "$(grep -c '<File ' "$1" || true) $(grep -c '<Class ' "$1" || true)" \
    "$(grep -c '<Method ' "$1" || true)"
}

# --- A generated framework -------------------------------------------------------------------

# header N: a header of five classes (one a template), about 300 lines with comments, default
# arguments, overloads, const twins and free functions.
header() {
  local n=$1
  awk -v n="$n" 'BEGIN {
    printf "// Generated header %d of the describe benchmark.\n// @ZOR2Level L1\n// @ZOR2Usage U1\n", n
    printf "#pragma once\n#include <string>\n#include <vector>\n\nnamespace bench%d {\n\n", n % 7
    for (c = 0; c < 5; c++) {
      name = sprintf("Item%d_%d", n, c)
      if (c == 4) printf "template <typename T>\n"
      printf "/// Class %s.\n/// @ZOR2Aut\nclass %s {\n public:\n", name, name
      printf "  %s();\n  explicit %s(const std::string& iName, int iSize = 16);\n", name, name
      printf "  virtual ~%s();\n\n", name
      for (m = 0; m < 12; m++) {
        printf "  /// Gets value %d.\n  /// @ZOR2Property R\n", m
        printf "  std::vector<std::string> Get%d(int iIndex, const std::string& iKey = \"k%d\") const;\n", m, m
        printf "  // Sets value %d.\n", m
        printf "  virtual void Set%d(const std::vector<double>& iValues, double iScale = 1.0 / %d);\n", m, m + 1
      }
      printf "  %s* Parent();\n  const %s* Parent() const;\n", name, name
      printf "  static long Count(unsigned long long iMask, ...);\n"
      printf "  bool operator==(const %s& iOther) const;\n", name
      printf "\n protected:\n  virtual int Compute(std::string& oText) const = 0;\n"
      printf "\n private:\n  std::vector<std::string> names_;\n  int size_ = 0;\n};\n\n"
    }
    for (f = 0; f < 6; f++) {
      printf "/// Free function %d.\nstd::string Describe%d_%d(const Item%d_0& iItem, int iDepth = %d);\n\n", f, n, f, n, f
    }
    printf "}  // namespace bench%d\n", n % 7
  }'
}

log "generating $count headers"
for ((i = 0; i < count; i++)); do
  header "$i" >"$work/headers/item_$(printf '%03d' "$i").h"
done
lines=$(cat "$work"/headers/*.h | wc -l)

log "describing them, $runs times"
times=()
for ((i = 0; i < runs; i++)); do
  if ! t=$(seconds "$describe" -framework Bench -public "$work/headers" -o "$work/bench.xml"); then
    log "zor2describe failed on the generated headers"
    status=1
    break
  fi
  times+=("$t")
done
if [ ${#times[@]} -eq "$runs" ]; then
  generated_time=$(median "${times[@]}")
  read -r files classes methods <<<"$(counts "$work/bench.xml")"
  generated_line=$(printf '%-28s %6s %7s %8s %8s %8.3f  %s' "generated, $count headers" \
    "$lines" "$files" "$classes" "$methods" "$generated_time" \
    "$(awk -v t="$generated_time" 'BEGIN { print (t <= 10) ? "PASS" : "MISS" }')")
else
  generated_line="generated, $count headers: failed to run"
fi

# --- The same with one header that leaves a brace open ------------------------------------------

log "describing them with one header that leaves a brace open, $runs times"
printf 'namespace broken {\nclass Open {\n public:\n  void F();\n' >"$work/headers/item_000b.h"
broken_times=()
for ((i = 0; i < runs; i++)); do
  t=$(seconds "$describe" -framework Bench -public "$work/headers" -o "$work/broken.xml" \
    2>/dev/null || true)
  broken_times+=("$t")
done
rm "$work/headers/item_000b.h"
broken_time=$(median "${broken_times[@]}")
ratio=$(awk -v b="$broken_time" -v t="${generated_time:-0}" \
  'BEGIN { if (t > 0) printf "%.2f", b / t; else printf "?" }')
verdict=$(awk -v b="$broken_time" -v t="${generated_time:-0}" \
  'BEGIN { print (t > 0 && b <= 2 * t) ? "PASS" : "MISS" }')
broken_line=$(printf '%-28s %6s %7s %8s %8s %8.3f  %s (x%s)' "one of them broken" "" "" "" "" \
  "$broken_time" "$verdict" "$ratio")

# --- A real library --------------------------------------------------------------------------

library_line="real library $library: not installed"
if [ -d "$library" ]; then
  log "describing $library"
  if ! library_time=$(seconds "$describe" -framework Library -public "$library" \
    -I "$library_include" -o "$work/library.xml"); then
    log "zor2describe failed on $library"
    status=1
    library_line="real library $library: failed to describe"
  else
    read -r files classes methods <<<"$(counts "$work/library.xml")"
    lines=$(find "$library" -type f \( -name '*.h' -o -name '*.hpp' \) -exec cat {} + | wc -l)
    "$check" -r "$work/library.xml" -c "$work/library.xml" -o "$work/library-report.xml" \
      -level M4R20 >/dev/null 2>&1 || true
    findings=$(grep -c '<Error ' "$work/library-report.xml" || true)
    library_line=$(printf '%-28s %6s %7s %8s %8s %8.3f  %s (%s findings)' "$library" "$lines" \
      "$files" "$classes" "$methods" "$library_time" \
      "$([ "$findings" = 0 ] && echo PASS || echo MISS)" "$findings")
  fi
fi

echo
echo "zor2describe (median of $runs runs for the generated framework; target: at most 10 s, and"
echo "at most twice that with one broken header; the real library checked against itself: target"
echo "no finding)"
printf '%-28s %6s %7s %8s %8s %8s\n' input lines files classes methods time,s
echo "$generated_line"
echo "$broken_line"
echo "$library_line"
[ "${BENCH_KEEP:-0}" = 1 ] || rm -rf "$work"
exit "$status"
