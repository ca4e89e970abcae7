# Used by the run.sh of the interruption cases: bash interrupt_at_rename.sh SIGNAL COMMAND...
# The run is held at the rename of its report and sent SIGNAL. A background command ignores
# SIGINT unless told otherwise; a sanitizer runtime accepts a library preloaded before it.
signal=$1
shift
(
  trap - INT
  export ZOR2_TEST_STOP_AT_RENAME=renaming LD_PRELOAD=$PWD/interpose.so \
    ASAN_OPTIONS=verify_asan_link_order=0
  exec "$@"
) &
run=$!
for _ in $(seq 400); do
  [ -d renaming ] && break
  sleep 0.05
done
kill "-$signal" $run
wait $run
