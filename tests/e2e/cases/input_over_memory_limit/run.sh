# AddressSanitizer reserves terabytes of address space: no limit can be set.
if grep -q __asan_init "$ZOR2CHECK"; then
  echo "SKIPPED: no address-space limit under AddressSanitizer"
  exit 77
fi
ulimit -v 716800
"$@"
