# A sanitizer runtime accepts a library preloaded before it. A run that hangs
# is stopped after a while (status 124).
ZOR2_TEST_FIFO_AT_OPEN=chk/a.xml LD_PRELOAD=$PWD/interpose.so \
  ASAN_OPTIONS=verify_asan_link_order=0 timeout 20 "$@"
