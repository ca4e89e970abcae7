# Files of the run may not grow past 2 KB: the help page (4 KB) cannot be
# written, the report and the log lines can.
ulimit -f 2
"$@"
