mkfifo help.htm
