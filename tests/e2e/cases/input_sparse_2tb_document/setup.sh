# A document of 2 TB that takes no room on disk.
truncate -s 2T big.xml 2>/dev/null ||
  { echo "SKIPPED: this file system holds no sparse file of 2 TB"; exit 77; }
