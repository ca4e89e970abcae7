# Names that hold a line feed and a tab cannot be written in args: run.sh
# passes them.
printf '<?xml version="1.0" encoding="UTF-8"?>\n<Workspace>\n' > "$(printf 'bad\nref.xml')"
