ln -s chk.xml link.htm
cp chk.xml chk.before
