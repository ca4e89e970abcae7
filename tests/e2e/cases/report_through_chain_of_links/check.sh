# The report replaced the file at the end of the chain, whose links stay,
# and nothing else is left beside it.
[ -L out.xml ] && [ -L links/a.xml ] && cmp -s expected.report.xml data/target.xml &&
  [ "$(LC_ALL=C ls -A data | tr '\n' ' ')" = "target.xml " ]
