# The help page is left as it was and no temporary file is left beside it.
[ "$(cat help.htm)" = "old page" ] &&
  [ "$(LC_ALL=C ls -A | grep -v '^expected\.\|^actual\.\|\.sh$\|^args$' | tr '\n' ' ')" = \
    "chk.xml help.htm out.xml ref.xml " ]
