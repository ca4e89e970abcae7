# The sanitizers' own checks need file descriptors (UndefinedBehaviorSanitizer
# opens a pipe to test memory), so the case cannot be arranged under them.
if grep -q __ubsan_handle "$ZOR2CHECK"; then
  echo "SKIPPED: a run without file descriptors cannot be checked by the sanitizers"
  exit 77
fi
ZOR2_TEST_NO_FD_FOR_ICONV=1 LD_PRELOAD=$PWD/interpose.so "$@"
