# Shared by the end-to-end runners: expect EXPECTED ACTUAL compares the file ACTUAL with the file
# EXPECTED byte for byte, shows the difference, and sets failed=1 when they differ or ACTUAL was
# not written.
failed=0
expect() {
  local expected=$1 actual=$2
  if [ ! -e "$actual" ]; then
    echo "--- $actual was not written"
    failed=1
  elif ! cmp -s "$expected" "$actual"; then
    echo "--- $actual differs from $expected:"
    diff -u "$expected" "$actual" | head -n 80
    failed=1
  fi
}
