# An argument file that is a named pipe, or a device that never ends, is refused at once: the
# program never waits for a writer nor reads without end.
mkfifo arguments.fifo
timeout 10 bash -c 'exec -a zor2describe "$0" = arguments.fifo' "$ZOR2DESCRIBE"
echo "status $?"
timeout 10 bash -c 'exec -a zor2describe "$0" = /dev/zero' "$ZOR2DESCRIBE"
echo "status $?"
