cmp -s options.txt options.kept  # the argument file is left as it was
