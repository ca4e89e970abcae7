# Nothing is written.
[ ! -e same.xml ]
