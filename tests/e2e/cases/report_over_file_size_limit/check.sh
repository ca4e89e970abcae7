# The report is left as it was and no temporary file is left beside it.
[ "$(cat out.xml)" = "old report" ] &&
  [ "$(LC_ALL=C ls -A | grep -v '^expected\.\|^actual\.\|\.sh$\|^args$' | tr '\n' ' ')" = \
    "chk out.xml ref " ]
