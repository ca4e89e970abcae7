# The same header under a second name, through a link.
ln -s linked.h pub/other_name.h
exec -a zor2describe "$ZOR2DESCRIBE" -framework F -public pub -o out.xml
