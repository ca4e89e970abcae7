echo "old report" > out.xml
