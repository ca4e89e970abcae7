cp chk/Geometry.xml Geometry.before
