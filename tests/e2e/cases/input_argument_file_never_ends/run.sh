# The argument file never ends; the run is limited to 700 MB of address space
# so that it runs out of memory soon. AddressSanitizer reserves terabytes of
# address space: no limit can be set under it.
if grep -q __asan_init "$ZOR2CHECK"; then
  echo "SKIPPED: no address-space limit under AddressSanitizer"
  exit 77
fi
ulimit -v 716800
"$@"
