# Under a limit of 1 GB of address space, which a list of every overload for
# each deleted method overflows many times. The sanitizers' runtime reserves
# terabytes of address space, so the case cannot be arranged under them.
if grep -q __asan_init "$ZOR2CHECK"; then
  echo "SKIPPED: the sanitizers cannot run under an address space limit"
  exit 77
fi
ulimit -v 1000000
timeout 120 "$@"
