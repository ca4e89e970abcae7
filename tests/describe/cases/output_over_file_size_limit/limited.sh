# Past the file size limit the document cannot be written: an ERROR line, status 2, and no
# temporary file left behind.
ulimit -f 0
"$ZOR2DESCRIBE" -framework F -public pub -o out.xml
status=$?
ls -A | grep -q '^\.zor2describe\.' && echo "a temporary file was left behind"
[ -e out.xml ] && echo "out.xml was written"
exit $status
