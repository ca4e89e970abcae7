# A named pipe that no one writes to: reading it would wait for ever.
mkfifo ref.xml
