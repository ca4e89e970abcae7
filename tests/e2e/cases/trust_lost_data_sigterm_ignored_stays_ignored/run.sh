# The run starts with SIGTERM ignored, as nohup and a shell's background jobs
# start it. Held at the rename of its report, it is sent SIGTERM, which it
# must go on ignoring, then SIGINT, which ends it.
(
  trap - INT
  trap '' TERM
  export ZOR2_TEST_STOP_AT_RENAME=renaming LD_PRELOAD=$PWD/interpose.so \
    ASAN_OPTIONS=verify_asan_link_order=0
  exec "$@"
) &
run=$!
for _ in $(seq 400); do
  [ -d renaming ] && break
  sleep 0.05
done
kill -TERM $run
sleep 0.5
kill -0 $run 2> /dev/null && echo "still running after SIGTERM"
kill -INT $run
wait $run
