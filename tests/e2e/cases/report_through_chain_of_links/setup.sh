# out.xml -> links/a.xml -> ../data/target.xml, both links relative.
mkdir links data
echo "old report" > data/target.xml
ln -s ../data/target.xml links/a.xml
ln -s links/a.xml out.xml
