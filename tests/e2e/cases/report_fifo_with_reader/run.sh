# The report is a named pipe whose reader starts reading only after a second,
# so that the run's writes wait for it. The pipe is held open here until the
# run ends, so that the reader sees its end only then; the reader gives up
# after a while, should the run never end.
mkfifo out.xml
exec 3<> out.xml
{ sleep 1; exec timeout 30 cat; } < out.xml > got.xml 3>&- &
reader=$!
timeout 20 "$@" 3>&-
status=$?
exec 3>&-
wait "$reader"
exit "$status"
