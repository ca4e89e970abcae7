# The link's target does not exist yet: writing through the link creates it.
ln -s target.xml out.xml
