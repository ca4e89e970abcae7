# Nothing was written.
[ ! -e out.md ] && [ ! -e r.md ] && [ ! -e h.html ] && [ ! -e out.xml ]
