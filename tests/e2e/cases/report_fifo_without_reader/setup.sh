mkfifo out.xml
