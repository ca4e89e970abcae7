# The run starts with SIGTERM ignored. Held at the rename of its report, it is
# sent SIGTERM, which it must go on ignoring, then SIGINT, which ends it.
bash "$E2E_DIR/interrupt_at_rename.sh" --ignored TERM TERM,INT "$@"
