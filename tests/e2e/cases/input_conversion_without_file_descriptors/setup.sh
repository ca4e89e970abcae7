# The run is brought to its descriptor limit at the moment it sets up the
# conversion of the checked document, by a preloaded library.
cc -shared -fPIC -o interpose.so "$E2E_DIR/interpose.c" -ldl -lpthread 2>/dev/null ||
  { echo "SKIPPED: no C compiler for the preloaded library"; exit 77; }
