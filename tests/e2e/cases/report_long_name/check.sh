# The report has a name of 250 bytes, near the limit of 255: written whole,
# and nothing else is left beside it.
name=$(sed -n 6p args)
cmp report.expected "$name" &&
  [ "$(LC_ALL=C ls -A | grep -v '^expected\.\|^actual\.\|^args$\|^check\.sh$' | tr '\n' ' ')" = \
    "chk.xml ref.xml report.expected $name " ]
