# Used by the run.sh of the interruption cases:
#   bash interrupt_at_rename.sh [--ignored SIGNAL] SIGNAL[,SIGNAL...] COMMAND...
# The run is held at the rename of its report and sent each SIGNAL in turn;
# after each but the last, "still running after SIGNAL" is said when it is.
# With --ignored, the run starts with that signal ignored, as nohup and a
# shell's background jobs start it. A background command ignores SIGINT
# unless told otherwise; a sanitizer runtime accepts a library preloaded
# before it.
ignored=
if [ "$1" = --ignored ]; then
  ignored=$2
  shift 2
fi
IFS=, read -r -a signals <<< "$1"
shift
(
  trap - INT
  [ -n "$ignored" ] && trap '' "$ignored"
  export ZOR2_TEST_STOP_AT_RENAME=renaming LD_PRELOAD=$PWD/interpose.so \
    ASAN_OPTIONS=verify_asan_link_order=0
  exec "$@"
) &
run=$!
for _ in $(seq 400); do
  [ -d renaming ] && break
  sleep 0.05
done
for ((i = 0; i < ${#signals[@]}; i++)); do
  kill "-${signals[i]}" $run
  if ((i + 1 < ${#signals[@]})); then
    sleep 0.5
    kill -0 $run 2> /dev/null && echo "still running after SIG${signals[i]}"
  fi
done
wait $run
