# The checked document chk/a.xml is replaced by a named pipe when the run
# opens it, after the directory was listed, by a preloaded library.
cc -shared -fPIC -o interpose.so "$E2E_DIR/interpose.c" -ldl -lpthread 2>/dev/null ||
  { echo "SKIPPED: no C compiler for the preloaded library"; exit 77; }
