mkfifo args.fifo
