# The output named through a symbolic link to a header.
ln -s pub/a.h out.xml
exec -a zor2describe "$ZOR2DESCRIBE" -framework F -public pub -o out.xml
