# Run as root, the runner starts the program as the user named in run_as, for
# whom this mode holds: the reference directory cannot be listed.
chmod 000 ref
