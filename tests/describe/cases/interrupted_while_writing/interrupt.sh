# SIGINT and SIGTERM while the document is being written remove its temporary file, keep the
# document that was there, and end the program by the signal.
cc -shared -fPIC -o interpose.so "$E2E_DIR/interpose.c" -ldl || exit 1
cp "$E2E_DIR/interrupt_at_rename.sh" .
for signal in INT TERM; do
  echo kept > out.xml
  bash interrupt_at_rename.sh "$signal" "$ZOR2DESCRIBE" -framework F -public pub -o out.xml
  echo "$signal: status $?"
  rmdir renaming
  ls -A | grep '^\.zor2describe\.' && echo "a temporary file was left behind"
  cat out.xml
done
exit 0
