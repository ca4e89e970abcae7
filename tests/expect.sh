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

# With UPDATE=1, update_expected ACTUAL EXPECTED writes the bytes of ACTUAL to the file that
# EXPECTED names, through its links: cases share an expected file by linking to it, and the shared
# file is what changes. It is replaced whole, under a lock on its folder and only when it differs,
# so that cases run at once that share it write it once.
update_expected() {
  local actual=$1 target
  target=$(realpath -m "$2") || return 1
  (
    flock 9
    cmp -s "$actual" "$target" && exit 0
    echo "--- updated $target"
    cp "$actual" "$target.updating" && mv -f "$target.updating" "$target"
  ) 9<"$(dirname "$target")"
}
