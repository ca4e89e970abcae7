# The link and its target are left as they were, and no temporary file is
# left beside them.
[ -L out.xml ] && [ "$(cat target.xml)" = "old report" ] &&
  [ "$(LC_ALL=C ls -A | grep -v '^expected\.\|^actual\.\|\.sh$\|^args$' | tr '\n' ' ')" = \
    "chk out.xml ref target.xml " ]
