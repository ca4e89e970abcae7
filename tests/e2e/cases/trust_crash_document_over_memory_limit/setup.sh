# A checked document of 600 MB (sparse: zeros) for a run limited to 700 MB of
# address space.
truncate -s 600M chk.xml 2>/dev/null ||
  { echo "SKIPPED: this file system holds no sparse file of 600 MB"; exit 77; }
