# Three runs, each naming one output that does not exist yet in two ways: an
# absolute and a relative path, and a path through a link to the current
# directory. The absolute paths of the messages are shown as $PWD.
ln -s . here
for outputs in "-o $PWD/out.md -export out.md" "-o here/r.md -export r.md" \
  "-o out.xml -htm $PWD/h.html -export h.html"; do
  # shellcheck disable=SC2086
  "$@" $outputs 2> err
  echo "status $?"
  sed "s|$PWD|\$PWD|g" err | head -n 1 >&2
done
