command -v cmark-gfm > /dev/null ||
  { echo "SKIPPED: cmark-gfm renders the export as hosting services do; it is missing"; exit 77; }
