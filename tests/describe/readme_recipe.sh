#!/usr/bin/env bash
# Runs the README's "From headers" recipe exactly as written there (its first sh block), with the
# programs and outputs of this build, on the example SDK; then the same description tuned by hand
# (-I, -default-level, -default-usage). Both must find the changes listed in
# readme_recipe.expected, one "CODE place" per line, and nothing else.
#   readme_recipe.sh ZOR2DESCRIBE ZOR2CHECK
set -u
describe_bin=$(realpath "$1")
check_bin=$(realpath "$2")
root=$(cd "$(dirname "$0")/../.." && pwd)
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
cd "$root" || exit 1

recipe=$(awk '/^## From headers/ { on = 1 } on && /^```sh/ { inside = 1; next }
              inside && /^```/ { exit } inside { print }' README.md)
if [ -z "$recipe" ]; then
  echo "--- no sh block in the README's From headers section"
  exit 1
fi
recipe=${recipe//build\/zor2describe/@DESCRIBE@}
recipe=${recipe//build\/zor2check/@CHECK@}
recipe=${recipe//build\//$work/}
recipe=${recipe//@DESCRIBE@/$describe_bin}
recipe=${recipe//@CHECK@/$check_bin}
if ! (eval "$recipe") >"$work/recipe.log" 2>&1; then
  echo "--- the recipe failed:"
  cat "$work/recipe.log"
  exit 1
fi

# findings REPORT: one "CODE chain of names" line per finding, sorted.
findings() {
  python3 - "$1" <<'PY' | sort
import sys, xml.etree.ElementTree as ET
root = ET.fromstring(open(sys.argv[1], encoding="utf-8").read().replace("@ZOR2", "ZOR2"))
def walk(element, path):
    for child in element:
        if child.tag == "Error":
            print(child.get("ID"), " / ".join(path))
        else:
            walk(child, path + [child.get("Signature") or child.get("Name")])
walk(root, [])
PY
}

tuned=$work/tuned
mkdir "$tuned"
for release in 1 2; do
  include=examples/sdk/release-$release/include
  "$describe_bin" -framework Geometry -public "$include" -I "$include" -default-level L1 \
    -default-usage U5 -o "$tuned/$release.xml" || exit 1
done
"$check_bin" -r "$tuned/1.xml" -c "$tuned/2.xml" -o "$tuned/report.xml" -L -level M4R20 >/dev/null

failed=0
expected=$root/tests/describe/readme_recipe.expected
report=$(ls "$work"/*report*.xml 2>/dev/null | head -n 1)
if ! diff -u "$expected" <(findings "$report"); then
  echo "--- the README's recipe found other changes than expected"
  failed=1
fi
if ! diff -u "$expected" <(findings "$tuned/report.xml"); then
  echo "--- the tuned description found other changes than expected"
  failed=1
fi
exit $failed
