# The run is held at the rename of its report and sent SIGTERM.
bash "$E2E_DIR/interrupt_at_rename.sh" TERM "$@"
