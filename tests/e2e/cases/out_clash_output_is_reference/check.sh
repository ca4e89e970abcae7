# The reference document is left as it was.
cmp ref.xml ref.before
