echo "old report" > target.xml
ln -s target.xml out.xml
