# Needs root: the report's link points into a small file system, mounted here
# and filled up (check.sh unmounts it).
[ "$(id -u)" -eq 0 ] || { echo "SKIPPED: mounting a file system needs root"; exit 77; }
mkdir fs
mount -t tmpfs -o size=64k tmpfs fs 2>/dev/null ||
  { rmdir fs; echo "SKIPPED: cannot mount a tmpfs here"; exit 77; }
echo "old report" > fs/target.xml
dd if=/dev/zero of=fs/filler bs=4k 2>/dev/null
ln -s fs/target.xml out.xml
