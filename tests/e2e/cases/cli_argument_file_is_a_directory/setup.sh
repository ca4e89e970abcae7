# Git keeps no empty directory: make it here.
mkdir -p options
