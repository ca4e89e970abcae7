# A checked document of 690 MB (sparse: zeros) for a run limited to 700 MB of
# address space.
truncate -s 690M chk.xml 2>/dev/null ||
  { echo "SKIPPED: this file system holds no sparse file of 690 MB"; exit 77; }
