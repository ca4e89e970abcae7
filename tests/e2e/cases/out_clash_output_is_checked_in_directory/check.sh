# The checked document is left as it was.
cmp chk/Geometry.xml Geometry.before
