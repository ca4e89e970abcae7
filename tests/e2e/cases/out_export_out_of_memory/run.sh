# No allocation of more than 1 MB succeeds: the documents, the report and the
# findings fit, an export that holds the long signature twenty times does not.
if grep -q __asan_init "$ZOR2CHECK"; then
  echo "SKIPPED: the sanitizers replace the allocation functions themselves"
  exit 77
fi
ZOR2_TEST_NO_MEMORY_ABOVE=1000000 LD_PRELOAD=$PWD/memory_limit.so "$@"
