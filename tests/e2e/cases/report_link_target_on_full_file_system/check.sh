# The link and its target are left as they were, and no temporary file is
# left beside the target.
[ -L out.xml ] && [ "$(cat fs/target.xml)" = "old report" ] &&
  [ "$(LC_ALL=C ls -A fs | tr '\n' ' ')" = "filler target.xml " ]
kept=$?
umount fs
exit $kept
