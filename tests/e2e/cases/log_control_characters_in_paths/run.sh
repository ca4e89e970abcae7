# The paths of a control character: a line feed in the reference document's
# name (not well-formed), a tab in the report's directory (missing).
"$@" -r "$(printf 'bad\nref.xml')" -c chk.xml -o "$(printf 'no\tdir/out.xml')"
