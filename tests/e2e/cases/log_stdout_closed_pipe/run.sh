# Standard output is a pipe whose reader has gone: a named pipe opened for
# writing while a reader held it, which then closes.
mkfifo pipe
exec 4<> pipe 5> pipe 4<&-
"$@" >&5
